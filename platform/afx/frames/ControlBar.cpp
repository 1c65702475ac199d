#include "platform/afx/frames/ControlBar.h"

#include "platform/afx/frames/detail/BarWindow.h"

#include <QMainWindow>
#include <QToolBar>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CControlBar, CWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CControlBar, CWnd)
    ON_WM_CREATE()
    ON_WM_DESTROY()
    ON_MESSAGE(WM_IDLEUPDATECMDUI, &CControlBar::OnIdleUpdateCmdUI)
    ON_MESSAGE(WM_INITIALUPDATE, &CControlBar::OnInitialUpdate)
    ON_MESSAGE(WM_HELPHITTEST, &CControlBar::OnHelpHitTest)
END_MESSAGE_MAP()
// clang-format on

CControlBar::~CControlBar() {
    if (CFrameWnd* frame = m_hWnd ? GetDockingFrame() : nullptr) {
        frame->removeBar(this);
    }
}

BOOL CControlBar::PreCreateWindow(CREATESTRUCT& cs) {
    return CWnd::PreCreateWindow(cs);
}

void CControlBar::PostNcDestroy() {
    if (m_bAutoDelete) {
        delete this;
    }
}

int CControlBar::OnCreate(CREATESTRUCT* cs) {
    if (CWnd::OnCreate(cs) == -1) {
        return -1;
    }
    if (CFrameWnd* frame = GetDockingFrame()) {
        frame->addBar(this);
    }
    return 0;
}

void CControlBar::OnDestroy() {
    if (CFrameWnd* frame = GetDockingFrame()) {
        frame->removeBar(this);
    }
    CWnd::OnDestroy();
}

DWORD CControlBar::GetBarStyle() const {
    const DWORD side = sideOfDockBar(GetDockSide());
    return side != 0 ? (m_dwStyle & ~DWORD{CBRS_ALIGN_ANY}) | side : m_dwStyle;
}

void CControlBar::SetBarStyle(DWORD style) {
    m_dwStyle = style;
}

void CControlBar::EnableDocking(DWORD sides) {
    m_dockSides = sides & CBRS_ALIGN_ANY;
    m_dockable = true;
    if (QToolBar* tools = toolsOf(*this)) {
        tools->setMovable(true);
    }
}

BOOL CControlBar::IsFloating() const {
    const QToolBar* tools = toolsOf(*this);
    return tools && tools->isFloating() ? TRUE : FALSE;
}

BOOL CControlBar::IsVisible() const {
    if (m_delayed != Delayed::None) {
        return m_delayed == Delayed::Show ? TRUE : FALSE;
    }
    return m_hWnd && (GetStyle() & WS_VISIBLE) != 0 ? TRUE : FALSE;
}

CFrameWnd* CControlBar::GetDockingFrame() const {
    return GetParentFrame();
}

UINT CControlBar::GetDockSide() const {
    QToolBar* tools = toolsOf(*this);
    const auto* main = tools ? qobject_cast<QMainWindow*>(tools->parentWidget()) : nullptr;
    if (!main || tools->isFloating()) {
        return 0;
    }
    return dockBarOf(main->toolBarArea(tools));
}

CSize CControlBar::CalcFixedLayout(BOOL, BOOL) {
    const Window* state = GetState();
    const QSize size = state ? state->widget()->sizeHint() : QSize();
    return {size.width(), size.height()};
}

void CControlBar::DelayShow(BOOL show) {
    m_delayed = show ? Delayed::Show : Delayed::Hide;
}

BOOL CControlBar::PreTranslateMessage(MSG* message) {
    if (CWnd::PreTranslateMessage(message)) {
        return TRUE;
    }
    // Keys in a bar's controls: the frame's accelerators come first, then those of a dialog.
    const CWnd* owner = GetOwner();
    for (CWnd* frame = owner ? owner->GetTopLevelFrame() : nullptr; frame; frame = frame->GetParentFrame()) {
        if (frame->PreTranslateMessage(message)) {
            return TRUE;
        }
    }
    return PreTranslateInput(message);
}

LRESULT CControlBar::OnIdleUpdateCmdUI(WPARAM disable, LPARAM) {
    // Nobody sees the states of a hidden bar; the idle time after it is shown brings them.
    if (!m_hWnd || !IsWindowVisible()) {
        return 0;
    }
    CWnd* owner = GetOwner();
    CFrameWnd* target = owner && owner->IsFrameWnd() ? static_cast<CFrameWnd*>(owner) : GetParentFrame();
    if (target) {
        OnUpdateCmdUI(target, disable != 0 ? TRUE : FALSE);
    }
    return 0;
}

LRESULT CControlBar::OnInitialUpdate(WPARAM, LPARAM) {
    return OnIdleUpdateCmdUI(TRUE, 0);
}
