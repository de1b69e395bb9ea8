// The directives kept in front, among comments, CRLF and blanks.

#version 100
  #	extension GL_OES_standard_derivatives : enable /* a
 b */
#ifdef GL_ES
precision highp float;
#endif
attribute vec4 p;
void main() {
    gl_Position = p;
}
