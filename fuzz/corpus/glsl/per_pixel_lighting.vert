/*
 * Passes eye-space position, normal and tangent frame on to a per-pixel
 * lighting fragment shader with a normal map.
 */
uniform mat4 u_model_view;
uniform mat4 u_projection;
uniform mat3 u_normal_matrix;

attribute vec4 a_position;
attribute vec3 a_normal;
attribute vec4 a_tangent;   // w holds the handedness
attribute vec2 a_uv;

varying vec3 v_eye_position;
varying vec3 v_normal;
varying vec3 v_tangent;
varying vec3 v_bitangent;
varying vec2 v_uv;

void main(void)
{
    vec4 eye = u_model_view * a_position;
    v_eye_position = eye.xyz;
    v_normal = normalize(u_normal_matrix * a_normal);
    v_tangent = normalize(u_normal_matrix * a_tangent.xyz);
    v_bitangent = cross(v_normal, v_tangent) * a_tangent.w;
    v_uv = a_uv;
    gl_Position = u_projection * eye;
}
