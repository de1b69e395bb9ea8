#ifndef OVO_TESTS_TUNE_TOOL_PROCESS_H
#define OVO_TESTS_TUNE_TOOL_PROCESS_H

#include <sys/types.h>

#include <regex>
#include <string>
#include <vector>

// ovo-tune run as a person or a script would run it: keys written to its standard input as
// the test goes, its report read line by line from its standard output.
class ToolProcess {
public:
    ToolProcess() = default;
    ~ToolProcess();
    ToolProcess(const ToolProcess&) = delete;
    ToolProcess& operator=(const ToolProcess&) = delete;

    // Starts `arguments` (a full path first) with NAME=VALUE `environment` on top of this
    // process's; standard error goes to `errors_path`.
    bool Start(const std::vector<std::string>& arguments, const std::vector<std::string>& environment,
               const std::string& errors_path);
    void Send(const std::string& text);
    void CloseInput();
    // The next line of the report that matches `pattern`, read within `seconds`; false when
    // none came (the report ended, or the time ran out).
    bool WaitForLine(const std::regex& pattern, int seconds, std::smatch* match, std::string* line);
    // The exit status once it ended within `seconds`, -1 when it had to be killed.
    int Wait(int seconds);
    // Everything it reported so far.
    const std::string& Report() const { return m_report; }

private:
    bool ReadLine(int milliseconds, std::string* line);

    pid_t m_pid = -1;
    int m_input = -1;
    int m_output = -1;
    std::string m_report;
    std::string m_unread;
};

#endif
