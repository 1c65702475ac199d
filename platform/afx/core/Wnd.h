#pragma once

/// @file
/// CWnd, the object around a window handle, and the calls that work on bare handles.

#include "platform/afx/core/CmdTarget.h"
#include "platform/afx/core/MessageMap.h"
#include "platform/afx/core/WindowCalls.h"

class CBitmap;
class CDC;
class CDataExchange;
class CFont;
class CFrameWnd;
class CMenu;
class CRgn;
class CScrollBar;
class CWinThread;

namespace tvx::afx {
class Window;
}

/// A window: a top-level frame, a dialog, a view, a control.
///
/// Derive a class, give it a message map, make the object and create its window:
///
/// @code
/// auto* view = new CMyView;              // deletes itself in PostNcDestroy, or is a member of its parent
/// view->Create(nullptr, nullptr, WS_CHILD | WS_VISIBLE, rect, parent, AFX_IDW_PANE_FIRST);
/// @endcode
///
/// The object and its window are two things: the window ends with DestroyWindow (the object's destructor calls it if
/// the window still lives), the object when its owner deletes it. Objects that delete themselves do so in
/// PostNcDestroy. FromHandle answers the object of a window, or a temporary one that must not be kept: it is gone when
/// the application is next idle.
///
/// Coordinates are pixels: of the screen for window rectangles, of the parent's client area for moving children, of the
/// own client area for drawing and mouse messages. Texts are UTF-8. Members that need a window answer 0 or do nothing
/// when there is none.
class TVX_PLATFORM_API CWnd : public CCmdTarget {
    DECLARE_DYNCREATE(CWnd)

public:
    /// The window's handle, null when there is no window.
    HWND m_hWnd = nullptr;

    CWnd() = default;
    /// Destroys the window if it still lives; it gets no PostNcDestroy any more.
    ~CWnd() override;
    CWnd(const CWnd&) = delete;
    CWnd& operator=(const CWnd&) = delete;

    /// The handle of an object that may be null: null then, and when it has no window.
    HWND GetSafeHwnd() const {
        return HandleOf(this);
    }
    /// The handle, null when there is no window.
    operator HWND() const {
        return m_hWnd;
    }

    /// Objects and handles.
    /// @{

    /// The object of a window, or a temporary one; null for a null handle.
    static CWnd* FromHandle(HWND window);
    /// The object of a window, or null when it has none of its own.
    static CWnd* FromHandlePermanent(HWND window);
    /// Deletes the temporary objects made since the last call. The idle loop does this.
    static void DeleteTempMap();
    /// Makes this object the one of an existing window that has none. The window's messages go to this object's map.
    BOOL Attach(HWND window);
    /// Gives up the window without destroying it and answers its handle.
    HWND Detach();
    /// Like Attach; PreSubclassWindow is called first.
    BOOL SubclassWindow(HWND window);
    /// Attaches to the control `id` of `parent`. FALSE when there is none or it has an object already.
    BOOL SubclassDlgItem(UINT id, CWnd* parent);
    /// Gives up the window, whose messages go to its class alone again, and answers its handle. The same as Detach.
    HWND UnsubclassWindow();
    /// @}

    /// Creation and end.
    /// @{

    /// Creates a child window.
    /// @param className a registered class ("Edit", AfxRegisterWndClass, ...); null for the framework's plain class.
    virtual BOOL Create(LPCSTR className, LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id,
                        struct CCreateContext* context = nullptr);
    /// Creates any window. `rect` is in the parent's client coordinates for children, else in screen coordinates.
    BOOL CreateEx(DWORD exStyle, LPCSTR className, LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id,
                  LPVOID param = nullptr);
    /// The same with single numbers; CW_USEDEFAULT leaves place or size to the window manager.
    BOOL CreateEx(DWORD exStyle, LPCSTR className, LPCSTR text, DWORD style, int x, int y, int width, int height,
                  HWND parent, HMENU menuOrId, LPVOID param = nullptr);
    /// Destroys the window and its children: WM_DESTROY parents first, WM_NCDESTROY children first.
    virtual BOOL DestroyWindow();
    /// Last chance to change the class and styles a window is created with. FALSE gives up the creation.
    virtual BOOL PreCreateWindow(CREATESTRUCT& cs);
    /// Called before an object is attached to a window, by creation and by subclassing.
    virtual void PreSubclassWindow();
    /// Called when the window is gone; the place for `delete this`.
    virtual void PostNcDestroy();
    /// @}

    /// Messages.
    /// @{

    /// Hands a message straight to the window's procedure; 0 without a window. From another thread it waits for that.
    LRESULT SendMessage(UINT message, WPARAM wParam = 0, LPARAM lParam = 0) const {
        return ::SendMessageA(m_hWnd, message, wParam, lParam);
    }
    /// Puts a message behind those that wait. Without a window it goes to the thread itself.
    BOOL PostMessage(UINT message, WPARAM wParam = 0, LPARAM lParam = 0) const {
        return ::PostMessageA(m_hWnd, message, wParam, lParam);
    }
    /// SendMessage by the name that sources compiled elsewhere hold.
    LRESULT SendMessageA(UINT message, WPARAM wParam = 0, LPARAM lParam = 0) const {
        return ::SendMessageA(m_hWnd, message, wParam, lParam);
    }
    /// Sends a message to every child, and to theirs when `deep`. With `onlyPerm` only to windows with an object.
    void SendMessageToDescendants(UINT message, WPARAM wParam = 0, LPARAM lParam = 0, BOOL deep = TRUE,
                                  BOOL onlyPerm = FALSE);
    /// Looks at a message before it is dispatched, this window being its target or an ancestor of it. TRUE consumes it.
    virtual BOOL PreTranslateMessage(MSG* message);
    /// Handles every message of the window: the message map first, then DefWindowProc.
    virtual LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam);
    /// What happens with a message that no handler took.
    virtual LRESULT DefWindowProc(UINT message, WPARAM wParam, LPARAM lParam);
    /// DefWindowProc with the message now being handled; what the On... members of this class do.
    LRESULT Default();
    /// The message now being handled by any window of this thread.
    static const MSG* GetCurrentMessage();
    /// Offers a message to PreTranslateMessage of its target and of each ancestor up to `stop`.
    static BOOL WalkPreTranslateTree(HWND stop, MSG* message);
    /// Answers for the keys and the mouse of this window and its children as a dialog does: acts on Tab, arrows, Enter,
    /// Esc and mnemonics, and leaves everything else to the window that it is for. TRUE for each such message, so that
    /// nobody around or behind the dialog takes its keys; FALSE for other messages and other windows'.
    BOOL PreTranslateInput(MSG* message);
    /// The first WM_COMMAND/WM_NOTIFY handler of the parent's; called with notifications of this window before them.
    virtual BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);
    /// @}

    /// State.
    /// @{

    /// The bits that the window has now: WS_VISIBLE, WS_DISABLED and the scroll bars' follow what was done with it.
    DWORD GetStyle() const;
    /// The WS_EX_... bits.
    DWORD GetExStyle() const;
    /// Removes and adds style bits, removing first. Answers whether anything changed.
    /// @param swpFlags passed on to SetWindowPos when not 0. Not needed for the new style to be seen: that is at once.
    BOOL ModifyStyle(DWORD remove, DWORD add, UINT swpFlags = 0);
    /// The same for WS_EX_... bits.
    BOOL ModifyStyleEx(DWORD remove, DWORD add, UINT swpFlags = 0);
    /// The identifier that a child is found by and its messages carry; SetDlgCtrlID answers the previous one.
    int GetDlgCtrlID() const;
    int SetDlgCtrlID(int id);
    /// Enables or disables input. Answers whether the window was disabled before.
    BOOL EnableWindow(BOOL enable = TRUE);
    /// Whether this window itself takes input; its parents may be disabled all the same.
    BOOL IsWindowEnabled() const;
    /// Shows, hides, minimises, maximises or restores (SW_...). Answers whether the window was visible before.
    BOOL ShowWindow(int command);
    /// Whether the window and all its ancestors are shown.
    BOOL IsWindowVisible() const;
    /// Whether the window is minimised or, IsZoomed, maximised: both when it will be maximised on being restored.
    BOOL IsIconic() const;
    BOOL IsZoomed() const;
    /// @}

    /// Text and font.
    /// @{

    /// Sets the caption of a frame, the text of a control.
    void SetWindowText(LPCSTR text);
    void SetWindowTextA(LPCSTR text) {
        SetWindowText(text);
    }
    /// Copies at most size - 1 bytes, never half a character, and answers how many.
    int GetWindowText(LPSTR buffer, int size) const;
    void GetWindowText(CString& text) const;
    /// Bytes of the text, the ending NUL not counted.
    int GetWindowTextLength() const;
    /// Sets the font a control draws with; it stays the caller's and must live as long as the control uses it.
    void SetFont(CFont* font, BOOL redraw = TRUE);
    /// The font set last, null for the system's.
    CFont* GetFont() const;
    /// Gives a frame its icon; `bigIcon` selects the one for task lists. Answers the previous one.
    HICON SetIcon(HICON icon, BOOL bigIcon);
    /// The icon set last, null when none was.
    HICON GetIcon(BOOL bigIcon) const;
    /// @}

    /// Place and size.
    /// @{

    /// The window with its frame, in screen pixels, children too. Left alone without a window.
    void GetWindowRect(RECT* rect) const;
    /// The client area, with its left top corner at 0, 0.
    void GetClientRect(RECT* rect) const;
    /// Puts the window with its frame into a rectangle: of the parent's client area for children, of the screen for
    /// others. WM_SIZE and WM_MOVE come before the call returns where something has changed; what a window manager
    /// decides otherwise comes later. `repaint` is not looked at: what was uncovered is always repainted.
    void MoveWindow(int x, int y, int width, int height, BOOL repaint = TRUE);
    void MoveWindow(const RECT* rect, BOOL repaint = TRUE);
    /// Moves, sizes, reorders, shows or hides in one step (SWP_...).
    /// @param insertAfter a sibling to stand behind, null: in front of all; not looked at with SWP_NOZORDER. Or one of
    /// wndTop (in front of all), wndBottom (behind all), wndTopMost (before other applications, too), wndNoTopMost
    BOOL SetWindowPos(const CWnd* insertAfter, int x, int y, int cx, int cy, UINT flags);
    static const CWnd& wndTop;
    static const CWnd& wndBottom;
    static const CWnd& wndTopMost;
    static const CWnd& wndNoTopMost;
    /// How the window is shown and where it is when it is neither minimised nor maximised: what is kept from one run to
    /// the next. FALSE without a window.
    BOOL GetWindowPlacement(WINDOWPLACEMENT* placement) const;
    /// Puts it back and shows it. A rectangle that is off the screen is moved until its caption can be reached. FALSE
    /// when `length` is not the structure's.
    BOOL SetWindowPlacement(const WINDOWPLACEMENT* placement);
    /// Centres over `other`, over the owner, or on the screen, keeping the window on the screen.
    void CenterWindow(CWnd* other = nullptr);
    /// In front of its siblings; a top-level window in front of all others, as far as the desktop allows that.
    void BringWindowToTop();
    /// Converts in place between this window's client area and the screen.
    void ClientToScreen(POINT* point) const;
    void ClientToScreen(RECT* rect) const;
    void ScreenToClient(POINT* point) const;
    void ScreenToClient(RECT* rect) const;
    /// Converts in place from this window's client area to another's; null stands for the screen.
    void MapWindowPoints(CWnd* to, POINT* points, UINT count) const;
    void MapWindowPoints(CWnd* to, RECT* rect) const;
    /// Makes of a client rectangle the rectangle of the window around it, as this window is now: frame, caption and
    /// menu bar of a top-level window are known once it has been shown.
    /// @param adjustType not used
    virtual void CalcWindowRect(RECT* rect, UINT adjustType = 0);
    /// @}

    /// Painting.
    /// @{

    /// Requests a repaint of the whole client area.
    void Invalidate(BOOL erase = TRUE);
    /// Requests a repaint of a rectangle of the client area; null for all of it.
    void InvalidateRect(const RECT* rect, BOOL erase = TRUE);
    /// Paints what has been requested, now.
    void UpdateWindow();
    /// Requests a repaint of a region of the client area, else of a rectangle, else (both null) of all, and carries it
    /// out with RDW_UPDATENOW. Children are repainted with RDW_ALLCHILDREN. A request is never taken back: RDW_VALIDATE
    /// does nothing.
    BOOL RedrawWindow(const RECT* rect = nullptr, CRgn* region = nullptr,
                      UINT flags = RDW_INVALIDATE | RDW_UPDATENOW | RDW_ERASE);
    /// Suspends or resumes painting of the window and its children while contents change. Resuming requests a repaint
    /// of everything. Contexts (CClientDC) draw meanwhile.
    void SetRedraw(BOOL redraw = TRUE);
    /// A context over the client area, to be given back with ReleaseDC. It draws at once, also outside WM_PAINT.
    CDC* GetDC();
    /// A context over the whole window. A frame that the desktop draws can be measured, but not drawn on.
    CDC* GetWindowDC();
    /// Gives a context of GetDC or GetWindowDC back and shows what was drawn. 0 for any other.
    int ReleaseDC(CDC* dc);
    /// Tells of a button that the host draws itself into the frame of this window, in its caption or its menu bar: the
    /// caption's title is kept clear of it, and assistive tools find a push button there. Pressed by them, it has
    /// WM_SYSCOMMAND sent; clicks of the mouse are the host's to handle, as messages of the non-client area. A window
    /// has one such button.
    /// @param name  what assistive tools call it
    /// @param place in the coordinates of GetWindowDC, to be told anew when it changes; null: there is none any more
    /// @param command what WM_SYSCOMMAND carries
    void SetFrameButton(LPCSTR name, const RECT* place, UINT command);
    /// Moves the contents by an offset in pixels and requests the uncovered strip.
    /// @param scroll what is to be moved, null: the whole client area, and the children with it
    /// @param clip   counts where `scroll` is null
    void ScrollWindow(int dx, int dy, const RECT* scroll = nullptr, const RECT* clip = nullptr);
    /// @}

    /// The tree of windows.
    /// @{

    /// The parent of a child, the window that a popup or dialog stands over; null for a main window. Temporary when it
    /// has no object.
    CWnd* GetParent() const;
    /// Makes the window a child of another and answers the previous parent.
    CWnd* SetParent(CWnd* parent);
    /// The window that a bar reports to and that CenterWindow centres over: the one set last, else the parent (of a
    /// popup or dialog the window it stands over).
    CWnd* GetOwner() const;
    /// Sets that; null for the parent again. It changes neither parent nor stacking, and is not told of its end.
    void SetOwner(CWnd* owner);
    /// The last of the parents, over owners too; the window itself when it has none.
    CWnd* GetTopLevelParent() const;
    /// The nearest frame around this window, not itself: a document's frame before the main one. Null for none.
    CFrameWnd* GetParentFrame() const;
    /// The outermost frame, which may be this one.
    CFrameWnd* GetTopLevelFrame() const;
    /// The window in a relation to this one (GW_...): first, last, next or previous sibling, first child, owner. Null
    /// when there is none.
    CWnd* GetWindow(UINT relation) const;
    /// The first child.
    CWnd* GetTopWindow() const;
    /// The sibling behind this one, with GW_HWNDPREV the one before; null after the last. Siblings of a top-level
    /// window are this process's other ones in the order of their creation.
    CWnd* GetNextWindow(UINT relation = GW_HWNDNEXT) const {
        return GetWindow(relation);
    }
    /// Whether `other` is a child of this window, or of its children; popups over it are not.
    BOOL IsChild(const CWnd* other) const;
    /// The child with an identifier; temporary when it has no object, null when there is none.
    CWnd* GetDlgItem(int id) const;
    void GetDlgItem(int id, HWND* handle) const;
    /// The same among all descendants; with `onlyPerm` only windows with an object.
    CWnd* GetDescendantWindow(int id, BOOL onlyPerm = FALSE) const;
    /// Stands for the screen: only its rectangles can be asked for.
    static CWnd* GetDesktopWindow();
    /// FindWindowA: a top-level window of this process by class and caption (null: any).
    static CWnd* FindWindow(LPCSTR className, LPCSTR text);
    /// The innermost window of this process at a point of the screen; null for none.
    static CWnd* WindowFromPoint(POINT point);
    /// The first child at a point of the client area, hidden and disabled ones included; the window itself where no
    /// child is, null outside of it.
    CWnd* ChildWindowFromPoint(POINT point) const;
    /// @}

    /// Activation, focus, capture.
    /// @{

    /// Asks for the top-level window of this one to be the active one and answers the one before. The desktop decides,
    /// and WM_ACTIVATE tells. GetActiveWindow knows this process's windows: it is null while another process has it.
    CWnd* SetActiveWindow();
    static CWnd* GetActiveWindow();
    /// Raises the window and activates it.
    BOOL SetForegroundWindow();
    /// The active window if it is this process's, else null.
    static CWnd* GetForegroundWindow();
    /// Gives the window the keyboard and answers the window that had it.
    CWnd* SetFocus();
    static CWnd* GetFocus();
    /// Sends all mouse messages here until ReleaseCapture, wherever the pointer is.
    CWnd* SetCapture();
    static CWnd* GetCapture();
    /// @}

    /// The caret; the calls of the same name (WindowCalls.h) tell more.
    /// @{

    /// Makes the caret, hidden: of a bitmap's size, or of a size in pixels (0: the width of a border).
    void CreateCaret(CBitmap* bitmap);
    void CreateSolidCaret(int width, int height) {
        ::CreateCaret(m_hWnd, nullptr, width, height);
    }
    /// Carets have one look: the same as CreateSolidCaret.
    void CreateGrayCaret(int width, int height) {
        ::CreateCaret(m_hWnd, nullptr, width, height);
    }
    static void SetCaretPos(POINT point) {
        ::SetCaretPos(point.x, point.y);
    }
    static CPoint GetCaretPos();
    void ShowCaret() {
        ::ShowCaret(m_hWnd);
    }
    void HideCaret() {
        ::HideCaret(m_hWnd);
    }
    /// @}

    /// Timers.
    /// @{

    /// Starts or restarts a timer that sends WM_TIMER (or calls `callback`) every `elapse` milliseconds.
    UINT_PTR SetTimer(UINT_PTR id, UINT elapse, TIMERPROC callback = nullptr);
    /// FALSE when there is no such timer. Timers end with their window.
    BOOL KillTimer(UINT_PTR id);
    /// @}

    /// Scroll bars of the window's frame: SB_HORZ or SB_VERT. The calls that ask answer 0 where there is no such bar. A
    /// window scrolls nothing by itself: it gets WM_HSCROLL or WM_VSCROLL, moves what it shows and sets the position.
    /// Bars of edits and lists can be asked and set to a position; their ranges are theirs.
    /// @{

    /// Puts the thumb, within the range, and answers where it was. No message comes of it.
    int SetScrollPos(int bar, int pos, BOOL redraw = TRUE);
    int GetScrollPos(int bar) const;
    /// From the least position to the last thing to be seen; a range of nothing hides the bar.
    void SetScrollRange(int bar, int min, int max, BOOL redraw = TRUE);
    void GetScrollRange(int bar, int* min, int* max) const;
    /// What SCROLLINFO tells. FALSE where there is no such bar.
    BOOL SetScrollInfo(int bar, SCROLLINFO* info, BOOL redraw = TRUE);
    BOOL GetScrollInfo(int bar, SCROLLINFO* info, UINT mask = SIF_ALL);
    /// Shows or hides bars, SB_BOTH too; the client area shrinks or grows at once.
    void ShowScrollBar(UINT bar, BOOL show = TRUE);
    /// The control that stands in for a bar of the frame: null unless a derived class has one to answer.
    virtual CScrollBar* GetScrollBarCtrl(int bar) const;
    /// @}

    /// Menus.
    /// @{

    /// The menu bar's menu, null when there is none; it ends with the window.
    CMenu* GetMenu() const;
    /// Shows another menu, null for none. The window owns it from then on, the previous one is the caller's. FALSE for
    /// child windows.
    BOOL SetMenu(CMenu* menu);
    /// Not needed: changes of a menu are seen at once.
    void DrawMenuBar();
    /// The window menu; with `revert` it gets its original items back.
    CMenu* GetSystemMenu(BOOL revert) const;
    /// @}

    /// Dialog items.
    /// @{

    /// The text of an item, as SetWindowText and GetWindowText of it; nothing and 0 when there is no such child.
    void SetDlgItemText(int id, LPCSTR text);
    int GetDlgItemText(int id, LPSTR buffer, int size) const;
    int GetDlgItemText(int id, CString& text) const;
    /// A number in decimal digits; with `isSigned` `value` is taken for an int.
    void SetDlgItemInt(int id, UINT value, BOOL isSigned = TRUE);
    /// The number in an item's text. `translated` tells whether the text was a number of 32 bits.
    UINT GetDlgItemInt(int id, BOOL* translated = nullptr, BOOL isSigned = TRUE) const;
    /// Marks of buttons: 0 off, 1 on, 2 neither (three-state boxes). CheckRadioButton sets one of a range and clears
    /// the others; GetCheckedRadioButton answers which one is set, 0 for none.
    void CheckDlgButton(int id, UINT check);
    void CheckRadioButton(int first, int last, int checked);
    UINT IsDlgButtonChecked(int id) const;
    int GetCheckedRadioButton(int first, int last) const;
    /// Sends a message to an item; 0 when there is no such child.
    LRESULT SendDlgItemMessage(int id, UINT message, WPARAM wParam = 0, LPARAM lParam = 0);
    /// The control that Tab (Shift+Tab with `previous`) reaches from `from`, the first one when `from` is null.
    CWnd* GetNextDlgTabItem(CWnd* from, BOOL previous = FALSE) const;
    /// The control that the arrow keys reach from `from`: the next one that can be used in its group, which begins with
    /// WS_GROUP, and after the last the first again. Null when `from` is.
    CWnd* GetNextDlgGroupItem(CWnd* from, BOOL previous = FALSE) const;
    /// Moves data between the controls and the members, through DoDataExchange. FALSE when validation failed.
    /// @param save TRUE from the controls into the members.
    BOOL UpdateData(BOOL save = TRUE);
    /// Updates the controls' states through their ON_UPDATE_COMMAND_UI handlers.
    void UpdateDialogControls(CCmdTarget* target, BOOL disableIfNoHandler);
    /// A message box over this window; answers the button (IDOK, ...).
    /// @param caption null: the application's name
    int MessageBox(LPCSTR text, LPCSTR caption = nullptr, UINT type = MB_OK);
    /// Accepts files dropped from other programs (WM_DROPFILES).
    void DragAcceptFiles(BOOL accept = TRUE);
    /// Passes a help request on to the application.
    virtual void WinHelpA(DWORD_PTR data, UINT command = HELP_CONTEXT);
    void WinHelp(DWORD_PTR data, UINT command = HELP_CONTEXT) {
        WinHelpA(data, command);
    }
    virtual void WinHelpInternal(DWORD_PTR data, UINT command = HELP_CONTEXT);
    /// The number that the window's help requests carry; controls of dialogs have their template's. 0 for none.
    DWORD GetWindowContextHelpId() const;
    BOOL SetWindowContextHelpId(DWORD context);

    /// Commands of the Help menu, for the message maps of hosts: ON_COMMAND(ID_HELP_FINDER,
    /// &CMDIFrameWnd::OnHelpFinder).
    /// @{

    /// Help on where the keyboard is, as the help key asks for it.
    afx_msg void OnHelp();
    /// The list of topics: HELP_INDEX.
    afx_msg void OnHelpIndex();
    /// The contents page: HELP_FINDER.
    afx_msg void OnHelpFinder();
    /// How help is used: HELP_HELPONHELP.
    afx_msg void OnHelpUsing();
    /// @}

    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;
    /// Whether WindowProc's caller should treat the window as a frame.
    virtual BOOL IsFrameWnd() const;
    /// Ends a modal loop that runs on this window.
    virtual void EndModalLoop(int result);

    /// The state behind the handle; null when there is no window. For the layer itself.
    tvx::afx::Window* GetState() const;
    /// @}

    /// Handlers of messages; the base versions do what happens by default, whatever values they are called with.
    ///
    /// Points are pixels of the client area, except those of OnContextMenu and OnMouseWheel, which are the screen's
    /// ((-1, -1) when the keyboard asked for a menu). Windows that come as arguments may be temporary or null.
    ///
    /// Messages of the part around the client area (OnNc...) come to child frames and to top-level windows with
    /// WS_EX_OWNCAPTION, which draw their frames themselves; to other top-level windows for their menu bar alone, since
    /// the desktop draws the rest. OnNcHitTest is asked before each message of the mouse that nobody has captured, and
    /// its answer counts: HTCAPTION in the client area lets the window be moved by it. Points of these messages are the
    /// screen's. OnNcPaint comes whenever something of the frame is painted; call the base first, then draw with
    /// CWindowDC, which may be done at any other time, too. OnNcActivate's base draws the frame as it is told to, and a
    /// handler that does not call it leaves the frame as it looks. A press that a handler takes (SetCapture, no call of
    /// the base) ends with OnLButtonUp of this window, wherever the pointer is by then; one that the base takes ends in
    /// the base. A caption that is held by the mouse is let go of by Esc.
    ///
    /// What differs: OnActivateApp, OnEnterIdle, OnSettingChange, OnSysColorChange,
    /// OnQueryDragIcon, OnWindowPosChanging, OnWindowPosChanged and those of the session's end are called for messages
    /// that hosts send: the layer sends none of these. OnMove and OnSize tell of a new place.
    /// @{

    afx_msg void OnActivate(UINT state, CWnd* other, BOOL minimized);
    afx_msg void OnActivateApp(BOOL active, DWORD threadId);
    afx_msg void OnCancelMode();
    afx_msg void OnCaptureChanged(CWnd* other);
    afx_msg void OnClose();
    afx_msg void OnContextMenu(CWnd* window, CPoint point);
    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg HBRUSH OnCtlColor(CDC* dc, CWnd* control, UINT kind);
    afx_msg void OnDestroy();
    afx_msg void OnDrawItem(int id, DRAWITEMSTRUCT* item);
    afx_msg void OnDropFiles(HANDLE drop);
    afx_msg void OnEnable(BOOL enabled);
    afx_msg void OnEndSession(BOOL ending);
    afx_msg void OnEnterIdle(UINT reason, CWnd* who);
    afx_msg BOOL OnEraseBkgnd(CDC* dc);
    afx_msg UINT OnGetDlgCode();
    afx_msg void OnGetMinMaxInfo(MINMAXINFO* info);
    /// The help key was pressed here, or help was asked for here in another way, or a window in or over this one has
    /// not taken such a request. TRUE takes it; the base hands it on.
    afx_msg BOOL OnHelpInfo(HELPINFO* info);
    afx_msg void OnHScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg void OnVScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg void OnInitMenu(CMenu* menu);
    afx_msg void OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu);
    afx_msg void OnKeyDown(UINT key, UINT repeat, UINT flags);
    afx_msg void OnKeyUp(UINT key, UINT repeat, UINT flags);
    afx_msg void OnChar(UINT character, UINT repeat, UINT flags);
    afx_msg void OnSysKeyDown(UINT key, UINT repeat, UINT flags);
    afx_msg void OnSysKeyUp(UINT key, UINT repeat, UINT flags);
    afx_msg void OnSysChar(UINT character, UINT repeat, UINT flags);
    afx_msg void OnSysCommand(UINT command, LPARAM parameter);
    afx_msg void OnKillFocus(CWnd* next);
    afx_msg void OnSetFocus(CWnd* previous);
    afx_msg void OnLButtonDown(UINT flags, CPoint point);
    afx_msg void OnLButtonUp(UINT flags, CPoint point);
    afx_msg void OnLButtonDblClk(UINT flags, CPoint point);
    afx_msg void OnRButtonDown(UINT flags, CPoint point);
    afx_msg void OnRButtonUp(UINT flags, CPoint point);
    afx_msg void OnRButtonDblClk(UINT flags, CPoint point);
    afx_msg void OnMButtonDown(UINT flags, CPoint point);
    afx_msg void OnMButtonUp(UINT flags, CPoint point);
    afx_msg void OnMouseMove(UINT flags, CPoint point);
    afx_msg void OnMouseLeave();
    afx_msg BOOL OnMouseWheel(UINT flags, short delta, CPoint point);
    afx_msg int OnMouseActivate(CWnd* desktop, UINT hitTest, UINT message);
    afx_msg void OnMDIActivate(BOOL activate, CWnd* activated, CWnd* deactivated);
    afx_msg void OnMeasureItem(int id, MEASUREITEMSTRUCT* item);
    afx_msg void OnMenuSelect(UINT item, UINT flags, HMENU menu);
    afx_msg void OnMove(int x, int y);
    afx_msg BOOL OnNcActivate(BOOL active);
    afx_msg void OnNcDestroy();
    afx_msg LRESULT OnNcHitTest(CPoint point);
    afx_msg void OnNcLButtonDblClk(UINT hitTest, CPoint point);
    afx_msg void OnNcLButtonDown(UINT hitTest, CPoint point);
    afx_msg void OnNcLButtonUp(UINT hitTest, CPoint point);
    afx_msg void OnNcMouseMove(UINT hitTest, CPoint point);
    afx_msg void OnNcRButtonUp(UINT hitTest, CPoint point);
    afx_msg void OnNcPaint();
    afx_msg void OnPaint();
    afx_msg HCURSOR OnQueryDragIcon();
    afx_msg BOOL OnQueryEndSession();
    afx_msg BOOL OnSetCursor(CWnd* window, UINT hitTest, UINT message);
    afx_msg void OnSettingChange(UINT flags, LPCSTR section);
    afx_msg void OnShowWindow(BOOL shown, UINT status);
    afx_msg void OnSize(UINT type, int cx, int cy);
    afx_msg void OnSysColorChange();
    afx_msg LRESULT OnThemeChanged();
    afx_msg void OnTimer(UINT_PTR id);
    afx_msg void OnWindowPosChanged(WINDOWPOS* place);
    afx_msg void OnWindowPosChanging(WINDOWPOS* place);
    /// @}
protected:
    friend class tvx::afx::Window;
    /// Looks a message up in the map and calls its handler. FALSE when there is none.
    virtual BOOL OnWndMsg(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);
    /// A command from a menu, an accelerator or a control. FALSE when nobody handled it.
    virtual BOOL OnCommand(WPARAM wParam, LPARAM lParam);
    /// A WM_NOTIFY from a control. FALSE when nobody handled it.
    virtual BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result);
    /// Binds members to controls; see CDataExchange.
    virtual void DoDataExchange(CDataExchange* dx);
    /// Offers a control's message to the control's own object first.
    static BOOL SendChildNotifyLastMsg(HWND child, UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result);
    /// Runs a loop until EndModalLoop; answers its result, -1 when the application is quitting.
    int RunModalLoop(DWORD flags = 0);

    DECLARE_MESSAGE_MAP()

private:
    // For the marks that stand for an order: no window has their handles.
    explicit CWnd(HWND mark) : m_hWnd(mark) {}
    // Out of line, where the compiler cannot conclude that the object is not null.
    static HWND HandleOf(const CWnd* window);
    CWnd* m_pOwner = nullptr;
    void* m_modalLoop = nullptr;
    bool m_continueModal = false;
};

/// Registers (or finds) a window class with these properties and answers its name.
/// @param cursor null for the arrow. @param background null for a window that paints all of itself.
TVX_PLATFORM_API LPCSTR AfxRegisterWndClass(UINT classStyle, HCURSOR cursor = nullptr, HBRUSH background = nullptr,
                                            HICON icon = nullptr);
