#ifndef OVO_TESTS_THREADS_THREADS_TOGETHER_H
#define OVO_TESTS_THREADS_THREADS_TOGETHER_H

#include <atomic>
#include <fstream>
#include <sstream>
#include <string>
#include <thread>
#include <vector>

#include "config/stereo_profile.h"
#include "support/device_files.h"

// Runs body(number) on `count` threads that all start at the same moment, so that their
// first calls meet, and returns once every one has finished.
template <typename Body>
void RunTogether(int count, Body body) {
    std::atomic<int> waiting{count};
    std::vector<std::thread> threads;
    for (int number = 0; number < count; ++number) {
        threads.emplace_back([&waiting, &body, number] {
            waiting.fetch_sub(1);
            while (waiting.load() > 0) std::this_thread::yield();
            body(number);
        });
    }
    for (std::thread& thread : threads) thread.join();
}

// Runs body() on a thread of its own, to its end.
template <typename Body>
void RunOnAnotherThread(Body body) {
    std::thread(body).join();
}

// Calls GL on a thread that never made a context current, over and over, until Stop():
// the calls of a loader or UI thread that forgot its context. Every call must do nothing.
class ContextlessCaller {
public:
    ContextlessCaller() : m_thread([this] { Run(); }) {}
    ~ContextlessCaller() { Stop(); }

    void Stop() {
        m_stop.store(true);
        if (m_thread.joinable()) m_thread.join();
    }
    // Returns once the calls have gone round at least once.
    void WaitForFirstRound() const {
        while (m_rounds.load() == 0) std::this_thread::yield();
    }
    // What the calls gave back and wrote, summed: 0 while every call did nothing.
    long Answers() const { return m_answers; }

private:
    void Run();

    std::atomic<bool> m_stop{false};
    std::atomic<int> m_rounds{0};
    long m_answers = 0;
    std::thread m_thread;
};

// The stereo profile that tests/e2e/profiles/NAME.txt describes, built by ovo-profile,
// installed as the companion application installs it before the game starts.
inline void InstallProfile(const std::string& built_profile) {
    std::ifstream file(built_profile, std::ios::binary);
    std::stringstream bytes;
    bytes << file.rdbuf();
    device_files::Write(ovo::PROFILE_PATH, bytes.str());
}

#endif
