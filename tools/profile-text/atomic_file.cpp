#include "atomic_file.h"

#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace ovo_profile {

bool WriteFileAtomically(const std::string& path, const uint8_t* bytes, size_t size, std::string& problem) {
    const size_t slash = path.rfind('/');
    const std::string folder = slash == std::string::npos ? "." : path.substr(0, slash + 1);
    const std::string base = slash == std::string::npos ? path : path.substr(slash + 1);
    std::string temporary = (slash == std::string::npos ? "" : folder) + "." + base + ".XXXXXX";
    int descriptor = mkstemp(&temporary[0]);
    if (descriptor < 0) {
        problem = "cannot create a temporary file next to " + path + ": " + std::strerror(errno);
        return false;
    }
    // The permissions that a plainly created file would get.
    const mode_t mask = umask(0);
    umask(mask);
    bool written = fchmod(descriptor, 0666 & ~mask) == 0;
    size_t done = 0;
    while (written && done < size) {
        const ssize_t count = write(descriptor, bytes + done, size - done);
        if (count < 0 && errno == EINTR) continue;
        written = count > 0;
        if (written) done += static_cast<size_t>(count);
    }
    const int saved = errno;
    written = close(descriptor) == 0 && written;
    if (!written || std::rename(temporary.c_str(), path.c_str()) != 0) {
        problem = "cannot write " + path + ": " + std::strerror(written ? errno : saved);
        unlink(temporary.c_str());
        return false;
    }
    return true;
}

}  // namespace ovo_profile
