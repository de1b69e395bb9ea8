// 2D sprites from an atlas: position in pixels, frame picked from a grid.
precision mediump float;

uniform vec2 u_screen_size;
uniform vec2 u_atlas_grid;   // columns, rows

attribute vec2 a_corner;     // 0..1 quad corner
attribute vec4 a_rect;       // x, y, width, height in pixels
attribute float a_frame;
attribute vec4 a_tint;

varying vec2 v_uv;
varying vec4 v_tint;

void main() {
    vec2 pixel = a_rect.xy + a_corner * a_rect.zw;
    vec2 ndc = pixel / u_screen_size * 2.0 - 1.0;
    float column = mod(a_frame, u_atlas_grid.x);
    float row = floor(a_frame / u_atlas_grid.x);
    v_uv = (vec2(column, row) + vec2(a_corner.x, 1.0 - a_corner.y)) / u_atlas_grid;
    v_tint = a_tint;
    gl_Position = vec4(ndc.x, -ndc.y, 0.0, 1.0);
}
