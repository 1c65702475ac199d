#include "platform/afx/core/detail/Timers.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QObject>
#include <QTimerEvent>

#include <algorithm>
#include <vector>

namespace tvx::afx {

namespace {

struct Timer {
    HWND window;
    UINT_PTR id;
    TIMERPROC callback;
    int toolkitId;
};

/// All timers of the process. They run on one object of ours, since widgets have timers of their own.
class Timers : public QObject {
public:
    static Timers& instance() {
        static auto* timers = new Timers;
        return *timers;
    }

    UINT_PTR start(HWND window, UINT_PTR id, UINT elapse, TIMERPROC callback) {
        if (!window) {
            id = find(window, id) != m_timers.end() ? id : ++m_lastId;
        }
        stop(window, id);
        constexpr UINT longest = 0x7FFFFFFF;
        // An interval of 0 would let the toolkit's loop never rest.
        const int toolkitId = startTimer(static_cast<int>(std::clamp(elapse, 1U, longest)));
        m_timers.push_back({window, id, callback, toolkitId});
        return id != 0 ? id : 1;
    }

    bool stop(HWND window, UINT_PTR id) {
        const auto found = find(window, id);
        if (found == m_timers.end()) {
            return false;
        }
        killTimer(found->toolkitId);
        m_timers.erase(found);
        return true;
    }

    void stopAll(HWND window) {
        std::erase_if(m_timers, [&](const Timer& timer) {
            if (timer.window == window) {
                killTimer(timer.toolkitId);
            }
            return timer.window == window;
        });
    }

protected:
    void timerEvent(QTimerEvent* event) override {
        const auto found = std::find_if(m_timers.begin(), m_timers.end(),
                                        [&](const Timer& timer) { return timer.toolkitId == event->timerId(); });
        if (found != m_timers.end()) {
            MSG msg = makeMessage(found->window, WM_TIMER, found->id, reinterpret_cast<LPARAM>(found->callback));
            pump(msg);
        }
    }

private:
    std::vector<Timer>::iterator find(HWND window, UINT_PTR id) {
        return std::find_if(m_timers.begin(), m_timers.end(),
                            [&](const Timer& timer) { return timer.window == window && timer.id == id; });
    }

    std::vector<Timer> m_timers;
    UINT_PTR m_lastId = 0x7F00;
};

} // namespace

LRESULT callTimer(const MSG& msg) {
    reinterpret_cast<TIMERPROC>(msg.lParam)(msg.hwnd, WM_TIMER, msg.wParam, msg.time);
    return 0;
}

void forgetTimers(HWND window) {
    Timers::instance().stopAll(window);
}

} // namespace tvx::afx

using namespace tvx::afx;

UINT_PTR SetTimer(HWND window, UINT_PTR id, UINT elapse, TIMERPROC callback) {
    if (!ensureGui() || (window && !Window::from(window))) {
        return 0;
    }
    return Timers::instance().start(window, id, elapse, callback);
}

BOOL KillTimer(HWND window, UINT_PTR id) {
    return Timers::instance().stop(window, id) ? TRUE : FALSE;
}
