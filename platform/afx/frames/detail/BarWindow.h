#pragma once

/// @file
/// The windows of control bars: tool bars of the toolkit, and what status bars share with them.

#include "platform/afx/core/detail/Window.h"
#include "platform/base/String.h"

class CControlBar;
class CWnd;
class QMainWindow;
class QToolBar;

namespace tvx::afx {

/// A bar at the edge of a frame, which the frame's layout places and sizes.
class TVX_PLATFORM_API BarWindow : public Window {
public:
    using Window::Window;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    /// The text is the name in the caption of a floating tool bar.
    void setText(const QString& text) override;
    void setWindowRect(const QRect& rect) override;
    /// A floating bar of a frame that is not shown waits for it; see showFloating.
    void show(int command) override;

protected:
    QWidget* makeWidget(QWidget* parent) override;

private:
    void contextMenu(CControlBar& bar, WPARAM wParam, LPARAM lParam);
};

/// The toolkit's tool bar behind a bar; null for a bar of another kind and for one without a window.
[[nodiscard]] QToolBar* toolsOf(const CWnd& bar);

/// A side of a frame under its three names: the dock bar's identifier, the toolkit's area, the CBRS_ALIGN_... bit. What
/// is no side is 0, and the area at the top.
/// @{
[[nodiscard]] UINT dockBarOf(Qt::ToolBarArea area);
[[nodiscard]] Qt::ToolBarArea areaOf(UINT dockBar);
[[nodiscard]] DWORD sideOfDockBar(UINT dockBar);
/// @}

/// The name of a bar, which has the number of the command that shows it: that command's tip, else another string.
[[nodiscard]] CString nameOfBar(UINT id, UINT otherwise);

/// Gives a frame its status bar, if the widget is one.
void attachStatusBar(QMainWindow& main, QWidget* widget);
/// Makes a tool bar a small window at a point of the screen. It comes up when the frame does.
void floatToolBar(QToolBar& bar, QPoint at);
/// Where a floating tool bar stands on the screen. One that the desktop is about to show is where it was asked to be.
[[nodiscard]] QPoint placeOfFloating(const QToolBar& bar);
/// Shows a floating tool bar that waited for its frame.
void showFloating(QToolBar& bar);

} // namespace tvx::afx
