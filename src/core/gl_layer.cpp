#include "core/gl_layer.h"

#include <new>

#include "core/raw_gl.h"

namespace ovo {

GlLayer::~GlLayer() = default;

GlLayer& ContextlessLayer() {
    alignas(PassThroughLayer) static unsigned char storage[sizeof(PassThroughLayer)];
    static GlLayer* const layer = new (storage) PassThroughLayer();
    return *layer;
}

#define OVO_GL_ENTRY(index, result, name, params, args) \
    result GlLayer::name OVO_PREPEND(StereoManager&, params) { return raw::name args; }
#include "core/gl_entry_table.inc"

}  // namespace ovo
