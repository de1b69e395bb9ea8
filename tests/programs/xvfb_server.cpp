#include "xvfb_server.h"

#include <poll.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace {
// The window system's screen; larger than any window the programs open.
constexpr char XVFB_SCREEN[] = "1024x768x24";
constexpr int XVFB_START_TIMEOUT_MS = 20000;
}  // namespace

XvfbServer::~XvfbServer() {
    if (m_pid <= 0) return;
    kill(m_pid, SIGTERM);
    int status = 0;
    waitpid(m_pid, &status, 0);
}

// Xvfb writes its display number to the -displayfd descriptor once it takes clients.
bool XvfbServer::Start(std::string* problem) {
    int channel[2];
    if (pipe(channel) != 0) {
        *problem = "pipe: " + std::string(std::strerror(errno));
        return false;
    }
    m_pid = fork();
    if (m_pid == 0) {
        close(channel[0]);
        const std::string descriptor = std::to_string(channel[1]);
        execlp("Xvfb", "Xvfb", "-displayfd", descriptor.c_str(), "-screen", "0", XVFB_SCREEN,
               "-nolisten", "tcp", "-noreset", static_cast<char*>(nullptr));
        _exit(127);
    }
    close(channel[1]);
    std::string number;
    pollfd ready = {channel[0], POLLIN, 0};
    while (m_pid > 0 && poll(&ready, 1, XVFB_START_TIMEOUT_MS) == 1) {
        char byte = 0;
        if (read(channel[0], &byte, 1) != 1 || byte == '\n') break;
        number.push_back(byte);
    }
    close(channel[0]);
    if (m_pid < 0 || number.empty()) {
        *problem = "Xvfb did not start (is the xvfb package installed?)";
        return false;
    }
    m_display = ":" + number;
    return true;
}
