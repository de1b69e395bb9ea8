
uniform mat4 u_mvp;
uniform mat3 u_normal_matrix;
uniform vec3 u_light_direction;
uniform vec4 u_color;
attribute vec3 a_position;
attribute vec3 a_normal;
varying vec4 v_color;

void main() {
    vec3 normal = normalize(u_normal_matrix * a_normal);
    float diffuse = max(dot(normal, u_light_direction), 0.0);
    v_color = vec4(u_color.rgb * (0.3 + 0.7 * diffuse), u_color.a);
    gl_Position = u_mvp * vec4(a_position, 1.0);
}
