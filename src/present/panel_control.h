#ifndef OVO_PRESENT_PANEL_CONTROL_H
#define OVO_PRESENT_PANEL_CONTROL_H

namespace ovo {

constexpr const char PANEL_MODE_NODE[] = "/dev/zpx";
constexpr const char COMPOSITION_NODE[] = "/dev/zdriver";

// The mode value goes to the driver by value, even though the number has the layout of a
// read-write request with a 4-byte payload.
constexpr unsigned long PANEL_MODE_REQUEST = 0xC0047602;
constexpr unsigned long COMPOSITION_START_REQUEST = 0x616;

enum PanelMode : long {
    PANEL_MODE_2D = 0,
    PANEL_MODE_3D_LANDSCAPE = 1,
    PANEL_MODE_3D_PORTRAIT = 2,
};

// Puts the panel into 2D, or into 3D for a landscape or portrait picture. False when the
// panel node cannot be opened; the driver's answer is not looked at.
bool SetPanelMode(bool on, bool landscape);

// Tells the display driver that the stencil composition starts. The node stays open until
// the process ends.
void SendCompositionStart();

}  // namespace ovo

#endif
