#include "DrawingFrame.h"

#include "Board.h"
#include "Resource.h"

#include <iterator>

IMPLEMENT_DYNCREATE(CDrawingFrame, Gui_FloatChildFrame)
IMPLEMENT_DYNCREATE(CDrawingWindow, Gui_ExternFrame)

CDrawingFrame::CDrawingFrame() {
    SetRipResourceId(IDR_BOARDFLOAT);
    SetRipOutFrame(RUNTIME_CLASS(CDrawingWindow));
}

int CDrawingWindow::CreateStatusBar() {
    constexpr UINT indicators[] = {ID_SEPARATOR, ID_INDICATOR_POSITION, ID_INDICATOR_CAPS, ID_INDICATOR_NUM};
    return m_statusBar.Create(this) && m_statusBar.SetIndicators(indicators, std::size(indicators));
}

void CDrawingWindow::PostLoadFrame(CView*) {
    theApp.GetKeyboard().Apply(*this);
}
