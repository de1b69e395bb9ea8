#include "part_process.h"

#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>

namespace {

constexpr char PART_FLAG[] = "--ovo_part=";
constexpr char FIGURES_FD_FLAG[] = "--ovo_figures_fd=";

bool TakeValue(const char* argument, const char* flag, const char** value) {
    const size_t length = std::strlen(flag);
    if (std::strncmp(argument, flag, length) != 0) return false;
    *value = argument + length;
    return true;
}

std::string ReadAll(int fd) {
    std::string text;
    char buffer[4096];
    ssize_t length;
    while ((length = read(fd, buffer, sizeof(buffer))) > 0) text.append(buffer, length);
    return text;
}

}  // namespace

bool RunPart(const char* process_name, const std::string& part,
             const std::vector<std::string>& arguments, BenchFigureTable* figures) {
    int channel[2];
    if (pipe(channel) != 0) {
        std::perror("stereo_draw_bench: pipe");
        return false;
    }
    std::vector<std::string> words = {process_name, PART_FLAG + part,
                                      FIGURES_FD_FLAG + std::to_string(channel[1])};
    words.insert(words.end(), arguments.begin(), arguments.end());
    std::vector<char*> command;
    for (std::string& word : words) command.push_back(word.data());
    command.push_back(nullptr);

    std::fflush(stdout);
    std::fflush(stderr);
    const pid_t child = fork();
    if (child == 0) {
        close(channel[0]);
        execv("/proc/self/exe", command.data());
        std::perror("stereo_draw_bench: execv");
        _exit(127);
    }
    close(channel[1]);
    const std::string text = child > 0 ? ReadAll(channel[0]) : std::string();
    close(channel[0]);
    int status = 0;
    if (child < 0 || waitpid(child, &status, 0) != child || !WIFEXITED(status) ||
        WEXITSTATUS(status) != 0) {
        std::fprintf(stderr, "stereo_draw_bench: the part %s failed\n", part.c_str());
        return false;
    }
    if (!ParseFigures(text, figures)) {
        std::fprintf(stderr, "stereo_draw_bench: the part %s reported malformed figures\n",
                     part.c_str());
        return false;
    }
    return true;
}

bool TakePartFlags(int* argc, char** argv, PartFlags* flags) {
    const char* part = nullptr;
    const char* fd = nullptr;
    if (*argc < 3 || !TakeValue(argv[1], PART_FLAG, &part) ||
        !TakeValue(argv[2], FIGURES_FD_FLAG, &fd)) {
        return false;
    }
    flags->m_part = part;
    flags->m_figures_fd = std::atoi(fd);
    for (int i = 3; i <= *argc; ++i) argv[i - 2] = argv[i];  // argv[argc] is null
    *argc -= 2;
    return true;
}

bool ReportFigures(const PartFlags& flags, const BenchFigureTable& figures) {
    const std::string text = FormatFigures(figures);
    size_t written = 0;
    while (written < text.size()) {
        const ssize_t length =
            write(flags.m_figures_fd, text.data() + written, text.size() - written);
        if (length <= 0) {
            std::perror("stereo_draw_bench: reporting the figures");
            return false;
        }
        written += static_cast<size_t>(length);
    }
    return true;
}
