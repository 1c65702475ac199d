#pragma once

#include <csignal>
#include <cstdlib>
#include <functional>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

/// A process that does something of its own, with a pipe through which it reports and one through which it is told to
/// go on.
class ChildProcess {
public:
    explicit ChildProcess(const std::function<void(ChildProcess&)>& body) {
        int report[2];
        int order[2];
        if (pipe(report) != 0 || pipe(order) != 0) {
            std::abort();
        }
        m_id = fork();
        const bool isChild = m_id == 0;
        m_read = isChild ? order[0] : report[0];
        m_write = isChild ? report[1] : order[1];
        close(isChild ? order[1] : report[1]);
        close(isChild ? report[0] : order[0]);
        if (isChild) {
            body(*this);
            std::exit(0); // with everything that ends a process properly
        }
    }
    ~ChildProcess() {
        if (m_id > 0) {
            kill();
        }
        close(m_read);
        close(m_write);
    }
    ChildProcess(const ChildProcess&) = delete;
    ChildProcess& operator=(const ChildProcess&) = delete;

    /// To the other side.
    void send(int number) const {
        if (::write(m_write, &number, sizeof number) != sizeof number) {
            _exit(3);
        }
    }
    /// From the other side; -1 when it has ended.
    [[nodiscard]] int receive() const {
        int number = -1;
        return ::read(m_read, &number, sizeof number) == sizeof number ? number : -1;
    }
    /// Ends the child at once, wherever it is.
    void kill() {
        ::kill(m_id, SIGKILL);
        waitpid(m_id, nullptr, 0);
        m_id = -1;
    }
    /// Waits for the child's own end; true when that was a good one.
    bool end() {
        int status = 0;
        waitpid(m_id, &status, 0);
        m_id = -1;
        return WIFEXITED(status) && WEXITSTATUS(status) == 0;
    }

private:
    pid_t m_id = -1;
    int m_read = -1;
    int m_write = -1;
};
