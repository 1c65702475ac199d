#include "platform/port/Stream.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <ctime>
#include <pthread.h>
#include <sys/stat.h>
#include <unistd.h>

namespace Port {

namespace {

constexpr std::size_t chunkSize = 4096;
constexpr std::size_t longestCharacter = 4;

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
        // The signal of this write is taken away before signals are let in again; one that waited before is the host's.
        const timespec atOnce{};
        if (!m_wasPending) {
            while (sigtimedwait(&m_pipe, nullptr, &atOnce) == -1 && errno == EINTR) {
            }
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
        if (written >= 0) {
            text.remove_prefix(static_cast<std::size_t>(written));
        } else if (errno != EINTR) {
            // No reader or a full disk: a message is lost, which is no reason to disturb the work it tells of.
            return;
        }
    }
}

/// Bytes read into the buffer; 0 at the end of the file and when it cannot be read on.
std::size_t readSome(int descriptor, char* to, std::size_t size) {
    for (;;) {
        const ssize_t got = ::read(descriptor, to, size);
        if (got >= 0 || errno != EINTR) {
            return got > 0 ? static_cast<std::size_t>(got) : 0;
        }
    }
}

/// What a file has behind the place up to which it was read; 0 where that cannot be known.
std::size_t sizeOfRest(int descriptor) {
    struct stat status{};
    const off_t at = ::lseek(descriptor, 0, SEEK_CUR);
    const bool isKnown = at >= 0 && ::fstat(descriptor, &status) == 0 && status.st_size > at;
    return isKnown ? static_cast<std::size_t>(status.st_size - at) : 0;
}

/// Length of the line end at the beginning of @p text.
std::size_t lineEndLength(std::string_view text) {
    return text.starts_with("\r\n") ? 2 : 1;
}

} // namespace

Stream::Stream(int descriptor) : m_descriptor(descriptor) {}

Stream::~Stream() = default;

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

int Stream::readline(char* to, int limit) {
    const auto most = static_cast<std::size_t>(std::max(limit, 1));
    // Enough to see a line end behind the longest piece, and whether a cut there would split a character.
    buffer(most + longestCharacter);
    const std::string_view text = std::string_view(m_input).substr(m_consumed, most + longestCharacter);
    std::size_t length = text.find_first_of("\r\n");
    std::size_t used = 0;
    m_eof = false;
    if (length <= most) {
        used = length + lineEndLength(text.substr(length));
    } else if (text.size() > most) {
        length = tvx::text::characterStart(text, most);
        // A limit smaller than one character: cutting it is the only way on.
        used = length = length > 0 ? length : most;
    } else {
        used = length = text.size();
        m_eof = true;
    }
    std::memcpy(to, text.data(), length);
    to[length] = '\0';
    m_consumed += used;
    return static_cast<int>(length);
}

bool Stream::geteof() const {
    return m_eof;
}

std::string Stream::readall() {
    std::string text = m_input.substr(m_consumed);
    m_input.clear();
    m_consumed = 0;
    std::size_t length = text.size();
    // One byte more than the file is said to have: the read that leaves it empty tells that the file ends there.
    text.resize(length + sizeOfRest(m_descriptor) + 1);
    while (const std::size_t got = readSome(m_descriptor, text.data() + length, text.size() - length)) {
        length += got;
        if (length == text.size()) {
            text.resize(length + std::max(length, chunkSize));
        }
    }
    text.resize(length);
    m_exhausted = true;
    m_eof = true;
    return text;
}

/// Reads on until @p count bytes wait, or there are no more.
void Stream::buffer(std::size_t count) {
    if (m_exhausted || m_input.size() - m_consumed >= count) {
        return;
    }
    m_input.erase(0, m_consumed);
    m_consumed = 0;
    while (!m_exhausted && m_input.size() < count) {
        const std::size_t before = m_input.size();
        m_input.resize(before + chunkSize);
        const std::size_t got = readSome(m_descriptor, m_input.data() + before, chunkSize);
        m_input.resize(before + got);
        m_exhausted = got == 0;
    }
}

} // namespace Port
