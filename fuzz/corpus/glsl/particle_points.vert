/* Point sprites for sparks. */
uniform mat4 u_mvp;
uniform float u_point_scale;
attribute vec4 a_position;   // w: seed
attribute vec4 a_color;
varying vec4 v_color;

void main() {
    gl_Position = u_mvp * vec4(a_position.xyz, 1.0);
    gl_PointSize = u_point_scale * (0.5 + fract(a_position.w * 43758.5453)) / gl_Position.w;
    v_color = a_color;
}
