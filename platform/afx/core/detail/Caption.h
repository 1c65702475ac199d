#pragma once

/// @file
/// Captions and borders that windows draw themselves, with the desktop's style: those of child frames and of top-level
/// frames that ask for one.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <QIcon>
#include <QMargins>
#include <QPoint>
#include <QProxyStyle>
#include <QRect>
#include <QStyleOptionTitleBar>

#include <memory>

class QPainter;

namespace tvx::afx {

class Window;

/// The desktop's style for captions. It draws a border around them, keeps the place of a button that the host has
/// added, and draws captions on dark desktops so that they can be read.
class TVX_PLATFORM_API CaptionStyle : public QProxyStyle {
public:
    CaptionStyle();
    int styleHint(StyleHint hint, const QStyleOption* option, const QWidget* widget,
                  QStyleHintReturn* data) const override;
    QRect subControlRect(ComplexControl control, const QStyleOptionComplex* option, SubControl part,
                         const QWidget* widget) const override;
    void drawComplexControl(ComplexControl control, const QStyleOptionComplex* option, QPainter* painter,
                            const QWidget* widget) const override;
    QIcon standardIcon(StandardPixmap picture, const QStyleOption* option, const QWidget* widget) const override;
    /// The place of a button that the host draws, in the window's coordinates; empty for none.
    QRect button;
    /// Whether captions are drawn as those of active windows, whatever the toolkit takes them for: the window was told.
    bool isActive = false;
};

/// The caption and the border of one window: what they take, what lies where, and how they look.
class TVX_PLATFORM_API Caption {
public:
    explicit Caption(Window& window);
    ~Caption();
    Caption(const Caption&) = delete;
    Caption& operator=(const Caption&) = delete;

    /// The style that measures and draws the caption; another one after the desktop's has changed.
    QStyle& style() const;
    /// Follows a change of the desktop's style.
    void renewStyle();
    /// What border and caption take from the window's widget: nothing of what is not drawn at the moment.
    QMargins margins() const;
    /// The smallest window in which no button lies on another.
    QSize leastSize() const;
    /// How wide the border would be that a maximised window does not show; 0 for others.
    int hiddenBorder() const;
    /// The part (HT...) at a point of the window's widget.
    int hitTest(QPoint point) const;
    /// Draws border and caption on the window's widget.
    void paint(QPainter& painter) const;
    /// Does what a message means for how it looks; false for one that has more to do.
    bool proc(UINT message, WPARAM wParam);
    /// Asks for all of it to be painted.
    void update() const;
    /// The place of the picture that opens the system menu, in the widget's coordinates.
    QRect systemMenuRect() const;
    /// Told that the window was maximised, minimised or brought back: the mouse is no longer where it was in it.
    void stateChanged();
    /// Draws it as that of the active window, or not.
    void setActive(bool active);
    /// Keeps a part of the caption free of the title, for a button that the host draws there. Widget's coordinates.
    void setButton(const QRect& place);

    int pressed = 0; ///< the button (HT...) that is drawn as held down
    int hovered = 0; ///< the button that the pointer is over

private:
    int border() const;
    int fullBorder() const;
    int height() const;
    QStyleOptionTitleBar bar() const;
    int edgeAt(QPoint point) const;
    Window& m_window;
    std::unique_ptr<CaptionStyle> m_style;
};

} // namespace tvx::afx
