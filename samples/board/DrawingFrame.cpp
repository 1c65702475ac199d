#include "DrawingFrame.h"

#include "Board.h"
#include "Indicators.h"
#include "Resource.h"

IMPLEMENT_DYNCREATE(CDrawingFrame, Gui_FloatChildFrame)
IMPLEMENT_DYNCREATE(CDrawingWindow, Gui_ExternFrame)

BEGIN_MESSAGE_MAP(CDrawingWindow, Gui_ExternFrame)
ON_WM_HELPINFO()
END_MESSAGE_MAP()

CDrawingFrame::CDrawingFrame() {
    SetRipResourceId(IDR_BOARDFLOAT);
    SetRipOutFrame(RUNTIME_CLASS(CDrawingWindow));
}

int CDrawingWindow::CreateStatusBar() {
    return m_statusBar.Create(this) && m_statusBar.SetIndicators(indicators, std::size(indicators)) &&
           m_statusBar.SetToolTips(indicatorTips, std::size(indicatorTips));
}

void CDrawingWindow::PostLoadFrame(CView*) {
    theApp.GetKeyboard().Apply(*this);
    DragAcceptFiles();
}

// The family leaves the help key to its hosts; the board has a page for whatever it is pressed on.
BOOL CDrawingWindow::OnHelpInfo(HELPINFO* info) {
    return SECFrameWnd::OnHelpInfo(info);
}
