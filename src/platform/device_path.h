#ifndef OVO_PLATFORM_DEVICE_PATH_H
#define OVO_PLATFORM_DEVICE_PATH_H

#include <cstddef>

namespace ovo {

// Where the device's file system starts for this build: "" on Android, the configured
// device root on host builds, so that host runs never touch the machine's own /sdcard,
// /system, /data or /dev.
extern const char DEVICE_ROOT[];

// Room for any device path that the library builds: a device path of up to 1024 bytes
// below a root of up to 3072 bytes.
constexpr size_t DEVICE_PATH_CAPACITY = 4096;

// Writes DEVICE_ROOT followed by `path` (an absolute device path such as
// "/sdcard/duoscope/version.txt") into `out`. Returns false, with `out` holding an empty
// string, when the result does not fit into `capacity` bytes.
bool MakeDevicePath(const char* path, char* out, size_t capacity);

}  // namespace ovo

#endif
