#include "MainFrame.h"

#include "Resource.h"

#include <iterator>

namespace {

constexpr UINT indicators[] = {ID_SEPARATOR, ID_INDICATOR_POSITION, ID_INDICATOR_CAPS, ID_INDICATOR_NUM};
constexpr UINT indicatorTips[] = {0, IDS_TIP_POSITION, IDS_TIP_CAPS, IDS_TIP_NUM};

} // namespace

IMPLEMENT_DYNCREATE(CMainFrame, Gui_FrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CMainFrame, Gui_FrameWnd)
    ON_WM_CREATE()
    ON_COMMAND(ID_HELP_FINDER, &CFrameWnd::OnHelpFinder)
END_MESSAGE_MAP()
// clang-format on

// The size of the first start; later ones have their own.
BOOL CMainFrame::PreCreateWindow(CREATESTRUCT& cs) {
    cs.cx = 700;
    cs.cy = 500;
    return Gui_FrameWnd::PreCreateWindow(cs);
}

int CMainFrame::OnCreate(CREATESTRUCT* cs) {
    if (Gui_FrameWnd::OnCreate(cs) == -1) {
        return -1;
    }
    constexpr DWORD style = WS_CHILD | WS_VISIBLE | CBRS_TOP | CBRS_TOOLTIPS | CBRS_FLYBY;
    if (!m_toolBar.CreateEx(this, TBSTYLE_FLAT, style) || !m_toolBar.LoadToolBar(IDR_MAINFRAME)) {
        return -1;
    }
    if (!m_statusBar.Create(this) || !m_statusBar.SetIndicators(indicators, std::size(indicators))) {
        return -1;
    }
    m_statusBar.SetToolTips(indicatorTips, std::size(indicatorTips));
    m_toolBar.EnableDocking(CBRS_ALIGN_ANY);
    EnableDocking(CBRS_ALIGN_ANY);
    DockControlBar(&m_toolBar);
    return 0;
}
