// Camera-facing particle quads; age drives size and fade.
precision highp float;

uniform mat4 u_view;
uniform mat4 u_projection;
uniform float u_time;
uniform float u_lifetime;
uniform vec3 u_gravity;

attribute vec3 a_origin;
attribute vec3 a_velocity;
attribute float a_birth;
attribute vec2 a_corner;

varying vec2 v_uv;
varying float v_alpha;

void main() {
    float age = u_time - a_birth;
    if (age < 0.0 || age > u_lifetime) {
        // Not alive: collapse the quad outside the clip volume.
        gl_Position = vec4(2.0, 2.0, 2.0, 1.0);
        v_alpha = 0.0;
        v_uv = vec2(0.0);
        return;
    }
    float t = age / u_lifetime;
    vec3 world = a_origin + a_velocity * age + 0.5 * u_gravity * age * age;
    vec4 eye = u_view * vec4(world, 1.0);
    eye.xy += a_corner * mix(0.05, 0.4, t);
    v_uv = a_corner * 0.5 + 0.5;
    v_alpha = 1.0 - t * t;
    gl_Position = u_projection * eye;
}
