#include "present/panel_control.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include "platform/device_path.h"

namespace ovo {

namespace {
int OpenNode(const char* node) {
    char path[DEVICE_PATH_CAPACITY];
    if (!MakeDevicePath(node, path, sizeof(path))) return -1;
    return open(path, O_RDWR);
}
}  // namespace

bool SetPanelMode(bool on, bool landscape) {
    int node = OpenNode(PANEL_MODE_NODE);
    if (node < 0) return false;
    long mode = on ? (landscape ? PANEL_MODE_3D_LANDSCAPE : PANEL_MODE_3D_PORTRAIT) : PANEL_MODE_2D;
    ioctl(node, PANEL_MODE_REQUEST, mode);
    close(node);
    return true;
}

// The descriptor stays open: the driver may tie the composition to it.
void SendCompositionStart() {
    int node = OpenNode(COMPOSITION_NODE);
    if (node < 0) return;
    ioctl(node, COMPOSITION_START_REQUEST, 1L);
}

}  // namespace ovo
