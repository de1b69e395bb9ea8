// Chrome and car paint: reflection vector for a cube map, Fresnel term per vertex.
precision mediump float;

uniform mat4 u_model;
uniform mat3 u_normal_matrix;
uniform mat4 u_view_projection;
uniform vec3 u_camera_position;

attribute vec3 a_position;
attribute vec3 a_normal;

varying vec3 v_reflection;
varying float v_fresnel;

void main() {
    vec4 world = u_model * vec4(a_position, 1.0);
    vec3 n = normalize(u_normal_matrix * a_normal);
    vec3 view = normalize(world.xyz - u_camera_position);
    v_reflection = reflect(view, n);
    float facing = 1.0 - max(dot(-view, n), 0.0);
    v_fresnel = 0.04 + 0.96 * facing * facing * facing * facing * facing;
    gl_Position = u_view_projection * world;
}
