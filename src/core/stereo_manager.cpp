#include "core/stereo_manager.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>

#include "config/debug_config.h"
#include "core/gl_layer.h"
#include "egl/context_registry.h"
#include "platform/device_path.h"
#include "present/composition_renderer.h"
#include "present/viewer_tracker.h"
#include "stereo/es1_scaled_layer.h"
#include "stereo/es1_sprite_stereo_layer.h"
#include "stereo/es1_stereo_layer.h"
#include "stereo/es2_scaled_layer.h"
#include "stereo/es2_stereo_layer.h"
#include "stereo/eye_texture.h"
#include "stereo/gl_object_tracker.h"
#include "stereo/overlay_target.h"
#include "stereo/shader_source_store.h"

namespace ovo {

namespace {
constexpr char NO_PROCESS_NAME[] = "no.proc.name";

bool IsWhitespace(char byte) { return (byte >= 9 && byte <= 13) || byte == ' '; }

// The manager's storage, and what the calls after its release use instead of the owned
// objects. Neither is ever destroyed: exit handlers that run later still find them.
struct LateCallObjects {
    PassThroughLayer m_layer;
    OverlayTarget m_overlay{0, 0, 0};
    ViewerTracker m_viewer{false};
};
alignas(StereoManager) unsigned char g_manager_storage[sizeof(StereoManager)];
alignas(LateCallObjects) unsigned char g_late_call_storage[sizeof(LateCallObjects)];

void ReleaseManagerAtExit() { StereoManager::instance().ReleaseAtExit(); }
}  // namespace

std::atomic<StereoManager*> StereoManager::m_instance{nullptr};

StereoManager& StereoManager::Build() {
    static StereoManager* const manager = [] {
        StereoManager* built = new (g_manager_storage) StereoManager();
        std::atexit(ReleaseManagerAtExit);
        return built;
    }();
    m_instance.store(manager, std::memory_order_release);
    return *manager;
}

StereoManager::StereoManager()
    : m_viewport{0, 0, 0, 0},
      m_scissor{0, 0, 0, 0},
      m_program(0),
      m_depth_shift_location(0),
      m_depth_plane(0.0f),
      m_last_texture(0),
      m_frame_draws(0),
      m_depth_unit(0.0025f),
      m_depth_step(2.0f),
      m_depth_start(5.0f),
      m_process_name{},
      m_debug(nullptr),
      m_profile(nullptr),
      m_layer(nullptr),
      m_overlay(nullptr),
      m_viewer(nullptr),
      m_objects(nullptr),
      m_eye_textures(nullptr),
      m_composer(nullptr),
      m_frame_number(0),
      m_es2_layer_installed(false),
      m_scale_x(1.0f),
      m_scale_y(1.0f),
      m_interleave(false),
      m_contexts(nullptr),
      m_shader_sources(nullptr) {
    ReadProcessName(m_process_name);
    m_profile = new StereoProfile();
    m_overlay = new OverlayTarget(m_profile->m_target_width, m_profile->m_target_height,
                                  OVERLAY_CREATE_OBJECTS);
    m_debug = new DebugConfig();
    m_viewer = new ViewerTracker(m_profile->m_auto_eye);
    const StereoMode mode = m_profile->ResolveMode();
    m_layer = CreateLayerForMode(mode);
    m_objects = new GlObjectTracker();
    m_contexts = new ContextRegistry();
    m_shader_sources = new ShaderSourceStore();
    const bool shader_mode = mode == STEREO_MODE_SHADER || mode == STEREO_MODE_SHADER_LISTED;
    if (shader_mode && m_profile->m_valid) {
        m_composer = new CompositionRenderer(m_profile->m_swap_eye_mask ? 1 : 0);
        m_interleave = true;
    }
    UpdateScale();
}

void StereoManager::ReleaseAtExit() {
    delete m_objects;
    delete m_layer;
    delete m_viewer;
    delete m_debug;
    delete m_overlay;
    // The profile stays, back at its defaults with stereo off: the EGL calls read it.
    static_cast<StereoProfileFields&>(*m_profile) = StereoProfileFields();
    m_profile->m_mode = STEREO_MODE_OFF;
    // Their GL objects go with their contexts; only the records are freed.
    delete m_eye_textures;
    delete m_shader_sources;
    // The context registry stays: EGL calls from exit handlers still keep it.
    // Released last: nothing that goes before draws any more.
    delete m_composer;
    LateCallObjects* late = new (g_late_call_storage) LateCallObjects();
    m_objects = nullptr;
    m_layer = &late->m_layer;
    m_viewer = &late->m_viewer;
    m_debug = nullptr;
    m_overlay = &late->m_overlay;
    m_eye_textures = nullptr;
    m_shader_sources = nullptr;
    m_composer = nullptr;
    m_interleave = false;
    m_es2_layer_installed = false;
}

GlLayer* StereoManager::CreateLayerForMode(StereoMode mode) {
    switch (mode) {
        case STEREO_MODE_PLAIN: return new Es1ScaledLayer();
        case STEREO_MODE_SHADER: return new Es1StereoLayer();
        case STEREO_MODE_SHADER_LISTED: return new Es1SpriteStereoLayer();
        default: return new PassThroughLayer();
    }
}

void StereoManager::InstallEs2Layer() {
    if (m_es2_layer_installed) return;
    m_es2_layer_installed = true;
    delete m_layer;
    if (m_profile->ResolveMode() == STEREO_MODE_PLAIN) {
        m_layer = new Es2ScaledLayer();
    } else {
        m_layer = new Es2StereoLayer(Es2StereoLayer::SubmodeFor(m_process_name));
    }
}

void StereoManager::UpdateScale() {
    m_scale_x = static_cast<float>(m_profile->m_width) / static_cast<float>(m_profile->m_target_width);
    m_scale_y = static_cast<float>(m_profile->m_height) / static_cast<float>(m_profile->m_target_height);
}

void StereoManager::ReadProcessName(char* buffer) {
    char path[64];
    std::snprintf(path, sizeof(path), "/proc/%d/cmdline", static_cast<int>(getpid()));
    int file = open(path, O_RDONLY);
    if (file < 0) {
        std::memcpy(buffer, NO_PROCESS_NAME, sizeof(NO_PROCESS_NAME));
        return;
    }
    // A name that fills the buffer is cut, so the last byte always terminates it.
    size_t length = 0;
    while (length < PROCESS_NAME_CAPACITY - 1) {
        char byte;
        if (read(file, &byte, 1) != 1) break;
        if (IsWhitespace(byte)) break;
        buffer[length++] = byte;
        if (byte == '\0') break;
    }
    buffer[length] = '\0';
    close(file);
}

void PrepareDisplay() {
    StereoManager::instance();
    char path[DEVICE_PATH_CAPACITY];
    if (MakeDevicePath(PROFILE_PATH, path, sizeof(path))) unlink(path);
}

}  // namespace ovo
