#pragma once

/// @file
/// The widget of child windows that hosts draw on or fill: a border and scroll bars where the window's style asks for
/// them.

#include "platform/base/Export.h"

#include <QAbstractScrollArea>

namespace tvx::afx {

class Window;

/// The frame around a child window's client area, which is its viewport. Everything the toolkit would do by itself in a
/// scroll area is the window's business here.
class TVX_PLATFORM_API ScrollFrame : public QAbstractScrollArea {
public:
    /// Who paints the client area before the window does: nobody, as the window paints each pixel of it, or the
    /// toolkit.
    enum class Background { Windows, Toolkits };

    ScrollFrame(Window& window, QWidget* parent, Background background);
    /// Takes border, bars and what may be dropped from the window's style.
    void followStyle();
    /// The bar of a direction, SB_HORZ or SB_VERT, shown or not.
    QScrollBar* bar(int direction) const;
    void showBar(int direction, bool show);

protected:
    void keyPressEvent(QKeyEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void scrollContentsBy(int dx, int dy) override {}

private:
    void connectBar(int direction);
    Window& m_window;
};

} // namespace tvx::afx
