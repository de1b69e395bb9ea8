// Distance-based level of detail: far vertices are flattened, near ones animated.
// Several exits from main.
precision mediump float;
uniform mat4 u_mvp;
uniform vec3 u_camera;
uniform float u_far;
uniform float u_time;
attribute vec3 a_position;
attribute float a_wave;
varying float v_fade;

void main() {
    float d = distance(a_position, u_camera);
    v_fade = clamp(1.0 - d / u_far, 0.0, 1.0);
    if (v_fade <= 0.0) {
        gl_Position = u_mvp * vec4(a_position.x, 0.0, a_position.z, 1.0);
        return;
    }
    if (a_wave == 0.0) {
        gl_Position = u_mvp * vec4(a_position, 1.0);
        return;
    }
    vec3 p = a_position;
    p.y += sin(u_time * 3.0 + a_wave) * 0.1 * v_fade;
    gl_Position = u_mvp * vec4(p, 1.0);
    return;
}
