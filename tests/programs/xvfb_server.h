#ifndef OVO_TESTS_PROGRAMS_XVFB_SERVER_H
#define OVO_TESTS_PROGRAMS_XVFB_SERVER_H

#include <sys/types.h>

#include <string>

// A private X server for one test: Xvfb on the first free display number, gone with the
// object.
class XvfbServer {
public:
    XvfbServer() = default;
    ~XvfbServer();
    XvfbServer(const XvfbServer&) = delete;
    XvfbServer& operator=(const XvfbServer&) = delete;

    // Starts the server and waits until it takes clients; false (with the reason in
    // `problem`) when it does not come up.
    bool Start(std::string* problem);
    // ":N", for DISPLAY.
    const std::string& Display() const { return m_display; }

private:
    pid_t m_pid = -1;
    std::string m_display;
};

#endif
