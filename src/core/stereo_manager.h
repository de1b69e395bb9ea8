#ifndef OVO_CORE_STEREO_MANAGER_H
#define OVO_CORE_STEREO_MANAGER_H

#include <atomic>
#include <cstddef>
#include <cstdint>

#include "config/stereo_profile.h"
#include "core/gl_api.h"

namespace ovo {

class CompositionRenderer;
class ContextRegistry;
class DebugConfig;
class GlLayer;
class GlObjectTracker;
class OverlayTarget;
class ShaderSourceStore;
class ViewerTracker;
struct EyeTexturePair;
template <typename Owner, typename Record>
class ContextObjectTable;

// A rectangle as glViewport and glScissor take it.
struct GlRect {
    int32_t m_x;
    int32_t m_y;
    int32_t m_width;
    int32_t m_height;
};

constexpr size_t PROCESS_NAME_CAPACITY = 1024;

// The one process-wide object that owns the library's state. Plain fields: the entry
// points, the layers and the EGL calls read and write them directly.
class StereoManager {
public:
    // The single manager; the first call in the process builds it (thread-safe), and at
    // process exit it releases what it owns. Inline: every GL call starts here, and once
    // the manager exists that costs one load and a test.
    static StereoManager& instance() {
        StereoManager* manager = m_instance.load(std::memory_order_acquire);
        return __builtin_expect(manager != nullptr, 1) ? *manager : Build();
    }

    StereoManager();
    // Releases the layer and the owned objects at process exit. The manager itself stays,
    // with a layer that passes every call through and stereo off, for the calls that
    // still come: from an exit handler, or from a thread that runs on.
    void ReleaseAtExit();
    StereoManager(const StereoManager&) = delete;
    StereoManager& operator=(const StereoManager&) = delete;

    // The layer class that handles `mode`; the caller owns it.
    static GlLayer* CreateLayerForMode(StereoMode mode);
    // Exchanges the layer, once per process, for the OpenGL ES 2.0 one.
    void InstallEs2Layer();
    // m_scale_x and m_scale_y from the profile's output and target sizes.
    void UpdateScale();
    float ScaleX() const { return m_scale_x; }
    float ScaleY() const { return m_scale_y; }

    // The first argument of this process's command line, cut at the first whitespace.
    static void ReadProcessName(char* buffer);

    GlRect m_viewport;
    GlRect m_scissor;
    GLuint m_program;
    GLint m_depth_shift_location;
    float m_depth_plane;
    GLuint m_last_texture;
    uint32_t m_frame_draws;
    float m_depth_unit;
    float m_depth_step;
    float m_depth_start;
    char m_process_name[PROCESS_NAME_CAPACITY];
    DebugConfig* m_debug;
    StereoProfile* m_profile;
    GlLayer* m_layer;
    OverlayTarget* m_overlay;
    ViewerTracker* m_viewer;
    GlObjectTracker* m_objects;
    // The eye textures of each context (the tracked ES 2.0 submode).
    ContextObjectTable<EGLContext, EyeTexturePair>* m_eye_textures;
    CompositionRenderer* m_composer;
    uint32_t m_frame_number;
    bool m_es2_layer_installed;
    float m_scale_x;
    float m_scale_y;
    bool m_interleave;
    // The application's contexts and their share groups (EGL calls).
    ContextRegistry* m_contexts;
    // The application's own sources of the vertex shaders the ES 2.0 layer rewrote.
    ShaderSourceStore* m_shader_sources;

private:
    // Builds the manager once; concurrent first callers wait for it. Out of line, so that
    // the GL entry points need no stack frame for it.
    __attribute__((noinline, cold)) static StereoManager& Build();

    static std::atomic<StereoManager*> m_instance;
};

// eglGetDisplay's start-up step once the driver is bound: builds the manager if needed
// and deletes the profile file, which belongs to one process start only.
void PrepareDisplay();

}  // namespace ovo

#endif
