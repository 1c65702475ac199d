#pragma once

#include "platform/base/Types.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace tvx::detail {

/// Tells when the window manager has done what one connection to the X server asked of it.
///
/// Window managers take requests in the order in which the server got them. One of these asks for an answer that can be
/// told from all others: the widths of the borders that a window would get, here one that is never shown
/// (_NET_REQUEST_FRAME_EXTENTS of the extended window-manager hints). When it comes, all that was asked before is done
/// and told.
class DesktopAnswers {
public:
    /// @param connection the caller's `xcb_connection_t`, which outlives this object
    explicit DesktopAnswers(void* connection);
    ~DesktopAnswers();
    DesktopAnswers(const DesktopAnswers&) = delete;
    DesktopAnswers& operator=(const DesktopAnswers&) = delete;

    /// Asks once more; each question gets an answer of its own, in the order of the questions.
    /// @return false when nobody will answer: there is no window manager, or it does not know the request
    [[nodiscard]] bool ask();
    struct Borders {
        std::uint32_t left, right, top, bottom;
    };
    /// The borders that a window with a caption will get. Asks and waits, unlike the rest.
    /// @return nothing when nobody has answered in this time
    [[nodiscard]] std::optional<Borders> waitForBorders(std::chrono::milliseconds patience);
    /// The window whose borders an event of the connection (an `xcb_generic_event_t`) tells; 0 for any other event.
    [[nodiscard]] std::uint32_t windowOf(const void* event) const;
    /// Whether that is the window that is never shown: an answer.
    [[nodiscard]] bool isAnswer(std::uint32_t window) const {
        return window == m_window;
    }

private:
    struct Atoms {
        std::uint32_t supported = 0;
        std::uint32_t managerCheck = 0;
        std::uint32_t request = 0;
        std::uint32_t borders = 0;
    };
    [[nodiscard]] bool isKnown() const;

    void* m_connection;
    Atoms m_atoms;
    std::uint32_t m_root = 0;
    std::uint32_t m_window = 0;
};

} // namespace tvx::detail
