#pragma once

/// @file
/// Windows without behaviour of their own: views, panes, frames. What they show and do is their CWnd's affair.

#include "platform/afx/core/detail/Window.h"

class QMainWindow;

namespace tvx::afx {

class ScrollFrame;

/// A child window: an area to draw on, with a border and scroll bars where its style asks for them.
class TVX_PLATFORM_API PlainWindow : public Window {
public:
    using Window::Window;
    QWidget* clientWidget() const override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;

private:
    ScrollFrame* m_frame = nullptr;
};

/// A top-level window: a frame with caption, menu bar, tool bars and a central pane, or a bare popup.
class TVX_PLATFORM_API TopLevelWindow : public Window {
public:
    explicit TopLevelWindow(const CREATESTRUCT& cs);
    /// Destroys the menu it has at the end.
    ~TopLevelWindow() override;
    /// The area below the menu bar.
    QRect clientRect() const override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    void setWindowRect(const QRect& rect) override;
    /// What the caption shows; a maximised child frame adds its name to it.
    QString text() const override;
    HMENU menu() const override {
        return m_menu;
    }
    void setMenu(HMENU menu) override;
    QMainWindow* mainWindow() const;
    int hitTest(QPoint screen) const override;
    void updateFrame() override;

protected:
    /// The smallest size that parts drawn by the window itself need.
    virtual QSize leastSize() const {
        return {0, 0};
    }
    void beforeShow(bool visible) override;
    void showWidget(int command) override;
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void iconChanged() override;

private:
    HMENU m_menu = nullptr;
};

/// The toolkit's main window around the client area of a frame of any kind; null for windows that are no frames.
TVX_PLATFORM_API QMainWindow* mainWindowOf(const Window& window);
/// A main window as frames have it: the prompts of bars under the pointer go to the frame's status line.
QMainWindow* makeMainWidget(QWidget* parent, Qt::WindowFlags flags);
/// The client area of a frame: what the menu bar leaves of its main window.
QRect frameClientRect(const QMainWindow& main);

/// A PlainWindow for a child, a TopLevelWindow otherwise.
TVX_PLATFORM_API std::unique_ptr<Window> makePlainWindow(const CREATESTRUCT& cs);

/// Tells what makes children with WS_EX_MDICHILD; called when the library is loaded.
void setChildFrameFactory(WindowFactory factory);

/// The toolkit's window flags for a framework window's styles.
TVX_PLATFORM_API Qt::WindowFlags windowFlags(DWORD style, DWORD exStyle);
/// Gives the widget of a top-level window other flags, whether it is shown or not.
TVX_PLATFORM_API void changeWindowFlags(QWidget& widget, Qt::WindowFlags flags);

/// Asks a window for its limits (WM_GETMINMAXINFO) and sets them.
/// @param least what its parts need in any case
TVX_PLATFORM_API void applySizeLimits(Window& window, QSize least);
/// Does what a show command (SW_...) says with a top-level window's widget.
TVX_PLATFORM_API void showTopLevel(Window& window, int command);

/// Paints a window's background with its class brush. False when the class has none.
bool eraseBackground(Window& window, HDC dc);

} // namespace tvx::afx
