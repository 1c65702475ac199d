#include "platform/afx/core/detail/MessageQueue.h"

#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QCoreApplication>

#include <algorithm>

namespace tvx::afx {

namespace {

const QEvent::Type wakeType = static_cast<QEvent::Type>(QEvent::registerEventType());

bool matches(const MSG& msg, HWND window, UINT first, UINT last) {
    const bool inRange = (first == 0 && last == 0) || (msg.message >= first && msg.message <= last);
    return inRange && (!window || msg.hwnd == window);
}

} // namespace

MessageQueue::MessageQueue() {
    if (QCoreApplication::instance()) {
        moveToThread(QCoreApplication::instance()->thread());
    }
}

MessageQueue& MessageQueue::instance() {
    // Never destroyed: windows may be taken down by static destructors.
    static auto* queue = new MessageQueue;
    return *queue;
}

void MessageQueue::post(const MSG& msg) {
    const std::lock_guard lock(m_mutex);
    m_messages.push_back(msg);
    if (!m_wakePosted) {
        m_wakePosted = true;
        QCoreApplication::postEvent(this, new QEvent(wakeType));
    }
}

void MessageQueue::wake() {
    const std::lock_guard lock(m_mutex);
    if (!m_wakePosted && (!m_messages.empty() || isQuitting() || !EventCapture::instance().isEmpty())) {
        m_wakePosted = true;
        QCoreApplication::postEvent(this, new QEvent(wakeType));
    }
}

bool MessageQueue::isEmpty() {
    const std::lock_guard lock(m_mutex);
    return m_messages.empty();
}

std::optional<MSG> MessageQueue::find(HWND window, UINT first, UINT last, bool remove) {
    const std::lock_guard lock(m_mutex);
    const auto found = std::find_if(m_messages.begin(), m_messages.end(),
                                    [&](const MSG& msg) { return matches(msg, window, first, last); });
    if (found == m_messages.end()) {
        return std::nullopt;
    }
    const MSG msg = *found;
    if (remove) {
        m_messages.erase(found);
    }
    return msg;
}

void MessageQueue::forget(HWND window) {
    const std::lock_guard lock(m_mutex);
    std::erase_if(m_messages, [window](const MSG& msg) { return msg.hwnd == window; });
}

std::optional<MSG> MessageQueue::take() {
    const std::lock_guard lock(m_mutex);
    if (m_messages.empty()) {
        return std::nullopt;
    }
    const MSG msg = m_messages.front();
    m_messages.pop_front();
    return msg;
}

bool MessageQueue::event(QEvent* event) {
    if (event->type() != wakeType) {
        return QObject::event(event);
    }
    {
        const std::lock_guard lock(m_mutex);
        m_wakePosted = false;
    }
    // An exception on its way to the loop must not be overtaken by later messages, and while PeekMessage collects
    // events, posted messages stay where it looks for them. Both places wake the queue again.
    if (!ExceptionCarrier::isPending() && !EventCapture::instance().isCollecting()) {
        runBatch();
    }
    return true;
}

void MessageQueue::runBatch() {
    struct WakeAgain {
        ~WakeAgain() {
            MessageQueue::instance().wake();
        }
    } wakeAgain;
    while (EventCapture::instance().redeliverFirst()) {
        // Events that PeekMessage has seen and left came before anything that is posted now.
    }
    std::size_t count = 0;
    {
        const std::lock_guard lock(m_mutex);
        count = m_messages.size();
    }
    // Only what waits now: messages that handlers post go behind the input that has come meanwhile.
    for (; count > 0 && !isQuitting(); --count) {
        auto msg = take();
        if (!msg) {
            break;
        }
        pump(*msg);
        if (ExceptionCarrier::isPending()) {
            return;
        }
    }
    endLoopIfQuitting();
}

void MessageQueue::endLoopIfQuitting() {
    if (isQuitting() && ModalLoop::innermost()) {
        ModalLoop::innermost()->quit();
    }
}

void CapturedEvent::redeliver() {
    if (!receiver) {
        return;
    }
    bool& flag = EventCapture::instance().m_redelivering;
    const bool outer = std::exchange(flag, true);
    struct Reset {
        bool& flag;
        bool value;
        ~Reset() {
            flag = value;
        }
    } reset{flag, outer};
    guarded([this] { QCoreApplication::instance()->notify(receiver, event.get()); });
}

bool EventCapture::redeliverFirst() {
    if (m_waiting.empty()) {
        return false;
    }
    CapturedEvent first = std::move(m_waiting.front());
    m_waiting.pop_front();
    first.redeliver();
    return true;
}

EventCapture& EventCapture::instance() {
    static EventCapture capture;
    return capture;
}

void EventCapture::add(CapturedEvent captured) {
    m_waiting.push_back(std::move(captured));
}

void EventCapture::collect(bool wait) {
    const bool outer = std::exchange(m_collecting, true);
    guarded([wait] { QCoreApplication::processEvents(wait ? QEventLoop::WaitForMoreEvents : QEventLoop::AllEvents); });
    m_collecting = outer;
    MessageQueue::instance().wake();
}

std::optional<CapturedEvent> EventCapture::find(HWND window, UINT first, UINT last, bool remove) {
    const auto found = std::find_if(m_waiting.begin(), m_waiting.end(), [&](const CapturedEvent& captured) {
        return matches(captured.msg, window, first, last);
    });
    if (found == m_waiting.end()) {
        return std::nullopt;
    }
    CapturedEvent answer;
    answer.msg = found->msg;
    if (remove) {
        m_taken.push_back(std::move(*found));
        m_waiting.erase(found);
    }
    return answer;
}

std::optional<CapturedEvent> EventCapture::claim(const MSG& msg) {
    const auto found = std::find_if(m_taken.begin(), m_taken.end(), [&](const CapturedEvent& captured) {
        return captured.msg.hwnd == msg.hwnd && captured.msg.message == msg.message &&
               captured.msg.wParam == msg.wParam && captured.msg.time == msg.time;
    });
    if (found == m_taken.end()) {
        return std::nullopt;
    }
    CapturedEvent answer = std::move(*found);
    // Messages are dispatched in the order they were taken: what was taken earlier has been thrown away.
    m_taken.erase(m_taken.begin(), std::next(found));
    return answer;
}

} // namespace tvx::afx
