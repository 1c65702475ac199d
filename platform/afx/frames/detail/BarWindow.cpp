#include "platform/afx/frames/detail/BarWindow.h"

#include "platform/afx/core/Menu.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MenuRequest.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/afx/frames/ControlBar.h"
#include "platform/afx/frames/Frame.h"
#include "platform/afx/frames/detail/ToolWidget.h"
#include "platform/win/FrameworkIds.h"

#include <QMainWindow>
#include <QStatusBar>
#include <QToolBar>

#include <algorithm>
#include <iterator>
#include <memory>

namespace tvx::afx {

namespace {

bool isFrameShown(const QWidget& bar) {
    return bar.parentWidget() && bar.parentWidget()->window()->isVisible();
}

std::unique_ptr<Window> makeBar(const CREATESTRUCT& cs) {
    return std::make_unique<BarWindow>(cs);
}

const WindowClassEntry barEntry("ToolbarWindow32", &makeBar);

} // namespace

QWidget* BarWindow::makeWidget(QWidget* parent) {
    auto* bar = new ToolWidget(text(), parent);
    // Layouts are remembered under this name.
    bar->setObjectName(QStringLiteral("bar%1").arg(id()));
    bar->setMovable(false);
    return bar;
}

void BarWindow::setText(const QString& text) {
    Window::setText(text);
    if (widget()) {
        guarded([&] { widget()->setWindowTitle(text); });
    }
}

void BarWindow::setWindowRect(const QRect& rect) {
    const bool placed = qobject_cast<QMainWindow*>(widget()->parentWidget()) && !widget()->isWindow();
    if (!placed) {
        Window::setWindowRect(rect);
    }
}

namespace {

/// The menu of a floating bar, which does what a double click on the caption and the button in it do.
void showFloatingMenu(CControlBar& bar, CFrameWnd& frame, QPoint at) {
    const HWND handle = bar.m_hWnd;
    // Help on the first item is that on the bar.
    const auto dock = static_cast<UINT>(bar.GetDlgCtrlID());
    const HMENU menu = CreatePopupMenu();
    AppendMenuA(menu, MF_STRING | (bar.GetDockSides() != 0 ? MF_ENABLED : MF_GRAYED), dock,
                fromQt(ownText(TVX_IDS_BAR_DOCK)).c_str());
    AppendMenuA(menu, MF_STRING, SC_CLOSE, fromQt(ownText(TVX_IDS_SYS_CLOSE).section('\t', 0, 0)).c_str());
    const auto chosen = static_cast<UINT>(
        TrackPopupMenu(menu, TPM_RETURNCMD | TPM_NONOTIFY | TPM_RIGHTBUTTON, at.x(), at.y(), 0, frame.m_hWnd, nullptr));
    DestroyMenu(menu);
    if (!Window::from(handle)) {
        return;
    }
    if (chosen == dock) {
        frame.DockControlBar(&bar);
    } else if (chosen == SC_CLOSE) {
        bar.SendMessage(WM_CLOSE);
    }
}

} // namespace

void BarWindow::contextMenu(CControlBar& bar, WPARAM wParam, LPARAM lParam) {
    const HWND self = handle();
    if (parentsTakeMenu(*this, wParam, lParam) || !from(self)) {
        return;
    }
    CFrameWnd* frame = bar.GetDockingFrame();
    const QPoint place(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
    if (frame && bar.IsFloating()) {
        showFloatingMenu(bar, *frame, place != QPoint(-1, -1) ? place : windowRect().topLeft());
    }
}

LRESULT BarWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    auto* bar = dynamic_cast<CControlBar*>(object());
    CFrameWnd* frame = bar ? bar->GetDockingFrame() : nullptr;
    if (frame && message == WM_CLOSE) {
        // A floating bar that is closed must not end: the frame's menu brings it back.
        frame->ShowControlBar(bar, FALSE, FALSE);
        return 0;
    }
    if (bar && message == WM_CONTEXTMENU) {
        contextMenu(*bar, wParam, lParam);
        return 0;
    }
    return Window::defaultProc(message, wParam, lParam);
}

void BarWindow::show(int command) {
    if (command != SW_HIDE && widget() && widget()->isWindow() && !isFrameShown(*widget())) {
        setStyle(style() | WS_VISIBLE, exStyle());
        return;
    }
    Window::show(command);
}

CString nameOfBar(UINT id, UINT otherwise) {
    CString text;
    CString name;
    if (text.LoadString(id)) {
        AfxExtractSubString(name, text, 1);
    }
    if (name.IsEmpty()) {
        name.LoadString(otherwise);
    }
    return name;
}

void attachStatusBar(QMainWindow& main, QWidget* widget) {
    if (auto* bar = qobject_cast<QStatusBar*>(widget)) {
        main.setStatusBar(bar);
    }
}

namespace {

struct Side {
    UINT dockBar;
    Qt::ToolBarArea area;
    DWORD bit;
};

constexpr Side sides[] = {{AFX_IDW_DOCKBAR_TOP, Qt::TopToolBarArea, CBRS_ALIGN_TOP},
                          {AFX_IDW_DOCKBAR_LEFT, Qt::LeftToolBarArea, CBRS_ALIGN_LEFT},
                          {AFX_IDW_DOCKBAR_RIGHT, Qt::RightToolBarArea, CBRS_ALIGN_RIGHT},
                          {AFX_IDW_DOCKBAR_BOTTOM, Qt::BottomToolBarArea, CBRS_ALIGN_BOTTOM}};

} // namespace

QToolBar* toolsOf(const CWnd& bar) {
    const Window* state = bar.GetState();
    return state ? qobject_cast<QToolBar*>(state->widget()) : nullptr;
}

UINT dockBarOf(Qt::ToolBarArea area) {
    const auto* side = std::find_if(std::begin(sides), std::end(sides), [=](const Side& s) { return s.area == area; });
    return side != std::end(sides) ? side->dockBar : 0;
}

Qt::ToolBarArea areaOf(UINT dockBar) {
    const auto* side =
        std::find_if(std::begin(sides), std::end(sides), [=](const Side& s) { return s.dockBar == dockBar; });
    return side != std::end(sides) ? side->area : Qt::TopToolBarArea;
}

DWORD sideOfDockBar(UINT dockBar) {
    const auto* side =
        std::find_if(std::begin(sides), std::end(sides), [=](const Side& s) { return s.dockBar == dockBar; });
    return side != std::end(sides) ? side->bit : 0;
}

void floatToolBar(QToolBar& bar, QPoint at) {
    const bool shown = !bar.isHidden();
    bar.setWindowFlags(Qt::Tool | Qt::FramelessWindowHint);
    bar.setOrientation(Qt::Horizontal);
    bar.move(at);
    bar.adjustSize();
    bar.setVisible(shown && isFrameShown(bar));
}

QPoint placeOfFloating(const QToolBar& bar) {
    const auto* tools = dynamic_cast<const ToolWidget*>(&bar);
    return tools ? tools->place() : bar.pos();
}

void showFloating(QToolBar& bar) {
    if (bar.isFloating() && bar.isHidden() && isFrameShown(bar)) {
        bar.show();
    }
}

} // namespace tvx::afx
