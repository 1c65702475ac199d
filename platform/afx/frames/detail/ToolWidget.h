#pragma once

/// @file
/// The widget behind a tool bar.

#include <QPoint>
#include <QToolBar>

class QToolButton;

namespace tvx::afx {

/// A tool bar that has a caption with its name and a close button while it floats, and knows where it floats.
///
/// A floating bar of buttons never takes the keyboard: it is dragged out while the user works in a view, and the
/// frame's caption stays the active one. Dragged by its caption or its grip it can be docked; a double click docks it.
class ToolWidget : public QToolBar {
public:
    ToolWidget(const QString& title, QWidget* parent);
    /// Where it floats. While a window manager takes in a new window, the place that it tells can be the screen's
    /// corner; only what is told after the first painting counts.
    QPoint place() const;
    QSize sizeHint() const override;

protected:
    bool event(QEvent* event) override;
    void showEvent(QShowEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void moveEvent(QMoveEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    int captionHeight() const;
    QRect captionRect() const;
    void fitCaption();
    bool onCaption(QMouseEvent& event);
    void keepFromKeyboard();
    QToolButton* m_close;
    QPoint m_place;
    int m_fitted = 0; ///< The caption's height when the size was chosen.
    QPoint m_toGrip;  ///< From where the caption was pressed to the grip, which the toolkit drags bars by.
    bool m_pressed = false;
    bool m_painted = false;
};

} // namespace tvx::afx
