#include "platform/afx/core/Wnd.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"

#include <cstdio>

using namespace tvx::afx;

IMPLEMENT_DYNCREATE(CWnd, CCmdTarget)

// --- objects and handles ---

CWnd::~CWnd() {
    // A frame whose window could not be created has deleted itself; hosts have often made it the main window before.
    if (CWinThread* thread = AfxGetThread(); thread && thread->m_pMainWnd == this) {
        thread->m_pMainWnd = nullptr;
    }
    if (!m_hWnd) {
        return;
    }
    // What derived classes override is gone by now, so the window ends as one without an object.
    const HWND window = Detach();
    try {
        ::DestroyWindow(window);
    } catch (...) {
        ExceptionCarrier::store(std::current_exception());
    }
}

HWND CWnd::HandleOf(const CWnd* window) {
    return window ? window->m_hWnd : nullptr;
}

CWnd* CWnd::FromHandle(HWND handle) {
    Window* window = Window::from(handle);
    return window ? window->objectOrTemporary() : nullptr;
}

CWnd* CWnd::FromHandlePermanent(HWND handle) {
    const Window* window = Window::from(handle);
    return window ? window->object() : nullptr;
}

namespace {

void dropTemporaries(const std::vector<Window*>& windows) {
    for (Window* window : windows) {
        window->dropTemporary();
        dropTemporaries(window->children());
    }
}

} // namespace

void CWnd::DeleteTempMap() {
    dropTemporaries(Window::topLevels());
}

Window* CWnd::GetState() const {
    return Window::from(m_hWnd);
}

BOOL CWnd::Attach(HWND handle) {
    Window* window = Window::from(handle);
    if (!window || window->object() || m_hWnd) {
        return FALSE;
    }
    m_hWnd = handle;
    window->attach(this);
    return TRUE;
}

HWND CWnd::Detach() {
    const HWND handle = m_hWnd;
    Window* window = Window::from(handle);
    if (window && window->object() == this) {
        window->detach();
    }
    m_hWnd = nullptr;
    return handle;
}

BOOL CWnd::SubclassWindow(HWND handle) {
    if (FromHandlePermanent(handle) || !Window::from(handle)) {
        return FALSE;
    }
    PreSubclassWindow();
    return Attach(handle);
}

BOOL CWnd::SubclassDlgItem(UINT id, CWnd* parent) {
    return SubclassWindow(::GetDlgItem(parent->m_hWnd, static_cast<int>(id)));
}

HWND CWnd::UnsubclassWindow() {
    return Detach();
}

void CWnd::PreSubclassWindow() {}

// --- creation and end ---

BOOL CWnd::PreCreateWindow(CREATESTRUCT& cs) {
    if (!cs.lpszClass) {
        cs.lpszClass = AfxRegisterWndClass(CS_DBLCLKS, ::LoadCursorA(nullptr, IDC_ARROW));
    }
    return TRUE;
}

BOOL CWnd::Create(LPCSTR className, LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id,
                  CCreateContext* context) {
    return CreateEx(0, className, text, style | WS_CHILD, rect, parent, id, context);
}

BOOL CWnd::CreateEx(DWORD exStyle, LPCSTR className, LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id,
                    LPVOID param) {
    return CreateEx(exStyle, className, text, style, rect.left, rect.top, rect.right - rect.left,
                    rect.bottom - rect.top, HandleOf(parent), reinterpret_cast<HMENU>(static_cast<UINT_PTR>(id)),
                    param);
}

BOOL CWnd::CreateEx(DWORD exStyle, LPCSTR className, LPCSTR text, DWORD style, int x, int y, int width, int height,
                    HWND parent, HMENU menuOrId, LPVOID param) {
    CREATESTRUCT cs{};
    cs.dwExStyle = exStyle;
    cs.lpszClass = className;
    cs.lpszName = text;
    cs.style = static_cast<LONG>(style);
    cs.x = x;
    cs.y = y;
    cs.cx = width;
    cs.cy = height;
    cs.hwndParent = parent;
    cs.hMenu = menuOrId;
    cs.hInstance = AfxGetInstanceHandle();
    cs.lpCreateParams = param;
    if (!PreCreateWindow(cs)) {
        // Objects that delete themselves do so there, also when there never was a window.
        PostNcDestroy();
        return FALSE;
    }
    // A creation that fails has sent WM_NCDESTROY when the window stood already, and PostNcDestroy with it.
    bool stood = false;
    const HWND window = createWindow(cs, this, &stood);
    if (!window && !stood) {
        PostNcDestroy();
    }
    return window ? TRUE : FALSE;
}

BOOL CWnd::DestroyWindow() {
    return m_hWnd ? ::DestroyWindow(m_hWnd) : FALSE;
}

void CWnd::PostNcDestroy() {}

void CWnd::OnNcDestroy() {
    if (CWinThread* thread = AfxGetThread(); thread && thread->m_pMainWnd == this) {
        // The main window's end is the application's end.
        thread->m_pMainWnd = nullptr;
        AfxPostQuitMessage(0);
    }
    Default();
    Detach();
    PostNcDestroy();
}

// --- messages ---

LRESULT CWnd::WindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
    LRESULT result = 0;
    if (!OnWndMsg(message, wParam, lParam, &result)) {
        result = DefWindowProc(message, wParam, lParam);
    }
    return result;
}

LRESULT CWnd::DefWindowProc(UINT message, WPARAM wParam, LPARAM lParam) {
    Window* window = GetState();
    return window ? window->defaultProc(message, wParam, lParam) : 0;
}

LRESULT CWnd::Default() {
    const Dispatch* current = DispatchScope::current();
    return current ? DefWindowProc(current->msg.message, current->msg.wParam, current->msg.lParam) : 0;
}

const MSG* CWnd::GetCurrentMessage() {
    const Dispatch* current = DispatchScope::current();
    return current ? &current->msg : nullptr;
}

BOOL CWnd::OnWndMsg(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
    if (message == WM_COMMAND) {
        if (OnCommand(wParam, lParam)) {
            *result = 1;
            return TRUE;
        }
        return FALSE;
    }
    if (message == WM_NOTIFY) {
        const auto* header = reinterpret_cast<const NMHDR*>(lParam);
        return header && header->hwndFrom ? OnNotify(wParam, lParam, result) : FALSE;
    }
    // Commands and notifications have roads of their own, above; every other message ends in this window's map.
    const AFX_MSGMAP_ENTRY* entry = FindMessageEntry(message, 0, 0);
    if (!entry) {
        return FALSE;
    }
    MessageCall call;
    call.message = message;
    call.wParam = wParam;
    call.lParam = lParam;
    if (!entry->pfn(*this, call)) {
        return FALSE;
    }
    *result = call.result;
    return TRUE;
}

namespace {

/// Finds out whether a command is enabled before it is carried out.
class CommandTest : public CCmdUI {
public:
    explicit CommandTest(UINT id) {
        m_nID = id;
    }
    void Enable(BOOL on) override {
        m_bEnableChanged = TRUE;
        enabled = on != FALSE;
    }
    void SetCheck(int) override {}
    void SetRadio(BOOL) override {}
    void SetText(LPCSTR) override {}
    bool enabled = true;
};

} // namespace

BOOL CWnd::OnCommand(WPARAM wParam, LPARAM lParam) {
    const UINT id = LOWORD(wParam);
    const auto control = reinterpret_cast<HWND>(lParam);
    int code = HIWORD(wParam);
    if (id == 0) {
        return FALSE;
    }
    if (!control) {
        CommandTest test(id);
        OnCmdMsg(id, CN_UPDATE_COMMAND_UI, &test, nullptr);
        if (!test.enabled) {
            return TRUE; // a disabled command is carried out by nobody
        }
        code = CN_COMMAND;
    } else if (HeldNotifications::areHeldFrom(m_hWnd)) {
        return TRUE;
    } else {
        LRESULT result = 0;
        if (SendChildNotifyLastMsg(control, WM_COMMAND, wParam, lParam, &result)) {
            return TRUE;
        }
    }
    return OnCmdMsg(id, code, nullptr, nullptr);
}

BOOL CWnd::OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) {
    auto* header = reinterpret_cast<NMHDR*>(lParam);
    if (HeldNotifications::areHeldFrom(m_hWnd)) {
        return TRUE;
    }
    if (SendChildNotifyLastMsg(header->hwndFrom, WM_NOTIFY, wParam, lParam, result)) {
        return TRUE;
    }
    NotifyExtra extra{header, result};
    const int code = MAKELONG(static_cast<int>(header->code), WM_NOTIFY);
    return OnCmdMsg(static_cast<UINT>(header->idFrom), code, &extra, nullptr);
}

BOOL CWnd::SendChildNotifyLastMsg(HWND child, UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
    CWnd* object = FromHandlePermanent(child);
    return object ? object->OnChildNotify(message, wParam, lParam, result) : FALSE;
}

BOOL CWnd::OnChildNotify(UINT, WPARAM, LPARAM, LRESULT*) {
    return FALSE;
}

BOOL CWnd::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    return CCmdTarget::OnCmdMsg(id, code, extra, info);
}

BOOL CWnd::PreTranslateMessage(MSG*) {
    return FALSE;
}

BOOL CWnd::WalkPreTranslateTree(HWND stop, MSG* message) {
    for (HWND handle = message->hwnd; handle; handle = ::GetParent(handle)) {
        CWnd* object = FromHandlePermanent(handle);
        if (object && object->PreTranslateMessage(message)) {
            return TRUE;
        }
        if (handle == stop) {
            break;
        }
    }
    return FALSE;
}

namespace {

void sendToDescendants(const Window& window, const MSG& msg, BOOL deep, BOOL onlyPerm) {
    // Handlers may create and destroy siblings, so the list is walked as it is now.
    const std::vector<Window*> children(window.children().begin(), window.children().end());
    for (const Window* child : children) {
        const HWND handle = child->handle();
        if (!Window::from(handle)) {
            continue;
        }
        if (!onlyPerm || child->object()) {
            ::SendMessageA(handle, msg.message, msg.wParam, msg.lParam);
        }
        if (const Window* still = Window::from(handle); deep && still) {
            sendToDescendants(*still, msg, deep, onlyPerm);
        }
    }
}

} // namespace

void CWnd::SendMessageToDescendants(UINT message, WPARAM wParam, LPARAM lParam, BOOL deep, BOOL onlyPerm) {
    if (const Window* window = GetState()) {
        sendToDescendants(*window, MSG{m_hWnd, message, wParam, lParam, 0, {}}, deep, onlyPerm);
    }
}

// --- modal loops ---

int CWnd::RunModalLoop(DWORD) {
    ModalLoop loop;
    void* outer = std::exchange(m_modalLoop, &loop);
    struct Restore {
        void*& place;
        void* value;
        ~Restore() {
            place = value;
        }
    } restore{m_modalLoop, outer};
    return loop.run();
}

void CWnd::EndModalLoop(int result) {
    if (m_modalLoop) {
        static_cast<ModalLoop*>(m_modalLoop)->end(result);
    }
}

BOOL CWnd::IsFrameWnd() const {
    return FALSE;
}

// --- classes ---

LPCSTR AfxRegisterWndClass(UINT classStyle, HCURSOR cursor, HBRUSH background, HICON icon) {
    char name[96];
    std::snprintf(name, sizeof(name), "Afx:%x:%zx:%zx:%zx", classStyle, reinterpret_cast<std::size_t>(cursor),
                  reinterpret_cast<std::size_t>(background), reinterpret_cast<std::size_t>(icon));
    if (!findWindowClass(name)) {
        WindowClass entry;
        entry.name = name;
        entry.style = classStyle;
        entry.cursor = cursor;
        entry.background = background;
        entry.icon = icon;
        addWindowClass(std::move(entry));
    }
    // The table's own text, which stays where it is: hosts keep the pointer.
    return findWindowClass(name)->name.c_str();
}

namespace tvx::afx {

CWnd* windowOf(HWND handle) {
    return CWnd::FromHandle(handle);
}

bool isHandleOf(const CCmdTarget& target, LPARAM handle) {
    const auto* window = dynamic_cast<const CWnd*>(&target);
    return window && reinterpret_cast<LPARAM>(window->m_hWnd) == handle;
}

} // namespace tvx::afx
