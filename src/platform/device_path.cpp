#include "platform/device_path.h"

#include <cstdio>

namespace ovo {

bool MakeDevicePath(const char* path, char* out, size_t capacity) {
    if (capacity == 0) return false;
    int length = std::snprintf(out, capacity, "%s%s", DEVICE_ROOT, path);
    if (length < 0 || static_cast<size_t>(length) >= capacity) {
        out[0] = '\0';
        return false;
    }
    return true;
}

}  // namespace ovo
