#include "present/viewer_tracker.h"

#include <cmath>

#include "present/matrix4.h"

namespace ovo {

namespace {
constexpr double VIEWER_PI = 3.141592653589793;
}  // namespace

ViewerTracker::ViewerTracker(bool active)
    : m_depth_min(0.0f),
      m_current_projection(nullptr),
      m_current_modelview(nullptr),
      m_estimated_distance(0.0f),
      m_estimated_angle(0.0f),
      m_active(active) {
    Mat4Identity(m_last_projection);
}

void ViewerTracker::Observe(const float projection[16], const float modelview[16]) {
    if (!m_active) return;
    m_current_projection = projection;
    m_current_modelview = modelview;
    RecordDepth();
}

void ViewerTracker::RecordDepth() {
    const float origin[4] = {0.0f, 0.0f, 0.0f, 1.0f};
    float eye[4];
    float clip[4];
    Mat4MulVec4(eye, m_current_modelview, origin);
    Mat4MulVec4(clip, m_current_projection, eye);
    if (clip[3] == 0.0f) return;

    const float x = clip[0] / clip[3];
    const float y = clip[1] / clip[3];
    const float z = clip[2] / clip[3];
    const bool on_screen = x >= -1.0f && x <= 1.0f && y >= -1.0f && y <= 1.0f;
    if (z > 0.0f && z < 1.0f && on_screen) {
        if (m_depth_min == 0.0f) m_depth_min = z;
        m_depth_min = std::fmin(m_depth_min, z);
    }
    Mat4Copy(m_last_projection, m_current_projection);
}

void ViewerTracker::EstimateEyes() {
    const float nearest[4] = {0.0f, 0.0f, m_depth_min, 1.0f};
    m_depth_min = 0.0f;
    float unproject[16];
    // A singular projection has no inverse to unproject through: keep the last estimates.
    if (!Mat4Invert(unproject, m_last_projection)) return;
    float viewer[4];
    Mat4MulVec4(viewer, unproject, nearest);
    if (viewer[3] == 0.0f) return;

    const float x = viewer[0] / viewer[3];
    const float z = viewer[2] / viewer[3];
    m_estimated_distance = x;
    m_estimated_angle = static_cast<float>(
        std::atan2(static_cast<double>(x), static_cast<double>(std::fabs(z))) * 180.0 / VIEWER_PI);
}

}  // namespace ovo
