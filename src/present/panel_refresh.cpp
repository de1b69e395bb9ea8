#include "present/panel_refresh.h"

#include <cstdint>
#include <ctime>

#include "core/stereo_manager.h"
#include "present/live_tuning.h"
#include "present/panel_control.h"

namespace ovo {

namespace {

constexpr double PANEL_REFRESH_INTERVAL_SECONDS = 0.1;
constexpr float PROCESSOR_TICKS_PER_SECOND = 1000000.0f;

// When set, the next swap that gets here starts a new interval.
bool panelRefreshRearm = true;
clock_t panelRefreshStart;

}  // namespace

void RefreshPanel(StereoManager& manager) {
    if (manager.m_profile == nullptr || !manager.m_profile->m_shader_convert) return;
    if (panelRefreshRearm) {
        panelRefreshStart = clock();
        panelRefreshRearm = false;
    }
    int32_t ticks = ProcessorTicksBetween(panelRefreshStart, clock());
    float elapsed = static_cast<float>(ticks) / PROCESSOR_TICKS_PER_SECOND;
    if (!(static_cast<double>(elapsed) > PANEL_REFRESH_INTERVAL_SECONDS)) return;
    panelRefreshRearm = true;

    StereoProfile& profile = *manager.m_profile;
    if (profile.m_force_portrait) {
        SetPanelMode(true, false);
        return;
    }
    SetPanelMode(true, profile.m_target_width >= profile.m_target_height);
    ReadLiveTuning(profile);
}

}  // namespace ovo
