#pragma once

#include "platform/afx/core/WindowCalls.h"

#include <chrono>
#include <cstdio>
#include <fcntl.h>
#include <functional>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

/// Looks again and again until something holds, for ten seconds at most.
inline bool becomesTrue(const std::function<bool()>& holds) {
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(10);
    while (!holds()) {
        if (std::chrono::steady_clock::now() > end) {
            return false;
        }
        poll(nullptr, 0, 5);
    }
    return true;
}

/// Another process with one window (PeerMain.cpp), on the screen when the constructor is through.
class Peer {
public:
    Peer() {
        int input[2];
        int output[2];
        if (pipe2(input, O_CLOEXEC) != 0 || pipe2(output, O_CLOEXEC) != 0) {
            return;
        }
        posix_spawn_file_actions_t actions;
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_adddup2(&actions, input[0], 0);
        posix_spawn_file_actions_adddup2(&actions, output[1], 1);
        char name[] = TVX_TEST_PEER;
        char* arguments[] = {name, nullptr};
        posix_spawn(&process, name, &actions, nullptr, arguments, environ);
        posix_spawn_file_actions_destroy(&actions);
        close(input[0]);
        close(output[1]);
        m_input = input[1];
        FILE* written = fdopen(output[0], "r");
        std::size_t number = 0;
        if (std::fscanf(written, "%zu", &number) == 1) {
            window = reinterpret_cast<HWND>(number);
        }
        std::fclose(written);
        shown = becomesTrue([this] { return GetForegroundWindow() == window; });
    }
    ~Peer() {
        end();
    }
    Peer(const Peer&) = delete;
    Peer& operator=(const Peer&) = delete;

    /// Ends the process and waits for its end.
    void end() {
        if (m_input < 0) {
            return;
        }
        close(m_input);
        m_input = -1;
        waitpid(process, nullptr, 0);
    }

    HWND window = nullptr;
    pid_t process = 0;
    bool shown = false;

private:
    int m_input = -1;
};
