#version 100
precision highp float;
// Projects the vertex into the light's view for shadow mapping.
uniform mat4 u_model;
uniform mat3 u_normal_matrix;
uniform mat4 u_view_projection;
uniform mat4 u_light_matrix;   // bias * light projection * light view
uniform vec3 u_light_direction;
attribute vec3 a_position;
attribute vec3 a_normal;
varying vec4 v_shadow_coord;
varying float v_diffuse;

void main() {
    vec4 world = u_model * vec4(a_position, 1.0);
    vec3 n = normalize(u_normal_matrix * a_normal);
    v_diffuse = max(dot(n, -u_light_direction), 0.0);
    // Offset along the normal against shadow acne.
    v_shadow_coord = u_light_matrix * (world + vec4(n * 0.02, 0.0));
    gl_Position = u_view_projection * world;
}
