#include "platform/device_node.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <cstdio>

namespace ovo {

#ifdef __ANDROID__

void DeviceRequest(int node, unsigned long request, long argument) { ioctl(node, request, argument); }

#else

void DeviceRequest(int node, unsigned long request, long argument) {
    char line[64];
    int length = std::snprintf(line, sizeof(line), "request=0x%lx argument=%ld\n", request, argument);
    lseek(node, 0, SEEK_END);
    ssize_t written = write(node, line, static_cast<size_t>(length));
    (void)written;
}

#endif

}  // namespace ovo
