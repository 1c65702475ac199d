#pragma once

#include "platform/win/detail/KernelObject.h"

#include <csignal>
#include <mutex>
#include <optional>
#include <sys/types.h>
#include <vector>

namespace tvx::win {

/// Whose child a process is: only children of this process can be ended, collected and asked for their code.
enum class Kinship { Child, Stranger };

/// A process, held by the system's reference to it.
class ProcessObject : public KernelObject {
public:
    /// @param group  the number of a child's group; 0 for a stranger
    ProcessObject(Descriptor process, Kinship kinship, pid_t group = 0) noexcept;
    /// A child that still runs is handed to the ReleasedChildren.
    ~ProcessObject() override;

    /// The code that the process ended with, `STILL_ACTIVE` while it runs. Collects a child that has ended.
    DWORD exitCode();
    /// Kills a child and what is left in its group; the child then reports `code`. Answers `ERROR_SUCCESS` or why not.
    DWORD terminate(DWORD code);

private:
    DWORD collect();

    const Kinship m_kinship;
    const pid_t m_group;
    std::mutex m_mutex;
    std::optional<DWORD> m_code;    ///< once the end was seen
    std::optional<DWORD> m_ordered; ///< what the child is to report when it was killed
};

/// The platform's exit code for the status of an ended child.
DWORD exitCodeOf(const siginfo_t& status);

/// Children that nobody holds any more. They are collected when they have ended, so that none stays behind as a zombie:
/// whenever a process is started or released, and as soon as they end where the event loop watches the bell.
class TVX_PLATFORM_API ReleasedChildren {
public:
    static ReleasedChildren& instance();

    void add(Descriptor process);
    /// Collects those that have ended.
    void collect();
    /// How many still run.
    std::size_t count() const;
    /// A descriptor that is readable while an ended child waits to be collected; -1 when the system gives none.
    int bell() const noexcept {
        return m_bell.number();
    }

private:
    ReleasedChildren();

    mutable std::mutex m_mutex;
    std::vector<Descriptor> m_running;
    Descriptor m_bell;
};

} // namespace tvx::win
