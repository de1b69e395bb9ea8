// Grass and leaves sway with the wind; the vertex colour's alpha holds the stiffness.
precision mediump float;
uniform mat4 u_mvp;
uniform float u_time;
uniform vec2 u_wind; // direction * strength
attribute vec3 a_position;
attribute vec2 a_uv;
attribute vec4 a_color;
varying vec2 v_uv;
varying vec4 v_color;
void main()
{
  float phase = dot(a_position.xz, vec2(0.37, 0.21)) + u_time * 2.3;
  float sway = sin(phase) * 0.6 + sin(phase * 2.7) * 0.25;
  vec3 p = a_position;
  p.xz += u_wind * sway * (1.0 - a_color.a) * a_position.y;
  v_uv = a_uv;
  v_color = a_color;
  gl_Position = u_mvp * vec4(p, 1.0);
}
