#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/frames/DocTemplate.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/MdiFrame.h"
#include "platform/afx/frames/View.h"
#include "platform/afx/frames/detail/RoutingFrame.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Resource.h"

using namespace tvx::afx;

IMPLEMENT_DYNCREATE(CMDIChildWnd, CFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CMDIChildWnd, CFrameWnd)
    ON_WM_MDIACTIVATE()
    ON_WM_MOUSEACTIVATE()
    ON_WM_DESTROY()
    ON_WM_SIZE()
END_MESSAGE_MAP()
// clang-format on

BOOL CMDIChildWnd::PreCreateWindow(CREATESTRUCT& cs) {
    cs.style |= WS_CHILD;
    cs.dwExStyle |= WS_EX_MDICHILD;
    return CFrameWnd::PreCreateWindow(cs);
}

BOOL CMDIChildWnd::Create(LPCSTR className, LPCSTR title, DWORD style, const RECT& rect, CMDIFrameWnd* parent,
                          CCreateContext* context) {
    if (!parent) {
        parent = DYNAMIC_DOWNCAST(CMDIFrameWnd, AfxGetMainWnd());
    }
    if (!parent) {
        PostNcDestroy();
        return FALSE;
    }
    m_strTitle = title ? title : "";
    const bool ownPlace = rect.left != CW_USEDEFAULT;
    return CreateEx(0, className, m_strTitle, style | WS_CHILD, rect.left, rect.top,
                    ownPlace ? rect.right - rect.left : CW_USEDEFAULT,
                    ownPlace ? rect.bottom - rect.top : CW_USEDEFAULT, parent->m_hWndMDIClient, nullptr, context);
}

BOOL CMDIChildWnd::LoadFrame(UINT id, DWORD style, CWnd* parent, CCreateContext* context) {
    m_nIDHelp = id;
    const auto* docTemplate = context ? DYNAMIC_DOWNCAST(CMultiDocTemplate, context->m_pNewDocTemplate) : nullptr;
    if (docTemplate) {
        SetHandles(docTemplate->m_hMenuShared, docTemplate->m_hAccelTable);
    } else if (!m_hMenuShared) {
        const LPCSTR name = MAKEINTRESOURCE(id);
        m_hMenuShared = ::LoadMenuA(AfxFindResourceHandle(name, RT_MENU), name);
        m_ownMenu = m_hMenuShared != nullptr;
        LoadAccelTable(name);
    }
    CString strings;
    CString title;
    if (strings.LoadString(id)) {
        AfxExtractSubString(title, strings, 0);
    }
    const LPCSTR className =
        AfxRegisterWndClass(CS_DBLCLKS, ::LoadCursorA(nullptr, IDC_ARROW), nullptr, LoadFrameIcon(id));
    return Create(className, title, style, rectDefault, DYNAMIC_DOWNCAST(CMDIFrameWnd, parent), context);
}

void CMDIChildWnd::SetHandles(HMENU menu, HACCEL accelerators) {
    m_hMenuShared = menu;
    m_hAccelTable = accelerators;
}

CMDIFrameWnd* CMDIChildWnd::GetMDIFrame() const {
    const HWND client = ::GetParent(m_hWnd);
    return DYNAMIC_DOWNCAST(CMDIFrameWnd, CWnd::FromHandlePermanent(::GetParent(client)));
}

void CMDIChildWnd::MDIDestroy() {
    DestroyWindow();
}

void CMDIChildWnd::MDIActivate() {
    if (CMDIFrameWnd* frame = GetMDIFrame()) {
        frame->MDIActivate(this);
    }
}

void CMDIChildWnd::MDIMaximize() {
    ShowWindow(SW_SHOWMAXIMIZED);
}

void CMDIChildWnd::MDIRestore() {
    ShowWindow(SW_RESTORE);
}

BOOL CMDIChildWnd::DestroyWindow() {
    return CFrameWnd::DestroyWindow();
}

void CMDIChildWnd::OnDestroy() {
    CFrameWnd::OnDestroy();
    if (m_ownMenu) {
        ::DestroyMenu(m_hMenuShared);
        m_hMenuShared = nullptr;
        m_ownMenu = false;
    }
}

void CMDIChildWnd::OnSize(UINT type, int cx, int cy) {
    CFrameWnd::OnSize(type, cx, cy);
    CMDIFrameWnd* frame = GetMDIFrame();
    if (frame && frame->MDIGetActive() == this) {
        frame->OnUpdateFrameTitle(TRUE);  // a maximised child's name stands elsewhere in it
        frame->m_nIdleFlags |= idleTitle; // the toolkit has its own idea of it, later
    }
}

void CMDIChildWnd::ActivateFrame(int command) {
    CMDIFrameWnd* frame = GetMDIFrame();
    if (!frame) {
        CFrameWnd::ActivateFrame(command);
        return;
    }
    if (command == -1) {
        // A new frame is as large as the one that was active.
        BOOL maximized = FALSE;
        frame->MDIGetActive(&maximized);
        if (!IsWindowVisible() && (maximized || (GetStyle() & WS_MAXIMIZE) != 0)) {
            command = SW_SHOWMAXIMIZED;
        }
    }
    if (command == -1 && IsIconic()) {
        command = SW_RESTORE;
    }
    ShowWindow(command != -1 ? command : SW_SHOW);
    MDIActivate();
    // The user works in a frame beside the main window: what he has opened there must not stay behind it.
    if (isRouted(*frame) && frame->IsWindowVisible()) {
        frame->SetForegroundWindow();
    }
}

void CMDIChildWnd::OnMDIActivate(BOOL activate, CWnd* activated, CWnd*) {
    CView* view = GetActiveView();
    if (!activate && view) {
        view->OnActivateView(FALSE, view, view);
    }
    OnUpdateFrameMenu(activate, activated, nullptr);
    CMDIFrameWnd* frame = GetMDIFrame();
    if (frame) {
        frame->OnUpdateFrameTitle(TRUE);
    }
    if (activate && view) {
        view->OnActivateView(TRUE, view, view);
        // A control of this frame that was clicked has the keyboard already, and keeps it.
        const HWND focus = ::GetFocus();
        if (focus != view->m_hWnd && !::IsChild(m_hWnd, focus)) {
            view->SetFocus();
        }
    }
}

void CMDIChildWnd::OnUpdateFrameMenu(HMENU alternative) {
    OnUpdateFrameMenu(TRUE, this, alternative);
}

void CMDIChildWnd::OnUpdateFrameMenu(BOOL activate, CWnd* activated, HMENU alternative) {
    CMDIFrameWnd* frame = GetMDIFrame();
    if (!frame || (!activate && activated)) {
        return; // the one that becomes active brings its own
    }
    HMENU menu = activate ? (alternative ? alternative : m_hMenuShared) : nullptr;
    if (!menu) {
        menu = frame->m_hMenuDefault;
    }
    if (menu) {
        frame->MDISetMenu(CMenu::FromHandle(menu), nullptr);
    }
}

void CMDIChildWnd::OnUpdateFrameTitle(BOOL addToTitle) {
    if (CMDIFrameWnd* frame = GetMDIFrame()) {
        frame->OnUpdateFrameTitle(addToTitle);
    }
    if ((GetStyle() & FWS_ADDTOTITLE) == 0) {
        return;
    }
    const CDocument* document = GetActiveDocument();
    CString text = addToTitle && document ? document->GetTitle() : m_strTitle;
    if (document && m_nWindow > 0) {
        text.AppendFormat(":%d", m_nWindow);
    }
    CString before;
    GetWindowText(before);
    if (before == text) {
        return;
    }
    // A maximised child's name is part of the main frame's caption.
    SetWindowText(text);
    if (CMDIFrameWnd* frame = GetMDIFrame()) {
        frame->OnUpdateFrameTitle(addToTitle);
    }
}

HACCEL CMDIChildWnd::GetDefaultAccelerator() {
    return m_hAccelTable;
}

CWnd* CMDIChildWnd::GetMessageBar() {
    CMDIFrameWnd* frame = GetMDIFrame();
    return frame ? frame->GetMessageBar() : CFrameWnd::GetMessageBar();
}

BOOL CMDIChildWnd::PreTranslateMessage(MSG* message) {
    if (message->message < WM_KEYFIRST || message->message > WM_KEYLAST) {
        return CFrameWnd::PreTranslateMessage(message);
    }
    // The main frame has the menu, so the command is its to send on.
    const CMDIFrameWnd* frame = GetMDIFrame();
    const HACCEL accelerators = GetDefaultAccelerator();
    return frame && accelerators && !menuHasKeyboard() && ::TranslateAcceleratorA(frame->m_hWnd, accelerators, message)
               ? TRUE
               : FALSE;
}

int CMDIChildWnd::OnMouseActivate(CWnd* desktop, UINT hitTest, UINT message) {
    const int answer = CFrameWnd::OnMouseActivate(desktop, hitTest, message);
    const CMDIFrameWnd* frame = GetMDIFrame();
    if (answer != MA_NOACTIVATE && answer != MA_NOACTIVATEANDEAT && frame && frame->MDIGetActive() != this) {
        MDIActivate();
    }
    return answer;
}
