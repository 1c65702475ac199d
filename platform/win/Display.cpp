#include "platform/win/Display.h"

#include "platform/base/Text.h"
#include "platform/win/detail/XSession.h"

#include <cerrno>
#include <cstdlib>
#include <string>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>
#include <xcb/xcb.h>

namespace tvx {

namespace {

std::string environment(const char* name) {
    const char* value = std::getenv(name);
    return value ? value : "";
}

/// Whether somebody listens at a socket of the file system.
bool isServed(const std::string& path) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (path.size() >= sizeof(address.sun_path)) {
        return false;
    }
    text::copyCut(path, address.sun_path, sizeof(address.sun_path));
    const int connection = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
    if (connection < 0) {
        return false;
    }
    // A server whose queue is full is there too.
    const bool served =
        ::connect(connection, reinterpret_cast<const sockaddr*>(&address), sizeof(address)) == 0 || errno == EAGAIN;
    ::close(connection);
    return served;
}

} // namespace

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

bool canOpenWaylandDisplay() {
    if (!environment("WAYLAND_SOCKET").empty()) {
        return true;
    }
    const std::string name = environment("WAYLAND_DISPLAY");
    if (name.empty()) {
        return false;
    }
    return isServed(name.starts_with('/') ? name : environment("XDG_RUNTIME_DIR") + '/' + name);
}

} // namespace tvx
