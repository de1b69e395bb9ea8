#ifndef OVO_CORE_GL_LAYER_H
#define OVO_CORE_GL_LAYER_H

#include "core/entry_tables.h"
#include "core/gl_api.h"

namespace ovo {

class StereoManager;

// The interception interface: one operation per GL entry point, in table order, each
// taking the manager first. The base operations hand the call to the vendor unchanged;
// stereo layers override the few that stereo rendering must change.
class GlLayer {
public:
    GlLayer() = default;
    GlLayer(const GlLayer&) = delete;
    GlLayer& operator=(const GlLayer&) = delete;
    virtual ~GlLayer();

#define OVO_GL_ENTRY(index, result, name, params, args) \
    virtual result name OVO_PREPEND(StereoManager& manager, params);
#include "core/gl_entry_table.inc"
};

// The layer of STEREO_MODE_OFF: every call reaches the vendor unchanged.
class PassThroughLayer : public GlLayer {};

// The layer of threads without a current context, whatever the process's layer is. Never
// destroyed: such threads may still call while exit handlers run.
GlLayer& ContextlessLayer();

}  // namespace ovo

#endif
