#ifndef OVO_CONFIG_COMMAND_LINE_AREA_H
#define OVO_CONFIG_COMMAND_LINE_AREA_H

// The process's argument strings, read where they are. The kernel serves /proc/self/cmdline
// from this memory, so a name written over them after start (as Android renames a process
// forked from the zygote) is seen here as in the file, without a system call.

#include <cstddef>

namespace ovo {

// Where the argument strings lie; a length of 0 means the area is not known.
struct CommandLineArea {
    const char* m_start = nullptr;
    size_t m_length = 0;
};

// What reading the process name from the area gave.
enum CommandLineName : int {
    // The name, as the first string of /proc/self/cmdline gives it.
    COMMAND_LINE_NAME_READ = 0,
    // The area holds no NUL: the kernel's reader then carries the name on past the area's
    // end, which this reader never looks at; the name holds what lies inside the area.
    COMMAND_LINE_NAME_RUNS_ON = 1,
    // The area is not known; only the file can tell.
    COMMAND_LINE_AREA_UNKNOWN = 2,
};

// The area of this process, from /proc/self/stat (arg_start and arg_end). Unknown when the
// file does not give it: kernels before 3.5, emulators that write their own.
CommandLineArea LocateCommandLineArea();

// The area given by a line of /proc/self/stat (fields 48 and 49, counted after the
// parenthesised command name, which may itself hold spaces and parentheses). Unknown when
// the fields are missing, malformed, too large for an address, or give no area.
CommandLineArea ParseCommandLineArea(const char* stat_line);

// The process name from the area into `name` (PROFILE_PROCESS_NAME_CAPACITY bytes, always
// terminated): the first NUL-terminated string, cut as the file's reader cuts it. Reads
// nothing outside the area; no system call, no allocation.
CommandLineName ReadNameInArea(const CommandLineArea& area, char* name);

}  // namespace ovo

#endif
