#pragma once

/// @file
/// CFrameWnd: the window around a view, with menu, accelerators and control bars.

#include "platform/afx/core/Accelerator.h"
#include "platform/afx/core/Menu.h"
#include "platform/afx/core/Wnd.h"
#include "platform/win/FrameworkIds.h"

#include <vector>

class CControlBar;
class CControlBarInfo;
class CDockState;
class CDocTemplate;
class CDocument;
class CView;

// Styles that frames have besides those of all windows
/// The document's name stands in the caption.
#define FWS_ADDTOTITLE 0x00008000
/// The document's name stands before the application's.
#define FWS_PREFIXTITLE 0x00004000

// Sides of a frame that bars dock at; see also ControlBar.h
#define CBRS_ALIGN_LEFT 0x1000
#define CBRS_ALIGN_TOP 0x2000
#define CBRS_ALIGN_RIGHT 0x4000
#define CBRS_ALIGN_BOTTOM 0x8000
#define CBRS_ALIGN_ANY 0xF000

/// What a frame, its client and its view are created for. It lives as long as the creation.
struct CCreateContext {
    CRuntimeClass* m_pNewViewClass = nullptr;  ///< The view to make; null for none.
    CDocument* m_pCurrentDoc = nullptr;        ///< The document the view shows.
    CDocTemplate* m_pNewDocTemplate = nullptr; ///< The template it comes from.
    CView* m_pLastView = nullptr;              ///< The view that was active before.
    CFrameWnd* m_pCurrentFrame = nullptr;      ///< The frame that the new one is modelled on.
};

/// A frame: the application's main window in an application that shows one document at a time, and the base of the
/// frames of the others.
///
/// LoadFrame makes it from the resources of one number: menu, accelerators, icon and the title, the first part of the
/// string. Its client area is a child window with the identifier AFX_IDW_PANE_FIRST, which OnCreateClient makes (the
/// view of the document); control bars stand around it. Commands go to the active view, its document, the frame, then
/// the application.
///
/// Frames delete themselves when their window has ended; they are made with `new`, mostly by a document template.
///
/// @code
/// auto* frame = new CMainFrame;
/// frame->LoadFrame(IDR_MAINFRAME);
/// theApp.m_pMainWnd = frame;
/// frame->ShowWindow(theApp.m_nCmdShow);
/// @endcode
class TVX_PLATFORM_API CFrameWnd : public CWnd {
    DECLARE_DYNCREATE(CFrameWnd)

public:
    /// Leaves place and size to the window manager.
    static const CRect rectDefault;

    /// Makes the object; Create or LoadFrame makes the window.
    CFrameWnd();
    ~CFrameWnd() override;

    /// Whether menu items whose command nobody handles are greyed. TRUE at first.
    BOOL m_bAutoMenuEnable = TRUE;
    /// The accelerators; destroyed with the frame only when the frame loaded them.
    HACCEL m_hAccelTable = nullptr;
    /// The menu the frame was created with; the one shown may be a document's.
    HMENU m_hMenuDefault = nullptr;
    /// Number of the view (":1", ":2") when a document has several; -1 when no number is shown.
    int m_nWindow = -1;
    /// The number that the application's help is asked for when the help key is pressed in the frame
    /// (HID_BASE_RESOURCE is added), 0 for none; LoadFrame takes that of the resources.
    UINT m_nIDHelp = 0;
    /// Whether the pointer chooses what to explain.
    BOOL m_bHelpMode = FALSE;
    /// The number of the message that the status line shows, and the one it showed before.
    UINT m_nIDTracking = 0;
    UINT m_nIDLastMessage = 0;

    /// Creation.
    /// @{

    /// Creates the window from the resources with the number `id`: title (first part of the string), menu,
    /// accelerators, icon.
    /// @param style  FWS_ADDTOTITLE puts the document's name into the caption
    /// @param parent the window this one stands over, mostly null
    /// @param context what to make the view for; null for a frame without document
    /// @return FALSE when the menu resource is missing or the creation was refused; the object is deleted then
    virtual BOOL LoadFrame(UINT id, DWORD style = WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE, CWnd* parent = nullptr,
                           CCreateContext* context = nullptr);
    /// Creates the window.
    /// @param className null for the framework's own class
    /// @param menuName  a menu resource, null for none. Answers FALSE when it is missing
    virtual BOOL Create(LPCSTR className, LPCSTR title, DWORD style = WS_OVERLAPPEDWINDOW,
                        const RECT& rect = rectDefault, CWnd* parent = nullptr, LPCSTR menuName = nullptr,
                        DWORD exStyle = 0, CCreateContext* context = nullptr);
    using CWnd::Create;
    /// Loads the accelerators. FALSE when there are some already or the resource is missing.
    BOOL LoadAccelTable(LPCSTR name);
    /// Makes the pane inside the frame. The base makes the view that `context` names.
    virtual BOOL OnCreateClient(CREATESTRUCT* cs, CCreateContext* context);
    /// Makes a view of the context's class with the identifier `id`, created and tied to the context's document. Null
    /// when that failed.
    CWnd* CreateView(CCreateContext* context, UINT id = AFX_IDW_PANE_FIRST);
    /// Sends the first update to all views, shows the frame and makes it active.
    /// @param document may be null
    void InitialUpdateFrame(CDocument* document, BOOL makeVisible);
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    void PostNcDestroy() override;
    /// @}

    /// View and document.
    /// @{

    CView* GetActiveView() const;
    /// Makes a view the active one: the former hears of it, the new one as well when `notify` is TRUE.
    void SetActiveView(CView* view, BOOL notify = TRUE);
    virtual CDocument* GetActiveDocument();
    /// The active child frame of a frame with child frames; this frame otherwise.
    virtual CFrameWnd* GetActiveFrame();
    /// Shows the frame (-1: as it is, restored when it is an icon) and makes it the active window.
    virtual void ActivateFrame(int command = -1);
    /// The title of the application or document type, without a document's name.
    void SetTitle(LPCSTR title) {
        m_strTitle = title;
    }
    CString GetTitle() const {
        return m_strTitle;
    }
    /// Puts the document's name and the title into the caption.
    virtual void OnUpdateFrameTitle(BOOL addToTitle);
    /// Lets the frame show another menu while a document's frame is active; see CMDIChildWnd.
    virtual void OnUpdateFrameMenu(HMENU alternative);
    /// The accelerators in force now: the document type's or the frame's own.
    virtual HACCEL GetDefaultAccelerator();
    /// Brings menus' and bars' states of all frames that are seen up to date now, not only when the application is
    /// idle: their update handlers are called.
    /// @param except a frame to leave out; null for none
    static void UpdateAllFrames(const CWnd* except);
    /// @}

    /// Layout and bars.
    /// @{

    /// Places the bars and gives the pane the rest. `notify` FALSE only places.
    virtual void RecalcLayout(BOOL notify = TRUE);
    /// Allows bars to dock at these sides (CBRS_ALIGN_...).
    void EnableDocking(DWORD sides);
    /// Docks a bar.
    /// @param side AFX_IDW_DOCKBAR_...; 0 for the first side that both allow
    /// @param rect place on the screen to dock near to; null behind the bars that are there
    void DockControlBar(CControlBar* bar, UINT side = 0, const RECT* rect = nullptr);
    /// Makes a bar a small window of its own at a point of the screen.
    void FloatControlBar(CControlBar* bar, CPoint point, DWORD style = CBRS_ALIGN_TOP);
    /// Shows or hides a bar. With `delay` the layout follows when the application is idle.
    void ShowControlBar(CControlBar* bar, BOOL show, BOOL delay);
    /// The bar with an identifier, null when the frame has none.
    CControlBar* GetControlBar(UINT id);
    /// Tells where each bar stands; a value to keep and to hand to SetDockState.
    void GetDockState(CDockState& state) const;
    /// Puts the bars where `state` says. Records of bars that the frame does not have, and sides at which a bar may not
    /// dock, are passed over; bars without a record stand behind the others. A floating bar is moved onto a screen.
    void SetDockState(const CDockState& state);
    /// Puts the bars where they stood when SaveBarState was called with that name; without such a record nothing
    /// happens. Call it when all bars are made.
    void LoadBarState(LPCSTR profileName);
    /// Keeps where the bars stand in the application profile, under a name of the host's choice.
    void SaveBarState(LPCSTR profileName) const;
    /// @}

    /// Status line.
    /// @{

    /// The prompt of a command: its string's part before the line end. FALSE leaves `message` empty.
    virtual void GetMessageString(UINT id, CString& message) const;
    /// Shows a text, or the prompt of a number, in the status line; null or 0 empties it, AFX_IDS_IDLEMESSAGE shows the
    /// idle message.
    void SetMessageText(LPCSTR text);
    void SetMessageText(UINT id);
    /// The bar whose first pane shows the messages; the base answers the bar AFX_IDW_STATUS_BAR.
    virtual CWnd* GetMessageBar();

    BOOL IsFrameWnd() const override;
    BOOL PreTranslateMessage(MSG* message) override;
    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;
    /// @}

    /// Handlers.
    /// @{

    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnDestroy();
    afx_msg void OnClose();
    afx_msg void OnSize(UINT type, int cx, int cy);
    afx_msg void OnActivate(UINT state, CWnd* other, BOOL minimized);
    afx_msg BOOL OnNcActivate(BOOL active);
    afx_msg void OnSetFocus(CWnd* previous);
    afx_msg void OnSysCommand(UINT command, LPARAM parameter);
    afx_msg void OnInitMenu(CMenu* menu);
    /// Updates the items of a menu that is about to be shown through their update handlers.
    afx_msg void OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu);
    afx_msg void OnMenuSelect(UINT item, UINT flags, HMENU menu);
    afx_msg void OnEnterIdle(UINT reason, CWnd* who);
    afx_msg void OnDropFiles(HANDLE drop);
    afx_msg BOOL OnQueryEndSession();
    afx_msg void OnEndSession(BOOL ending);
    afx_msg void OnHScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg void OnVScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg BOOL OnEraseBkgnd(CDC* dc);
    afx_msg LRESULT OnSetMessageString(WPARAM id, LPARAM text);
    afx_msg LRESULT OnIdleUpdateCmdUI(WPARAM disable, LPARAM);
    afx_msg void OnUpdateControlBarMenu(CCmdUI* item);
    afx_msg BOOL OnBarCheck(UINT id);
    afx_msg void OnUpdateKeyIndicator(CCmdUI* item);
    /// Turns a help request into WM_COMMANDHELP for the window that it is about, and then for those around it.
    afx_msg BOOL OnHelpInfo(HELPINFO* info);
    /// Asks the application for help: on `context`, else on the item of an open menu, else on the frame (m_nIDHelp).
    /// FALSE when there is none of these.
    afx_msg LRESULT OnCommandHelp(WPARAM, LPARAM context);
    afx_msg LRESULT OnExitHelpMode(WPARAM, LPARAM);
    /// ID_CONTEXT_HELP: begins or ends the mode in which the pointer chooses what to explain. What is clicked on, or
    /// chosen in a menu, is explained instead of done; then, and by Esc, the mode is over.
    afx_msg void OnContextHelp();
    /// Ends that mode, if it is on.
    virtual void ExitHelpMode();
    /// @}
protected:
    /// In help mode: ends it and explains a command. FALSE where the command is to be carried out.
    bool explains(UINT command);

    friend class CControlBar;
    friend class CDocument;
    friend class CView;

    BOOL OnCommand(WPARAM wParam, LPARAM lParam) override;
    /// What OnCreate does, with the context that CREATESTRUCT carries.
    virtual int OnCreateHelper(CREATESTRUCT* cs, CCreateContext* context);
    /// Icon of the resource `id`, null when there is none.
    HICON LoadFrameIcon(UINT id) const;
    /// Puts "document - title" or, by style, "title - document" into the caption.
    void UpdateFrameTitleForDocument(LPCSTR documentName);
    /// Whether the caption or layout waits for the application to be idle.
    enum IdleFlags : UINT { idleMenu = 1, idleTitle = 2, idleLayout = 8 };
    UINT m_nIdleFlags = 0;
    CView* m_pViewActive = nullptr;
    CString m_strTitle;
    DWORD m_dockSides = 0;

    DECLARE_MESSAGE_MAP()

private:
    void addBar(CControlBar* bar);
    void removeBar(CControlBar* bar);
    void dockBars(const std::vector<const CControlBarInfo*>& records);
    void updateMenuItems(CMenu& popup);
    bool closeDocument();
    BOOL forwardScroll(UINT message, UINT code, UINT position);
    std::vector<CControlBar*> m_bars;
    bool m_ownAccelerators = false;
};

/// The frame that stands in for the active child frame of the application's main frame: one that floats beside it.
///
/// While there is one, commands that reach the main frame, such as those of its accelerators, and questions for the
/// state of such commands go to the routing frame's OnCmdMsg first (its view, document, itself), then to the main frame
/// itself and the application; not to the active child frame, whose accelerators and keys are not looked at either. The
/// main frame's bars still show at idle time what the active child frame says, because a click on them makes the main
/// frame the active one again. A frame sets itself when it becomes active and puts back the one before when it ceases
/// to be (OnActivate):
///
/// @code
/// m_before = AfxSetRoutingFrame(this);
/// ...
/// AfxSetRoutingFrame(m_before); // which must not have ended meanwhile
/// @endcode
///
/// @return the routing frame of this thread; null at first, and when its window has ended
TVX_PLATFORM_API CFrameWnd* AfxGetRoutingFrame();
/// Makes a frame that has a window the routing frame, or none (null). The main frame itself counts as none.
/// @return the one before
TVX_PLATFORM_API CFrameWnd* AfxSetRoutingFrame(CFrameWnd* frame);
