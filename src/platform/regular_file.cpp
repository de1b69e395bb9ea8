#include "platform/regular_file.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace ovo {

int OpenRegularFile(const char* path, RegularFileUse use) {
    const int access = use == REGULAR_FILE_READ ? O_RDONLY : O_WRONLY | O_CREAT;
    const int file = open(path, access | O_NONBLOCK | O_NOCTTY | O_CLOEXEC, 0666);
    if (file < 0) return -1;
    struct stat status;
    // Emptied only once it is known to be a regular file, and then put back into blocking
    // mode, so that its reads and writes behave as after fopen.
    const bool regular = fstat(file, &status) == 0 && S_ISREG(status.st_mode);
    if (!regular || (use == REGULAR_FILE_REPLACE && ftruncate(file, 0) != 0) ||
        fcntl(file, F_SETFL, fcntl(file, F_GETFL) & ~O_NONBLOCK) != 0) {
        close(file);
        return -1;
    }
    return file;
}

FILE* OpenRegularStream(const char* path, RegularFileUse use) {
    const int file = OpenRegularFile(path, use);
    if (file < 0) return nullptr;
    FILE* stream = fdopen(file, use == REGULAR_FILE_READ ? "r" : "w");
    if (stream == nullptr) close(file);
    return stream;
}

}  // namespace ovo
