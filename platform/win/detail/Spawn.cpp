#include "platform/win/detail/Spawn.h"

#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <memory>
#include <sched.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

namespace tvx::win {

namespace {

/// What the child is told and what it answers: until the program starts it runs in this process's memory, while the
/// thread that started it stands still.
struct Start {
    const SpawnRequest& request;
    SpawnStep step = SpawnStep::Start;
    int error = 0;
};

constexpr std::size_t stackSize = 64 * 1024;

/// A handler of the host's would run in the host's memory; and a host that ignores broken pipes or the ends of its
/// children does so for itself.
void resetSignals() {
    for (int number = 1; number < NSIG; ++number) {
        struct sigaction action = {};
        if (::sigaction(number, nullptr, &action) != 0 || action.sa_handler == SIG_DFL) {
            continue;
        }
        if (action.sa_handler == SIG_IGN && number != SIGPIPE && number != SIGCHLD) {
            continue;
        }
        action = {};
        ::sigaction(number, &action, nullptr);
    }
}

int openStandard(int descriptor) {
    const int source = descriptor == nullDevice ? ::open("/dev/null", O_RDWR) : descriptor;
    // Above the three, where placing one does not overwrite another.
    return ::fcntl(source, F_DUPFD, 3);
}

bool placeStandard(const std::array<int, 3>& standard) {
    std::array<int, 3> sources{};
    for (std::size_t index = 0; index < standard.size(); ++index) {
        sources[index] = openStandard(standard[index]);
    }
    for (std::size_t index = 0; index < standard.size(); ++index) {
        // What this process itself does not have, the child does not get.
        if (sources[index] < 0) {
            ::close(static_cast<int>(index));
        } else if (::dup2(sources[index], static_cast<int>(index)) < 0) {
            return false;
        }
    }
    return true;
}

void closeOthers() {
    if (::close_range(3, ~0U, 0) == 0) {
        return;
    }
    rlimit limit{};
    ::getrlimit(RLIMIT_NOFILE, &limit);
    for (rlim_t descriptor = 3; descriptor < limit.rlim_cur; ++descriptor) {
        ::close(static_cast<int>(descriptor));
    }
}

bool prepare(Start& start) {
    resetSignals();
    ::setsid();
    if (!placeStandard(start.request.standard)) {
        return false;
    }
    closeOthers();
    start.step = SpawnStep::Directory;
    return !start.request.directory || ::chdir(start.request.directory) == 0;
}

/// Runs in the child, on a stack of its own.
__attribute__((no_sanitize("address"))) int runChild(void* data) {
    Start& start = *static_cast<Start*>(data);
    if (prepare(start)) {
        start.step = SpawnStep::Program;
        sigset_t none;
        ::sigemptyset(&none);
        ::sigprocmask(SIG_SETMASK, &none, nullptr);
        ::execve(start.request.program, start.request.arguments, start.request.environment);
    }
    start.error = errno;
    return 127;
}

/// Keeps signals away from the thread: their handlers must not run in the child.
class SignalsBlocked {
public:
    SignalsBlocked() {
        sigset_t all;
        ::sigfillset(&all);
        ::pthread_sigmask(SIG_SETMASK, &all, &m_before);
    }
    ~SignalsBlocked() {
        ::pthread_sigmask(SIG_SETMASK, &m_before, nullptr);
    }
    SignalsBlocked(const SignalsBlocked&) = delete;
    SignalsBlocked& operator=(const SignalsBlocked&) = delete;

private:
    sigset_t m_before;
};

void collectFailed(int process) {
    siginfo_t status;
    while (::waitid(P_PIDFD, static_cast<id_t>(process), &status, WEXITED | __WALL) != 0 && errno == EINTR) {
    }
}

} // namespace

SpawnResult spawn(const SpawnRequest& request) {
    Start start{request};
    const auto stack = std::make_unique_for_overwrite<std::byte[]>(stackSize);
    int process = -1;
    SpawnResult result;
    {
        const SignalsBlocked blocked;
        result.id = ::clone(&runChild, stack.get() + stackSize, CLONE_VM | CLONE_VFORK | CLONE_PIDFD | SIGCHLD, &start,
                            &process);
        result.error = result.id < 0 ? errno : start.error;
    }
    if (result.id < 0) {
        return result;
    }
    Descriptor held(process);
    result.failedStep = start.step;
    if (result.error != 0) {
        collectFailed(held.number());
    } else {
        result.process = std::move(held);
    }
    return result;
}

} // namespace tvx::win
