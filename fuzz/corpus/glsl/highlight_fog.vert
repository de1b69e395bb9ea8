// Blinn-Phong specular with linear distance fog, computed per vertex.
#ifdef GL_FRAGMENT_PRECISION_HIGH
precision highp float;
#else
precision mediump float;
#endif

uniform mat4 u_model_view;
uniform mat4 u_projection;
uniform mat3 u_normal_matrix;
uniform vec3 u_light_direction;  // eye space, normalised
uniform float u_shininess;
uniform vec2 u_fog_range;        // start, end

attribute vec3 a_position;
attribute vec3 a_normal;

varying vec2 v_lighting;  // diffuse, specular
varying float v_fog;

void main() {
    vec4 eye = u_model_view * vec4(a_position, 1.0);
    vec3 n = normalize(u_normal_matrix * a_normal);
    vec3 h = normalize(u_light_direction - normalize(eye.xyz));
    float diffuse = max(dot(n, u_light_direction), 0.0);
    float specular = diffuse > 0.0 ? pow(max(dot(n, h), 0.0), u_shininess) : 0.0;
    v_lighting = vec2(diffuse, specular);
    v_fog = clamp((-eye.z - u_fog_range.x) / (u_fog_range.y - u_fog_range.x), 0.0, 1.0);
    gl_Position = u_projection * eye;
}
