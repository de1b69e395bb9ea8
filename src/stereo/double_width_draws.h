#ifndef OVO_STEREO_DOUBLE_WIDTH_DRAWS_H
#define OVO_STEREO_DOUBLE_WIDTH_DRAWS_H

#include "core/gl_api.h"

namespace ovo {

class StereoManager;
struct DrawCall;
struct TextureRecord;

// `width` doubled, held at the int32 range rather than overflowing.
GLsizei DoubleWidth(GLsizei width);

// After the application attached `texture` to its bound framebuffer: the texture becomes
// twice as wide as the application made it, and the framebuffer remembers the width the
// application believes in.
void WidenRenderTexture(StereoManager& manager, GLuint texture);

// A draw into an application framebuffer: eye 0 into the left half, eye 1 into the right.
void DrawIntoDoubleWidth(StereoManager& manager, const DrawCall& draw);

// A draw to the window that samples a double-width render texture: each half is copied
// into its eye's texture, and each eye draws with its own.
void DrawRenderTexturePerEye(StereoManager& manager, const DrawCall& draw,
                             const TextureRecord& texture);

}  // namespace ovo

#endif
