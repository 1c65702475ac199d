#include "platform/win/detail/ProcessObject.h"

#include "platform/win/Process.h"
#include "platform/win/detail/PidFd.h"

#include <algorithm>
#include <cerrno>
#include <sys/epoll.h>
#include <sys/wait.h>

namespace tvx::win {

namespace {

/// Of signals for programs that have failed, for which the system would write down their memory.
constexpr DWORD signalBase = 0xC0000000;
/// Of signals that only end a program, as shells count them.
constexpr DWORD stoppedBase = 128;

/// Collects an ended child. False when it runs, or when somebody else has collected it.
bool collectStatus(int process, siginfo_t& status) {
    status = {};
    int result = 0;
    do {
        result = ::waitid(P_PIDFD, static_cast<id_t>(process), &status, WEXITED | WNOHANG | __WALL);
    } while (result != 0 && errno == EINTR);
    return result == 0 && status.si_pid != 0;
}

bool hasEnded(int process) {
    return waitReadable(process, 0) != 0;
}

} // namespace

DWORD exitCodeOf(const siginfo_t& status) {
    if (status.si_code == CLD_EXITED) {
        return static_cast<DWORD>(status.si_status) & 0xFF;
    }
    switch (status.si_status) {
    case SIGINT:
        return STATUS_CONTROL_C_EXIT;
    case SIGSEGV:
        return STATUS_ACCESS_VIOLATION;
    case SIGILL:
        return STATUS_ILLEGAL_INSTRUCTION;
    case SIGFPE:
        return STATUS_INTEGER_DIVIDE_BY_ZERO;
    case SIGBUS:
        return STATUS_IN_PAGE_ERROR;
    case SIGABRT:
        return STATUS_ASSERTION_FAILURE;
    case SIGTRAP:
        return STATUS_BREAKPOINT;
    case SIGQUIT:
    case SIGSYS:
    case SIGXCPU:
    case SIGXFSZ:
        return signalBase + static_cast<DWORD>(status.si_status);
    default:
        return stoppedBase + static_cast<DWORD>(status.si_status);
    }
}

ProcessObject::ProcessObject(Descriptor process, Kinship kinship, pid_t group) noexcept
    : KernelObject(std::move(process)), m_kinship(kinship), m_group(group) {}

ProcessObject::~ProcessObject() {
    if (m_kinship == Kinship::Stranger) {
        return;
    }
    if (exitCode() == STILL_ACTIVE && !m_code) {
        ReleasedChildren::instance().add(std::move(m_descriptor));
    }
    ReleasedChildren::instance().collect();
}

DWORD ProcessObject::exitCode() {
    const std::lock_guard lock(m_mutex);
    if (!m_code && hasEnded(descriptor())) {
        m_code = collect();
    }
    return m_code.value_or(STILL_ACTIVE);
}

DWORD ProcessObject::collect() {
    siginfo_t status;
    if (m_kinship == Kinship::Stranger || !collectStatus(descriptor(), status)) {
        return signalBase;
    }
    // A child that was faster than the order to end keeps its own code.
    const bool killed = status.si_code == CLD_KILLED && status.si_status == SIGKILL;
    return killed && m_ordered ? *m_ordered : exitCodeOf(status);
}

DWORD ProcessObject::terminate(DWORD code) {
    const std::lock_guard lock(m_mutex);
    if (m_kinship == Kinship::Stranger || m_code || hasEnded(descriptor())) {
        return ERROR_ACCESS_DENIED;
    }
    if (::pidfd_send_signal(descriptor(), SIGKILL, nullptr, 0) != 0) {
        return errorFromErrno(errno);
    }
    // The group has its number from the child, and nobody else gets it before the child is collected.
    if (m_group > 0) {
        ::kill(-m_group, SIGKILL);
    }
    // The first order is the one that ends the child.
    if (!m_ordered) {
        m_ordered = code;
    }
    return ERROR_SUCCESS;
}

ReleasedChildren& ReleasedChildren::instance() {
    static auto* children = new ReleasedChildren;
    return *children;
}

ReleasedChildren::ReleasedChildren() : m_bell(::epoll_create1(EPOLL_CLOEXEC)) {}

void ReleasedChildren::add(Descriptor process) {
    const std::lock_guard lock(m_mutex);
    epoll_event event{EPOLLIN, {}};
    // Without the bell the child is still collected with the next start or release.
    ::epoll_ctl(m_bell.number(), EPOLL_CTL_ADD, process.number(), &event);
    m_running.push_back(std::move(process));
}

void ReleasedChildren::collect() {
    const std::lock_guard lock(m_mutex);
    std::erase_if(m_running, [](const Descriptor& process) {
        siginfo_t status;
        const bool ended = hasEnded(process.number());
        if (ended) {
            collectStatus(process.number(), status);
        }
        return ended;
    });
}

std::size_t ReleasedChildren::count() const {
    const std::lock_guard lock(m_mutex);
    return m_running.size();
}

} // namespace tvx::win
