#include "platform/afx/core/detail/Loop.h"

#include "platform/afx/core/LastReport.h"
#include "platform/afx/core/detail/MessageQueue.h"
#include "platform/base/Exception.h"

namespace tvx::afx {

namespace {

struct LoopState {
    ModalLoop* innermost = nullptr;
    int guards = 0; ///< Guarded calls on the stack above the innermost loop.
    std::exception_ptr pending;
    int lastReports = 0; ///< While there are any, what handlers throw is dropped.
    bool quitting = false;
    int exitCode = 0;
};

LoopState& state() {
    thread_local LoopState instance;
    return instance;
}

/// Ends an exception. The framework's own ones are thrown as pointers, which go with them.
void drop(const std::exception_ptr& error) noexcept {
    try {
        std::rethrow_exception(error);
    } catch (CException* framework) {
        framework->Delete();
    } catch (...) {
        return; // the others end with the last reference to them
    }
}

} // namespace

ModalLoop* ModalLoop::innermost() {
    return state().innermost;
}

int ModalLoop::run() {
    LoopState& current = state();
    if (!m_ended && !current.quitting) {
        m_outer = std::exchange(current.innermost, this);
        // Guarded calls around this loop do not guard what happens in it.
        const int guards = std::exchange(current.guards, 0);
        m_running = true;
        // Messages posted before this loop began must not wait for the loop around it.
        MessageQueue::instance().wake();
        m_loop.exec();
        m_running = false;
        current.guards = guards;
        current.innermost = m_outer;
        // A loop of the toolkit cannot return before those inside of it, so the wish to quit goes outwards one by one.
        if (current.quitting && m_outer) {
            m_outer->m_loop.exit();
        }
        ExceptionCarrier::rethrow();
    }
    return m_ended ? m_result : -1;
}

void ModalLoop::end(int result) {
    m_ended = true;
    m_result = result;
    m_loop.exit();
}

void ExceptionCarrier::store(std::exception_ptr error) noexcept {
    LoopState& current = state();
    if (current.lastReports > 0) {
        drop(error);
        return;
    }
    if (!current.pending) {
        current.pending = std::move(error);
    }
    // Inside of a guarded call the exception goes on when the call returns to us.
    if (current.guards == 0 && current.innermost) {
        current.innermost->m_loop.exit();
    }
}

bool ExceptionCarrier::isPending() noexcept {
    return state().pending != nullptr;
}

void ExceptionCarrier::rethrow() {
    if (state().pending) {
        std::rethrow_exception(std::exchange(state().pending, nullptr));
    }
}

int ExceptionCarrier::enter() noexcept {
    return state().guards++;
}

void ExceptionCarrier::leave(int depth) noexcept {
    state().guards = depth;
}

void requestQuit(int exitCode) {
    LoopState& current = state();
    current.quitting = true;
    current.exitCode = exitCode;
    if (current.innermost) {
        MessageQueue::instance().wake();
    }
}

bool isQuitting() {
    return state().quitting;
}

int quitCode() {
    return state().exitCode;
}

int takeQuit() {
    state().quitting = false;
    return quitCode();
}

} // namespace tvx::afx

CLastReport::CLastReport() {
    ++tvx::afx::state().lastReports;
}

CLastReport::~CLastReport() {
    --tvx::afx::state().lastReports;
}
