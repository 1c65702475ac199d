#include "s/FloatMainFrame.h"

#include "res/resource.h"
#include "s/ExternFrame.h"
#include "s/FloatPlaces.h"

IMPLEMENT_DYNAMIC(Gui_FloatMainFrame, SECWorkbook)

// clang-format off
BEGIN_MESSAGE_MAP(Gui_FloatMainFrame, SECWorkbook)
    ON_WM_CREATE()
    ON_WM_DESTROY()
    ON_WM_ACTIVATE()
    ON_WM_NCPAINT()
    ON_WM_NCACTIVATE()
    ON_WM_NCLBUTTONDOWN()
    ON_WM_NCLBUTTONUP()
    ON_WM_NCLBUTTONDBLCLK()
    ON_WM_LBUTTONUP()
    ON_WM_CAPTURECHANGED()
    ON_WM_SYSCOMMAND()
    ON_WM_INITMENU()
    ON_WM_THEMECHANGED()
    ON_COMMAND(GUI_ID_DOCK_ALL, &Gui_FloatMainFrame::OnDockAll)
    ON_UPDATE_COMMAND_UI(GUI_ID_DOCK_ALL, &Gui_FloatMainFrame::OnUpdateDockAll)
END_MESSAGE_MAP()
// clang-format on

Gui_FloatMainFrame::Gui_FloatMainFrame() : FloatFrame(true) {}

Gui_FloatMainFrame::~Gui_FloatMainFrame() = default;

void Gui_FloatMainFrame::SetRipEnabled(bool enabled) {
    GetFloatHelp().SetEnabled(enabled);
}

bool Gui_FloatMainFrame::IsRipEnabled() const {
    return GetFloatHelp().IsEnabled();
}

int Gui_FloatMainFrame::OnCreate(CREATESTRUCT* cs) {
    if (SECWorkbook::OnCreate(cs) == -1) {
        return -1;
    }
    prepareTheme();
    return 0;
}

void Gui_FloatMainFrame::OnDestroy() {
    // Documents took theirs with them; views without a document have nobody else who does.
    const auto frames = Gui_ExternFrame::GetAll();
    for (Gui_ExternFrame* frame : frames) {
        if (Gui_ExternFrame::IsLiving(frame)) {
            frame->DestroyWindow();
        }
    }
    FloatPlaces::save();
    SECWorkbook::OnDestroy();
}

void Gui_FloatMainFrame::OnActivate(UINT state, CWnd* other, BOOL minimized) {
    // A floating frame whose dialog was active until now has not heard that it is no longer the one to ask.
    if (state != WA_INACTIVE) {
        AfxSetRoutingFrame(nullptr);
    }
    SECWorkbook::OnActivate(state, other, minimized);
}

void Gui_FloatMainFrame::OnSysCommand(UINT command, LPARAM parameter) {
    if (command == GUI_ID_FLOAT_WINDOW) {
        GetFloatHelp().RipOutView();
        return;
    }
    SECWorkbook::OnSysCommand(command, parameter);
}

void Gui_FloatMainFrame::OnInitMenu(CMenu* menu) {
    SECWorkbook::OnInitMenu(menu);
    menu->EnableMenuItem(GUI_ID_FLOAT_WINDOW, MF_BYCOMMAND | MF_ENABLED);
}

LRESULT Gui_FloatMainFrame::OnThemeChanged() {
    const LRESULT answer = SECWorkbook::OnThemeChanged();
    if (Gui_FrameTheme* theme = Gui_FrameTheme::current()) {
        theme->changed(*this);
    }
    return answer;
}

// --- floating views ---

std::vector<HWND> Gui_FloatMainFrame::ListedWindows() const {
    std::vector<HWND> windows = SECWorkbook::ListedWindows();
    for (const Gui_ExternFrame* frame : Gui_ExternFrame::GetAll()) {
        windows.push_back(frame->m_hWnd);
    }
    return windows;
}

void Gui_FloatMainFrame::DockAll() {
    const auto frames = Gui_ExternFrame::GetAll();
    for (Gui_ExternFrame* frame : frames) {
        if (Gui_ExternFrame::IsLiving(frame)) {
            frame->GetFloatHelp().UnripView();
        }
    }
}

void Gui_FloatMainFrame::OnDockAll() {
    DockAll();
}

void Gui_FloatMainFrame::OnUpdateDockAll(CCmdUI* item) {
    item->Enable(!Gui_ExternFrame::GetAll().empty());
}
