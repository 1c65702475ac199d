#include "platform/afx/detail/BarWindow.h"

#include <QMainWindow>
#include <QStatusBar>
#include <QToolBar>

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeBar(const CREATESTRUCT& cs) {
    return std::make_unique<BarWindow>(cs);
}

std::unique_ptr<Window> makeStatusBar(const CREATESTRUCT& cs) {
    return std::make_unique<StatusBarWindow>(cs);
}

const WindowClassEntry barEntry("ToolbarWindow32", &makeBar);
const WindowClassEntry statusBarEntry("msctls_statusbar32", &makeStatusBar);

} // namespace

QWidget* BarWindow::makeWidget(QWidget* parent) {
    auto* bar = new QToolBar(text(), parent);
    // Layouts are remembered under this name.
    bar->setObjectName(QStringLiteral("bar%1").arg(id()));
    bar->setMovable(false);
    return bar;
}

QWidget* StatusBarWindow::makeWidget(QWidget* parent) {
    auto* bar = new QStatusBar(parent);
    bar->setObjectName(QStringLiteral("bar%1").arg(id()));
    return bar;
}

void BarWindow::setWindowRect(const QRect& rect) {
    const bool placed = qobject_cast<QMainWindow*>(widget()->parentWidget()) != nullptr && !widget()->isWindow();
    if (!placed) {
        Window::setWindowRect(rect);
    }
}

void attachStatusBar(QMainWindow& main, QWidget* widget) {
    if (auto* bar = qobject_cast<QStatusBar*>(widget)) {
        main.setStatusBar(bar);
    }
}

void floatToolBar(QToolBar& bar, QPoint at) {
    const bool shown = !bar.isHidden();
    bar.setWindowFlags(Qt::Tool | Qt::FramelessWindowHint | Qt::X11BypassWindowManagerHint);
    bar.move(at);
    bar.adjustSize();
    bar.setVisible(shown);
}

} // namespace tvx::afx
