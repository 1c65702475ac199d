#pragma once

/// @file
/// Message maps. A class declares its map in the class body and lists its handlers in the source:
///
/// @code
/// class CMyView : public CView {
///     ...
///     afx_msg void OnSize(UINT type, int cx, int cy);
///     afx_msg void OnEditCopy();
///     DECLARE_MESSAGE_MAP()
/// };
///
/// BEGIN_MESSAGE_MAP(CMyView, CView)
///     ON_WM_SIZE()
///     ON_COMMAND(ID_EDIT_COPY, &CMyView::OnEditCopy)
/// END_MESSAGE_MAP()
/// @endcode
///
/// Each macro names the signature its handler must have; a handler of another signature does not compile.
///
/// Older sources leave the "&" out, and the class before a handler of their own: ON_COMMAND(ID_EDIT_COPY, OnEditCopy).
/// g++ takes that from hosts that tvx_add_application builds (-fms-extensions); clang does not.

#include "platform/afx/core/CmdTarget.h"

#include <type_traits>

class CDC;
class CScrollBar;
class CWnd;

namespace tvx::afx {

/// Takes a handler's type apart: `type` is the class it is a member of, `result` what it answers.
/// @{
template <class T>
struct MemberOf;
template <class Class, class Result, class... Args>
struct MemberOf<Result (Class::*)(Args...)> {
    using type = Class;
    using result = Result;
};
template <class Class, class Result, class... Args>
struct MemberOf<Result (Class::*)(Args...) const> {
    using type = const Class;
    using result = Result;
};
/// @}

/// Calls a handler on the target and keeps what it answers; a handler without result answers 0.
template <auto Fn, class... Args>
bool call(CCmdTarget& target, MessageCall& message, Args... args) {
    using Member = MemberOf<decltype(Fn)>;
    auto& object = static_cast<typename Member::type&>(target);
    if constexpr (std::is_void_v<typename Member::result>) {
        (object.*Fn)(args...);
        message.result = 0;
    } else if constexpr (std::is_pointer_v<typename Member::result>) {
        message.result = reinterpret_cast<LRESULT>((object.*Fn)(args...));
    } else {
        message.result = static_cast<LRESULT>((object.*Fn)(args...));
    }
    return true;
}

/// The window object of a handle that a message carries, temporary if it has none of its own.
TVX_PLATFORM_API CWnd* windowOf(HWND handle);
/// Temporary objects around the device context and the menu that a message carries.
/// @{
TVX_PLATFORM_API CDC* contextOf(HDC handle);
TVX_PLATFORM_API CMenu* menuOf(HMENU handle);
/// @}

/// What handlers are given of a parameter: the window whose handle it is, the point of its signed halves.
/// @{
inline CWnd* windowOf(WPARAM value) {
    return windowOf(reinterpret_cast<HWND>(value));
}
inline CWnd* windowOf(LPARAM value) {
    return windowOf(reinterpret_cast<HWND>(value));
}
inline CPoint pointOf(LPARAM value) {
    return CPoint(GET_X_LPARAM(value), GET_Y_LPARAM(value));
}
/// @}

/// One function for each shape of parameters that handlers have. Each unpacks the two numbers a message travels with,
/// calls the handler and answers whether the message is finished with it.
/// @{

template <auto Fn> // ()
bool onNothing(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m);
}
template <auto Fn> // (UINT flags, CPoint point)
bool onPoint(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(m.wParam), pointOf(m.lParam));
}
template <auto Fn> // (UINT flags, short delta, CPoint point) -> BOOL
bool onWheel(CCmdTarget& t, MessageCall& m) {
    call<Fn>(t, m, static_cast<UINT>(LOWORD(m.wParam)), static_cast<short>(HIWORD(m.wParam)), pointOf(m.lParam));
    return m.result != 0;
}
template <auto Fn> // (UINT key, UINT repeat, UINT flags)
bool onKey(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(m.wParam), static_cast<UINT>(LOWORD(m.lParam)),
                    static_cast<UINT>(HIWORD(m.lParam)));
}
template <auto Fn> // (CWnd* other)
bool onWindow(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, windowOf(m.wParam));
}
template <auto Fn> // (CWnd* other), the handle in the second parameter
bool onWindow2(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, windowOf(m.lParam));
}
template <auto Fn> // (CWnd* window, CPoint point)
bool onWindowPoint(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, windowOf(m.wParam), pointOf(m.lParam));
}
template <auto Fn> // (CWnd* window, UINT hitTest, UINT message)
bool onWindowHit(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, windowOf(m.wParam), static_cast<UINT>(static_cast<int>(static_cast<SHORT>(LOWORD(m.lParam)))),
                    static_cast<UINT>(HIWORD(m.lParam)));
}
template <auto Fn> // (CWnd* window, UINT hitTest, UINT message) -> BOOL; FALSE lets the default act
bool onSetCursor(CCmdTarget& t, MessageCall& m) {
    return onWindowHit<Fn>(t, m);
}
template <auto Fn> // (UINT type, int cx, int cy)
bool onSize(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(m.wParam), static_cast<int>(LOWORD(m.lParam)),
                    static_cast<int>(HIWORD(m.lParam)));
}
template <auto Fn> // (int x, int y)
bool onMove(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, GET_X_LPARAM(m.lParam), GET_Y_LPARAM(m.lParam));
}
template <auto Fn> // (UINT state, CWnd* other, BOOL minimized)
bool onActivate(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(LOWORD(m.wParam)), windowOf(m.lParam), static_cast<BOOL>(HIWORD(m.wParam)));
}
template <auto Fn> // (BOOL flag)
bool onFlag(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<BOOL>(m.wParam));
}
template <auto Fn> // (BOOL flag, DWORD number)
bool onFlagNumber(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<BOOL>(m.wParam), static_cast<DWORD>(m.lParam));
}
template <auto Fn> // (BOOL shown, UINT status)
bool onShow(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<BOOL>(m.wParam), static_cast<UINT>(m.lParam));
}
template <auto Fn> // (UINT number, LPARAM parameter)
bool onNumberParam(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(m.wParam), m.lParam);
}
template <auto Fn> // (UINT_PTR id)
bool onTimer(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT_PTR>(m.wParam));
}
template <auto Fn> // (CREATESTRUCT*) -> int
bool onCreate(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, reinterpret_cast<CREATESTRUCT*>(m.lParam));
}
template <class T, auto Fn> // (T* data)
bool onPointer(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, reinterpret_cast<T*>(m.lParam));
}
template <class T, auto Fn> // (int id, T* data)
bool onIdPointer(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<int>(m.wParam), reinterpret_cast<T*>(m.lParam));
}
template <auto Fn> // (CDC*) -> BOOL
bool onContext(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, contextOf(reinterpret_cast<HDC>(m.wParam)));
}
template <auto Fn> // (CDC*, CWnd* control, UINT kind) -> HBRUSH
bool onCtlColor(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, contextOf(reinterpret_cast<HDC>(m.wParam)), windowOf(m.lParam),
                    static_cast<UINT>(m.message - WM_CTLCOLORMSGBOX));
}
template <auto Fn> // (UINT code, UINT position, CScrollBar* bar)
bool onScroll(CCmdTarget& t, MessageCall& m) {
    auto* bar = reinterpret_cast<CScrollBar*>(windowOf(m.lParam));
    return call<Fn>(t, m, static_cast<UINT>(LOWORD(m.wParam)), static_cast<UINT>(HIWORD(m.wParam)), bar);
}
template <auto Fn> // (CMenu* menu)
bool onMenu(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, menuOf(reinterpret_cast<HMENU>(m.wParam)));
}
template <auto Fn> // (CMenu* popup, UINT index, BOOL systemMenu)
bool onMenuPopup(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, menuOf(reinterpret_cast<HMENU>(m.wParam)), static_cast<UINT>(LOWORD(m.lParam)),
                    static_cast<BOOL>(HIWORD(m.lParam)));
}
template <auto Fn> // (UINT item, UINT flags, HMENU menu)
bool onMenuSelect(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(LOWORD(m.wParam)), static_cast<UINT>(HIWORD(m.wParam)),
                    reinterpret_cast<HMENU>(m.lParam));
}
/// Whether a handle is that of the window that handles the message.
TVX_PLATFORM_API bool isHandleOf(const CCmdTarget& target, LPARAM handle);
template <auto Fn> // (BOOL becomesActive, CWnd* activated, CWnd* deactivated)
bool onMdiActivate(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<BOOL>(isHandleOf(t, m.lParam)), windowOf(m.lParam), windowOf(m.wParam));
}
template <auto Fn> // (UINT reason, CWnd* who)
bool onEnterIdle(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(m.wParam), windowOf(m.lParam));
}
template <auto Fn> // (UINT flags, LPCSTR section)
bool onSettingChange(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, static_cast<UINT>(m.wParam), reinterpret_cast<LPCSTR>(m.lParam));
}
template <auto Fn> // (CPoint point) -> LRESULT
bool onHitTest(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, pointOf(m.lParam));
}
template <auto Fn> // (HANDLE handle)
bool onHandle(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, reinterpret_cast<HANDLE>(m.wParam));
}
template <auto Fn> // (WPARAM, LPARAM) -> LRESULT
bool onMessage(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, m.wParam, m.lParam);
}
template <auto Fn> // void (WPARAM, LPARAM), for thread messages
bool onThreadMessage(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, m.wParam, m.lParam);
}

// Commands: a handler may also take the command's identifier, and answer FALSE to let routing go on.

template <auto Fn> // void ()
bool onCommand(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m);
}
template <auto Fn> // BOOL (UINT id)
bool onCommandEx(CCmdTarget& t, MessageCall& m) {
    call<Fn>(t, m, m.id);
    return m.result != 0;
}
template <auto Fn> // void (UINT id)
bool onCommandRange(CCmdTarget& t, MessageCall& m) {
    return call<Fn>(t, m, m.id);
}
template <auto Fn> // void (CCmdUI*)
bool onUpdate(CCmdTarget& t, MessageCall& m) {
    auto* element = static_cast<CCmdUI*>(m.extra);
    element->m_bContinueRouting = FALSE;
    call<Fn>(t, m, element);
    const bool finished = !element->m_bContinueRouting;
    element->m_bContinueRouting = FALSE;
    return finished;
}

/// What OnCmdMsg carries for WM_NOTIFY.
struct NotifyExtra {
    NMHDR* header;   ///< What the control sent; a longer structure that begins with it.
    LRESULT* result; ///< What the control is to be answered.
};
template <auto Fn> // void (NMHDR*, LRESULT*)
bool onNotify(CCmdTarget& t, MessageCall& m) {
    auto* extra = static_cast<NotifyExtra*>(m.extra);
    return call<Fn>(t, m, extra->header, extra->result);
}
template <auto Fn> // BOOL (UINT id, NMHDR*, LRESULT*)
bool onNotifyEx(CCmdTarget& t, MessageCall& m) {
    auto* extra = static_cast<NotifyExtra*>(m.extra);
    call<Fn>(t, m, m.id, extra->header, extra->result);
    return m.result != 0;
}
/// @}

} // namespace tvx::afx

#define DECLARE_MESSAGE_MAP()                                                                                          \
protected:                                                                                                             \
    static const AFX_MSGMAP* GetThisMessageMap();                                                                      \
    const AFX_MSGMAP* GetMessageMap() const override;

#define BEGIN_MESSAGE_MAP(theClass, baseClass)                                                                         \
    const AFX_MSGMAP* theClass::GetMessageMap() const {                                                                \
        return GetThisMessageMap();                                                                                    \
    }                                                                                                                  \
    const AFX_MSGMAP* theClass::GetThisMessageMap() {                                                                  \
        using ThisClass [[maybe_unused]] = theClass;                                                                   \
        using TheBaseClass = baseClass;                                                                                \
        static const AFX_MSGMAP_ENTRY entries[] = {
#define END_MESSAGE_MAP()                                                                                              \
    {                                                                                                                  \
        0, 0, 0, 0, nullptr, nullptr                                                                                   \
    }                                                                                                                  \
    }                                                                                                                  \
    ;                                                                                                                  \
    static const AFX_MSGMAP map = {&TheBaseClass::GetThisMessageMap, entries};                                         \
    return &map;                                                                                                       \
    }

#define TVX_ON_MESSAGE(message, handler) {message, 0, 0, 0, handler, nullptr},
#define TVX_ON_NOTIFICATION(code, id, lastId, handler)                                                                 \
    {WM_COMMAND, static_cast<int>(code), static_cast<UINT>(id), static_cast<UINT>(lastId), handler, nullptr},

#define ON_COMMAND(id, memberFxn) TVX_ON_NOTIFICATION(CN_COMMAND, id, id, (&::tvx::afx::onCommand<memberFxn>))
#define ON_COMMAND_EX(id, memberFxn) TVX_ON_NOTIFICATION(CN_COMMAND, id, id, (&::tvx::afx::onCommandEx<memberFxn>))
#define ON_COMMAND_RANGE(id, idLast, memberFxn)                                                                        \
    TVX_ON_NOTIFICATION(CN_COMMAND, id, idLast, (&::tvx::afx::onCommandRange<memberFxn>))
#define ON_COMMAND_EX_RANGE(id, idLast, memberFxn)                                                                     \
    TVX_ON_NOTIFICATION(CN_COMMAND, id, idLast, (&::tvx::afx::onCommandEx<memberFxn>))
#define ON_UPDATE_COMMAND_UI(id, memberFxn)                                                                            \
    TVX_ON_NOTIFICATION(CN_UPDATE_COMMAND_UI, id, id, (&::tvx::afx::onUpdate<memberFxn>))
#define ON_UPDATE_COMMAND_UI_RANGE(id, idLast, memberFxn)                                                              \
    TVX_ON_NOTIFICATION(CN_UPDATE_COMMAND_UI, id, idLast, (&::tvx::afx::onUpdate<memberFxn>))
#define ON_CONTROL(code, id, memberFxn) TVX_ON_NOTIFICATION(code, id, id, (&::tvx::afx::onCommand<memberFxn>))
#define ON_CONTROL_RANGE(code, id, idLast, memberFxn)                                                                  \
    TVX_ON_NOTIFICATION(code, id, idLast, (&::tvx::afx::onCommandRange<memberFxn>))
#define ON_NOTIFY(code, id, memberFxn)                                                                                 \
    {WM_NOTIFY,                                                                                                        \
     static_cast<int>(code),                                                                                           \
     static_cast<UINT>(id),                                                                                            \
     static_cast<UINT>(id),                                                                                            \
     (&::tvx::afx::onNotify<memberFxn>),                                                                               \
     nullptr},
#define ON_NOTIFY_EX(code, id, memberFxn)                                                                              \
    {WM_NOTIFY,                                                                                                        \
     static_cast<int>(code),                                                                                           \
     static_cast<UINT>(id),                                                                                            \
     static_cast<UINT>(id),                                                                                            \
     (&::tvx::afx::onNotifyEx<memberFxn>),                                                                             \
     nullptr},
#define ON_MESSAGE(message, memberFxn) TVX_ON_MESSAGE(message, (&::tvx::afx::onMessage<memberFxn>))
#define ON_REGISTERED_MESSAGE(variable, memberFxn) {0xC000, 0, 0, 0, (&::tvx::afx::onMessage<memberFxn>), &(variable)},
#define ON_THREAD_MESSAGE(message, memberFxn) TVX_ON_MESSAGE(message, (&::tvx::afx::onThreadMessage<memberFxn>))

#define ON_BN_CLICKED(id, memberFxn) ON_CONTROL(BN_CLICKED, id, memberFxn)
#define ON_BN_DOUBLECLICKED(id, memberFxn) ON_CONTROL(BN_DOUBLECLICKED, id, memberFxn)
#define ON_STN_CLICKED(id, memberFxn) ON_CONTROL(STN_CLICKED, id, memberFxn)
#define ON_STN_DBLCLK(id, memberFxn) ON_CONTROL(STN_DBLCLK, id, memberFxn)
#define ON_EN_SETFOCUS(id, memberFxn) ON_CONTROL(EN_SETFOCUS, id, memberFxn)
#define ON_EN_KILLFOCUS(id, memberFxn) ON_CONTROL(EN_KILLFOCUS, id, memberFxn)
#define ON_EN_CHANGE(id, memberFxn) ON_CONTROL(EN_CHANGE, id, memberFxn)
#define ON_EN_UPDATE(id, memberFxn) ON_CONTROL(EN_UPDATE, id, memberFxn)
#define ON_EN_MAXTEXT(id, memberFxn) ON_CONTROL(EN_MAXTEXT, id, memberFxn)
#define ON_LBN_SELCHANGE(id, memberFxn) ON_CONTROL(LBN_SELCHANGE, id, memberFxn)
#define ON_LBN_DBLCLK(id, memberFxn) ON_CONTROL(LBN_DBLCLK, id, memberFxn)
#define ON_LBN_SETFOCUS(id, memberFxn) ON_CONTROL(LBN_SETFOCUS, id, memberFxn)
#define ON_LBN_KILLFOCUS(id, memberFxn) ON_CONTROL(LBN_KILLFOCUS, id, memberFxn)
#define ON_CBN_SELCHANGE(id, memberFxn) ON_CONTROL(CBN_SELCHANGE, id, memberFxn)
#define ON_CBN_DBLCLK(id, memberFxn) ON_CONTROL(CBN_DBLCLK, id, memberFxn)
#define ON_CBN_SETFOCUS(id, memberFxn) ON_CONTROL(CBN_SETFOCUS, id, memberFxn)
#define ON_CBN_KILLFOCUS(id, memberFxn) ON_CONTROL(CBN_KILLFOCUS, id, memberFxn)
#define ON_CBN_EDITCHANGE(id, memberFxn) ON_CONTROL(CBN_EDITCHANGE, id, memberFxn)
#define ON_CBN_DROPDOWN(id, memberFxn) ON_CONTROL(CBN_DROPDOWN, id, memberFxn)
#define ON_CBN_SELENDOK(id, memberFxn) ON_CONTROL(CBN_SELENDOK, id, memberFxn)
#define ON_CBN_CLOSEUP(id, memberFxn) ON_CONTROL(CBN_CLOSEUP, id, memberFxn)

#define ON_WM_CREATE() TVX_ON_MESSAGE(WM_CREATE, (&::tvx::afx::onCreate<&ThisClass::OnCreate>))
#define ON_WM_DESTROY() TVX_ON_MESSAGE(WM_DESTROY, (&::tvx::afx::onNothing<&ThisClass::OnDestroy>))
#define ON_WM_NCDESTROY() TVX_ON_MESSAGE(WM_NCDESTROY, (&::tvx::afx::onNothing<&ThisClass::OnNcDestroy>))
#define ON_WM_MOVE() TVX_ON_MESSAGE(WM_MOVE, (&::tvx::afx::onMove<&ThisClass::OnMove>))
#define ON_WM_SIZE() TVX_ON_MESSAGE(WM_SIZE, (&::tvx::afx::onSize<&ThisClass::OnSize>))
#define ON_WM_ACTIVATE() TVX_ON_MESSAGE(WM_ACTIVATE, (&::tvx::afx::onActivate<&ThisClass::OnActivate>))
#define ON_WM_ACTIVATEAPP() TVX_ON_MESSAGE(WM_ACTIVATEAPP, (&::tvx::afx::onFlagNumber<&ThisClass::OnActivateApp>))
#define ON_WM_SETFOCUS() TVX_ON_MESSAGE(WM_SETFOCUS, (&::tvx::afx::onWindow<&ThisClass::OnSetFocus>))
#define ON_WM_KILLFOCUS() TVX_ON_MESSAGE(WM_KILLFOCUS, (&::tvx::afx::onWindow<&ThisClass::OnKillFocus>))
#define ON_WM_ENABLE() TVX_ON_MESSAGE(WM_ENABLE, (&::tvx::afx::onFlag<&ThisClass::OnEnable>))
#define ON_WM_PAINT() TVX_ON_MESSAGE(WM_PAINT, (&::tvx::afx::onNothing<&ThisClass::OnPaint>))
#define ON_WM_CLOSE() TVX_ON_MESSAGE(WM_CLOSE, (&::tvx::afx::onNothing<&ThisClass::OnClose>))
#define ON_WM_QUERYENDSESSION()                                                                                        \
    TVX_ON_MESSAGE(WM_QUERYENDSESSION, (&::tvx::afx::onNothing<&ThisClass::OnQueryEndSession>))
#define ON_WM_QUERYDRAGICON() TVX_ON_MESSAGE(WM_QUERYDRAGICON, (&::tvx::afx::onNothing<&ThisClass::OnQueryDragIcon>))
#define ON_WM_ENDSESSION() TVX_ON_MESSAGE(WM_ENDSESSION, (&::tvx::afx::onFlag<&ThisClass::OnEndSession>))
#define ON_WM_ERASEBKGND() TVX_ON_MESSAGE(WM_ERASEBKGND, (&::tvx::afx::onContext<&ThisClass::OnEraseBkgnd>))
#define ON_WM_SYSCOLORCHANGE() TVX_ON_MESSAGE(WM_SYSCOLORCHANGE, (&::tvx::afx::onNothing<&ThisClass::OnSysColorChange>))
#define ON_WM_SHOWWINDOW() TVX_ON_MESSAGE(WM_SHOWWINDOW, (&::tvx::afx::onShow<&ThisClass::OnShowWindow>))
#define ON_WM_CTLCOLOR()                                                                                               \
    TVX_ON_MESSAGE(WM_CTLCOLOREDIT, (&::tvx::afx::onCtlColor<&ThisClass::OnCtlColor>))                                 \
    TVX_ON_MESSAGE(WM_CTLCOLORLISTBOX, (&::tvx::afx::onCtlColor<&ThisClass::OnCtlColor>))                              \
    TVX_ON_MESSAGE(WM_CTLCOLORBTN, (&::tvx::afx::onCtlColor<&ThisClass::OnCtlColor>))                                  \
    TVX_ON_MESSAGE(WM_CTLCOLORDLG, (&::tvx::afx::onCtlColor<&ThisClass::OnCtlColor>))                                  \
    TVX_ON_MESSAGE(WM_CTLCOLORSTATIC, (&::tvx::afx::onCtlColor<&ThisClass::OnCtlColor>))
#define ON_WM_CANCELMODE() TVX_ON_MESSAGE(WM_CANCELMODE, (&::tvx::afx::onNothing<&ThisClass::OnCancelMode>))
#define ON_WM_CAPTURECHANGED() TVX_ON_MESSAGE(WM_CAPTURECHANGED, (&::tvx::afx::onWindow2<&ThisClass::OnCaptureChanged>))
#define ON_WM_SETCURSOR() TVX_ON_MESSAGE(WM_SETCURSOR, (&::tvx::afx::onSetCursor<&ThisClass::OnSetCursor>))
#define ON_WM_MOUSEACTIVATE() TVX_ON_MESSAGE(WM_MOUSEACTIVATE, (&::tvx::afx::onWindowHit<&ThisClass::OnMouseActivate>))
#define ON_WM_GETMINMAXINFO()                                                                                          \
    TVX_ON_MESSAGE(WM_GETMINMAXINFO, (&::tvx::afx::onPointer<MINMAXINFO, &ThisClass::OnGetMinMaxInfo>))
#define ON_WM_DRAWITEM() TVX_ON_MESSAGE(WM_DRAWITEM, (&::tvx::afx::onIdPointer<DRAWITEMSTRUCT, &ThisClass::OnDrawItem>))
#define ON_WM_MEASUREITEM()                                                                                            \
    TVX_ON_MESSAGE(WM_MEASUREITEM, (&::tvx::afx::onIdPointer<MEASUREITEMSTRUCT, &ThisClass::OnMeasureItem>))
#define ON_WM_CONTEXTMENU() TVX_ON_MESSAGE(WM_CONTEXTMENU, (&::tvx::afx::onWindowPoint<&ThisClass::OnContextMenu>))
#define ON_WM_HELPINFO() TVX_ON_MESSAGE(WM_HELP, (&::tvx::afx::onPointer<HELPINFO, &ThisClass::OnHelpInfo>))
#define ON_WM_THEMECHANGED() TVX_ON_MESSAGE(WM_THEMECHANGED, (&::tvx::afx::onNothing<&ThisClass::OnThemeChanged>))
#define ON_WM_NCHITTEST() TVX_ON_MESSAGE(WM_NCHITTEST, (&::tvx::afx::onHitTest<&ThisClass::OnNcHitTest>))
#define ON_WM_NCPAINT() TVX_ON_MESSAGE(WM_NCPAINT, (&::tvx::afx::onNothing<&ThisClass::OnNcPaint>))
#define ON_WM_NCACTIVATE() TVX_ON_MESSAGE(WM_NCACTIVATE, (&::tvx::afx::onFlag<&ThisClass::OnNcActivate>))
#define ON_WM_GETDLGCODE() TVX_ON_MESSAGE(WM_GETDLGCODE, (&::tvx::afx::onNothing<&ThisClass::OnGetDlgCode>))
#define ON_WM_NCMOUSEMOVE() TVX_ON_MESSAGE(WM_NCMOUSEMOVE, (&::tvx::afx::onPoint<&ThisClass::OnNcMouseMove>))
#define ON_WM_NCLBUTTONDOWN() TVX_ON_MESSAGE(WM_NCLBUTTONDOWN, (&::tvx::afx::onPoint<&ThisClass::OnNcLButtonDown>))
#define ON_WM_NCLBUTTONUP() TVX_ON_MESSAGE(WM_NCLBUTTONUP, (&::tvx::afx::onPoint<&ThisClass::OnNcLButtonUp>))
#define ON_WM_NCLBUTTONDBLCLK()                                                                                        \
    TVX_ON_MESSAGE(WM_NCLBUTTONDBLCLK, (&::tvx::afx::onPoint<&ThisClass::OnNcLButtonDblClk>))
#define ON_WM_NCRBUTTONUP() TVX_ON_MESSAGE(WM_NCRBUTTONUP, (&::tvx::afx::onPoint<&ThisClass::OnNcRButtonUp>))
#define ON_WM_KEYDOWN() TVX_ON_MESSAGE(WM_KEYDOWN, (&::tvx::afx::onKey<&ThisClass::OnKeyDown>))
#define ON_WM_KEYUP() TVX_ON_MESSAGE(WM_KEYUP, (&::tvx::afx::onKey<&ThisClass::OnKeyUp>))
#define ON_WM_CHAR() TVX_ON_MESSAGE(WM_CHAR, (&::tvx::afx::onKey<&ThisClass::OnChar>))
#define ON_WM_SYSKEYDOWN() TVX_ON_MESSAGE(WM_SYSKEYDOWN, (&::tvx::afx::onKey<&ThisClass::OnSysKeyDown>))
#define ON_WM_SYSKEYUP() TVX_ON_MESSAGE(WM_SYSKEYUP, (&::tvx::afx::onKey<&ThisClass::OnSysKeyUp>))
#define ON_WM_SYSCHAR() TVX_ON_MESSAGE(WM_SYSCHAR, (&::tvx::afx::onKey<&ThisClass::OnSysChar>))
#define ON_WM_SYSCOMMAND() TVX_ON_MESSAGE(WM_SYSCOMMAND, (&::tvx::afx::onNumberParam<&ThisClass::OnSysCommand>))
#define ON_WM_TIMER() TVX_ON_MESSAGE(WM_TIMER, (&::tvx::afx::onTimer<&ThisClass::OnTimer>))
#define ON_WM_HSCROLL() TVX_ON_MESSAGE(WM_HSCROLL, (&::tvx::afx::onScroll<&ThisClass::OnHScroll>))
#define ON_WM_VSCROLL() TVX_ON_MESSAGE(WM_VSCROLL, (&::tvx::afx::onScroll<&ThisClass::OnVScroll>))
#define ON_WM_INITMENU() TVX_ON_MESSAGE(WM_INITMENU, (&::tvx::afx::onMenu<&ThisClass::OnInitMenu>))
#define ON_WM_INITMENUPOPUP() TVX_ON_MESSAGE(WM_INITMENUPOPUP, (&::tvx::afx::onMenuPopup<&ThisClass::OnInitMenuPopup>))
#define ON_WM_MENUSELECT() TVX_ON_MESSAGE(WM_MENUSELECT, (&::tvx::afx::onMenuSelect<&ThisClass::OnMenuSelect>))
#define ON_WM_ENTERIDLE() TVX_ON_MESSAGE(WM_ENTERIDLE, (&::tvx::afx::onEnterIdle<&ThisClass::OnEnterIdle>))
#define ON_WM_MOUSEMOVE() TVX_ON_MESSAGE(WM_MOUSEMOVE, (&::tvx::afx::onPoint<&ThisClass::OnMouseMove>))
#define ON_WM_MOUSELEAVE() TVX_ON_MESSAGE(WM_MOUSELEAVE, (&::tvx::afx::onNothing<&ThisClass::OnMouseLeave>))
#define ON_WM_MOUSEWHEEL() TVX_ON_MESSAGE(WM_MOUSEWHEEL, (&::tvx::afx::onWheel<&ThisClass::OnMouseWheel>))
#define ON_WM_LBUTTONDOWN() TVX_ON_MESSAGE(WM_LBUTTONDOWN, (&::tvx::afx::onPoint<&ThisClass::OnLButtonDown>))
#define ON_WM_LBUTTONUP() TVX_ON_MESSAGE(WM_LBUTTONUP, (&::tvx::afx::onPoint<&ThisClass::OnLButtonUp>))
#define ON_WM_LBUTTONDBLCLK() TVX_ON_MESSAGE(WM_LBUTTONDBLCLK, (&::tvx::afx::onPoint<&ThisClass::OnLButtonDblClk>))
#define ON_WM_RBUTTONDOWN() TVX_ON_MESSAGE(WM_RBUTTONDOWN, (&::tvx::afx::onPoint<&ThisClass::OnRButtonDown>))
#define ON_WM_RBUTTONUP() TVX_ON_MESSAGE(WM_RBUTTONUP, (&::tvx::afx::onPoint<&ThisClass::OnRButtonUp>))
#define ON_WM_RBUTTONDBLCLK() TVX_ON_MESSAGE(WM_RBUTTONDBLCLK, (&::tvx::afx::onPoint<&ThisClass::OnRButtonDblClk>))
#define ON_WM_MBUTTONDOWN() TVX_ON_MESSAGE(WM_MBUTTONDOWN, (&::tvx::afx::onPoint<&ThisClass::OnMButtonDown>))
#define ON_WM_MBUTTONUP() TVX_ON_MESSAGE(WM_MBUTTONUP, (&::tvx::afx::onPoint<&ThisClass::OnMButtonUp>))
#define ON_WM_MDIACTIVATE() TVX_ON_MESSAGE(WM_MDIACTIVATE, (&::tvx::afx::onMdiActivate<&ThisClass::OnMDIActivate>))
#define ON_WM_WINDOWPOSCHANGING()                                                                                      \
    TVX_ON_MESSAGE(WM_WINDOWPOSCHANGING, (&::tvx::afx::onPointer<WINDOWPOS, &ThisClass::OnWindowPosChanging>))
#define ON_WM_WINDOWPOSCHANGED()                                                                                       \
    TVX_ON_MESSAGE(WM_WINDOWPOSCHANGED, (&::tvx::afx::onPointer<WINDOWPOS, &ThisClass::OnWindowPosChanged>))
#define ON_WM_DROPFILES() TVX_ON_MESSAGE(WM_DROPFILES, (&::tvx::afx::onHandle<&ThisClass::OnDropFiles>))
#define ON_WM_SETTINGCHANGE()                                                                                          \
    TVX_ON_MESSAGE(WM_SETTINGCHANGE, (&::tvx::afx::onSettingChange<&ThisClass::OnSettingChange>))
