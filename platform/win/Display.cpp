#include "platform/win/Display.h"

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

} // namespace tvx
