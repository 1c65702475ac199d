#include "platform/win/Handle.h"

#include "platform/win/Process.h"
#include "platform/win/detail/KernelObject.h"
#include "platform/win/detail/NumberTable.h"

#include <cerrno>
#include <chrono>
#include <fcntl.h>
#include <poll.h>
#include <unistd.h>
#include <utility>

namespace tvx::win {

namespace {

struct Entry {
    std::shared_ptr<KernelObject> object;
    Inheritance inheritance = Inheritance::None;
};

/// The handles of the process. Never destroyed: static objects of hosts may hold handles.
NumberTable<Entry>& handles() {
    static auto* table = new NumberTable<Entry>;
    return *table;
}

std::uintptr_t numberOf(HANDLE handle) {
    return reinterpret_cast<std::uintptr_t>(handle);
}

Entry entryOf(HANDLE handle) {
    Entry found;
    handles().with(numberOf(handle), [&](const Entry& entry) { found = entry; });
    return found;
}

using Clock = std::chrono::steady_clock;

/// What is left until `deadline`, rounded up so that nobody returns too early.
timespec remaining(Clock::time_point deadline) {
    const auto left = std::max(deadline - Clock::now(), Clock::duration::zero());
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(left);
    return {seconds.count(), std::chrono::nanoseconds(left - seconds).count()};
}

} // namespace

Descriptor::Descriptor(int number) noexcept : m_number(number) {
    const bool misplaced = number >= 0 && number <= STDERR_FILENO;
    const int moved = misplaced ? ::fcntl(number, F_DUPFD_CLOEXEC, STDERR_FILENO + 1) : -1;
    if (moved >= 0) {
        ::close(number);
        m_number = moved;
    }
}

Descriptor& Descriptor::operator=(Descriptor&& other) noexcept {
    std::swap(m_number, other.m_number);
    return *this;
}

Descriptor::~Descriptor() {
    if (m_number >= 0) {
        ::close(m_number);
    }
}

int Descriptor::release() noexcept {
    return std::exchange(m_number, -1);
}

short waitReadable(int descriptor, DWORD timeout) {
    pollfd entry{descriptor, POLLIN, 0};
    if (timeout == 0) {
        return ::poll(&entry, 1, 0) > 0 ? entry.revents : short{0};
    }
    const auto deadline = Clock::now() + std::chrono::milliseconds(timeout);
    for (;;) {
        const timespec left = remaining(deadline);
        const int count = ::ppoll(&entry, 1, timeout == INFINITE ? nullptr : &left, nullptr);
        if (count >= 0 || errno != EINTR) {
            return count > 0 ? entry.revents : short{0};
        }
    }
}

HANDLE makeHandle(std::shared_ptr<KernelObject> object, Inheritance inheritance) {
    return reinterpret_cast<HANDLE>(handles().add({std::move(object), inheritance}));
}

std::shared_ptr<KernelObject> objectOf(HANDLE handle) {
    std::shared_ptr<KernelObject> object = entryOf(handle).object;
    if (!object) {
        SetLastError(ERROR_INVALID_HANDLE);
    }
    return object;
}

bool isInheritable(HANDLE handle) {
    return entryOf(handle).inheritance == Inheritance::Inheritable;
}

} // namespace tvx::win

using namespace tvx::win;

BOOL CloseHandle(HANDLE handle) {
    if (handles().take(numberOf(handle)).object) {
        return TRUE;
    }
    SetLastError(ERROR_INVALID_HANDLE);
    return FALSE;
}

BOOL DuplicateHandle(HANDLE sourceProcess, HANDLE source, HANDLE targetProcess, HANDLE* target, DWORD /*access*/,
                     BOOL inherit, DWORD options) {
    if (sourceProcess != GetCurrentProcess() || targetProcess != GetCurrentProcess()) {
        SetLastError(ERROR_ACCESS_DENIED);
        return FALSE;
    }
    std::shared_ptr<KernelObject> object = objectOf(source);
    if (!object) {
        return FALSE;
    }
    if (options & DUPLICATE_CLOSE_SOURCE) {
        CloseHandle(source);
    }
    *target = makeHandle(std::move(object), inherit ? Inheritance::Inheritable : Inheritance::None);
    return TRUE;
}

DWORD WaitForSingleObject(HANDLE handle, DWORD timeout) {
    const std::shared_ptr<KernelObject> object = objectOf(handle);
    if (!object) {
        return WAIT_FAILED;
    }
    return waitReadable(object->descriptor(), timeout) ? WAIT_OBJECT_0 : WAIT_TIMEOUT;
}
