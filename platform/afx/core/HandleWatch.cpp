#include "platform/afx/core/HandleWatch.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/HandleWatches.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/win/Handle.h"
#include "platform/win/detail/KernelObject.h"
#include "platform/win/detail/ProcessObject.h"

#include <QCoreApplication>
#include <QSocketNotifier>
#include <QTimer>

#include <algorithm>
#include <chrono>
#include <memory>
#include <vector>

namespace tvx::afx {

namespace {

using Clock = std::chrono::steady_clock;
// A window that shows output need not be told of it more often than a display shows pictures.
constexpr std::chrono::milliseconds frame{16};

using Objects = std::vector<std::shared_ptr<win::KernelObject>>;

/// One window's request. It stays when it was answered, to know when that was.
class Watch : public QObject {
public:
    Watch(HWND window, UINT message) : m_window(window), m_message(message) {
        m_due.setSingleShot(true);
        m_due.setTimerType(Qt::PreciseTimer);
        connectStoring(&m_due, &QTimer::timeout, this, [this] { post(); });
    }
    ~Watch() override {
        disarm();
    }

    HWND window() const {
        return m_window;
    }
    bool isFor(HWND window, UINT message) const {
        return window == m_window && message == m_message;
    }
    bool waitsFor(HANDLE handle) const {
        return std::ranges::find(m_handles, handle) != m_handles.end();
    }

    void arm(std::span<const HANDLE> handles, Objects objects, DWORD timeout) {
        disarm();
        m_handles.assign(handles.begin(), handles.end());
        m_objects = std::move(objects);
        for (const auto& object : m_objects) {
            auto* notifier = new QSocketNotifier(object->descriptor(), QSocketNotifier::Read, this);
            connectStoring(notifier, &QSocketNotifier::activated, this, [this] { signalled(); });
            m_notifiers.push_back(notifier);
        }
        if (timeout != INFINITE) {
            m_due.start(std::max<std::chrono::milliseconds>(std::chrono::milliseconds(timeout), untilNextFrame()));
        }
    }

    void disarm() {
        m_due.stop();
        m_handles.clear();
        forgetObjects();
    }

private:
    void signalled() {
        // An object stays signalled: its notifier would call again at every turn of the loop.
        forgetObjects();
        const auto wait = untilNextFrame();
        if (wait.count() > 0) {
            m_due.start(wait);
        } else {
            post();
        }
    }

    std::chrono::milliseconds untilNextFrame() const {
        return std::chrono::ceil<std::chrono::milliseconds>(m_lastPost + frame - Clock::now());
    }

    void post() {
        disarm();
        m_lastPost = Clock::now();
        PostMessage(m_window, m_message, 0, 0);
    }

    void forgetObjects() {
        for (QSocketNotifier* notifier : m_notifiers) {
            notifier->setEnabled(false);
            // One of them may be calling now.
            notifier->deleteLater();
        }
        m_notifiers.clear();
        m_objects.clear();
    }

    const HWND m_window;
    const UINT m_message;
    std::vector<HANDLE> m_handles;
    Objects m_objects;
    std::vector<QSocketNotifier*> m_notifiers;
    QTimer m_due;
    Clock::time_point m_lastPost = Clock::now() - frame;
};

/// All requests, those of the windows that live.
std::vector<std::unique_ptr<Watch>>& watches() {
    // Never destroyed: windows may be taken down by static destructors.
    static auto* all = new std::vector<std::unique_ptr<Watch>>;
    return *all;
}

Watch& watchOf(HWND window, UINT message) {
    const auto found =
        std::ranges::find_if(watches(), [&](const auto& watch) { return watch->isFor(window, message); });
    if (found != watches().end()) {
        return **found;
    }
    return *watches().emplace_back(std::make_unique<Watch>(window, message));
}

} // namespace

void forgetHandleWatches(HWND window) {
    std::erase_if(watches(), [window](const auto& watch) { return watch->window() == window; });
}

void watchReleasedChildren() {
    auto& children = win::ReleasedChildren::instance();
    if (children.bell() < 0) {
        return;
    }
    auto* notifier = new QSocketNotifier(children.bell(), QSocketNotifier::Read, QCoreApplication::instance());
    connectStoring(notifier, &QSocketNotifier::activated, notifier, [&children] { children.collect(); });
}

} // namespace tvx::afx

using namespace tvx::afx;

bool tvx::postWhenSignalled(std::span<const HANDLE> handles, HWND window, UINT message, DWORD timeout) {
    Objects objects;
    for (const HANDLE handle : handles) {
        objects.push_back(win::objectOf(handle));
    }
    if (!Window::from(window) || std::ranges::find(objects, nullptr) != objects.end()) {
        return false;
    }
    watchOf(window, message).arm(handles, std::move(objects), timeout);
    return true;
}

void tvx::cancelPosts(HANDLE handle) {
    for (const auto& watch : watches()) {
        if (watch->waitsFor(handle)) {
            watch->disarm();
        }
    }
}
