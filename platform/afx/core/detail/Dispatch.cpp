#include "platform/afx/core/detail/Dispatch.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Accessible.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/HandleWatches.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MessageQueue.h"
#include "platform/afx/core/detail/Timers.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"
#include "platform/win/Module.h"
#include "platform/win/Resource.h"

#include <QAbstractEventDispatcher>
#include <QApplication>
#include <QThread>

#include <chrono>
#include <map>
#include <mutex>
#include <string>
#include <utility>

namespace tvx::afx {

namespace {

thread_local Dispatch* innermost = nullptr;
POINT pointer{0, 0};
bool idleDue = true;
LONG idleCount = 0;
/// Set while DispatchMessage hands on a message whose fetcher has pre-translated it, or has chosen not to.
bool preTranslateDone = false;
/// Set where pre-translation has answered for a message that its window is still to get.
bool handedToWindow = false;

/// Events on their way to the toolkit, which translateEvent must let through.
thread_local const QEvent* passing = nullptr;

std::vector<std::unique_ptr<Window>>& graveyard() {
    static auto* windows = new std::vector<std::unique_ptr<Window>>;
    return *windows;
}

} // namespace

DispatchScope::DispatchScope(Dispatch& dispatch) {
    dispatch.outer = innermost;
    innermost = &dispatch;
}

DispatchScope::~DispatchScope() {
    innermost = innermost->outer;
    // The state of a window that has ended lives until nobody on the stack can hold it any more.
    if (!innermost && !graveyard().empty()) {
        const auto ended = std::move(graveyard());
        graveyard().clear();
    }
}

Dispatch* DispatchScope::current() {
    return innermost;
}

void bury(Window* window) {
    graveyard().emplace_back(window);
}

void passToToolkit(EventSource& source) {
    source.passed = true;
    const QEvent* outer = std::exchange(passing, source.event);
    guarded([&source] { QCoreApplication::instance()->notify(source.receiver, source.event); });
    passing = outer;
}

bool takePassing(const QEvent* event) {
    if (passing != event) {
        return false;
    }
    passing = nullptr;
    return true;
}

bool passEvent(const Window& window, UINT message) {
    Dispatch* current = innermost;
    if (!current || !current->source || current->window != &window || current->msg.message != message ||
        current->source->passed) {
        return false;
    }
    // Once: a handler that calls its base twice must not type a character twice.
    passToToolkit(*current->source);
    return true;
}

bool isEventTaken() {
    return innermost && innermost->source && innermost->source->event->isAccepted();
}

bool preTranslate(MSG& msg) {
    if (preTranslateDone) {
        return false;
    }
    const bool key = msg.message >= WM_KEYFIRST && msg.message <= WM_KEYLAST;
    const Window* target = key ? Window::from(msg.hwnd) : nullptr;
    if (target && target->takesShortcuts()) {
        return target->object() && target->object()->PreTranslateMessage(&msg);
    }
    CWinThread* thread = AfxGetThread();
    // Handlers may run loops of their own, each with answers of its own.
    const bool outer = std::exchange(handedToWindow, false);
    const bool answered = thread && thread->PreTranslateMessage(&msg) != FALSE;
    const bool handed = std::exchange(handedToWindow, outer);
    return answered && !handed;
}

void handToWindow() {
    handedToWindow = true;
}

LRESULT dispatch(const MSG& msg, EventSource* source) {
    if (msg.message == WM_TIMER && msg.lParam != 0) {
        return callTimer(msg);
    }
    Window* window = Window::from(msg.hwnd);
    if (!window) {
        return 0;
    }
    Dispatch current;
    current.msg = msg;
    current.window = window;
    current.source = source;
    const DispatchScope scope(current);
    return window->deliver(msg.message, msg.wParam, msg.lParam);
}

void noteIdle(MSG& msg) {
    CWinThread* thread = AfxGetThread();
    if (!thread || thread->IsIdleMessage(&msg)) {
        armIdle();
    }
}

void pump(MSG& msg, EventSource* source) {
    noteIdle(msg);
    if (!preTranslate(msg)) {
        dispatch(msg, source);
    }
}

MSG makeMessage(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    return {window, message, wParam, lParam, GetTickCount(), pointer};
}

void notePointer(POINT position) {
    pointer = position;
}

void armIdle() {
    idleDue = true;
    idleCount = 0;
}

void runIdle() {
    CWinThread* thread = AfxGetThread();
    if (!idleDue || !thread || ExceptionCarrier::isPending() || EventCapture::instance().isCollecting() ||
        !MessageQueue::instance().isEmpty()) {
        return;
    }
    idleDue = false;
    const bool more = thread->OnIdle(idleCount) != FALSE;
    ++idleCount;
    if (more) {
        idleDue = true;
        QAbstractEventDispatcher::instance()->wakeUp();
    }
}

namespace {

HWND heldWindow = nullptr;

} // namespace

HeldNotifications::HeldNotifications(HWND window) : m_before(std::exchange(heldWindow, window)) {}

HeldNotifications::~HeldNotifications() {
    heldWindow = m_before;
}

bool HeldNotifications::areHeldFrom(HWND window) {
    return window && window == heldWindow;
}

namespace {

/// Windows without an icon of their own show the application's: the first that its resources have.
void showApplicationIcon() {
    const HMODULE application = GetModuleHandleA(nullptr);
    const std::string name = firstResource(application, RT_GROUP_ICON);
    if (!name.empty()) {
        QApplication::setWindowIcon(windowIcon(LoadIconA(application, name.c_str())));
    }
}

void startOnGuiThread() {
    connectStoring(QAbstractEventDispatcher::instance(), &QAbstractEventDispatcher::aboutToBlock, qApp, &runIdle);
    MessageQueue::instance().moveToThread(QThread::currentThread());
    watchReleasedChildren();
    showApplicationIcon();
    answerAssistiveTools();
}

struct HooksEntry {
    HooksEntry() {
        setGuiHooks({&translateEvent, &ExceptionCarrier::store, &startOnGuiThread});
    }
} const hooksEntry;

} // namespace

} // namespace tvx::afx

using namespace tvx::afx;

LRESULT SendMessageA(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    Window* window = Window::from(handle);
    if (!window) {
        return 0;
    }
    MessageQueue& queue = MessageQueue::instance();
    if (QThread::currentThread() == queue.thread() || !QCoreApplication::instance()) {
        return window->call(message, wParam, lParam);
    }
    LRESULT result = 0;
    QMetaObject::invokeMethod(
        &queue, [&] { result = SendMessageA(handle, message, wParam, lParam); }, Qt::BlockingQueuedConnection);
    return result;
}

BOOL PostMessageA(HWND handle, UINT message, WPARAM wParam, LPARAM lParam) {
    if (handle == HWND_BROADCAST) {
        for (const Window* window : Window::topLevels()) {
            PostMessageA(window->handle(), message, wParam, lParam);
        }
        return TRUE;
    }
    // Other threads cannot look into the table of windows; a stale handle is found when the message arrives.
    const bool ownThread = QThread::currentThread() == MessageQueue::instance().thread();
    if (ownThread && handle && !Window::from(handle)) {
        return FALSE;
    }
    if (message == WM_QUIT) {
        PostQuitMessage(static_cast<int>(wParam));
        return TRUE;
    }
    MessageQueue::instance().post(makeMessage(handle, message, wParam, lParam));
    return TRUE;
}

void PostQuitMessage(int exitCode) {
    requestQuit(exitCode);
}

namespace {

/// Fetches the first waiting message: posted ones come before input.
bool fetch(MSG* message, HWND window, UINT first, UINT last, bool remove) {
    if (const auto posted = MessageQueue::instance().find(window, first, last, remove)) {
        *message = *posted;
        return true;
    }
    if (const auto captured = EventCapture::instance().find(window, first, last, remove)) {
        *message = captured->msg;
        return true;
    }
    return false;
}

} // namespace

BOOL PeekMessageA(MSG* message, HWND window, UINT first, UINT last, UINT remove) {
    const bool take = (remove & PM_REMOVE) != 0;
    if (isQuitting()) {
        *message = makeMessage(nullptr, WM_QUIT, static_cast<WPARAM>(quitCode()), 0);
        return TRUE;
    }
    if (fetch(message, window, first, last, take)) {
        return TRUE;
    }
    if (!ensureGui()) {
        return FALSE;
    }
    EventCapture::instance().collect(false);
    return fetch(message, window, first, last, take) ? TRUE : FALSE;
}

BOOL GetMessageA(MSG* message, HWND window, UINT first, UINT last) {
    while (!PeekMessageA(message, window, first, last, PM_REMOVE)) {
        if (!ensureGui()) {
            return -1;
        }
        EventCapture::instance().collect(true);
    }
    return message->message != WM_QUIT ? TRUE : FALSE;
}

BOOL TranslateMessage(const MSG* message) {
    return message->message >= WM_KEYFIRST && message->message <= WM_KEYLAST ? TRUE : FALSE;
}

LRESULT DispatchMessageA(const MSG* message) {
    if (auto captured = EventCapture::instance().claim(*message)) {
        const bool outer = std::exchange(preTranslateDone, true);
        captured->redeliver();
        preTranslateDone = outer;
        return 0;
    }
    return dispatch(*message);
}

DWORD GetTickCount() {
    using namespace std::chrono;
    return static_cast<DWORD>(duration_cast<milliseconds>(steady_clock::now().time_since_epoch()).count());
}

DWORD GetMessagePos() {
    const POINT position = DispatchScope::current() ? DispatchScope::current()->msg.pt : pointer;
    return static_cast<DWORD>(MAKELONG(position.x, position.y));
}

LONG GetMessageTime() {
    return DispatchScope::current() ? static_cast<LONG>(DispatchScope::current()->msg.time) : 0;
}

UINT RegisterWindowMessageA(LPCSTR name) {
    if (!name || *name == '\0') {
        return 0;
    }
    static std::map<std::string, UINT, tvx::text::LessNoCase> numbers;
    static std::mutex guard;
    constexpr UINT first = 0xC000;
    const std::lock_guard lock(guard);
    return numbers.try_emplace(name, first + static_cast<UINT>(numbers.size())).first->second;
}
