#pragma once

/// @file
/// The windows of control bars: tool bars and status bars of the toolkit.

#include "platform/afx/detail/Window.h"

class QMainWindow;
class QToolBar;

namespace tvx::afx {

/// A bar at the edge of a frame, which the frame's layout places and sizes.
class TVX_PLATFORM_API BarWindow : public Window {
public:
    using Window::Window;
    void setWindowRect(const QRect& rect) override;

protected:
    QWidget* makeWidget(QWidget* parent) override;
};

class TVX_PLATFORM_API StatusBarWindow : public BarWindow {
public:
    using BarWindow::BarWindow;

protected:
    QWidget* makeWidget(QWidget* parent) override;
};

/// Gives a frame its status bar, if the widget is one.
void attachStatusBar(QMainWindow& main, QWidget* widget);
/// Makes a tool bar a small window at a point of the screen.
void floatToolBar(QToolBar& bar, QPoint at);

} // namespace tvx::afx
