// Water and conveyor surfaces: texture coordinates scroll and rotate over time.
precision mediump float;
uniform mat4 u_mvp;
uniform float u_time;
uniform vec2 u_scroll_speed;
uniform float u_rotation_speed;
attribute vec4 a_position;
attribute vec2 a_uv;
varying vec2 v_uv;
varying vec2 v_detail_uv;
void main() {
    float angle = u_time * u_rotation_speed;
    mat2 rotation = mat2(cos(angle), sin(angle), -sin(angle), cos(angle));
    vec2 centred = a_uv - 0.5;
    v_uv = rotation * centred + 0.5 + u_scroll_speed * u_time;
    v_detail_uv = a_uv * 8.0 - u_scroll_speed.yx * (u_time * 0.5);
    gl_Position = u_mvp * a_position;
}
