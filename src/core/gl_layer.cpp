#include "core/gl_layer.h"

#include "core/raw_gl.h"

namespace ovo {

GlLayer::~GlLayer() = default;

#define OVO_GL_ENTRY(index, result, name, params, args) \
    result GlLayer::name OVO_PREPEND(StereoManager&, params) { return raw::name args; }
#include "core/gl_entry_table.inc"

}  // namespace ovo
