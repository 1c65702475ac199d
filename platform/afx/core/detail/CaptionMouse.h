#pragma once

/// @file
/// What the mouse does to a window by the caption and the border that it draws itself.

#include "platform/afx/core/Message.h"

#include <QPoint>
#include <QRect>

#include <optional>

namespace tvx::afx {

class Caption;
class Window;

/// Whether the window manager is moving or sizing a window that was pressed by its caption or border. It has the
/// keyboard meanwhile; the window stays the active one all the same.
bool isHeldByDesktop(HWND window);

/// Presses of caption buttons, moves and changes of size. The window manager does the latter for top-level windows
/// where it offers to; else they are done by hand. A press captures the mouse until it is released.
class CaptionMouse {
public:
    CaptionMouse(Window& window, Caption& caption);

    /// Does what a message of the mouse means for the caption; the answer to it, none when it is not the caption's.
    std::optional<LRESULT> proc(UINT message, WPARAM wParam, LPARAM lParam);
    /// Whether a part is held down.
    bool isHeld() const {
        return m_part != 0;
    }

private:
    /// Shows that an edge can be taken hold of. False for a part that cannot.
    bool showCursor(int part);
    bool press(int part, QPoint at);
    void drag(QPoint at);
    void release(QPoint at);
    void doubleClick(int part, QPoint at);
    void hover(int part);
    void begin();
    void moveByHand(QPoint at);
    bool changesSize() const;
    WPARAM commandOf(int part) const;

    Window& m_window;
    Caption& m_caption;
    int m_part = 0;       ///< the part that is held, 0 for none
    bool m_began = false; ///< the window follows the mouse by hand
    QPoint m_from;        ///< where the part was pressed, in screen coordinates
    QRect m_place;        ///< the window's rectangle at that time
};

} // namespace tvx::afx
