#include "resident_memory.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>

namespace ovo_gl_count {

namespace {

// /proc/self/status is about 1.5 kB.
constexpr size_t RESIDENT_STATUS_CAPACITY = 8192;
constexpr char RESIDENT_FIELD[] = "\nVmRSS:";

}  // namespace

long ResidentKilobytes() {
    const int file = open("/proc/self/status", O_RDONLY | O_CLOEXEC);
    if (file < 0) return -1;
    char status[RESIDENT_STATUS_CAPACITY];
    size_t length = 0;
    ssize_t got = 0;
    while (length + 1 < sizeof(status) &&
           (got = read(file, status + length, sizeof(status) - 1 - length)) > 0) {
        length += static_cast<size_t>(got);
    }
    close(file);
    status[length] = '\0';
    const char* field = std::strstr(status, RESIDENT_FIELD);
    if (field == nullptr) return -1;
    char* end = nullptr;
    const long kilobytes = std::strtol(field + sizeof(RESIDENT_FIELD) - 1, &end, 10);
    return end == field + sizeof(RESIDENT_FIELD) - 1 ? -1 : kilobytes;
}

}  // namespace ovo_gl_count
