#pragma once

/// @file
/// The road of a message: from the toolkit's event or a posting, through pre-translation, to the window.

#include "platform/afx/core/Message.h"
#include "platform/base/Export.h"

class QEvent;
class QObject;

namespace tvx::afx {

class Window;

/// The toolkit's event behind a message. Default() hands it on to the widget, once.
struct EventSource {
    QObject* receiver = nullptr;
    QEvent* event = nullptr;
    bool passed = false;
};

/// A message now being handled.
struct Dispatch {
    MSG msg{};
    Window* window = nullptr;
    EventSource* source = nullptr; ///< Null when the message was sent or posted by code.
    Dispatch* outer = nullptr;
};

/// Keeps a dispatch on this thread's stack as long as it lives.
class TVX_PLATFORM_API DispatchScope {
public:
    explicit DispatchScope(Dispatch& dispatch);
    ~DispatchScope();
    DispatchScope(const DispatchScope&) = delete;
    DispatchScope& operator=(const DispatchScope&) = delete;
    /// The message being handled innermost, null outside of any.
    static Dispatch* current();
};

/// Hands the toolkit's event behind the message now being handled on to its widget. False when there is no such event
/// or when it was handed on already.
TVX_PLATFORM_API bool passEvent(const Window& window, UINT message);
/// Whether the widget took the event that was handed on, so that nobody around it is to act on it.
bool isEventTaken();
/// Hands an event on to its receiver, past the translation into messages.
void passToToolkit(EventSource& source);
/// Whether this event is on its way to the toolkit already; it is so once.
bool takePassing(const QEvent* event);

/// Offers a message to the pre-translation chain: target up to the main frame, then the thread. True when consumed.
TVX_PLATFORM_API bool preTranslate(MSG& msg);
/// Called within pre-translation by what answers for a message without acting on it: the walk ends, and the message
/// goes to its window as one that nobody consumed.
TVX_PLATFORM_API void handToWindow();
/// Sends a message to its window, or calls its timer's function.
TVX_PLATFORM_API LRESULT dispatch(const MSG& msg, EventSource* source = nullptr);
/// What the loop does with each message: preTranslate, then dispatch.
TVX_PLATFORM_API void pump(MSG& msg, EventSource* source = nullptr);

/// A message with the current time and the pointer position seen last.
TVX_PLATFORM_API MSG makeMessage(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
/// Where the pointer was when the toolkit last told, in screen coordinates.
void notePointer(POINT position);

/// Turns an event of the toolkit into messages. True when that is all that is to happen with the event; `result` is
/// then the answer of its delivery.
bool translateEvent(QObject* receiver, QEvent* event, bool& result);

/// Sends WM_NCPAINT for what the toolkit is painting of a window's frame.
/// @param source the event behind it, null where the toolkit has painted its part already
void paintFrame(Window& window, EventSource* source);

/// Does idle work before the loop waits, if a message has been handled since the last time.
void runIdle();
/// Makes idle work due.
TVX_PLATFORM_API void armIdle();
/// Makes idle work due if the thread finds the message worth it.
void noteIdle(MSG& msg);

/// Keeps what the controls of a window notify from it as long as this lives.
class TVX_PLATFORM_API HeldNotifications {
public:
    explicit HeldNotifications(HWND window);
    ~HeldNotifications();
    HeldNotifications(const HeldNotifications&) = delete;
    HeldNotifications& operator=(const HeldNotifications&) = delete;
    static bool areHeldFrom(HWND window);

private:
    HWND m_before;
};

/// Frees windows that have ended, once no message is being handled any more.
void bury(class Window* window);

} // namespace tvx::afx
