#include "platform/log.h"

#include <cstdarg>
#include <cstdio>

#ifdef __ANDROID__
#include <android/log.h>
#else
#include <unistd.h>
#endif

namespace ovo {

namespace {
constexpr const char* LOG_TAG = "ZVT";
}

#ifdef __ANDROID__

void LogPrint(LogPriority priority, const char* format, ...) {
    va_list arguments;
    va_start(arguments, format);
    __android_log_vprint(priority, LOG_TAG, format, arguments);
    va_end(arguments);
}

#else

namespace {
char PriorityLetter(LogPriority priority) {
    switch (priority) {
        case LOG_PRIORITY_DEBUG: return 'D';
        case LOG_PRIORITY_INFO: return 'I';
        case LOG_PRIORITY_ERROR: return 'E';
    }
    return '?';
}
}  // namespace

void LogPrint(LogPriority priority, const char* format, ...) {
    // Composed first and written at once, so lines of concurrent writers never interleave.
    char line[1024];
    int prefix = std::snprintf(line, sizeof(line), "%c/%s: ", PriorityLetter(priority), LOG_TAG);
    va_list arguments;
    va_start(arguments, format);
    int body = std::vsnprintf(line + prefix, sizeof(line) - prefix - 1, format, arguments);
    va_end(arguments);
    size_t length = prefix + (body < 0 ? 0 : static_cast<size_t>(body));
    if (length > sizeof(line) - 2) length = sizeof(line) - 2;
    line[length++] = '\n';
    ssize_t written = write(STDERR_FILENO, line, length);
    (void)written;
}

#endif

}  // namespace ovo
