#include "s/ExternFrame.h"

#include "res/resource.h"
#include "s/FloatPlaces.h"

#include <algorithm>
#include <iterator>
#include <utility>

IMPLEMENT_DYNCREATE(Gui_ExternFrame, SECFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(Gui_ExternFrame, SECFrameWnd)
    ON_WM_CREATE()
    ON_WM_DESTROY()
    ON_WM_CLOSE()
    ON_WM_ACTIVATE()
    ON_WM_NCPAINT()
    ON_WM_NCACTIVATE()
    ON_WM_NCLBUTTONDOWN()
    ON_WM_NCLBUTTONUP()
    ON_WM_NCLBUTTONDBLCLK()
    ON_WM_LBUTTONUP()
    ON_WM_CAPTURECHANGED()
    ON_WM_SYSCOMMAND()
    ON_WM_INITMENUPOPUP()
    ON_WM_THEMECHANGED()
    ON_WM_HELPINFO()
    ON_COMMAND(ID_WINDOW_NEW, &Gui_ExternFrame::OnWindowNew)
    ON_COMMAND(GUI_ID_FLOAT_VIEW, &Gui_ExternFrame::OnFloatView)
    ON_UPDATE_COMMAND_UI(GUI_ID_FLOAT_VIEW, &Gui_ExternFrame::OnUpdateFloatView)
END_MESSAGE_MAP()
// clang-format on

namespace {

std::vector<Gui_ExternFrame*>& livingFrames() {
    static auto* frames = new std::vector<Gui_ExternFrame*>;
    return *frames;
}

Gui_ExternFrame::CloseAction closeAction = Gui_ExternFrame::CloseAction::Close;

} // namespace

Gui_ExternFrame::Gui_ExternFrame() : FloatFrame(false) {}

Gui_ExternFrame::~Gui_ExternFrame() = default;

const std::vector<Gui_ExternFrame*>& Gui_ExternFrame::GetAll() {
    return livingFrames();
}

bool Gui_ExternFrame::IsLiving(const Gui_ExternFrame* frame) {
    return std::find(livingFrames().begin(), livingFrames().end(), frame) != livingFrames().end();
}

void Gui_ExternFrame::SetCloseAction(CloseAction action) {
    closeAction = action;
}

Gui_ExternFrame::CloseAction Gui_ExternFrame::GetCloseAction() {
    return closeAction;
}

void Gui_ExternFrame::SetUnRipEnabled(bool enabled) {
    GetFloatHelp().SetEnabled(enabled);
}

bool Gui_ExternFrame::IsUnRipEnabled() const {
    return GetFloatHelp().IsEnabled();
}

void Gui_ExternFrame::SetRipResourceId(unsigned int id) {
    GetFloatHelp().SetResourceId(id);
}

unsigned int Gui_ExternFrame::GetRipResourceId() {
    return GetFloatHelp().GetResourceId();
}

// --- creation ---

int Gui_ExternFrame::OnCreate(CREATESTRUCT* cs) {
    if (SECFrameWnd::OnCreate(cs) == -1) {
        return -1;
    }
    prepareTheme();
    const bool hasTools = GetFloatHelp().HasValidResourceId() && CreateToolBar() != 0;
    if (!hasTools && m_toolBar.m_hWnd) {
        m_toolBar.DestroyWindow(); // without its buttons
    }
    if (!CreateStatusBar()) {
        return -1;
    }
    if (hasTools) {
        SetupToolBarDocking();
    }
    addToSystemMenu(GUI_ID_DOCK_WINDOW, GUI_IDS_DOCK_WINDOW, GUI_IDB_DOCK);
    livingFrames().push_back(this);
    return 0;
}

int Gui_ExternFrame::CreateToolBar() {
    constexpr DWORD style =
        WS_CHILD | WS_VISIBLE | CBRS_TOP | CBRS_GRIPPER | CBRS_TOOLTIPS | CBRS_FLYBY | CBRS_SIZE_DYNAMIC;
    return m_toolBar.CreateEx(this, TBSTYLE_FLAT, style, CRect(0, 0, 0, 0), AFX_IDW_TOOLBAR) &&
           m_toolBar.LoadToolBar(LOWORD(GetRipResourceId()));
}

int Gui_ExternFrame::CreateStatusBar() {
    static constexpr UINT panes[] = {ID_SEPARATOR, ID_INDICATOR_CAPS, ID_INDICATOR_NUM, ID_INDICATOR_SCRL};
    return m_statusBar.Create(this, WS_CHILD | WS_VISIBLE | CBRS_BOTTOM, AFX_IDW_STATUS_BAR) &&
           m_statusBar.SetIndicators(panes, static_cast<int>(std::size(panes)));
}

void Gui_ExternFrame::SetupToolBarDocking() {
    m_toolBar.EnableDocking(CBRS_ALIGN_ANY);
    EnableDocking(CBRS_ALIGN_ANY);
    DockControlBar(&m_toolBar);
}

void Gui_ExternFrame::PreLoadFrame(CView*) {}

void Gui_ExternFrame::PostLoadFrame(CView*) {}

void Gui_ExternFrame::PreSetActiveView(CView*) {}

void Gui_ExternFrame::PostSetActiveView(CView*) {}

void Gui_ExternFrame::CustomizeGuiElement() {}

void Gui_ExternFrame::SetStatusPaneText(int pane, const CString& text) {
    m_statusBar.SetPaneText(pane, text, TRUE);
    UINT id = 0;
    UINT style = 0;
    int width = 0;
    m_statusBar.GetPaneInfo(pane, id, style, width);
    CClientDC dc(&m_statusBar);
    CFont* before = dc.SelectObject(m_statusBar.GetFont());
    m_statusBar.SetPaneInfo(pane, id, style, dc.GetTextExtent(text).cx + 2);
    dc.SelectObject(before);
}

// --- the end ---

void Gui_ExternFrame::OnClose() {
    if (closeAction == CloseAction::DockBack && GetFloatHelp().CanMove()) {
        GetFloatHelp().UnripView();
        return;
    }
    SECFrameWnd::OnClose();
}

void Gui_ExternFrame::OnDestroy() {
    std::erase(livingFrames(), this);
    FloatPlaces::remember(*this, GetRipResourceId());
    SECFrameWnd::OnDestroy();
}

// --- activation and commands ---

namespace {

/// Whether a window stands over a frame or in it, as its dialogs do: these are active for the frame.
bool belongsTo(const CWnd* window, const CFrameWnd& frame) {
    return window && (window->GetParent() == &frame || ::GetWindow(window->m_hWnd, GW_OWNER) == frame.m_hWnd);
}

} // namespace

void Gui_ExternFrame::OnActivate(UINT state, CWnd* other, BOOL minimized) {
    if (state != WA_INACTIVE) {
        CFrameWnd* former = AfxSetRoutingFrame(this);
        if (former != this) {
            m_formerRouting = former ? former->m_hWnd : nullptr;
        }
    } else if (!belongsTo(other, *this)) {
        const HWND former = std::exchange(m_formerRouting, nullptr);
        AfxSetRoutingFrame(DYNAMIC_DOWNCAST(CFrameWnd, CWnd::FromHandlePermanent(former)));
    }
    SECFrameWnd::OnActivate(state, other, minimized);
}

BOOL Gui_ExternFrame::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    if (SECFrameWnd::OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    // What belongs to the application as a whole is handled by the main frame: not by its active child frame, which is
    // another view's.
    CWnd* main = AfxGetMainWnd();
    return main && main != this ? main->CCmdTarget::OnCmdMsg(id, code, extra, info) : FALSE;
}

BOOL Gui_ExternFrame::OnCommand(WPARAM wParam, LPARAM lParam) {
    CWnd* main = AfxGetMainWnd();
    if (lParam == 0 && LOWORD(wParam) >= AFX_IDM_FIRST_MDICHILD && main && main != this) {
        return main->SendMessage(WM_COMMAND, wParam, lParam) != 0; // a window chosen in the list
    }
    return SECFrameWnd::OnCommand(wParam, lParam);
}

void Gui_ExternFrame::OnSysCommand(UINT command, LPARAM parameter) {
    if (command == GUI_ID_DOCK_WINDOW) {
        GetFloatHelp().UnripView();
        return;
    }
    SECFrameWnd::OnSysCommand(command, parameter);
}

void Gui_ExternFrame::OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu) {
    auto* main = DYNAMIC_DOWNCAST(CMDIFrameWnd, AfxGetMainWnd());
    if (main && !systemMenu && popup && popup->m_hMenu == main->GetWindowMenuPopup(::GetMenu(m_hWnd))) {
        main->ListWindows(*popup);
    }
    SECFrameWnd::OnInitMenuPopup(popup, index, systemMenu);
}

BOOL Gui_ExternFrame::OnHelpInfo(HELPINFO* info) {
    CWinApp* app = AfxGetApp();
    if (info->iContextType == HELPINFO_MENUITEM && app) {
        app->WinHelp(HID_BASE_COMMAND + static_cast<DWORD_PTR>(info->iCtrlId), HELP_CONTEXT);
    }
    return TRUE;
}

/// Another view of the document, docked.
void Gui_ExternFrame::OnWindowNew() {
    CDocument* document = GetActiveDocument();
    CDocTemplate* kind = document ? document->GetDocTemplate() : nullptr;
    if (CFrameWnd* frame = kind ? kind->CreateNewFrame(document, this) : nullptr) {
        kind->InitialUpdateFrame(frame, document);
    }
}

void Gui_ExternFrame::OnFloatView() {
    GetFloatHelp().UnripView();
}

void Gui_ExternFrame::OnUpdateFloatView(CCmdUI* item) {
    item->Enable(GetFloatHelp().CanMove());
    item->SetCheck(TRUE);
}
