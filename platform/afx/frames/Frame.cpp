#include "platform/afx/frames/Frame.h"

#include "platform/afx/gdi/Gdi.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/View.h"
#include "platform/afx/frames/detail/RoutingFrame.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"

using namespace tvx::afx;

IMPLEMENT_DYNCREATE(CFrameWnd, CWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CFrameWnd, CWnd)
    ON_WM_CREATE()
    ON_WM_DESTROY()
    ON_WM_CLOSE()
    ON_WM_SIZE()
    ON_WM_ACTIVATE()
    ON_WM_NCACTIVATE()
    ON_WM_SETFOCUS()
    ON_WM_SYSCOMMAND()
    ON_WM_INITMENU()
    ON_WM_INITMENUPOPUP()
    ON_WM_MENUSELECT()
    ON_WM_ENTERIDLE()
    ON_WM_DROPFILES()
    ON_WM_QUERYENDSESSION()
    ON_WM_ENDSESSION()
    ON_WM_HSCROLL()
    ON_WM_VSCROLL()
    ON_WM_ERASEBKGND()
    ON_MESSAGE(WM_SETMESSAGESTRING, &CFrameWnd::OnSetMessageString)
    ON_MESSAGE(WM_IDLEUPDATECMDUI, &CFrameWnd::OnIdleUpdateCmdUI)
    ON_UPDATE_COMMAND_UI_RANGE(AFX_IDW_CONTROLBAR_FIRST, AFX_IDW_CONTROLBAR_LAST, &CFrameWnd::OnUpdateControlBarMenu)
    ON_COMMAND_EX_RANGE(AFX_IDW_CONTROLBAR_FIRST, AFX_IDW_CONTROLBAR_LAST, &CFrameWnd::OnBarCheck)
    ON_UPDATE_COMMAND_UI(ID_INDICATOR_CAPS, &CFrameWnd::OnUpdateKeyIndicator)
    ON_UPDATE_COMMAND_UI(ID_INDICATOR_NUM, &CFrameWnd::OnUpdateKeyIndicator)
    ON_UPDATE_COMMAND_UI(ID_INDICATOR_SCRL, &CFrameWnd::OnUpdateKeyIndicator)
    ON_WM_HELPINFO()
    ON_MESSAGE(WM_COMMANDHELP, &CFrameWnd::OnCommandHelp)
    ON_MESSAGE(WM_EXITHELPMODE, &CFrameWnd::OnExitHelpMode)
    ON_COMMAND(ID_HELP, &CFrameWnd::OnHelp)
    ON_COMMAND(ID_CONTEXT_HELP, &CFrameWnd::OnContextHelp)
    ON_COMMAND(ID_DEFAULT_HELP, &CFrameWnd::OnHelpFinder)
END_MESSAGE_MAP()
// clang-format on

const CRect CFrameWnd::rectDefault(CW_USEDEFAULT, CW_USEDEFAULT, 0, 0);

namespace {

std::vector<CFrameWnd*>& allFrames() {
    static auto* frames = new std::vector<CFrameWnd*>;
    return *frames;
}

} // namespace

CFrameWnd::CFrameWnd() {
    allFrames().push_back(this);
}

CFrameWnd::~CFrameWnd() {
    std::erase(allFrames(), this);
    if (m_ownAccelerators) {
        ::DestroyAcceleratorTable(m_hAccelTable);
    }
}

void CFrameWnd::UpdateAllFrames(const CWnd* except) {
    const auto frames = allFrames();
    for (CFrameWnd* frame : frames) {
        const bool living = std::find(allFrames().begin(), allFrames().end(), frame) != allFrames().end();
        // Child frames are descendants of a frame that is updated itself.
        if (!living || frame == except || !frame->m_hWnd || (frame->GetStyle() & WS_CHILD) != 0 ||
            !frame->IsWindowVisible()) {
            continue;
        }
        frame->SendMessage(WM_IDLEUPDATECMDUI, TRUE, 0);
        frame->SendMessageToDescendants(WM_IDLEUPDATECMDUI, TRUE, 0, TRUE, TRUE);
    }
}

BOOL CFrameWnd::IsFrameWnd() const {
    return TRUE;
}

// --- creation ---

HICON CFrameWnd::LoadFrameIcon(UINT id) const {
    const LPCSTR name = MAKEINTRESOURCE(id);
    return ::LoadIconA(AfxFindResourceHandle(name, RT_GROUP_ICON), name);
}

BOOL CFrameWnd::PreCreateWindow(CREATESTRUCT& cs) {
    if (!cs.lpszClass) {
        cs.lpszClass = AfxRegisterWndClass(CS_DBLCLKS, ::LoadCursorA(nullptr, IDC_ARROW));
    }
    // The document comes first: task lists cut captions at their end.
    if ((cs.style & FWS_ADDTOTITLE) != 0) {
        cs.style |= FWS_PREFIXTITLE;
    }
    return TRUE;
}

BOOL CFrameWnd::LoadFrame(UINT id, DWORD style, CWnd* parent, CCreateContext* context) {
    m_nIDHelp = id;
    CString strings;
    if (strings.LoadString(id)) {
        AfxExtractSubString(m_strTitle, strings, 0);
    }
    const LPCSTR className =
        AfxRegisterWndClass(CS_DBLCLKS, ::LoadCursorA(nullptr, IDC_ARROW), nullptr, LoadFrameIcon(id));
    const CString title = m_strTitle;
    if (!Create(className, title, style, rectDefault, parent, MAKEINTRESOURCE(id), 0, context)) {
        return FALSE;
    }
    m_hMenuDefault = ::GetMenu(m_hWnd);
    LoadAccelTable(MAKEINTRESOURCE(id));
    // With a context, the template sends it when the document is filled.
    if (!context) {
        SendMessageToDescendants(WM_INITIALUPDATE, 0, 0, TRUE, TRUE);
    }
    return TRUE;
}

BOOL CFrameWnd::Create(LPCSTR className, LPCSTR title, DWORD style, const RECT& rect, CWnd* parent, LPCSTR menuName,
                       DWORD exStyle, CCreateContext* context) {
    HMENU menu = nullptr;
    if (menuName) {
        menu = ::LoadMenuA(AfxFindResourceHandle(menuName, RT_MENU), menuName);
        if (!menu) {
            // As after a creation that was refused: a frame that has no window deletes itself.
            PostNcDestroy();
            return FALSE;
        }
    }
    m_strTitle = title ? title : "";
    const bool ownPlace = rect.left != CW_USEDEFAULT;
    return CreateEx(
        exStyle, className, m_strTitle, style, rect.left, rect.top, ownPlace ? rect.right - rect.left : CW_USEDEFAULT,
        ownPlace ? rect.bottom - rect.top : CW_USEDEFAULT, parent ? parent->m_hWnd : nullptr, menu, context);
}

BOOL CFrameWnd::LoadAccelTable(LPCSTR name) {
    if (m_hAccelTable) {
        return FALSE;
    }
    m_hAccelTable = ::LoadAcceleratorsA(AfxFindResourceHandle(name, RT_ACCELERATOR), name);
    m_ownAccelerators = m_hAccelTable != nullptr;
    return m_ownAccelerators ? TRUE : FALSE;
}

int CFrameWnd::OnCreate(CREATESTRUCT* cs) {
    return OnCreateHelper(cs, static_cast<CCreateContext*>(cs->lpCreateParams));
}

int CFrameWnd::OnCreateHelper(CREATESTRUCT* cs, CCreateContext* context) {
    if (CWnd::OnCreate(cs) == -1 || !OnCreateClient(cs, context)) {
        return -1;
    }
    // Posted, because the status bar is made by the derived class behind this.
    PostMessage(WM_SETMESSAGESTRING, AFX_IDS_IDLEMESSAGE);
    RecalcLayout();
    return 0;
}

BOOL CFrameWnd::OnCreateClient(CREATESTRUCT*, CCreateContext* context) {
    if (context && context->m_pNewViewClass) {
        return CreateView(context, AFX_IDW_PANE_FIRST) ? TRUE : FALSE;
    }
    return TRUE;
}

CWnd* CFrameWnd::CreateView(CCreateContext* context, UINT id) {
    auto* view = DYNAMIC_DOWNCAST(CWnd, context->m_pNewViewClass->CreateObject());
    if (!view) {
        return nullptr;
    }
    // A view that could not be created has deleted itself.
    const CRect nowhere(0, 0, 0, 0);
    return view->Create(nullptr, nullptr, WS_CHILD | WS_VISIBLE | WS_BORDER, nowhere, this, id, context) ? view
                                                                                                         : nullptr;
}

void CFrameWnd::InitialUpdateFrame(CDocument* document, BOOL makeVisible) {
    CView* view = GetActiveView();
    if (!view) {
        view = DYNAMIC_DOWNCAST(CView, GetDescendantWindow(AFX_IDW_PANE_FIRST, TRUE));
        if (view) {
            // The view hears of it below, when it has its first contents.
            SetActiveView(view, FALSE);
        }
    }
    if (makeVisible) {
        SendMessageToDescendants(WM_INITIALUPDATE, 0, 0, TRUE, TRUE);
        if (view) {
            view->OnActivateFrame(WA_INACTIVE, this);
        }
        int command = -1;
        CWinApp* app = AfxGetApp();
        if (app && app->m_pMainWnd == this) {
            command = std::exchange(app->m_nCmdShow, -1); // only the first showing follows the start's wish
        }
        ActivateFrame(command);
        if (view) {
            view->OnActivateView(TRUE, view, view);
        }
    }
    if (document) {
        document->UpdateFrameCounts();
    }
    OnUpdateFrameTitle(TRUE);
}

void CFrameWnd::PostNcDestroy() {
    delete this;
}

void CFrameWnd::OnDestroy() {
    ExitHelpMode();
    // The menu of the document type is not the window's to destroy.
    if (m_hMenuDefault && ::GetMenu(m_hWnd) != m_hMenuDefault) {
        ::SetMenu(m_hWnd, m_hMenuDefault);
    }
    CWnd::OnDestroy();
}

// --- view and document ---

CView* CFrameWnd::GetActiveView() const {
    return m_pViewActive;
}

void CFrameWnd::SetActiveView(CView* view, BOOL notify) {
    if (view == m_pViewActive) {
        return;
    }
    CView* old = std::exchange(m_pViewActive, nullptr); // so that the old one's handler does not come back here
    if (old) {
        old->OnActivateView(FALSE, view, old);
    }
    if (m_pViewActive) {
        return; // the handler has chosen another one
    }
    m_pViewActive = view;
    if (view && notify) {
        view->OnActivateView(TRUE, view, old);
    }
}

CDocument* CFrameWnd::GetActiveDocument() {
    const CView* view = GetActiveView();
    return view ? view->GetDocument() : nullptr;
}

CFrameWnd* CFrameWnd::GetActiveFrame() {
    return this;
}

void CFrameWnd::ActivateFrame(int command) {
    if (command == -1) {
        if (!IsWindowVisible()) {
            command = SW_SHOWNORMAL;
        } else if (IsIconic()) {
            command = SW_RESTORE;
        }
    }
    if (command != -1) {
        ShowWindow(command);
    }
    BringWindowToTop();
}

void CFrameWnd::OnUpdateFrameTitle(BOOL addToTitle) {
    if ((GetStyle() & FWS_ADDTOTITLE) == 0) {
        return;
    }
    const CDocument* document = GetActiveDocument();
    UpdateFrameTitleForDocument(addToTitle && document ? document->GetTitle().GetString() : nullptr);
}

void CFrameWnd::UpdateFrameTitleForDocument(LPCSTR documentName) {
    CString name(documentName ? documentName : "");
    if (!name.IsEmpty() && m_nWindow > 0) {
        name.AppendFormat(":%d", m_nWindow);
    }
    const bool documentFirst = (GetStyle() & FWS_PREFIXTITLE) != 0;
    CString text = m_strTitle;
    if (m_strTitle.IsEmpty()) {
        text = name;
    } else if (!name.IsEmpty()) {
        text = documentFirst ? name + " - " + m_strTitle : m_strTitle + " - " + name;
    }
    // Called at idle times as well: hosts and the desktop are told of a caption only when it changes.
    CString before;
    GetWindowText(before);
    if (before != text) {
        SetWindowText(text);
    }
}

void CFrameWnd::OnUpdateFrameMenu(HMENU alternative) {
    if (!alternative) {
        alternative = m_hMenuDefault;
    }
    if (::GetMenu(m_hWnd) != alternative) {
        ::SetMenu(m_hWnd, alternative);
    }
}

HACCEL CFrameWnd::GetDefaultAccelerator() {
    return m_hAccelTable;
}

// --- messages and commands ---

BOOL CFrameWnd::PreTranslateMessage(MSG* message) {
    if (message->message < WM_KEYFIRST || message->message > WM_KEYLAST) {
        return CWnd::PreTranslateMessage(message);
    }
    const HACCEL accelerators = GetDefaultAccelerator();
    return accelerators && !menuHasKeyboard() && ::TranslateAcceleratorA(m_hWnd, accelerators, message) ? TRUE : FALSE;
}

BOOL CFrameWnd::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    const bool routed = isRouted(*this);
    if (routed && offerToRoutingFrame(id, code, extra, info)) {
        return TRUE;
    }
    CView* view = routed ? nullptr : GetActiveView();
    if (view && view->OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    if (CWnd::OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    CWinApp* app = isAskedForMainFrame(*this, id, code) ? nullptr : AfxGetApp();
    return app ? app->OnCmdMsg(id, code, extra, info) : FALSE;
}

BOOL CFrameWnd::OnCommand(WPARAM wParam, LPARAM lParam) {
    return (lParam == 0 && explains(LOWORD(wParam))) || CWnd::OnCommand(wParam, lParam) ? TRUE : FALSE;
}

bool CFrameWnd::closeDocument() {
    CDocument* document = GetActiveDocument();
    if (!document || !document->m_bAutoDelete) {
        return false;
    }
    for (POSITION at = document->GetFirstViewPosition(); at;) {
        const CView* view = document->GetNextView(at);
        if (view->GetParentFrame() != this) {
            // Another frame shows the document too, so that only this one goes.
            document->PreCloseFrame(this);
            return false;
        }
    }
    document->OnCloseDocument(); // destroys this frame too
    return true;
}

void CFrameWnd::OnClose() {
    CDocument* document = GetActiveDocument();
    if (document && !document->CanCloseFrame(this)) {
        return;
    }
    CWinApp* app = AfxGetApp();
    if (app && app->m_pMainWnd == this) {
        if (!document && !app->SaveAllModified()) {
            return;
        }
        const HWND self = m_hWnd;
        // The end of many documents takes its time; the user need not watch it.
        app->HideApplication();
        app->CloseAllDocuments(FALSE);
        if (!::IsWindow(self)) {
            return; // the last document took its frame with it
        }
    }
    if (!closeDocument()) {
        DestroyWindow();
    }
}

void CFrameWnd::OnSize(UINT type, int cx, int cy) {
    CWnd::OnSize(type, cx, cy);
    if (type != SIZE_MINIMIZED) {
        RecalcLayout();
    }
}

void CFrameWnd::OnActivate(UINT state, CWnd* other, BOOL minimized) {
    CWnd::OnActivate(state, other, minimized);
    CView* view = GetActiveView();
    if (!view) {
        view = GetActiveFrame()->GetActiveView();
    }
    if (!view) {
        return;
    }
    if (state != WA_INACTIVE && !minimized) {
        view->OnActivateView(TRUE, view, view);
    }
    view->OnActivateFrame(state, this);
}

BOOL CFrameWnd::OnNcActivate(BOOL active) {
    return CWnd::OnNcActivate(active);
}

void CFrameWnd::OnSetFocus(CWnd* previous) {
    if (m_pViewActive) {
        m_pViewActive->SetFocus();
    } else {
        CWnd::OnSetFocus(previous);
    }
}

void CFrameWnd::OnSysCommand(UINT command, LPARAM parameter) {
    const UINT item = command & 0xFFF0U;
    if (item == SC_KEYMENU || !GetTopLevelFrame()->explains(item)) {
        CWnd::OnSysCommand(command, parameter);
    }
}

void CFrameWnd::OnEnterIdle(UINT reason, CWnd* who) {
    CWnd::OnEnterIdle(reason, who);
}

BOOL CFrameWnd::OnQueryEndSession() {
    CWinApp* app = AfxGetApp();
    return !app || app->m_pMainWnd != this || app->SaveAllModified() ? TRUE : FALSE;
}

void CFrameWnd::OnEndSession(BOOL ending) {
    CWinApp* app = AfxGetApp();
    if (ending && app && app->m_pMainWnd == this) {
        app->CloseAllDocuments(TRUE);
        app->ExitInstance();
    }
}

BOOL CFrameWnd::OnEraseBkgnd(CDC* dc) {
    // The pane covers the client area, so painting below it would only flicker.
    return m_pViewActive ? TRUE : CWnd::OnEraseBkgnd(dc);
}

BOOL CFrameWnd::forwardScroll(UINT message, UINT code, UINT position) {
    // Scroll bars of a frame's own belong to its view.
    CWnd* view = GetActiveView();
    if (!view) {
        return FALSE;
    }
    view->SendMessage(message, MAKEWPARAM(static_cast<int>(code), static_cast<int>(position)));
    return TRUE;
}

void CFrameWnd::OnHScroll(UINT code, UINT position, CScrollBar*) {
    forwardScroll(WM_HSCROLL, code, position);
}

void CFrameWnd::OnVScroll(UINT code, UINT position, CScrollBar*) {
    forwardScroll(WM_VSCROLL, code, position);
}
