// Something other than a regular file at one of the library's file paths (a FIFO, a
// directory, a character device) counts as no file: opening it never blocks, nothing is
// read from it and nothing is written into it.
#include <gtest/gtest.h>

#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <string>

#include "config/debug_config.h"
#include "config/stereo_profile.h"
#include "config/version_report.h"
#include "present/live_tuning.h"
#include "support/device_files.h"

namespace {

const char LOG_PATH[] = "/sdcard/x.log";
const char FALLBACK_PATH[] = "/data/duoscope/debug.log";
const char LINE[] = "0007 : eye_distance(1.5)";
// A library that blocks in open or read is stopped after this long, and the case fails.
constexpr unsigned HANG_SECONDS = 5;

// One of the library's files and one use of it by the library.
struct LibraryFile {
    const char* m_device_path;
    // What the other end of a FIFO offers: a file that would change what the library does
    // if it were read. Empty for the files that the library writes.
    std::string m_offered;
    // Uses the file as the library does; true when that went as it goes without the file.
    std::function<bool()> m_behaves_as_missing;
};

const LibraryFile FILES[] = {
    {ovo::PROFILE_PATH, device_files::ProfileFile({{0x2301, {1}}, {0x2403, {1}}}),
     [] { return !ovo::StereoProfile().m_enabled; }},
    {ovo::DEBUG_CONFIG_PATH,
     "<duoscope version=\"1.0\"><debug enable=\"true\"><output filename=\"/sdcard/x.log\"/>"
     "</debug></duoscope>",
     [] {
         ovo::DebugConfig().Print("%s", LINE);
         return device_files::Read(LOG_PATH) == "old" && device_files::Read(FALLBACK_PATH) == "old";
     }},
    // A log path that is no file is one that cannot be opened: the fallback takes the lines.
    {LOG_PATH, "",
     [] {
         ovo::FileDebugLog(LOG_PATH).Write(LINE);
         return device_files::Read(FALLBACK_PATH) == LINE;
     }},
    {FALLBACK_PATH, "", [] { ovo::FileDebugLog("/sdcard/missing/x.log").Write(LINE); return true; }},
    {ovo::LIVE_TUNING_PATH, "1 2 3 4 5\n",
     [] {
         ovo::StereoProfile profile;
         profile.m_eye_distance = profile.m_ramp_steps = 9.0f;
         ovo::ReadLiveTuning(profile);
         return profile.m_eye_distance == 9.0f && profile.m_ramp_steps == 9.0f;
     }},
    {ovo::VERSION_REPORT_PATH, "",
     [] {
         ovo::VersionReport report(nullptr);
         report.SetPackageName("com.example.game");
         report.Write();
         return true;
     }},
};

enum NodeKind { FIFO_ALONE, FIFO_WITH_PEER, DIRECTORY, TERMINAL, NULL_DEVICE };
const char* const NODE_NAMES[] = {"a FIFO without a peer", "a FIFO with a peer", "a directory",
                                  "a terminal", "a link to /dev/null"};

// The node at a file's path, and our end of it when it has one.
class Node {
public:
    Node(NodeKind kind, const std::string& path, const std::string& offered) : m_end(-1) {
        std::filesystem::create_directories(std::filesystem::path(path).parent_path());
        switch (kind) {
            case FIFO_ALONE:
            case FIFO_WITH_PEER:
                EXPECT_EQ(mkfifo(path.c_str(), 0600), 0);
                // Read and write: a FIFO opened so never blocks, and is its own peer.
                if (kind == FIFO_WITH_PEER) m_end = open(path.c_str(), O_RDWR | O_NONBLOCK);
                if (m_end >= 0 && !offered.empty()) {
                    EXPECT_EQ(write(m_end, offered.data(), offered.size()), ssize_t(offered.size()));
                }
                break;
            case DIRECTORY:
                std::filesystem::create_directories(path);
                break;
            case TERMINAL:
                // A pseudo-terminal: a character device anyone may make, whose reads block
                // and whose writes arrive at our end.
                m_end = posix_openpt(O_RDWR | O_NOCTTY | O_NONBLOCK);
                EXPECT_GE(m_end, 0);
                EXPECT_TRUE(m_end >= 0 && grantpt(m_end) == 0 && unlockpt(m_end) == 0);
                EXPECT_EQ(symlink(m_end >= 0 ? ptsname(m_end) : "/dev/null", path.c_str()), 0);
                break;
            case NULL_DEVICE:
                EXPECT_EQ(symlink("/dev/null", path.c_str()), 0);
                break;
        }
    }
    ~Node() {
        if (m_end >= 0) close(m_end);
    }

    // Everything waiting at our end.
    std::string Pending() const {
        std::string bytes;
        char chunk[256];
        for (ssize_t got; m_end >= 0 && (got = read(m_end, chunk, sizeof(chunk))) > 0;) bytes.append(chunk, size_t(got));
        return bytes;
    }

private:
    int m_end;
};

enum Outcome { AS_MISSING, NOT_AS_MISSING, HUNG };

// Runs `use` in a child process that is stopped when it blocks.
Outcome RunGuarded(const std::function<bool()>& use) {
    const pid_t child = fork();
    if (child == 0) {
        alarm(HANG_SECONDS);
        _exit(use() ? 0 : 1);
    }
    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    if (WIFSIGNALED(status) && WTERMSIG(status) == SIGALRM) return HUNG;
    return WIFEXITED(status) && WEXITSTATUS(status) == 0 ? AS_MISSING : NOT_AS_MISSING;
}

TEST(LibraryFiles, AnythingButARegularFileCountsAsMissing) {
    for (const LibraryFile& file : FILES) {
        for (NodeKind kind : {FIFO_ALONE, FIFO_WITH_PEER, DIRECTORY, TERMINAL, NULL_DEVICE}) {
            SCOPED_TRACE(std::string(file.m_device_path) + " is " + NODE_NAMES[kind]);
            for (const char* folder : {"/sdcard", "/data"}) std::filesystem::remove_all(device_files::Path(folder));
            for (const char* log : {LOG_PATH, FALLBACK_PATH}) device_files::Write(log, "old");
            std::filesystem::remove(device_files::Path(file.m_device_path));
            const Node node(kind, device_files::Path(file.m_device_path), file.m_offered);

            EXPECT_EQ(RunGuarded(file.m_behaves_as_missing), AS_MISSING);
            // Nothing taken from a peer, nothing written to it.
            EXPECT_EQ(node.Pending(), kind == FIFO_WITH_PEER ? file.m_offered : "");
        }
    }
}

}  // namespace
