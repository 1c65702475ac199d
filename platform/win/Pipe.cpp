#include "platform/win/Pipe.h"

#include "platform/win/Error.h"
#include "platform/win/detail/PipeObject.h"

#include <cerrno>
#include <fcntl.h>
#include <poll.h>
#include <sys/ioctl.h>
#include <unistd.h>

using namespace tvx::win;

namespace {

constexpr int capacity = 1 << 20;

BOOL failed(DWORD error) {
    SetLastError(error);
    return FALSE;
}

/// The bytes that wait, -1 when none do and none can come any more.
int waitingBytes(int pipe) {
    const short events = waitReadable(pipe, 0);
    if (!(events & POLLIN)) {
        return events == 0 ? 0 : -1;
    }
    int count = 0;
    return ::ioctl(pipe, FIONREAD, &count) == 0 ? count : 0;
}

} // namespace

BOOL CreatePipe(HANDLE* readEnd, HANDLE* writeEnd, const SECURITY_ATTRIBUTES* attributes, DWORD size) {
    int ends[2];
    if (::pipe2(ends, O_CLOEXEC) != 0) {
        return failed(tvx::errorFromErrno(errno));
    }
    // The system's own size does where it allows no more.
    if (size == 0) {
        ::fcntl(ends[0], F_SETPIPE_SZ, capacity);
    }
    const Inheritance inheritance =
        attributes && attributes->bInheritHandle ? Inheritance::Inheritable : Inheritance::None;
    *readEnd = makeHandle(std::make_shared<PipeObject>(Descriptor(ends[0])), inheritance);
    *writeEnd = makeHandle(std::make_shared<PipeObject>(Descriptor(ends[1])), inheritance);
    return TRUE;
}

BOOL PeekNamedPipe(HANDLE pipe, LPVOID buffer, DWORD /*size*/, DWORD* /*read*/, DWORD* available, DWORD* /*left*/) {
    if (buffer) {
        return failed(ERROR_NOT_SUPPORTED);
    }
    const auto object = objectOf<PipeObject>(pipe);
    if (!object) {
        return FALSE;
    }
    const int count = waitingBytes(object->descriptor());
    if (count < 0) {
        return failed(ERROR_BROKEN_PIPE);
    }
    if (available) {
        *available = static_cast<DWORD>(count);
    }
    return TRUE;
}

BOOL ReadFile(HANDLE pipe, LPVOID buffer, DWORD size, DWORD* read, LPVOID /*overlapped*/) {
    *read = 0;
    const auto object = objectOf<PipeObject>(pipe);
    if (!object) {
        return FALSE;
    }
    ssize_t count = 0;
    do {
        count = ::read(object->descriptor(), buffer, size);
    } while (count < 0 && errno == EINTR);
    if (count < 0) {
        return failed(tvx::errorFromErrno(errno));
    }
    *read = static_cast<DWORD>(count);
    return count > 0 || size == 0 ? TRUE : failed(ERROR_BROKEN_PIPE);
}
