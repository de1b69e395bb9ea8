#ifndef OVO_EXAMPLES_ES1_SCENE_CUBE_DRAW_H
#define OVO_EXAMPLES_ES1_SCENE_CUBE_DRAW_H

namespace ovo_sample {

// The shared cube from client-side arrays, at the current modelview, in the current
// colour; with its texture coordinates when `textured`.
void DrawCube(bool textured);

}  // namespace ovo_sample

#endif
