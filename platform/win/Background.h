#pragma once

/// @file
/// Questions that may never be answered, such as those to the folder of a server that has gone: they are asked on a
/// thread of their own, and nobody ever waits for that.
///
/// @code
/// m_listing = tvx::Question<tvx::FolderNames>([folder] { return tvx::readFolders(folder); });
/// if (!m_listing.isAnswered(50)) { // milliseconds: a disk of this machine has answered by then
///     const HANDLE answered[] = {m_listing.handle()};
///     tvx::postWhenSignalled(answered, m_hWnd, messageAnswered, INFINITE);
/// }
/// @endcode

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <functional>
#include <memory>
#include <utility>

namespace tvx {

namespace win {
struct BackgroundState;
}

/// Work on a thread of its own. The object may end before the work, which goes on then, if need be for ever: what it
/// uses must belong to it. The process ends without waiting for it.
class TVX_PLATFORM_API BackgroundWork {
public:
    /// No work.
    BackgroundWork() noexcept = default;
    /// Begins the work. Exceptions end it. Where the system has no thread or descriptor left, it is done before the
    /// constructor returns.
    explicit BackgroundWork(std::function<void()> work);
    BackgroundWork(BackgroundWork&& other) noexcept;
    BackgroundWork& operator=(BackgroundWork&& other) noexcept;
    ~BackgroundWork();

    /// Whether there is any work, done or not.
    explicit operator bool() const noexcept {
        return m_state != nullptr;
    }
    /// Waits for the end of the work, at most so many milliseconds. False without any work.
    [[nodiscard]] bool isDone(DWORD timeout = 0) const;
    /// Signalled when the work is done; the object closes it. Null without any work, and where it was done at once.
    [[nodiscard]] HANDLE handle() const noexcept {
        return m_handle;
    }

private:
    std::shared_ptr<win::BackgroundState> m_state;
    HANDLE m_handle = nullptr;
};

/// Work that has a result.
template <class Answer>
class Question {
public:
    /// Nothing is asked.
    Question() = default;
    /// Begins to ask. `ask` and what it holds belong to the other thread from now on.
    template <class Ask>
    explicit Question(Ask ask)
        : m_answer(std::make_shared<Answer>()),
          m_work([answer = m_answer, ask = std::move(ask)] { *answer = ask(); }) {}

    /// Whether something is asked, answered or not.
    explicit operator bool() const noexcept {
        return static_cast<bool>(m_work);
    }
    /// Waits for the answer, at most so many milliseconds. False when nothing is asked.
    [[nodiscard]] bool isAnswered(DWORD timeout = 0) const {
        return m_work.isDone(timeout);
    }
    /// The answer, once there is one; what `Answer()` makes when `ask` raised an exception.
    [[nodiscard]] Answer& answer() const {
        return *m_answer;
    }
    /// As BackgroundWork::handle.
    [[nodiscard]] HANDLE handle() const noexcept {
        return m_work.handle();
    }

private:
    std::shared_ptr<Answer> m_answer;
    BackgroundWork m_work;
};

} // namespace tvx
