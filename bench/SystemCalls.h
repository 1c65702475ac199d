#pragma once

#include <functional>
#include <sys/ptrace.h>
#include <sys/syscall.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

/// Counts the calls of the system between two marks, those of children included until their own programs run.
class SystemCalls {
public:
    /// To be called by the work at the beginning and the end of what counts.
    static void mark() {
        ::syscall(SYS_getppid);
    }
    /// Runs the work in a process of its own, twice, so that what is done once only does not count.
    /// @return -1 where no process may be traced
    static long of(const std::function<void()>& work) {
        const pid_t process = ::fork();
        if (process == 0) {
            if (::ptrace(PTRACE_TRACEME, 0, 0, 0) == 0) {
                ::raise(SIGSTOP);
                work();
                work();
            }
            ::_exit(0);
        }
        SystemCalls calls(process);
        return calls.count();
    }

private:
    explicit SystemCalls(pid_t process) : m_process(process) {}

    long count() {
        int status = 0;
        ::waitpid(m_process, &status, 0);
        if (!WIFSTOPPED(status)) {
            return -1;
        }
        const long options = PTRACE_O_TRACESYSGOOD | PTRACE_O_TRACECLONE | PTRACE_O_TRACEFORK | PTRACE_O_TRACEVFORK |
                             PTRACE_O_TRACEEXEC | PTRACE_O_EXITKILL;
        ::ptrace(PTRACE_SETOPTIONS, m_process, 0, options);
        for (pid_t stopped = m_process; stopped > 0; stopped = ::waitpid(-1, &status, __WALL)) {
            if (WIFSTOPPED(status)) {
                goOn(stopped, status);
            } else if (stopped == m_process) {
                break;
            }
        }
        return m_marks == 4 ? m_count : -1;
    }

    void goOn(pid_t stopped, int status) {
        constexpr int systemCall = SIGTRAP | 0x80;
        const int signal = WSTOPSIG(status);
        if (status >> 8 == (SIGTRAP | (PTRACE_EVENT_EXEC << 8))) {
            ::ptrace(PTRACE_DETACH, stopped, 0, 0);
            return;
        }
        if (signal == systemCall) {
            look(stopped);
        }
        const bool isOwn = signal == systemCall || signal == SIGTRAP || signal == SIGSTOP;
        ::ptrace(PTRACE_SYSCALL, stopped, 0, isOwn ? 0 : signal);
    }

    void look(pid_t stopped) {
        __ptrace_syscall_info info{};
        ::ptrace(PTRACE_GET_SYSCALL_INFO, stopped, sizeof info, &info);
        if (info.op != PTRACE_SYSCALL_INFO_ENTRY) {
            return;
        }
        if (info.entry.nr == SYS_getppid) {
            ++m_marks;
        } else if (m_marks == 3) {
            ++m_count;
        }
    }

    pid_t m_process;
    int m_marks = 0;
    long m_count = 0;
};
