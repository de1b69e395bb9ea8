// Terrain tile: height from a texture, normal from central differences.
precision highp float;

uniform mat4 u_mvp;
uniform sampler2D u_heightmap;
uniform vec2 u_texel;        // 1 / heightmap size
uniform float u_height_scale;

attribute vec2 a_grid;       // 0..1 across the tile

varying vec3 v_normal;
varying vec2 v_uv;
varying float v_height;

float Height(vec2 uv) {
    return texture2DLod(u_heightmap, uv, 0.0).r * u_height_scale;
}

void main() {
    float h = Height(a_grid);
    float dx = Height(a_grid + vec2(u_texel.x, 0.0)) - Height(a_grid - vec2(u_texel.x, 0.0));
    float dz = Height(a_grid + vec2(0.0, u_texel.y)) - Height(a_grid - vec2(0.0, u_texel.y));
    v_normal = normalize(vec3(-dx, 2.0 * u_texel.x, -dz));
    v_uv = a_grid * 16.0;
    v_height = h;
    gl_Position = u_mvp * vec4(a_grid.x, h, a_grid.y, 1.0);
}
