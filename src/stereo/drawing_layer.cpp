#include "stereo/drawing_layer.h"

#include "stereo/draw_call.h"

namespace ovo {

void DrawingLayer::glDrawArrays(StereoManager& manager, GLenum mode, GLint first,
                                GLsizei count) {
    Draw(manager, DrawCall::Arrays(mode, first, count));
}

void DrawingLayer::glDrawElements(StereoManager& manager, GLenum mode, GLsizei count,
                                  GLenum type, const void* indices) {
    Draw(manager, DrawCall::Elements(mode, count, type, indices));
}

}  // namespace ovo
