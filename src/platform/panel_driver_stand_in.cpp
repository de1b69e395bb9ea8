// The panel's display driver as a host stands in for it. A host has no /dev/zpx or
// /dev/zdriver: below the device root they are plain files. Loaded ahead of the C library
// (linked before it, or through LD_PRELOAD), this ioctl() appends every request made on a
// plain file to that file as "request=0x<number> argument=<value>\n", so a test reads back
// what reached the node. Requests on anything else go to the real ioctl().
#include <dlfcn.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdarg>
#include <cstdio>

namespace {

using IoctlFunction = int (*)(int, unsigned long, ...);

int RealIoctl(int descriptor, unsigned long request, unsigned long argument) {
    static const auto real = reinterpret_cast<IoctlFunction>(dlsym(RTLD_NEXT, "ioctl"));
    if (real == nullptr) {
        errno = ENOSYS;
        return -1;
    }
    return real(descriptor, request, argument);
}

// The driver's answer is never looked at, so a recorded request simply succeeds.
int Record(int descriptor, unsigned long request, unsigned long argument) {
    char line[64];
    const int length = std::snprintf(line, sizeof(line), "request=0x%lx argument=%ld\n", request,
                                     static_cast<long>(argument));
    if (lseek(descriptor, 0, SEEK_END) < 0) return -1;
    return write(descriptor, line, static_cast<size_t>(length)) == length ? 0 : -1;
}

}  // namespace

extern "C" __attribute__((visibility("default"))) int ioctl(int descriptor, unsigned long request, ...) {
    // Every request carries one word: a value or a pointer.
    va_list arguments;
    va_start(arguments, request);
    const unsigned long argument = va_arg(arguments, unsigned long);
    va_end(arguments);
    struct stat status;
    if (fstat(descriptor, &status) == 0 && S_ISREG(status.st_mode)) {
        return Record(descriptor, request, argument);
    }
    return RealIoctl(descriptor, request, argument);
}
