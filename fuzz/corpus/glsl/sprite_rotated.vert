#version 100
// Rotated and scaled sprite drawn with an orthographic projection.
uniform mat4 u_projection;
uniform vec2 u_center;
uniform vec2 u_half_size;
uniform float u_angle;
attribute vec2 a_corner;  // -1..1
attribute vec2 a_uv;
varying vec2 v_uv;

vec2 Rotate(vec2 v, float a) {
    float c = cos(a), s = sin(a);
    return vec2(c * v.x - s * v.y, s * v.x + c * v.y);
}

void main() {
    v_uv = a_uv;
    gl_Position = u_projection * vec4(u_center + Rotate(a_corner * u_half_size, u_angle), 0.0, 1.0);
}
