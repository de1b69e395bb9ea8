#ifndef OVO_PLATFORM_DEVICE_NODE_H
#define OVO_PLATFORM_DEVICE_NODE_H

namespace ovo {

// Sends one request to an open device node, with the argument passed by value.
// On the device this is ioctl(). Host builds have no panel driver: the node below the
// device root is a plain file, and each request is appended to it as a line
// "request=0x<number> argument=<value>", so that a test sees every request that reached it.
void DeviceRequest(int node, unsigned long request, long argument);

}  // namespace ovo

#endif
