uniform highp mat4 u_mvp;
uniform mediump mat4 u_texture_matrix;
attribute highp vec4 a_position;
attribute mediump vec4 a_uv;
varying mediump vec2 v_uv;

void main(){v_uv=(u_texture_matrix*a_uv).xy;gl_Position=u_mvp*a_position;}
