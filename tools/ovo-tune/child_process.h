#ifndef OVO_TOOLS_OVO_TUNE_CHILD_PROCESS_H
#define OVO_TOOLS_OVO_TUNE_CHILD_PROCESS_H

#include <sys/types.h>

#include <string>
#include <vector>

// The programs that ovo-tune starts: the one it tunes, which runs beside it, and adb, whose
// answer it waits for.
namespace ovo_tune {

// The full path of `name` as execvp would find it (through PATH unless it holds a '/');
// false when there is no executable file of that name.
bool FindProgram(const std::string& name, std::string* path);

// Starts `arguments` (a full path first) with exactly `environment` (NAME=VALUE), standard
// input from /dev/null and standard output and error appended to `output_path`. Returns
// the process id, or -1 with the reason in `problem`.
pid_t StartChild(const std::vector<std::string>& arguments, const std::vector<std::string>& environment,
                 const std::string& output_path, std::string* problem);

// How a process that waitpid reported ended: "exited with status 3", "was ended by signal
// 11 (Segmentation fault)".
std::string DescribeEnding(int wait_status);

// Ends a child: SIGTERM, and SIGKILL when it has not ended after a grace period.
void StopChild(pid_t child);

struct CommandResult {
    bool m_started = false;
    int m_wait_status = 0;
    std::string m_output;  // standard output, byte for byte
    std::string m_errors;  // standard error
    bool Succeeded() const;
};

// Runs `arguments` (searched on PATH) to its end with this process's environment.
CommandResult RunCommand(const std::vector<std::string>& arguments);

}  // namespace ovo_tune

#endif
