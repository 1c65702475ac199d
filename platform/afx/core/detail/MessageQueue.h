#pragma once

/// @file
/// The posted messages of the user-interface thread, and the way to look at messages before they are dispatched.

#include "platform/afx/core/Message.h"
#include "platform/base/Export.h"

#include <QEvent>
#include <QObject>
#include <QPointer>

#include <deque>
#include <memory>
#include <mutex>
#include <optional>

namespace tvx::afx {

/// Holds what was posted. One wake-up event stands in the toolkit's queue for all of it, which makes posting cheaper
/// than the toolkit's own posted events and keeps the messages where PeekMessage can see them.
class TVX_PLATFORM_API MessageQueue : public QObject {
public:
    static MessageQueue& instance();

    /// Puts a message at the end; from any thread.
    void post(const MSG& msg);
    /// Takes out, or only copies, the first message for `window` (null: any) in the range (0, 0: any).
    std::optional<MSG> find(HWND window, UINT first, UINT last, bool remove);
    void forget(HWND window);
    /// Makes sure that a wake-up is on its way when messages wait or the application is quitting.
    void wake();
    bool isEmpty();

    bool event(QEvent* event) override;

private:
    MessageQueue();
    std::optional<MSG> take();
    void runBatch();
    void endLoopIfQuitting();

    std::mutex m_mutex;
    std::deque<MSG> m_messages;
    bool m_wakePosted = false;
};

/// An input event that was kept instead of dispatched, while PeekMessage or GetMessage looks for messages.
struct CapturedEvent {
    MSG msg;
    QPointer<QObject> receiver;
    std::unique_ptr<QEvent> event;

    /// Delivers the event as if it came now.
    void redeliver();
};

/// The kept events, in order. Events arrive here only while a collection is going on.
class EventCapture {
public:
    static EventCapture& instance();
    bool isCollecting() const {
        return m_collecting;
    }
    /// Whether an event that was kept before is being delivered now.
    bool isRedelivering() const {
        return m_redelivering;
    }
    void add(CapturedEvent captured);
    bool isEmpty() const {
        return m_waiting.empty();
    }
    /// Takes out the first kept event and delivers it. False when there is none.
    bool redeliverFirst();
    /// Lets the toolkit deliver what waits; input events are kept, others handled.
    void collect(bool wait);
    std::optional<CapturedEvent> find(HWND window, UINT first, UINT last, bool remove);
    /// The event behind a message that PeekMessage took out, when it is dispatched.
    std::optional<CapturedEvent> claim(const MSG& msg);

private:
    friend struct CapturedEvent;
    bool m_collecting = false;
    bool m_redelivering = false;
    std::deque<CapturedEvent> m_waiting;
    std::deque<CapturedEvent> m_taken;
};

} // namespace tvx::afx
