// Glyph quads for the HUD, already in pixels; "y" grows downwards.
uniform vec2 u_inverse_screen; // 2 / width, 2 / height
attribute vec2 a_position;
attribute vec2 a_uv;
attribute vec4 a_color;
varying vec2 v_uv;
varying vec4 v_color;
void main() {
	v_uv = a_uv;
	v_color = a_color;
	gl_Position = vec4(a_position.x * u_inverse_screen.x - 1.0,
	                   1.0 - a_position.y * u_inverse_screen.y, 0.0, 1.0);
}
