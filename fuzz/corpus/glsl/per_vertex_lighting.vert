// Gouraud lighting: one directional light, one point light, ambient term.
precision mediump float;

uniform mat4 u_model;
uniform mat4 u_view_projection;
uniform mat3 u_normal_matrix;
uniform vec3 u_sun_direction;
uniform vec3 u_sun_color;
uniform vec3 u_lamp_position;
uniform vec3 u_lamp_color;
uniform float u_lamp_radius;
uniform vec3 u_ambient;

attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec4 a_color;

varying lowp vec4 v_color;

void main() {
    vec4 world = u_model * vec4(a_position, 1.0);
    vec3 n = normalize(u_normal_matrix * a_normal);
    vec3 light = u_ambient + u_sun_color * max(dot(n, -u_sun_direction), 0.0);
    vec3 to_lamp = u_lamp_position - world.xyz;
    float distance = length(to_lamp);
    float falloff = clamp(1.0 - distance / u_lamp_radius, 0.0, 1.0);
    light += u_lamp_color * falloff * falloff * max(dot(n, to_lamp / distance), 0.0);
    v_color = vec4(a_color.rgb * light, a_color.a);
    gl_Position = u_view_projection * world;
}
