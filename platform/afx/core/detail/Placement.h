#pragma once

/// @file
/// Where a window with a caption stands, and where it goes back to from maximised or minimised.

#include "platform/base/Export.h"

#include <QRect>
#include <QTimer>

#include <optional>

class QWidget;

namespace tvx::afx {

class Window;

/// What a rectangle asked for measures.
enum class Measured {
    Frame,  ///< The window with its caption and borders.
    Client, ///< The place is the frame's, the size that of the area inside.
};

/// Keeps the place of one top-level window or child frame.
///
/// The desktop puts its caption and borders around a window only when the window is shown, and tells their widths a
/// little later. Until then only the size inside can be set: a rectangle asked for earlier is kept here and the frame
/// brought to it once its borders are known. What the desktop did is looked at when it has done all that it was asked,
/// never after a time.
///
/// The restored rectangle follows the window while it is neither maximised nor minimised. Desktops tell a new size and
/// a new state in either order, so it too is taken only when all has been told.
class TVX_PLATFORM_API Placement {
public:
    explicit Placement(Window& window);
    Placement(const Placement&) = delete;
    Placement& operator=(const Placement&) = delete;

    /// The frame of a top-level window as it is now, in screen coordinates.
    QRect frameRect() const;
    /// Moves the frame of a top-level window, at once or when its borders are known.
    /// @param measured what the size means while the borders are not known
    void moveFrame(const QRect& rect, Measured measured);
    /// Makes `rect` the frame that the window goes back to, without touching it as long as it is maximised or
    /// minimised.
    void setRestored(const QRect& rect);
    /// The frame the window has when it is neither maximised nor minimised.
    QRect restored() const;

    /// Whether the window is on its way to a place: something was asked of the desktop that it has not told yet.
    bool isUnsettled() const {
        return m_wish || m_asked || m_settle.isActive();
    }

    enum class Keyboard { Taken, Left };
    /// Called directly before the window is shown.
    /// @param keyboard Left: it stays with the window that has it, whatever the desktop does with new windows
    void aboutToShow(Keyboard keyboard);
    /// Called for every change of place, size or state.
    void changed();
    /// Called when the desktop has told the widths of its borders.
    void bordersChanged();

private:
    struct Wish {
        QRect rect;
        Measured measured = Measured::Frame;
        int attempts = 0; ///< How often the frame was moved for it.
    };
    /// A window that was neither maximised nor minimised, as far as was told.
    struct Seen {
        QRect frame;
        QRect inside; ///< The widget's own geometry.
    };
    QWidget& widget() const;
    QMargins borders() const;
    bool isGone() const;
    bool isNormal() const;
    bool awaitsBorders() const;
    QSize expectedGrowth() const;
    void refuseKeyboard(bool refuse);
    void settle();
    void ask();
    void hearWithheld();
    void answered();
    void leaveNormal();
    void grant();
    QRect wishedFrame() const;
    void remember(const QRect& frame);

    Window& m_window;
    QTimer m_settle; ///< Runs out when everything that came at a time has been heard.
    QTimer m_answer; ///< Runs out when the desktop has done what it was asked.
    bool m_asked = false;
    bool m_askAgain = false;
    bool m_refusesKeyboard = false; ///< Until the desktop has taken the window in.
    bool m_bordersTold = false;
    bool m_bordersComing = true; ///< False when the desktop tells nothing.
    std::optional<Wish> m_wish;
    std::optional<Seen> m_seen; ///< Not known yet whether a state belongs to it.
    QPoint m_askedCorner;       ///< For desktops that do not tell where windows are.
    QRect m_restored;
};

/// The rectangle, moved and if need be shrunk so that enough of its caption to grasp shows on a screen.
TVX_PLATFORM_API QRect reachableFrame(const QRect& frame);

} // namespace tvx::afx
