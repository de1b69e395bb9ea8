// Facial animation: two morph targets blended onto the base mesh.
precision highp float;
uniform mat4 u_mvp;
uniform mat3 u_normal_matrix;
uniform vec2 u_morph_weights;
attribute vec3 a_position;
attribute vec3 a_normal;
attribute vec3 a_morph0_delta;
attribute vec3 a_morph1_delta;
attribute vec3 a_morph0_normal;
attribute vec3 a_morph1_normal;
varying vec3 v_normal;

void main() {
    vec3 p = a_position + u_morph_weights.x * a_morph0_delta + u_morph_weights.y * a_morph1_delta;
    vec3 n = a_normal + u_morph_weights.x * a_morph0_normal + u_morph_weights.y * a_morph1_normal;
    v_normal = normalize(u_normal_matrix * n);
    gl_Position = u_mvp * vec4(p, 1.0);
}
