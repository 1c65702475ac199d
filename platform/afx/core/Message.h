#pragma once

/// @file
/// Messages: their numbers, the codes and structures that travel in them, and the calls that send, post and fetch
/// them. The numbers are those hosts were written against, since hosts also write them down as numbers.

#include "platform/base/Export.h"
#include "platform/base/Geometry.h"
#include "platform/base/Types.h"
#include "platform/win/ResourceConstants.h"

/// One message on its way to a window (or, with a null window, to a thread).
struct MSG {
    HWND hwnd;     ///< The window; null for messages of PostThreadMessage and for WM_QUIT.
    UINT message;  ///< WM_..., from WM_APP up a host's own, from 0xC000 up a registered one.
    WPARAM wParam; ///< What it says depends on the message, in `lParam` too: both have 64 bits here.
    LPARAM lParam; ///< A pointer in it is valid in the process and, for sent messages, during the call.
    DWORD time;    ///< Milliseconds since some fixed moment of this session.
    POINT pt;      ///< Pointer position on the screen when the message was made.
};
using LPMSG = MSG*;

// Life of a window
#define WM_NULL 0x0000
#define WM_CREATE 0x0001
#define WM_DESTROY 0x0002
#define WM_MOVE 0x0003
#define WM_SIZE 0x0005
#define WM_ACTIVATE 0x0006
#define WM_SETFOCUS 0x0007
#define WM_KILLFOCUS 0x0008
#define WM_ENABLE 0x000A
#define WM_SETREDRAW 0x000B
#define WM_SETTEXT 0x000C
#define WM_GETTEXT 0x000D
#define WM_GETTEXTLENGTH 0x000E
#define WM_PAINT 0x000F
#define WM_CLOSE 0x0010
#define WM_QUERYENDSESSION 0x0011
#define WM_QUIT 0x0012
#define WM_ERASEBKGND 0x0014
#define WM_SYSCOLORCHANGE 0x0015
#define WM_ENDSESSION 0x0016
#define WM_SHOWWINDOW 0x0018
#define WM_SETTINGCHANGE 0x001A
#define WM_ACTIVATEAPP 0x001C
#define WM_CANCELMODE 0x001F
#define WM_SETCURSOR 0x0020
#define WM_MOUSEACTIVATE 0x0021
#define WM_GETMINMAXINFO 0x0024
#define WM_NEXTDLGCTL 0x0028
#define WM_QUERYDRAGICON 0x0037
#define WM_DRAWITEM 0x002B
#define WM_MEASUREITEM 0x002C
#define WM_DELETEITEM 0x002D
#define WM_COMPAREITEM 0x0039
#define WM_SETFONT 0x0030
#define WM_GETFONT 0x0031
#define WM_WINDOWPOSCHANGING 0x0046
#define WM_WINDOWPOSCHANGED 0x0047
#define WM_NOTIFY 0x004E
#define WM_HELP 0x0053
#define WM_CONTEXTMENU 0x007B
#define WM_STYLECHANGED 0x007D
#define WM_GETICON 0x007F
#define WM_SETICON 0x0080

// The parts of a window outside its client area
#define WM_NCCREATE 0x0081
#define WM_NCDESTROY 0x0082
#define WM_NCCALCSIZE 0x0083
#define WM_NCHITTEST 0x0084
#define WM_NCPAINT 0x0085
#define WM_NCACTIVATE 0x0086
#define WM_GETDLGCODE 0x0087
#define WM_NCMOUSEMOVE 0x00A0
#define WM_NCLBUTTONDOWN 0x00A1
#define WM_NCLBUTTONUP 0x00A2
#define WM_NCLBUTTONDBLCLK 0x00A3
#define WM_NCRBUTTONDOWN 0x00A4
#define WM_NCRBUTTONUP 0x00A5
#define WM_NCRBUTTONDBLCLK 0x00A6
#define WM_NCMBUTTONDOWN 0x00A7

// Keyboard
#define WM_KEYFIRST 0x0100
#define WM_KEYDOWN 0x0100
#define WM_KEYUP 0x0101
#define WM_CHAR 0x0102
#define WM_DEADCHAR 0x0103
#define WM_SYSKEYDOWN 0x0104
#define WM_SYSKEYUP 0x0105
#define WM_SYSCHAR 0x0106
#define WM_KEYLAST 0x0109

// Dialogs, menus, scrolling, timers
#define WM_INITDIALOG 0x0110
#define WM_COMMAND 0x0111
#define WM_SYSCOMMAND 0x0112
#define WM_TIMER 0x0113
#define WM_HSCROLL 0x0114
#define WM_VSCROLL 0x0115
#define WM_INITMENU 0x0116
#define WM_INITMENUPOPUP 0x0117
#define WM_MENUSELECT 0x011F
#define WM_MENUCHAR 0x0120
#define WM_ENTERIDLE 0x0121
#define WM_UNINITMENUPOPUP 0x0125
#define WM_CTLCOLORMSGBOX 0x0132
#define WM_CTLCOLOREDIT 0x0133
#define WM_CTLCOLORLISTBOX 0x0134
#define WM_CTLCOLORBTN 0x0135
#define WM_CTLCOLORDLG 0x0136
#define WM_CTLCOLORSCROLLBAR 0x0137
#define WM_CTLCOLORSTATIC 0x0138

// Mouse
#define WM_MOUSEFIRST 0x0200
#define WM_MOUSEMOVE 0x0200
#define WM_LBUTTONDOWN 0x0201
#define WM_LBUTTONUP 0x0202
#define WM_LBUTTONDBLCLK 0x0203
#define WM_RBUTTONDOWN 0x0204
#define WM_RBUTTONUP 0x0205
#define WM_RBUTTONDBLCLK 0x0206
#define WM_MBUTTONDOWN 0x0207
#define WM_MBUTTONUP 0x0208
#define WM_MBUTTONDBLCLK 0x0209
#define WM_MOUSEWHEEL 0x020A
#define WM_MOUSELAST 0x020D
#define WM_PARENTNOTIFY 0x0210
#define WM_ENTERMENULOOP 0x0211
#define WM_EXITMENULOOP 0x0212
#define WM_CAPTURECHANGED 0x0215
#define WM_MDICREATE 0x0220
#define WM_MDIDESTROY 0x0221
#define WM_MDIACTIVATE 0x0222
#define WM_MDIRESTORE 0x0223
#define WM_MDINEXT 0x0224
#define WM_MDIMAXIMIZE 0x0225
#define WM_MDITILE 0x0226
#define WM_MDICASCADE 0x0227
#define WM_MDIICONARRANGE 0x0228
#define WM_MDIGETACTIVE 0x0229
#define WM_MDISETMENU 0x0230
#define WM_ENTERSIZEMOVE 0x0231
#define WM_EXITSIZEMOVE 0x0232
#define WM_DROPFILES 0x0233
#define WM_NCMOUSELEAVE 0x02A2
#define WM_MOUSELEAVE 0x02A3
#define WM_CUT 0x0300
#define WM_COPY 0x0301
#define WM_PASTE 0x0302
#define WM_CLEAR 0x0303
#define WM_UNDO 0x0304
#define WM_PRINT 0x0317
#define WM_THEMECHANGED 0x031A

// The framework's own, in the range it keeps for itself
#define WM_QUERYAFXWNDPROC 0x0360
#define WM_SIZEPARENT 0x0361
#define WM_SETMESSAGESTRING 0x0362
#define WM_IDLEUPDATECMDUI 0x0363
#define WM_INITIALUPDATE 0x0364
#define WM_COMMANDHELP 0x0365
#define WM_HELPHITTEST 0x0366
#define WM_EXITHELPMODE 0x0367
#define WM_RECALCPARENT 0x0368
#define WM_KICKIDLE 0x036A
#define WM_HELPPROMPTADDR 0x0376

#define WM_USER 0x0400
#define WM_APP 0x8000

// Codes in the high half of WM_COMMAND's first parameter
#define BN_CLICKED 0
#define BN_DOUBLECLICKED 5
#define BN_SETFOCUS 6
#define BN_KILLFOCUS 7
#define STN_CLICKED 0
#define STN_DBLCLK 1
#define EN_SETFOCUS 0x0100
#define EN_KILLFOCUS 0x0200
#define EN_CHANGE 0x0300
#define EN_UPDATE 0x0400
#define EN_MAXTEXT 0x0501
#define LBN_ERRSPACE (-2)
#define LBN_SELCHANGE 1
#define LBN_DBLCLK 2
#define LBN_SELCANCEL 3
#define LBN_SETFOCUS 4
#define LBN_KILLFOCUS 5
#define CBN_SELCHANGE 1
#define CBN_DBLCLK 2
#define CBN_SETFOCUS 3
#define CBN_KILLFOCUS 4
#define CBN_EDITCHANGE 5
#define CBN_EDITUPDATE 6
#define CBN_DROPDOWN 7
#define CBN_CLOSEUP 8
#define CBN_SELENDOK 9
#define CBN_SELENDCANCEL 10

// Codes of command routing below those of controls
#define CN_COMMAND 0
#define CN_UPDATE_COMMAND_UI (-1)

// WM_ACTIVATE
#define WA_INACTIVE 0
#define WA_ACTIVE 1
#define WA_CLICKACTIVE 2
// WM_SIZE
#define SIZE_RESTORED 0
#define SIZE_MINIMIZED 1
#define SIZE_MAXIMIZED 2
// WM_MOUSEACTIVATE
#define MA_ACTIVATE 1
#define MA_ACTIVATEANDEAT 2
#define MA_NOACTIVATE 3
#define MA_NOACTIVATEANDEAT 4
// WM_NCHITTEST and the mouse messages outside the client area
#define HTERROR (-2)
#define HTTRANSPARENT (-1)
#define HTNOWHERE 0
#define HTCLIENT 1
#define HTCAPTION 2
#define HTSYSMENU 3
#define HTMENU 5
#define HTHSCROLL 6
#define HTVSCROLL 7
#define HTMINBUTTON 8
#define HTMAXBUTTON 9
#define HTLEFT 10
#define HTRIGHT 11
#define HTTOP 12
#define HTTOPLEFT 13
#define HTTOPRIGHT 14
#define HTBOTTOM 15
#define HTBOTTOMLEFT 16
#define HTBOTTOMRIGHT 17
#define HTBORDER 18
#define HTCLOSE 20
/// An extended style of this layer's own, for top-level frames, as child frames are without it: the window draws its
/// caption and border itself, in the desktop's style, so that its procedure is asked for their parts, told of the mouse
/// there, and may draw on them (the handlers OnNc... of CWnd). The window manager still moves and sizes it. To be set
/// when the window is created.
#define WS_EX_OWNCAPTION 0x00800000
// Keys and buttons held down during a mouse message
#define MK_LBUTTON 0x0001
#define MK_RBUTTON 0x0002
#define MK_SHIFT 0x0004
#define MK_CONTROL 0x0008
#define MK_MBUTTON 0x0010
#define WHEEL_DELTA 120
// WM_SYSCOMMAND
#define SC_SIZE 0xF000
#define SC_MOVE 0xF010
#define SC_MINIMIZE 0xF020
#define SC_MAXIMIZE 0xF030
#define SC_NEXTWINDOW 0xF040
#define SC_PREVWINDOW 0xF050
#define SC_CLOSE 0xF060
#define SC_MOUSEMENU 0xF090
#define SC_KEYMENU 0xF100
#define SC_RESTORE 0xF120
// WM_GETDLGCODE
#define DLGC_WANTARROWS 0x0001
#define DLGC_WANTTAB 0x0002
#define DLGC_WANTALLKEYS 0x0004
#define DLGC_HASSETSEL 0x0008
#define DLGC_DEFPUSHBUTTON 0x0010
#define DLGC_UNDEFPUSHBUTTON 0x0020
#define DLGC_RADIOBUTTON 0x0040
#define DLGC_WANTCHARS 0x0080
#define DLGC_STATIC 0x0100
#define DLGC_BUTTON 0x2000
// WM_HSCROLL, WM_VSCROLL and scroll bars
#define SB_LINEUP 0
#define SB_LINELEFT 0
#define SB_LINEDOWN 1
#define SB_LINERIGHT 1
#define SB_PAGEUP 2
#define SB_PAGELEFT 2
#define SB_PAGEDOWN 3
#define SB_PAGERIGHT 3
#define SB_THUMBPOSITION 4
#define SB_THUMBTRACK 5
#define SB_TOP 6
#define SB_LEFT 6
#define SB_BOTTOM 7
#define SB_RIGHT 7
#define SB_ENDSCROLL 8
#define SB_HORZ 0
#define SB_VERT 1
#define SB_CTL 2
#define SB_BOTH 3
#define SIF_RANGE 0x0001
#define SIF_PAGE 0x0002
#define SIF_POS 0x0004
#define SIF_DISABLENOSCROLL 0x0008
#define SIF_TRACKPOS 0x0010
#define SIF_ALL 0x0017
// ShowWindow
#define SW_HIDE 0
#define SW_SHOWNORMAL 1
#define SW_NORMAL 1
#define SW_SHOWMINIMIZED 2
#define SW_SHOWMAXIMIZED 3
#define SW_MAXIMIZE 3
#define SW_SHOWNOACTIVATE 4
#define SW_SHOW 5
#define SW_MINIMIZE 6
#define SW_SHOWMINNOACTIVE 7
#define SW_SHOWNA 8
#define SW_RESTORE 9
#define SW_SHOWDEFAULT 10
// SetWindowPos
#define SWP_NOSIZE 0x0001
#define SWP_NOMOVE 0x0002
#define SWP_NOZORDER 0x0004
#define SWP_NOREDRAW 0x0008
#define SWP_NOACTIVATE 0x0010
#define SWP_FRAMECHANGED 0x0020
#define SWP_DRAWFRAME 0x0020
#define SWP_SHOWWINDOW 0x0040
#define SWP_HIDEWINDOW 0x0080
#define SWP_NOCOPYBITS 0x0100
#define SWP_NOOWNERZORDER 0x0200
// RedrawWindow
#define RDW_INVALIDATE 0x0001
#define RDW_ERASE 0x0004
#define RDW_VALIDATE 0x0008
#define RDW_NOERASE 0x0020
#define RDW_ALLCHILDREN 0x0080
#define RDW_UPDATENOW 0x0100
#define RDW_ERASENOW 0x0200
#define RDW_FRAME 0x0400
// GetWindow
#define GW_HWNDFIRST 0
#define GW_HWNDLAST 1
#define GW_HWNDNEXT 2
#define GW_HWNDPREV 3
#define GW_OWNER 4
#define GW_CHILD 5
// Get/SetWindowLong
#define GWL_STYLE (-16)
#define GWL_EXSTYLE (-20)
#define GWL_USERDATA (-21)
#define GWL_ID (-12)
// PeekMessage
#define PM_NOREMOVE 0x0000
#define PM_REMOVE 0x0001
#define PM_NOYIELD 0x0002
// WM_SETICON
#define ICON_SMALL 0
#define ICON_BIG 1
// Window classes
#define CS_VREDRAW 0x0001
#define CS_HREDRAW 0x0002
#define CS_DBLCLKS 0x0008
#define CS_OWNDC 0x0020
#define CS_SAVEBITS 0x0800
// Message boxes: buttons, icon, default button
#define MB_OK 0x00000000
#define MB_OKCANCEL 0x00000001
#define MB_ABORTRETRYIGNORE 0x00000002
#define MB_YESNOCANCEL 0x00000003
#define MB_YESNO 0x00000004
#define MB_RETRYCANCEL 0x00000005
#define MB_ICONHAND 0x00000010
#define MB_ICONSTOP 0x00000010
#define MB_ICONERROR 0x00000010
#define MB_ICONQUESTION 0x00000020
#define MB_ICONEXCLAMATION 0x00000030
#define MB_ICONWARNING 0x00000030
#define MB_ICONASTERISK 0x00000040
#define MB_ICONINFORMATION 0x00000040
#define MB_DEFBUTTON1 0x00000000
#define MB_DEFBUTTON2 0x00000100
#define MB_DEFBUTTON3 0x00000200
#define MB_APPLMODAL 0x00000000
#define MB_SYSTEMMODAL 0x00001000
#define MB_TASKMODAL 0x00002000
#define MB_HELP 0x00004000
#define MB_SETFOREGROUND 0x00010000
#define MB_TOPMOST 0x00040000
#define MB_TYPEMASK 0x0000000F
#define MB_ICONMASK 0x000000F0
#define MB_DEFMASK 0x00000F00
// Help requests
#define HELP_CONTEXT 0x0001
#define HELP_QUIT 0x0002
#define HELP_INDEX 0x0003
#define HELP_CONTENTS 0x0003
#define HELP_HELPONHELP 0x0004
#define HELP_CONTEXTPOPUP 0x0008
#define HELP_FINDER 0x000B
#define HELP_KEY 0x0101

// Where the help contexts of commands, of dialogs and other resources, of messages and of bars begin: a context is one
// of these and the identifier
#define HID_BASE_COMMAND 0x00010000U
#define HID_BASE_RESOURCE 0x00020000U
#define HID_BASE_PROMPT 0x00030000U
#define HID_BASE_CONTROL 0x00050000U

// What a help request is about
#define HELPINFO_WINDOW 0x0001
#define HELPINFO_MENUITEM 0x0002
#define CW_USEDEFAULT (static_cast<int>(0x80000000))

/// What a window is created from; WM_CREATE carries a pointer to it.
struct CREATESTRUCT {
    LPVOID lpCreateParams; ///< What the creator passed on; frames and views get a CCreateContext, or null.
    HINSTANCE hInstance;   ///< The application's module, whichever module's code creates the window.
    HMENU hMenu;           ///< The menu of a frame, the identifier of a child window.
    HWND hwndParent;       ///< The parent of a child, the owner of any other window; null for none.
    /// Size and place in pixels, in the parent's client area for children; CW_USEDEFAULT leaves them to the desktop.
    int cy;
    int cx;
    int y;
    int x;
    LONG style;       ///< WS_... and the bits of the class.
    LPCSTR lpszName;  ///< Caption or text; may be null.
    LPCSTR lpszClass; ///< A class's name; null until PreCreateWindow has chosen one.
    DWORD dwExStyle;  ///< WS_EX_...
};
using LPCREATESTRUCT = CREATESTRUCT*;

/// Show state and restored rectangle of a window, its frame included: a top-level window's in screen pixels (not
/// relative to what panels leave of the screen), a child's in its parent's client area.
struct WINDOWPLACEMENT {
    UINT length;           ///< sizeof(WINDOWPLACEMENT), 44.
    UINT flags;            ///< WPF_...
    UINT showCmd;          ///< SW_SHOWNORMAL, SW_SHOWMINIMIZED or SW_SHOWMAXIMIZED; any SW_... to set it.
    POINT ptMinPosition;   ///< (-1, -1): icons and maximised windows are placed by the desktop.
    POINT ptMaxPosition;   ///< (-1, -1) likewise.
    RECT rcNormalPosition; ///< The window when it is neither minimised nor maximised.
};

// flags of WINDOWPLACEMENT
/// Kept for hosts that set it; the desktop places icons.
#define WPF_SETMINPOSITION 0x0001
/// The minimised window will be maximised when it is restored.
#define WPF_RESTORETOMAXIMIZED 0x0002
/// Has no effect: windows of another thread do not exist.
#define WPF_ASYNCWINDOWPLACEMENT 0x0004

/// The limits a window may set when it is about to be sized; WM_GETMINMAXINFO carries a pointer to it.
struct MINMAXINFO {
    /// Sizes and places in screen pixels, the frame included; the first is unused.
    POINT ptReserved;
    POINT ptMaxSize;
    POINT ptMaxPosition;
    POINT ptMinTrackSize;
    POINT ptMaxTrackSize;
};

/// Where a window is about to be put. For hosts that send WM_WINDOWPOSCHANGING themselves: the layer does not, it tells
/// of a new place by WM_SIZE and WM_MOVE when the window has it.
struct WINDOWPOS {
    /// The window, the one it stands behind, its rectangle in its parent and the SWP_... flags.
    HWND hwnd;
    HWND hwndInsertAfter;
    int x;
    int y;
    int cx;
    int cy;
    UINT flags;
};

/// The head of every WM_NOTIFY structure.
struct NMHDR {
    HWND hwndFrom;   ///< The control that tells; a null one is not routed to any handler.
    UINT_PTR idFrom; ///< Its identifier: what ON_NOTIFY entries are found by.
    UINT code;       ///< What happened, the second thing they are found by.
};

/// State of a scroll bar. Positions run from nMin to nMax - nPage + 1.
struct SCROLLINFO {
    UINT cbSize;   ///< sizeof(SCROLLINFO); not looked at.
    UINT fMask;    ///< SIF_...: which fields are to be set. When asked, all are filled.
    int nMin;      ///< The least position.
    int nMax;      ///< The last thing to be seen, not the last position: that is nMax - nPage + 1.
    UINT nPage;    ///< How much is seen at once, which gives the thumb its length; 0 counts as 1.
    int nPos;      ///< Where the thumb was put last, always within the range.
    int nTrackPos; ///< Where the user holds the thumb while dragging it, else nPos. For reading only.
};

/// What WM_HELP carries a pointer to: what help is asked for. The message is sent for F1 and in the help mode of
/// frames, to the window that is meant or the owner of the open menu; who does not take it hands it to its parent or
/// owner by Default. docs/help-requests.md has the whole road.
struct HELPINFO {
    UINT cbSize;           ///< sizeof(HELPINFO).
    int iContextType;      ///< HELPINFO_WINDOW or HELPINFO_MENUITEM.
    int iCtrlId;           ///< The control's identifier or the item's command; 0 for an item that opens a popup.
    HANDLE hItemHandle;    ///< The control's or the menu's handle.
    DWORD_PTR dwContextId; ///< The window's help number (SetWindowContextHelpId, or its template's), 0 for none.
    POINT MousePos;        ///< The pointer in screen pixels.
};

/// An item of an owner-drawn control that is to be painted. Menus draw their items themselves.
struct DRAWITEMSTRUCT {
    UINT CtlType;       ///< ODT_...
    UINT CtlID;         ///< The control's identifier.
    UINT itemID;        ///< The item's index; 0 for buttons and static texts.
    UINT itemAction;    ///< ODA_DRAWENTIRE: items are always painted whole.
    UINT itemState;     ///< ODS_...: how it is to look.
    HWND hwndItem;      ///< The control.
    HDC hDC;            ///< Where to draw; the control's until the handler returns.
    RECT rcItem;        ///< The item in the control's client pixels.
    ULONG_PTR itemData; ///< What the item was given by SetItemData, or by AddString without LBS_HASSTRINGS.
};
using LPDRAWITEMSTRUCT = DRAWITEMSTRUCT*;

/// The items of an owner-drawn list or combo box are to be measured: the handler fills itemHeight. The question comes
/// once for the whole control: all its items are equally high, whatever its style says.
struct MEASUREITEMSTRUCT {
    UINT CtlType;       ///< ODT_LISTBOX or ODT_COMBOBOX.
    UINT CtlID;         ///< The control's identifier.
    UINT itemID;        ///< 0: no item in particular.
    UINT itemWidth;     ///< Not used: items are as wide as their list.
    UINT itemHeight;    ///< Pixels, 1 to 1000. Comes with the height of a line of text.
    ULONG_PTR itemData; ///< 0: no item in particular.
};
using LPMEASUREITEMSTRUCT = MEASUREITEMSTRUCT*;

/// Called by a timer: its window, WM_TIMER, its number and the time as GetTickCount tells it.
using TIMERPROC = void (*)(HWND, UINT, UINT_PTR, DWORD);
/// Called for each window of an enumeration with its last argument; FALSE ends the enumeration.
using WNDENUMPROC = BOOL (*)(HWND, LPARAM);

#define HWND_TOP (reinterpret_cast<HWND>(static_cast<std::intptr_t>(0)))
#define HWND_BOTTOM (reinterpret_cast<HWND>(static_cast<std::intptr_t>(1)))
#define HWND_TOPMOST (reinterpret_cast<HWND>(static_cast<std::intptr_t>(-1)))
#define HWND_NOTOPMOST (reinterpret_cast<HWND>(static_cast<std::intptr_t>(-2)))
#define HWND_BROADCAST (reinterpret_cast<HWND>(static_cast<std::intptr_t>(0xFFFF)))

/// Hands a message straight to a window's procedure and answers its result; 0 for what is no window. From another
/// thread than the window's the call waits until the window's thread has handled the message.
TVX_PLATFORM_API LRESULT SendMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
/// Puts a message behind those that wait for the window's thread. A null window addresses the calling thread;
/// HWND_BROADCAST every top-level window. 0 for what is no window.
TVX_PLATFORM_API BOOL PostMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
/// Asks the innermost loop and every loop around it to end; the outermost answers `exitCode`.
TVX_PLATFORM_API void PostQuitMessage(int exitCode);
/// Looks for a waiting message in the range first..last (0, 0: any) for `window` (null: any) and stores it.
/// With PM_REMOVE it is taken out, to be handed to DispatchMessage. Never waits.
TVX_PLATFORM_API BOOL PeekMessageA(MSG* message, HWND window, UINT first, UINT last, UINT remove);
/// Waits for a message and takes it out. 0 when the message is WM_QUIT, whose wParam is the exit code of
/// PostQuitMessage; -1 when there is no display to wait for. A loop of a host's own sees the WM_QUIT again if it asks
/// again: the loops around it are to end too.
TVX_PLATFORM_API BOOL GetMessageA(MSG* message, HWND window, UINT first, UINT last);
/// Characters are made from key messages when they are dispatched, so this only answers whether `message` is one.
TVX_PLATFORM_API BOOL TranslateMessage(const MSG* message);
/// Sends a message that was fetched with GetMessage or PeekMessage to its window.
TVX_PLATFORM_API LRESULT DispatchMessageA(const MSG* message);
/// The number, from 0xC000 up, that every process part registering the same text gets. 0 for an empty text.
TVX_PLATFORM_API UINT RegisterWindowMessageA(LPCSTR name);
/// Milliseconds since a fixed moment of this session; wraps after 49.7 days.
TVX_PLATFORM_API DWORD GetTickCount();
/// The pointer position packed as the message now being handled carries it.
TVX_PLATFORM_API DWORD GetMessagePos();
/// The time of the message now being handled.
TVX_PLATFORM_API LONG GetMessageTime();

/// The same calls by the names without their suffix.
/// @{
inline LRESULT SendMessage(HWND window, UINT message, WPARAM wParam = 0, LPARAM lParam = 0) {
    return SendMessageA(window, message, wParam, lParam);
}
inline BOOL PostMessage(HWND window, UINT message, WPARAM wParam = 0, LPARAM lParam = 0) {
    return PostMessageA(window, message, wParam, lParam);
}
inline BOOL PeekMessage(MSG* message, HWND window, UINT first, UINT last, UINT remove) {
    return PeekMessageA(message, window, first, last, remove);
}
inline BOOL GetMessage(MSG* message, HWND window, UINT first, UINT last) {
    return GetMessageA(message, window, first, last);
}
inline LRESULT DispatchMessage(const MSG* message) {
    return DispatchMessageA(message);
}
inline UINT RegisterWindowMessage(LPCSTR name) {
    return RegisterWindowMessageA(name);
}
/// @}

/// The signed halves of a parameter: a point, the turn of a wheel.
/// @{
constexpr int GET_X_LPARAM(LPARAM lParam) {
    return static_cast<SHORT>(LOWORD(static_cast<std::uintptr_t>(lParam)));
}
constexpr int GET_Y_LPARAM(LPARAM lParam) {
    return static_cast<SHORT>(HIWORD(static_cast<std::uintptr_t>(lParam)));
}
constexpr int GET_WHEEL_DELTA_WPARAM(WPARAM wParam) {
    return static_cast<SHORT>(HIWORD(wParam));
}
/// @}
