#include "recorder.h"

extern "C" __attribute__((visibility("default"))) RecorderState* RecorderGetState() {
    static RecorderState state = [] {
        RecorderState initial{};
        initial.m_recording = true;
        initial.m_surface_width = 1280;
        initial.m_surface_height = 720;
        return initial;
    }();
    return &state;
}
