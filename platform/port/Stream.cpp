#include "platform/port/Stream.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <ctime>
#include <pthread.h>
#include <unistd.h>

namespace Port {

namespace {

/// Holds back the signal that a pipe without reader sends, which would end the process, for the length of a write.
class BrokenPipeGuard {
public:
    BrokenPipeGuard() {
        sigemptyset(&m_pipe);
        sigaddset(&m_pipe, SIGPIPE);
        sigset_t pending;
        sigpending(&pending);
        m_wasPending = sigismember(&pending, SIGPIPE) != 0;
        pthread_sigmask(SIG_BLOCK, &m_pipe, &m_before);
    }
    ~BrokenPipeGuard() {
        const timespec atOnce{};
        if (!m_wasPending)
            while (sigtimedwait(&m_pipe, nullptr, &atOnce) == -1 && errno == EINTR) {
            }
        pthread_sigmask(SIG_SETMASK, &m_before, nullptr);
    }
    BrokenPipeGuard(const BrokenPipeGuard&) = delete;
    BrokenPipeGuard& operator=(const BrokenPipeGuard&) = delete;

private:
    sigset_t m_pipe;
    sigset_t m_before;
    bool m_wasPending;
};

void writeAll(int descriptor, std::string_view text) {
    while (!text.empty()) {
        const ssize_t written = ::write(descriptor, text.data(), text.size());
        if (written >= 0)
            text.remove_prefix(static_cast<std::size_t>(written));
        else if (errno != EINTR)
            return;
    }
}

} // namespace

Stream::Stream(int descriptor) : m_descriptor(descriptor) {}

Stream& Stream::operator<<(const char* text) {
    return text ? *this << std::string_view(text) : *this;
}

Stream& Stream::operator<<(std::string_view text) {
    const BrokenPipeGuard guard;
    // What the host printed before must come out before.
    std::fflush(m_descriptor == STDOUT_FILENO ? stdout : stderr);
    writeAll(m_descriptor, text);
    return *this;
}

Stream& Stream::operator<<(const std::string& text) {
    return *this << std::string_view(text);
}

Stream& Stream::operator<<(char character) {
    return *this << std::string_view(&character, 1);
}

Stream& Stream::operator<<(Stream& (*manipulator)(Stream&)) {
    return manipulator(*this);
}

Stream& Stream::endl(Stream& stream) {
    return stream << '\n';
}

} // namespace Port
