#include "platform/win/detail/Spawn.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdint>
#include <fcntl.h>
#include <linux/sched.h>
#include <memory>
#include <sched.h>
#include <sys/resource.h>
#include <sys/syscall.h>
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
    bool hasHandlers = false; ///< the handlers of this process are still the child's
};

constexpr std::size_t stackSize = 64 * 1024;

void setDefault(int number) {
    struct sigaction action = {};
    ::sigaction(number, &action, nullptr);
}

/// A handler of the host's would run in the host's memory.
void resetHandlers() {
    for (int number = 1; number < NSIG; ++number) {
        struct sigaction action = {};
        if (::sigaction(number, nullptr, &action) == 0 && action.sa_handler != SIG_DFL &&
            action.sa_handler != SIG_IGN) {
            setDefault(number);
        }
    }
}

/// The descriptor that is to become the standard one of that index, out of the way of the other two.
int sourceOf(int descriptor, int index) {
    return descriptor > STDERR_FILENO || descriptor == index ? descriptor : ::fcntl(descriptor, F_DUPFD, 3);
}

/// What this process itself does not have, the child does not get.
bool place(int source, int index) {
    if (source == index) {
        ::fcntl(index, F_SETFD, 0);
        return true;
    }
    return source < 0 ? ::close(index) == 0 || errno == EBADF : ::dup2(source, index) >= 0;
}

bool placeStandard(const std::array<int, 3>& standard) {
    const bool needsNull = std::ranges::find(standard, nullDevice) != standard.end();
    const int null = needsNull ? ::open("/dev/null", O_RDWR) : -1;
    std::array<int, 3> sources{};
    for (int index = 0; index < 3; ++index) {
        const int wanted = standard[static_cast<std::size_t>(index)];
        sources[static_cast<std::size_t>(index)] = sourceOf(wanted == nullDevice ? null : wanted, index);
    }
    return place(sources[0], 0) && place(sources[1], 1) && place(sources[2], 2);
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
    if (start.hasHandlers) {
        resetHandlers();
    }
    // A host that ignores broken pipes or the ends of its children does so for itself.
    setDefault(SIGPIPE);
    setDefault(SIGCHLD);
    ::setsid();
    if (!placeStandard(start.request.standard)) {
        return false;
    }
    closeOthers();
    start.step = SpawnStep::Directory;
    return !start.request.directory || ::chdir(start.request.directory) == 0;
}

/// Runs in the child, on a stack of its own.
int runChild(void* data) {
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

/// Runs the child on a stack, with no handler of this process's, and waits until the program has started or failed to.
/// This takes one call of the system, which the C library does not offer: its own function for it would return in the
/// child, on the stack of the caller. -1 where the system or the processor is another one, and on failure.
pid_t cloneWithoutHandlers([[maybe_unused]] Start& start, [[maybe_unused]] std::byte* stack,
                           [[maybe_unused]] int& process) {
#if defined(__x86_64__) && defined(CLONE_CLEAR_SIGHAND)
    clone_args arguments{};
    arguments.flags = CLONE_VM | CLONE_VFORK | CLONE_PIDFD | CLONE_CLEAR_SIGHAND;
    arguments.pidfd = reinterpret_cast<std::uintptr_t>(&process);
    arguments.exit_signal = SIGCHLD;
    arguments.stack = reinterpret_cast<std::uintptr_t>(stack);
    arguments.stack_size = stackSize;
    long result = SYS_clone3;
    asm volatile("syscall\n\t"
                 "testq %%rax, %%rax\n\t"
                 "jnz 1f\n\t"
                 "movq %[start], %%rdi\n\t"
                 "movq %[run], %%rax\n\t"
                 "xorl %%ebp, %%ebp\n\t" // the outermost frame; either operand may have been there
                 "callq *%%rax\n\t"
                 "movl %%eax, %%edi\n\t"
                 "movl %[exit], %%eax\n\t"
                 "syscall\n\t"
                 "hlt\n"
                 "1:"
                 : "+a"(result)
                 : "D"(&arguments),
                   "S"(sizeof arguments), [start] "r"(&start), [run] "r"(&runChild), [exit] "i"(SYS_exit)
                 : "rcx", "r11", "memory", "cc");
    return result < 0 ? -1 : static_cast<pid_t>(result);
#else
    return -1;
#endif
}

pid_t cloneChild(Start& start, std::byte* stack, int& process) {
    const pid_t id = cloneWithoutHandlers(start, stack, process);
    if (id >= 0) {
        return id;
    }
    start.hasHandlers = true;
    return ::clone(&runChild, stack + stackSize, CLONE_VM | CLONE_VFORK | CLONE_PIDFD | SIGCHLD, &start, &process);
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
        result.id = cloneChild(start, stack.get(), process);
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
