#pragma once

/// @file
/// Loops that wait for events, and what carries exceptions and the wish to quit through them.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <QEventLoop>

#include <exception>
#include <utility>

namespace tvx::afx {

/// A nested or outermost event loop. Modal dialogs, popup menus, message boxes and the application's own run are all
/// such loops, since only they let an exception out again.
class TVX_PLATFORM_API ModalLoop {
public:
    ModalLoop() = default;
    ModalLoop(const ModalLoop&) = delete;
    ModalLoop& operator=(const ModalLoop&) = delete;

    /// Waits for events until end() is called and answers its result; at once when it was called before. Answers -1
    /// when the application is quitting. An exception that escapes an event handler meanwhile comes out here.
    int run();
    void end(int result);
    /// Leaves the loop without a result, because the application is quitting.
    void quit() {
        m_loop.exit();
    }
    bool isRunning() const {
        return m_running;
    }
    /// The loop of this thread that is running now, null when none is.
    static ModalLoop* innermost();

private:
    friend class ExceptionCarrier;
    QEventLoop m_loop;
    ModalLoop* m_outer = nullptr;
    int m_result = 0;
    bool m_ended = false;
    bool m_running = false;
};

/// Carries an exception from an event handler over the toolkit's frames, which cannot be unwound, to the next place
/// of ours below them: the wrapper of a call that dispatches events, or else the innermost loop.
class TVX_PLATFORM_API ExceptionCarrier {
public:
    /// Called in the outermost catch of event delivery.
    static void store(std::exception_ptr error) noexcept;
    static bool isPending() noexcept;
    /// Throws what was stored, if anything.
    static void rethrow();

private:
    friend class ModalLoop;
    template <class Call>
    friend void guarded(Call&& call);
    static int enter() noexcept;
    static void leave(int depth) noexcept;
};

/// Makes a call into the toolkit during which events may be delivered, and lets an exception of their handlers out
/// behind it.
template <class Call>
void guarded(Call&& call) {
    const int depth = ExceptionCarrier::enter();
    std::forward<Call>(call)();
    ExceptionCarrier::leave(depth);
    ExceptionCarrier::rethrow();
}

/// Runs a handler that the toolkit calls otherwise than by an event, such as a slot of a signal, and keeps its
/// exception for the place of ours below the toolkit.
template <class Call>
void storing(Call&& call) noexcept {
    try {
        std::forward<Call>(call)();
    } catch (...) {
        ExceptionCarrier::store(std::current_exception());
    }
}

/// The wish to end all loops of this thread, with the outermost one's result.
TVX_PLATFORM_API void requestQuit(int exitCode);
TVX_PLATFORM_API bool isQuitting();
/// The exit code of that wish, or of the last one.
int quitCode();
/// Forgets the wish and answers its exit code; the outermost loop's owner calls this.
TVX_PLATFORM_API int takeQuit();

} // namespace tvx::afx
