// Sky box at the far plane: the view's rotation only, depth forced to 1.
uniform mat4 u_projection;
uniform mat3 u_view_rotation;
attribute vec3 a_position;
varying vec3 v_direction;

void main() {
    v_direction = a_position;
    vec4 clip = u_projection * vec4(u_view_rotation * a_position, 1.0);
    gl_Position = clip.xyww;
}
