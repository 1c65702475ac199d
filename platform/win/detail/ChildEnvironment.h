#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <deque>
#include <string>
#include <vector>

namespace tvx::win {

/// How a child is to show its first window.
enum class StartShow { Normal, Hidden };

/// The environment of a child: the process's own, with the user's values where the application's bundle had put its
/// own for itself (docs/processes.md says how a bundle tells), without what was meant for this process alone, and with
/// the wish to be hidden, or on an X display with a startup id that belongs to what the user did last.
///
/// Holds while the process's environment is not changed.
class TVX_PLATFORM_API ChildEnvironment {
public:
    explicit ChildEnvironment(StartShow show);

    /// As `execve` takes it.
    char* const* block() const {
        return m_block.data();
    }

private:
    void add(std::string variable);

    std::deque<std::string> m_own;
    std::vector<char*> m_block;
};

/// Keeps the time of the user's last key or click for the startup ids of children.
void keepLastInputTime(DWORD time);

/// How this process was asked to show its first window when it was started.
StartShow askedStartShow();

} // namespace tvx::win
