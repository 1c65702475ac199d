#include "platform/sec/Frames.h"

#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/frames/detail/MdiWindow.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/sec/detail/SheetTabs.h"

using namespace tvx::afx;

IMPLEMENT_DYNCREATE(SECFrameWnd, CFrameWnd)
IMPLEMENT_DYNCREATE(SECWorksheet, CMDIChildWnd)
IMPLEMENT_DYNCREATE(SECWorkbook, CMDIFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(SECFrameWnd, CFrameWnd)
END_MESSAGE_MAP()

BEGIN_MESSAGE_MAP(SECWorksheet, CMDIChildWnd)
END_MESSAGE_MAP()

BEGIN_MESSAGE_MAP(SECWorkbook, CMDIFrameWnd)
    ON_WM_DESTROY()
END_MESSAGE_MAP()
// clang-format on

BOOL SECFrameWnd::PreCreateWindow(CREATESTRUCT& cs) {
    cs.dwExStyle |= WS_EX_OWNCAPTION;
    return CFrameWnd::PreCreateWindow(cs);
}

SECWorkbook::SECWorkbook() = default;
SECWorkbook::~SECWorkbook() = default;

BOOL SECWorkbook::PreCreateWindow(CREATESTRUCT& cs) {
    cs.dwExStyle |= WS_EX_OWNCAPTION;
    return CMDIFrameWnd::PreCreateWindow(cs);
}

BOOL SECWorkbook::CreateClient(CREATESTRUCT* cs, CMenu* windowMenu) {
    if (!CMDIFrameWnd::CreateClient(cs, windowMenu)) {
        return FALSE;
    }
    auto* client = dynamic_cast<MdiClientWindow*>(Window::from(m_hWndMDIClient));
    guarded([&] {
        m_tabs = new tvx::sec::SheetTabs(*client);
        client->setFoot(m_tabs);
    });
    return TRUE;
}

void SECWorkbook::OnDestroy() {
    m_tabs = nullptr; // goes with the client window
    CMDIFrameWnd::OnDestroy();
}

void SECWorkbook::SetSheetIcon(CMDIChildWnd* sheet, HICON icon, BOOL redraw) {
    const auto* child = sheet ? dynamic_cast<MdiChildWindow*>(Window::from(sheet->m_hWnd)) : nullptr;
    if (m_tabs && child && sheet->GetMDIFrame() == this) {
        guarded([&] { m_tabs->setIcon(*child->subWindow(), icon ? windowIcon(icon) : QIcon(), redraw != FALSE); });
    }
}
