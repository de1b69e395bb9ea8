#ifndef OVO_PRESENT_PANEL_REFRESH_H
#define OVO_PRESENT_PANEL_REFRESH_H

#include <cstdint>

namespace ovo {

class StereoManager;

// The ticks from `start` to `now`, two clock() readings, as a signed 32-bit difference. A
// 32-bit clock_t wraps after about 36 minutes of processor time, where subtracting the
// readings overflows; the unsigned difference of their low words does not, and it is the
// same answer for a 64-bit clock_t.
template <typename ClockReading>
constexpr int32_t ProcessorTicksBetween(ClockReading start, ClockReading now) {
    return static_cast<int32_t>(static_cast<uint32_t>(now) - static_cast<uint32_t>(start));
}

// Once per swap: in the shader modes, about every 0.1 s of processor time, re-asserts the
// panel's 3D mode for the picture's orientation and polls the live-tuning file.
void RefreshPanel(StereoManager& manager);

}  // namespace ovo

#endif
