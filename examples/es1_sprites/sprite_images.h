#ifndef OVO_EXAMPLES_ES1_SPRITES_SPRITE_IMAGES_H
#define OVO_EXAMPLES_ES1_SPRITES_SPRITE_IMAGES_H

#include <cstdint>

#include "common/rgba_image.h"

namespace ovo_sample {

// A strip of rolling hills, transparent above them; seamless left to right so it scrolls
// with GL_REPEAT. `phase` varies the outline, `base` is the foot's share of the height.
RgbaImage MakeHills(int32_t width, int32_t height, float phase, float base, Rgba foot,
                    Rgba crest);

// Mortared bricks.
RgbaImage MakeBricks(int32_t size);

// Dirt with a grass top.
RgbaImage MakeGrassTile(int32_t size);

// A five-pointed white star (tinted when drawn), transparent around it.
RgbaImage MakeStar(int32_t size);

// A round character with two eyes.
RgbaImage MakeCharacter(int32_t size);

}  // namespace ovo_sample

#endif
