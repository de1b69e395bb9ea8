#ifndef OVO_PLATFORM_REGULAR_FILE_H
#define OVO_PLATFORM_REGULAR_FILE_H

#include <cstdio>

namespace ovo {

enum RegularFileUse {
    REGULAR_FILE_READ,
    REGULAR_FILE_REPLACE,  // created when missing, emptied when it exists
};

// Opens `path` only when it is a regular file: a FIFO, a device node, a directory or a
// socket at the path counts as no file at all. The open itself never blocks (a FIFO
// without a peer would hold it forever), and what is at the path is checked on the opened
// descriptor, so it cannot be swapped between the check and the use. Returns the
// descriptor (close-on-exec), or -1.
int OpenRegularFile(const char* path, RegularFileUse use);

// The same as a stdio stream, or null.
FILE* OpenRegularStream(const char* path, RegularFileUse use);

}  // namespace ovo

#endif
