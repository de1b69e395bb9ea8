// One vertex shader for every debug view of the editor preview; each mode leaves early.
precision highp float;

uniform mat4 u_mvp;
uniform mat3 u_normal_matrix;
uniform int u_mode;
uniform float u_time;

attribute vec4 a_position;
attribute vec3 a_normal;
attribute vec2 a_uv;
attribute vec4 a_color;

varying vec4 v_color;

void main() {
    gl_Position = u_mvp * a_position;
    vec3 n = normalize(u_normal_matrix * a_normal);
    if (u_mode == 0) { v_color = a_color; return; }
    if (u_mode == 1) { v_color = vec4(n * 0.5 + 0.5, 1.0); return; }
    if (u_mode == 2) { v_color = vec4(a_uv, 0.0, 1.0); return; }
    if (u_mode == 3) { v_color = vec4(fract(a_uv * 8.0), 0.0, 1.0); return; }
    if (u_mode == 4) { v_color = vec4(vec3(gl_Position.z / gl_Position.w), 1.0); return; }
    if (u_mode == 5) { v_color = vec4(a_color.aaa, 1.0); return; }
    if (u_mode == 6) { v_color = vec4(abs(n), 1.0); return; }
    if (u_mode == 7) { v_color = vec4(0.5 + 0.5 * sin(u_time + a_position.xyz), 1.0); return; }
    if (u_mode == 8) {
        gl_Position.xy += 0.01 * sin(u_time * 10.0 + a_position.yx);
        v_color = a_color;
        return;
    }
    if (u_mode == 9) { v_color = vec4(1.0, 0.0, 1.0, 1.0); return; }
    if (u_mode == 10) { v_color = vec4(a_position.xyz * 0.1 + 0.5, 1.0); return; }
    if (u_mode == 11) { v_color = vec4(vec3(max(n.y, 0.0)), 1.0); return; }
    if (u_mode == 12) { v_color = vec4(a_uv.x, a_uv.y, a_uv.x * a_uv.y, 1.0); return; }
    v_color = vec4(0.0, 0.0, 0.0, 1.0);
}
