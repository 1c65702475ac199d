#include "MainFrame.h"

#include "Resource.h"

#include <iterator>

namespace {

constexpr UINT indicators[] = {ID_SEPARATOR, ID_INDICATOR_POSITION, ID_INDICATOR_CAPS, ID_INDICATOR_NUM};

} // namespace

IMPLEMENT_DYNCREATE(CMainFrame, CMDIFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CMainFrame, CMDIFrameWnd)
    ON_WM_CREATE()
END_MESSAGE_MAP()
// clang-format on

BOOL CMainFrame::PreCreateWindow(CREATESTRUCT& cs) {
    cs.cx = 1000;
    cs.cy = 700;
    return CMDIFrameWnd::PreCreateWindow(cs);
}

int CMainFrame::OnCreate(CREATESTRUCT* cs) {
    if (CMDIFrameWnd::OnCreate(cs) == -1) {
        return -1;
    }
    constexpr DWORD style = WS_CHILD | WS_VISIBLE | CBRS_TOP | CBRS_TOOLTIPS | CBRS_FLYBY;
    if (!m_toolBar.CreateEx(this, TBSTYLE_FLAT, style) || !m_toolBar.LoadToolBar(IDR_MAINFRAME)) {
        return -1;
    }
    if (!m_statusBar.Create(this) || !m_statusBar.SetIndicators(indicators, std::size(indicators))) {
        return -1;
    }
    return 0;
}
