#include "present/composition_renderer.h"

#include <new>

#include "core/raw_gl.h"
#include "core/stereo_manager.h"
#include "egl/context_registry.h"
#include "egl/current_context.h"
#include "present/matrix4.h"
#include "present/panel_control.h"

namespace ovo {

namespace {

struct TargetSize {
    int32_t m_width;
    int32_t m_height;
};

constexpr TargetSize COMPOSITION_KNOWN_SIZES[] = {
    {800, 480}, {800, 1280}, {480, 800},  {960, 540},
    {540, 960}, {1280, 720}, {1280, 800}, {720, 1280},
};

// Every size outside the table is drawn at this one.
constexpr TargetSize COMPOSITION_FALLBACK_SIZE = {800, 480};
constexpr int32_t COMPOSITION_FALLBACK_LINES = COMPOSITION_FALLBACK_SIZE.m_width / 2 + 1;

// The lines are built once per process, whichever renderer presents first.
bool g_composition_first_present = true;

TargetSize MaskSize(const StereoProfileFields& profile) {
    if (!CompositionRenderer::IsKnownTargetSize(profile)) return COMPOSITION_FALLBACK_SIZE;
    return {profile.m_target_width, profile.m_target_height};
}

}  // namespace

CompositionRenderer::CompositionRenderer(uint32_t swap_eyes)
    : m_line_count(0), m_vertices(nullptr), m_projection{}, m_swap_eyes(swap_eyes != 0 ? 1 : 0) {}

CompositionRenderer::~CompositionRenderer() {
    delete[] m_vertices;
}

void CompositionRenderer::Present(StereoManager& manager) {
    if (g_composition_first_present) {
        SendCompositionStart();
        if (manager.m_es2_layer_installed) {
            Mat4Identity(m_projection);
            BuildLinesGl2(*manager.m_profile);
        } else {
            BuildLinesGl1(*manager.m_profile);
        }
        g_composition_first_present = false;
    }
    DrawMask(manager, GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT | GL_STENCIL_BUFFER_BIT);
}

void CompositionRenderer::MaskNewSurface(const StereoManager& manager) {
    if (g_composition_first_present) return;
    // Only the window's stencil: the application's own framebuffer has no mask to hold.
    GLint framebuffer = 0;
    raw::glGetIntegerv(GL_FRAMEBUFFER_BINDING, &framebuffer);
    if (framebuffer != 0) return;
    DrawMask(manager, GL_STENCIL_BUFFER_BIT);
}

void CompositionRenderer::SetMaskTest(int on) const {
    on == 1 ? raw::glEnable(GL_STENCIL_TEST) : raw::glDisable(GL_STENCIL_TEST);
}

void CompositionRenderer::SelectEye(int eye) const {
    GLint reference = eye;
    if (m_swap_eyes != 0) reference = eye == 1 ? 0 : 1;
    raw::glStencilFunc(GL_EQUAL, reference, 1);
}

GLbitfield CompositionRenderer::FilterClearMask(GLbitfield mask) {
    return mask & ~static_cast<GLbitfield>(GL_STENCIL_BUFFER_BIT);
}

bool CompositionRenderer::IsKnownTargetSize(const StereoProfileFields& profile) {
    for (const TargetSize& size : COMPOSITION_KNOWN_SIZES) {
        if (size.m_width == profile.m_target_width && size.m_height == profile.m_target_height)
            return true;
    }
    return false;
}

// Known sizes are all positive, so the count never exceeds 641 and never goes negative.
bool CompositionRenderer::AllocateLines(const StereoProfileFields& profile) {
    const int32_t count =
        IsKnownTargetSize(profile) ? profile.m_target_width / 2 + 1 : COMPOSITION_FALLBACK_LINES;
    m_vertices = new (std::nothrow) float[4 * static_cast<size_t>(count)];
    m_line_count = m_vertices != nullptr ? count : 0;
    return m_vertices != nullptr;
}

void CompositionRenderer::BuildLinesGl2(const StereoProfileFields& profile) {
    if (!AllocateLines(profile)) return;
    const bool known = IsKnownTargetSize(profile);
    const float height = static_cast<float>(profile.m_target_height);
    for (int32_t i = 0; i < m_line_count; ++i) {
        float* line = &m_vertices[4 * i];
        if (known) {
            line[0] = line[2] = static_cast<float>(2 * i);
            line[1] = 0.0f;
            line[3] = height;
        } else {
            // A thousandth of a pixel right of the column edge. Rasterisers with coarse
            // sub-pixel precision (llvmpipe) snap it back onto the edge.
            line[0] = line[2] = static_cast<float>(2 * i) + 0.001f;
            line[1] = 480.0f;
            line[3] = 0.0f;
        }
    }
}

void CompositionRenderer::BuildLinesGl1(const StereoProfileFields& profile) {
    if (!AllocateLines(profile)) return;
    const TargetSize size = MaskSize(profile);
    const int32_t half_width = size.m_width / 2;
    const int32_t half_height = size.m_height / 2;
    for (int32_t i = 0; i < m_line_count; ++i) {
        float* line = &m_vertices[4 * i];
        line[0] = line[2] = static_cast<float>(2 * i - half_width);
        line[1] = static_cast<float>(half_height);
        line[3] = static_cast<float>(-half_height);
    }
}

// Leaves the stencil 0 on the lines and 1 elsewhere; no colour or depth reaches the lines.
void CompositionRenderer::DrawMask(const StereoManager& manager, GLbitfield clear_bits) {
    raw::glEnable(GL_STENCIL_TEST);
    raw::glClearStencil(1);
    raw::glClear(clear_bits);
    raw::glStencilFunc(GL_NEVER, 0, 1);
    raw::glStencilOp(GL_REPLACE, GL_KEEP, GL_KEEP);
    const TargetSize size = MaskSize(*manager.m_profile);
    if (manager.m_es2_layer_installed) {
        DrawLinesGl2(size.m_width, size.m_height,
                     manager.m_contexts->ShareGroupOf(CurrentContext()));
    } else {
        DrawLinesGl1(size.m_width, size.m_height);
    }
    raw::glStencilOp(GL_KEEP, GL_KEEP, GL_KEEP);
    raw::glDisable(GL_STENCIL_TEST);
    NoteSurfaceMasked();
}

}  // namespace ovo
