#ifndef OVO_PLATFORM_LOG_H
#define OVO_PLATFORM_LOG_H

namespace ovo {

// Android log priorities used by the library.
enum LogPriority {
    LOG_PRIORITY_DEBUG = 3,
    LOG_PRIORITY_INFO = 4,
    LOG_PRIORITY_ERROR = 6,
};

// One line of the Android log under the tag "ZVT". On host builds the line goes to
// standard error as "<priority letter>/ZVT: <message>".
void LogPrint(LogPriority priority, const char* format, ...)
    __attribute__((format(printf, 2, 3)));

}  // namespace ovo

#endif
