
uniform mat4 u_mvp;
uniform vec2 u_uv_scale;
attribute vec4 a_position;
attribute vec2 a_uv;
varying vec2 v_uv;

void main() {
    v_uv = a_uv * u_uv_scale;
    gl_Position = u_mvp * a_position;
}
