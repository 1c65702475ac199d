#pragma once

/// @file
/// Child frames in a main frame: the client window that holds them and the child frames' windows.

#include "platform/afx/core/detail/Caption.h"
#include "platform/afx/core/detail/CaptionMouse.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/Window.h"

#include <QTimer>

class QMainWindow;
class QMdiArea;
class QMdiSubWindow;

namespace tvx::afx {

class MdiChildWindow;

/// The area that child frames stand in. Controlled by WM_MDI... messages.
class TVX_PLATFORM_API MdiClientWindow : public Window {
public:
    using Window::Window;
    QWidget* clientWidget() const override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    Window* heldChildFrame() const override;
    QMdiArea* area() const;
    /// The active child frame, null when there is none.
    MdiChildWindow* active() const {
        return m_active;
    }
    /// Makes a child frame the active one (null: none) and tells both.
    void activate(MdiChildWindow* child);
    /// Chooses another active child frame when one ends.
    void forget(const MdiChildWindow& child);
    /// Where a new child frame goes that asks for no place: each a little lower and further right than the last.
    QRect nextPlace(const MdiChildWindow& child);
    /// Puts a widget of the area along its lower edge, below the room of the child frames, which gets smaller while the
    /// widget is shown.
    void setFoot(QWidget* foot);
    /// Follows a change of its height, or that it was shown or hidden.
    void placeFoot();

protected:
    QWidget* makeWidget(QWidget* parent) override;

private:
    void follow(const QMdiSubWindow* sub);
    void step(int direction);
    void tile(UINT type);
    void cascade();
    QSize room();
    QRect cascadePlace(int number);
    void placeAgain();
    void roomTold();
    std::vector<MdiChildWindow*> shownChildren() const;
    MdiChildWindow* m_active = nullptr;
    std::vector<MdiChildWindow*> m_history; ///< The latest active one last.
    bool m_activating = false;
    int m_placed = 0;
    /// Child frames whose places were chosen before the main frame had its size.
    struct Early {
        HWND child;
        int number;
        QRect place;
    };
    std::vector<Early> m_early;
    QTimer m_told; ///< Runs out when the desktop has told the main frame's size.
    bool m_roomKnown = false;
};

/// A child frame: a caption around a main window of its own, with bars and a pane.
class TVX_PLATFORM_API MdiChildWindow : public Window {
public:
    explicit MdiChildWindow(const CREATESTRUCT& cs);
    QWidget* clientWidget() const override;
    QWidget* childHost() const override;
    void setText(const QString& text) override;
    void setWindowRect(const QRect& rect) override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    QMdiSubWindow* subWindow() const;
    MdiClientWindow& client() const;
    Caption* caption() const override;
    int hitTest(QPoint screen) const override;
    void updateFrame() override;
    bool isHeldByCaption() const override;
    void stateChanged() override;

protected:
    void beforeShow(bool visible) override;
    void showWidget(int command) override;
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void iconChanged() override;

private:
    QPointer<QMainWindow> m_main;
    MenuHost m_systemMenu;
    void takeKeyboard() const;
    mutable Caption m_caption;
    CaptionMouse m_mouse;
    bool m_defaultPlace;
};

} // namespace tvx::afx
