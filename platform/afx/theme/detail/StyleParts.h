#pragma once

/// @file
/// Parts of windows as the toolkit's style draws them.

#include "platform/afx/core/detail/Caption.h"
#include "platform/base/Geometry.h"
#include "platform/base/Types.h"

#include <QIcon>
#include <QImage>
#include <QPixmap>
#include <QStyle>

namespace tvx::afx {

/// The style of captions, which can leave out the pictures on buttons.
class PartStyle : public CaptionStyle {
public:
    QIcon standardIcon(StandardPixmap picture, const QStyleOption* option, const QWidget* widget) const override;
    bool withPictures = true;
};

/// The buttons that minimise: those of captions, and those of menu bars, where a child frame that fills its main frame
/// has its buttons.
///
/// They are as the window's own ones are, but for the sign: that is a bar of one colour in the lower half, at the same
/// place in every state. Whoever wants another sign finds this one by its colour and can take it away.
class StyleParts {
public:
    /// What can be drawn, by the numbers that hosts know.
    enum Part { CaptionButton = 15, ChildButton = 16 };
    enum State { Normal = 1, Hot, Pushed, Disabled, Inactive };

    /// @param window what the parts belong to
    explicit StyleParts(HWND window) : m_window(window) {}

    /// Whether the style has buttons in captions.
    static bool exist();
    /// Draws a part over a rectangle in logical units; of that, what lies within `clip` where there is one.
    /// False for a part, a state or a context that is none.
    bool draw(HDC dc, int part, int state, const RECT& place, const RECT* clip) const;
    /// A system colour (COLOR_...). Those of texts in captions and on buttons are those of the signs.
    COLORREF color(int index) const;

private:
    /// A button, and the same without its sign.
    struct Button {
        QImage whole;
        QImage face;
    };
    Button button(int part, int state, double ratio) const;
    Button captionButton(int state, double ratio) const;
    Button childButton(int state, double ratio) const;
    QImage captionShot(QStyle::SubControl which, int state, double ratio) const;
    QImage childShot(int state, double ratio) const;
    QRgb sign(int part, int state) const;
    const QWidget* widget() const;

    HWND m_window;
    mutable PartStyle m_style;
};

} // namespace tvx::afx
