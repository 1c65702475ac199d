#include "s/FloatChildFrame.h"

#include "res/resource.h"

IMPLEMENT_DYNCREATE(Gui_FloatChildFrame, SECWorksheet)

// clang-format off
BEGIN_MESSAGE_MAP(Gui_FloatChildFrame, SECWorksheet)
    ON_WM_CREATE()
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
    ON_COMMAND(GUI_ID_FLOAT_VIEW, &Gui_FloatChildFrame::OnFloatView)
    ON_UPDATE_COMMAND_UI(GUI_ID_FLOAT_VIEW, &Gui_FloatChildFrame::OnUpdateFloatView)
END_MESSAGE_MAP()
// clang-format on

Gui_FloatChildFrame::Gui_FloatChildFrame() : FloatFrame(true) {}

Gui_FloatChildFrame::~Gui_FloatChildFrame() = default;

void Gui_FloatChildFrame::SetRipEnabled(bool enabled) {
    GetFloatHelp().SetEnabled(enabled);
}

bool Gui_FloatChildFrame::IsRipEnabled() const {
    return GetFloatHelp().IsEnabled();
}

void Gui_FloatChildFrame::SetRipResourceId(unsigned int id) {
    GetFloatHelp().SetResourceId(id);
    if (m_hWnd) {
        PostMessage(WM_NCPAINT, 1);
    }
}

unsigned int Gui_FloatChildFrame::GetRipResourceId() {
    return GetFloatHelp().GetResourceId();
}

void Gui_FloatChildFrame::SetRipOutFrame(CRuntimeClass* frameClass) {
    GetFloatHelp().SetRipOutFrame(frameClass);
}

CRuntimeClass* Gui_FloatChildFrame::GetRipOutFrame() {
    return GetFloatHelp().GetRipOutFrame();
}

void Gui_FloatChildFrame::PreSetActiveView(CView*) {}

void Gui_FloatChildFrame::PostSetActiveView(CView*) {}

int Gui_FloatChildFrame::OnCreate(CREATESTRUCT* cs) {
    if (SECWorksheet::OnCreate(cs) == -1) {
        return -1;
    }
    prepareTheme();
    addToSystemMenu(GUI_ID_FLOAT_WINDOW, GUI_IDS_FLOAT_WINDOW, GUI_IDB_FLOAT);
    return 0;
}

void Gui_FloatChildFrame::OnSysCommand(UINT command, LPARAM parameter) {
    if (command == GUI_ID_FLOAT_WINDOW) {
        GetFloatHelp().RipOutView();
        return;
    }
    SECWorksheet::OnSysCommand(command, parameter);
}

void Gui_FloatChildFrame::OnInitMenu(CMenu* menu) {
    SECWorksheet::OnInitMenu(menu);
    if (GetFloatHelp().HasValidResourceId()) {
        menu->EnableMenuItem(GUI_ID_FLOAT_WINDOW, MF_BYCOMMAND | MF_ENABLED);
    }
}

void Gui_FloatChildFrame::OnFloatView() {
    GetFloatHelp().RipOutView();
}

void Gui_FloatChildFrame::OnUpdateFloatView(CCmdUI* item) {
    item->Enable(GetFloatHelp().CanMove());
    item->SetCheck(FALSE);
}
