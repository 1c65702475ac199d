#include "platform/win/Display.h"

#include "platform/win/detail/XSession.h"

#include <cstdlib>
#include <xcb/xcb.h>

namespace tvx {

bool canOpenDisplay() {
    const char* name = std::getenv("DISPLAY");
    if (!name || *name == '\0') {
        return false;
    }
    xcb_connection_t* connection = xcb_connect(nullptr, nullptr);
    const bool answers = xcb_connection_has_error(connection) == 0;
    xcb_disconnect(connection);
    return answers;
}

KeyLocks keyLocks() {
    const detail::XSession session;
    if (!session) {
        return {};
    }
    xcb_connection_t* xcb = session->xcb();
    const detail::XReply<xcb_get_keyboard_control_reply_t> reply(
        xcb_get_keyboard_control_reply(xcb, xcb_get_keyboard_control(xcb), nullptr));
    // The lights in the order in which the keyboard descriptions of X servers number them.
    const std::uint32_t lights = reply ? reply->led_mask : 0;
    return {(lights & 1U) != 0, (lights & 2U) != 0, (lights & 4U) != 0};
}

} // namespace tvx
