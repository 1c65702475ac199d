#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/Frame.h"
#include "platform/afx/frames/detail/BarWindow.h"

#include <QLayout>
#include <QMainWindow>
#include <QToolBar>

using namespace tvx::afx;

// The bars of frames and the layout around the pane.

namespace {

/// Makes the pane the main window's centre. The former centre keeps its place in the tree of windows.
void placePane(QMainWindow& main, QWidget* pane) {
    if (main.centralWidget() == pane) {
        return;
    }
    if (QWidget* old = main.takeCentralWidget()) {
        old->setParent(&main);
    }
    if (pane) {
        main.setCentralWidget(pane);
    }
}

Qt::ToolBarAreas areasOf(DWORD sides) {
    Qt::ToolBarAreas areas;
    areas.setFlag(Qt::LeftToolBarArea, (sides & CBRS_ALIGN_LEFT) != 0);
    areas.setFlag(Qt::RightToolBarArea, (sides & CBRS_ALIGN_RIGHT) != 0);
    areas.setFlag(Qt::TopToolBarArea, (sides & CBRS_ALIGN_TOP) != 0);
    areas.setFlag(Qt::BottomToolBarArea, (sides & CBRS_ALIGN_BOTTOM) != 0);
    return areas;
}

Qt::ToolBarArea firstArea(DWORD sides) {
    for (const auto& [bit, area] : {std::pair{CBRS_ALIGN_TOP, Qt::TopToolBarArea},
                                    {CBRS_ALIGN_BOTTOM, Qt::BottomToolBarArea},
                                    {CBRS_ALIGN_LEFT, Qt::LeftToolBarArea},
                                    {CBRS_ALIGN_RIGHT, Qt::RightToolBarArea}}) {
        if ((sides & static_cast<DWORD>(bit)) != 0) {
            return area;
        }
    }
    return Qt::TopToolBarArea;
}

/// The bar of an area that stands at a point of the screen, before which a new one goes.
QToolBar* barAt(const QMainWindow& main, Qt::ToolBarArea area, const QPoint& at, const QToolBar* except) {
    const auto bars = main.findChildren<QToolBar*>(QString(), Qt::FindDirectChildrenOnly);
    for (QToolBar* bar : bars) {
        const QRect place(bar->mapToGlobal(QPoint(0, 0)), bar->size());
        if (bar != except && !bar->isFloating() && main.toolBarArea(bar) == area && place.contains(at)) {
            return bar;
        }
    }
    return nullptr;
}

} // namespace

void CFrameWnd::addBar(CControlBar* bar) {
    m_bars.push_back(bar);
    const Window* state = GetState();
    QMainWindow* main = state ? mainWindowOf(*state) : nullptr;
    QWidget* widget = bar->GetState() ? bar->GetState()->widget() : nullptr;
    if (!main) {
        return;
    }
    guarded([&] {
        if (auto* tools = qobject_cast<QToolBar*>(widget)) {
            main->addToolBar(firstArea(bar->m_dwStyle), tools);
        } else {
            attachStatusBar(*main, widget);
        }
    });
}

void CFrameWnd::removeBar(CControlBar* bar) {
    std::erase(m_bars, bar);
}

void CFrameWnd::RecalcLayout(BOOL) {
    Window* state = GetState();
    QMainWindow* main = state ? mainWindowOf(*state) : nullptr;
    if (!main || state->isDestroyed()) {
        return;
    }
    m_nIdleFlags &= ~UINT{idleLayout};
    for (CControlBar* bar : m_bars) {
        if (bar->m_delayed != CControlBar::Delayed::None) {
            const bool show = std::exchange(bar->m_delayed, CControlBar::Delayed::None) == CControlBar::Delayed::Show;
            bar->ShowWindow(show ? SW_SHOWNA : SW_HIDE);
        }
        auto* tools = bar->GetState() ? qobject_cast<QToolBar*>(bar->GetState()->widget()) : nullptr;
        if (tools && (bar->GetStyle() & WS_VISIBLE) != 0) {
            guarded([tools] { showFloating(*tools); });
        }
    }
    const Window* pane = state->child(AFX_IDW_PANE_FIRST);
    guarded([&] {
        placePane(*main, pane ? pane->widget() : nullptr);
        // Hosts ask for places right behind this call; the toolkit would lay out only in its loop.
        main->layout()->activate();
    });
    if (Window* still = Window::from(m_hWnd); still == state) {
        if (Window* placed = state->child(AFX_IDW_PANE_FIRST)) {
            placed->tellGeometry();
        }
    }
}

void CFrameWnd::EnableDocking(DWORD sides) {
    m_dockSides = sides;
}

void CFrameWnd::DockControlBar(CControlBar* bar, UINT side, const RECT* rect) {
    const Window* state = GetState();
    QMainWindow* main = state ? mainWindowOf(*state) : nullptr;
    auto* tools = bar->GetState() ? qobject_cast<QToolBar*>(bar->GetState()->widget()) : nullptr;
    if (!main || !tools) {
        return;
    }
    const DWORD allowed = m_dockSides & bar->GetDockSides();
    DWORD wanted = sideOfDockBar(side);
    if (wanted == 0) {
        const DWORD own = bar->GetBarStyle() & CBRS_ALIGN_ANY & allowed;
        wanted = own != 0 ? own : allowed;
    }
    const Qt::ToolBarArea area = firstArea(wanted);
    guarded([&] {
        tools->setAllowedAreas(areasOf(allowed));
        tools->setMovable(true);
        // A bar that the user has hidden must not come back by being moved.
        const bool shown = !tools->isHidden();
        QToolBar* before = rect ? barAt(*main, area, QPoint(rect->left, rect->top), tools) : nullptr;
        if (before) {
            main->insertToolBar(before, tools);
        } else {
            main->addToolBar(area, tools);
        }
        tools->setVisible(shown);
    });
    RecalcLayout();
}

void CFrameWnd::FloatControlBar(CControlBar* bar, CPoint point, DWORD) {
    auto* tools = bar->GetState() ? qobject_cast<QToolBar*>(bar->GetState()->widget()) : nullptr;
    if (!tools) {
        return;
    }
    guarded([&] {
        tools->setMovable(true);
        floatToolBar(*tools, toQt(point));
    });
    RecalcLayout();
}

void CFrameWnd::ShowControlBar(CControlBar* bar, BOOL show, BOOL delay) {
    if (delay) {
        bar->DelayShow(show);
        m_nIdleFlags |= idleLayout;
        return;
    }
    bar->m_delayed = CControlBar::Delayed::None;
    bar->ShowWindow(show ? SW_SHOWNA : SW_HIDE);
    RecalcLayout();
}

CControlBar* CFrameWnd::GetControlBar(UINT id) {
    for (CControlBar* bar : m_bars) {
        if (static_cast<UINT>(bar->GetDlgCtrlID()) == id) {
            return bar;
        }
    }
    return nullptr;
}

void CFrameWnd::OnUpdateControlBarMenu(CCmdUI* item) {
    const CControlBar* bar = GetControlBar(item->m_nID);
    if (!bar) {
        item->ContinueRouting();
        return;
    }
    item->SetCheck(bar->IsVisible() ? 1 : 0);
    item->Enable(TRUE);
}

BOOL CFrameWnd::OnBarCheck(UINT id) {
    CControlBar* bar = GetControlBar(id);
    if (!bar) {
        return FALSE;
    }
    ShowControlBar(bar, !bar->IsVisible(), FALSE);
    return TRUE;
}
