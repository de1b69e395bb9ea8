#include "config/command_line_area.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "config/stereo_profile_fields.h"

namespace ovo {

namespace {

constexpr const char SELF_STAT[] = "/proc/self/stat";
// Field numbers of /proc/self/stat as proc(5) counts them: the command name is field 2.
constexpr int STAT_FIELD_AFTER_NAME = 3;
constexpr int STAT_FIELD_ARG_START = 48;
constexpr int STAT_FIELD_ARG_END = 49;
// Room for the whole line: 52 numbers of at most 20 digits and the command name.
constexpr size_t STAT_LINE_CAPACITY = 2048;
// The most of the name that the file's reader keeps.
constexpr size_t NAME_LIMIT = PROFILE_PROCESS_NAME_CAPACITY - 1;

// A decimal field; false for anything else or a value that no address can hold.
bool ParseAddress(const char* begin, const char* end, uintptr_t* value) {
    if (begin == end) return false;
    uintptr_t result = 0;
    for (const char* digit = begin; digit < end; ++digit) {
        if (*digit < '0' || *digit > '9') return false;
        const uintptr_t number = static_cast<uintptr_t>(*digit - '0');
        if (result > (UINTPTR_MAX - number) / 10) return false;
        result = result * 10 + number;
    }
    *value = result;
    return true;
}

}  // namespace

CommandLineArea LocateCommandLineArea() {
    char line[STAT_LINE_CAPACITY];
    const int file = open(SELF_STAT, O_RDONLY | O_CLOEXEC);
    if (file < 0) return {};
    size_t length = 0;
    ssize_t got;
    while (length < sizeof(line) - 1 &&
           (got = read(file, line + length, sizeof(line) - 1 - length)) > 0) {
        length += static_cast<size_t>(got);
    }
    close(file);
    // A full buffer may have cut the line inside the fields wanted.
    if (length == sizeof(line) - 1) return {};
    line[length] = '\0';
    return ParseCommandLineArea(line);
}

CommandLineArea ParseCommandLineArea(const char* stat_line) {
    // The name may hold ") ", so the fields begin after the last parenthesis.
    const char* field = std::strrchr(stat_line, ')');
    if (field == nullptr) return {};
    ++field;
    uintptr_t start = 0;
    uintptr_t end = 0;
    for (int number = STAT_FIELD_AFTER_NAME; number <= STAT_FIELD_ARG_END; ++number) {
        if (*field != ' ') return {};
        ++field;
        const char* field_end = field + std::strcspn(field, " \n");
        if (number == STAT_FIELD_ARG_START && !ParseAddress(field, field_end, &start)) return {};
        if (number == STAT_FIELD_ARG_END && !ParseAddress(field, field_end, &end)) return {};
        field = field_end;
    }
    // Zeros when the kernel withholds them; an empty area has no name to read in place.
    if (start == 0 || end <= start) return {};
    return {reinterpret_cast<const char*>(start), static_cast<size_t>(end - start)};
}

CommandLineName ReadNameInArea(const CommandLineArea& area, char* name) {
    name[0] = '\0';
    if (area.m_length == 0) return COMMAND_LINE_AREA_UNKNOWN;
    const size_t readable = std::min(area.m_length, NAME_LIMIT);
    const void* terminator = std::memchr(area.m_start, '\0', readable);
    const size_t length =
        terminator != nullptr ? static_cast<size_t>(static_cast<const char*>(terminator) - area.m_start)
                              : readable;
    std::memcpy(name, area.m_start, length);
    name[length] = '\0';
    // The kernel takes a name without a NUL in the area as rewritten in place and reads on
    // past the area's end (into the environment that follows it), up to the reader's limit.
    const bool runs_on = terminator == nullptr && area.m_length < NAME_LIMIT;
    return runs_on ? COMMAND_LINE_NAME_RUNS_ON : COMMAND_LINE_NAME_READ;
}

}  // namespace ovo
