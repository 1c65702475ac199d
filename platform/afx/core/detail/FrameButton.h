#pragma once

/// @file
/// A button that a host draws into the frame of its window.

#include "platform/base/Types.h"

#include <QObject>
#include <QRect>
#include <QString>

namespace tvx::afx {

class Window;

/// The button, for those who are to know of it: assistive tools are told of it as of a part of the window. There is no
/// widget, so that mouse, keyboard and drawing go on as they would without.
class FrameButton : public QObject {
public:
    FrameButton(const Window& window, const QString& name, UINT command);
    ~FrameButton() override;

    /// @param place in the coordinates of the window's widget
    void setPlace(const QRect& place);
    /// Where it is on the screen; empty while the part of the window that it stands in is not seen.
    [[nodiscard]] QRect screenPlace() const;
    [[nodiscard]] const QString& name() const {
        return m_name;
    }
    [[nodiscard]] UINT command() const {
        return m_command;
    }
    [[nodiscard]] const Window* window() const;
    /// Does what a click on it does: has WM_SYSCOMMAND sent to the window.
    void press() const;

private:
    HWND m_window;
    QString m_name;
    UINT m_command;
    QRect m_place;
};

} // namespace tvx::afx
