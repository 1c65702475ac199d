#include "platform/win/Desktop.h"

#include "platform/win/Process.h"
#include "platform/win/detail/XSession.h"

#include <unistd.h>

#include <algorithm>
#include <array>
#include <optional>
#include <string_view>

namespace tvx::desktop {

using detail::XConnection;
using detail::XReply;
using detail::XSession;

namespace {

constexpr std::chrono::milliseconds patience{200};
// The number of WM_STATE for windows that are not shown, and of the request to become one (window-manager
// conventions, 4.1.4).
constexpr std::uint32_t iconicState = 3;

std::string hostName() {
    std::array<char, 256> name{};
    return gethostname(name.data(), name.size() - 1) == 0 ? name.data() : "";
}

DWORD processOf(XConnection& x, WindowId window) {
    static const std::string here = hostName();
    std::string machine = x.text(window, XCB_ATOM_WM_CLIENT_MACHINE);
    machine.resize(std::min(machine.find('\0'), machine.size()));
    return machine.empty() || machine == here ? x.number(window, x.ewmh()->_NET_WM_PID) : 0;
}

bool isTopLevel(XConnection& x, WindowId window) {
    const auto cookie = xcb_get_window_attributes(x.xcb(), window);
    const XReply<xcb_get_window_attributes_reply_t> found(xcb_get_window_attributes_reply(x.xcb(), cookie, nullptr));
    return found && found->_class == XCB_WINDOW_CLASS_INPUT_OUTPUT && window != x.root() &&
           (!x.text(window, x.atom("WM_STATE")).empty() || !x.text(window, XCB_ATOM_WM_CLASS).empty());
}

bool isForeign(XConnection& x, WindowId window) {
    return window != 0 && isTopLevel(x, window) && processOf(x, window) != GetCurrentProcessId();
}

/// Whether the window manager has put all of these states on the window.
bool hasStates(XConnection& x, WindowId window, std::initializer_list<xcb_atom_t> wanted) {
    xcb_ewmh_get_atoms_reply_t states;
    if (xcb_ewmh_get_wm_state_reply(x.ewmh(), xcb_ewmh_get_wm_state(x.ewmh(), window), &states, nullptr) == 0) {
        return false;
    }
    const bool has = std::ranges::all_of(wanted, [&](xcb_atom_t state) {
        return std::find(states.atoms, states.atoms + states.atoms_len, state) != states.atoms + states.atoms_len;
    });
    xcb_ewmh_get_atoms_reply_wipe(&states);
    return has;
}

/// The virtual desktop to go to for a window; none when it is on the current one, on all, or nobody has told.
std::optional<std::uint32_t> otherDesktopOf(XConnection& x, WindowId window) {
    constexpr std::uint32_t all = 0xFFFFFFFF;
    const auto own = x.optionalNumber(window, x.ewmh()->_NET_WM_DESKTOP);
    const auto current = x.optionalNumber(x.root(), x.ewmh()->_NET_CURRENT_DESKTOP);
    return own && current && own != all && own != current ? own : std::nullopt;
}

bool isIconic(XConnection& x, WindowId window) {
    // Some window managers give the windows of other desktops the state of minimised ones.
    return hasStates(x, window, {x.ewmh()->_NET_WM_STATE_HIDDEN}) ||
           (x.number(window, x.atom("WM_STATE")) == iconicState && !otherDesktopOf(x, window));
}

bool isMaximized(XConnection& x, WindowId window) {
    return hasStates(x, window, {x.ewmh()->_NET_WM_STATE_MAXIMIZED_HORZ, x.ewmh()->_NET_WM_STATE_MAXIMIZED_VERT});
}

WindowId activeWindow(XConnection& x) {
    return x.number(x.root(), x.ewmh()->_NET_ACTIVE_WINDOW);
}

bool isManaged(XConnection& x) {
    return x.number(x.root(), x.ewmh()->_NET_SUPPORTING_WM_CHECK) != 0;
}

/// Without a window manager every client may do it itself.
void raiseAlone(XConnection& x, WindowId window) {
    const std::uint32_t above = XCB_STACK_MODE_ABOVE;
    xcb_map_window(x.xcb(), window);
    xcb_configure_window(x.xcb(), window, XCB_CONFIG_WINDOW_STACK_MODE, &above);
    xcb_set_input_focus(x.xcb(), XCB_INPUT_FOCUS_PARENT, window, XCB_CURRENT_TIME);
    xcb_flush(x.xcb());
}

/// Requests go to the window manager as messages of the root window.
void request(XConnection& x, WindowId window, xcb_atom_t type, std::uint32_t value) {
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = window;
    message.type = type;
    message.data.data32[0] = value;
    xcb_send_event(x.xcb(), 0, x.root(), XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY,
                   reinterpret_cast<const char*>(&message));
    xcb_flush(x.xcb());
}

void changeStates(XConnection& x, WindowId window, xcb_ewmh_wm_state_action_t action, xcb_atom_t first,
                  xcb_atom_t second) {
    xcb_ewmh_request_change_wm_state(x.ewmh(), x.screen(), window, action, first, second,
                                     XCB_EWMH_CLIENT_SOURCE_TYPE_OTHER);
    xcb_flush(x.xcb());
}

/// Lists the windows, the topmost last.
std::vector<WindowId> managedWindows(XConnection& x) {
    xcb_ewmh_get_windows_reply_t list;
    const auto cookie = xcb_ewmh_get_client_list_stacking(x.ewmh(), x.screen());
    if (xcb_ewmh_get_client_list_stacking_reply(x.ewmh(), cookie, &list, nullptr) == 0) {
        return {};
    }
    std::vector<WindowId> result(list.windows, list.windows + list.windows_len);
    xcb_ewmh_get_windows_reply_wipe(&list);
    return result;
}

} // namespace

bool exists(WindowId window) {
    const XSession x;
    return x && isForeign(*x, window);
}

bool isIconic(WindowId window) {
    const XSession x;
    return x && isForeign(*x, window) && isIconic(*x, window);
}

bool isMaximized(WindowId window) {
    const XSession x;
    return x && isForeign(*x, window) && isMaximized(*x, window);
}

WindowId ownerOf(WindowId window) {
    const XSession x;
    if (!x || !isForeign(*x, window)) {
        return 0;
    }
    // Dialogs of a whole application name the root window.
    const WindowId owner = x->number(window, XCB_ATOM_WM_TRANSIENT_FOR);
    return owner != x->root() ? owner : 0;
}

std::string classNameOf(WindowId window) {
    const XSession x;
    if (!x || !isForeign(*x, window)) {
        return {};
    }
    // Two texts, each ended by a zero: the instance's name and the class.
    const std::string names = x->text(window, XCB_ATOM_WM_CLASS);
    const std::size_t first = names.find('\0');
    return first < names.size() ? std::string(names.c_str() + first + 1) : names;
}

DWORD processOf(WindowId window) {
    const XSession x;
    return x && isForeign(*x, window) ? processOf(*x, window) : 0;
}

WindowId active() {
    const XSession x;
    if (!x) {
        return 0;
    }
    const WindowId window = activeWindow(*x);
    return isForeign(*x, window) ? window : 0;
}

std::vector<WindowId> windows() {
    const XSession x;
    if (!x) {
        return {};
    }
    std::vector<WindowId> result = managedWindows(*x);
    std::erase_if(result, [&](WindowId window) { return !isForeign(*x, window); });
    std::ranges::reverse(result);
    return result;
}

bool activate(WindowId window) {
    const XSession x;
    if (!x || !isForeign(*x, window)) {
        return false;
    }
    if (!isManaged(*x)) {
        raiseAlone(*x, window);
        return true;
    }
    if (const auto other = otherDesktopOf(*x, window)) {
        xcb_ewmh_request_change_current_desktop(x->ewmh(), x->screen(), *other, x->now());
    }
    // As a task list does it: the user has asked for this window, so nothing that looks like stolen focus is refused.
    xcb_ewmh_request_change_active_window(x->ewmh(), x->screen(), window, XCB_EWMH_CLIENT_SOURCE_TYPE_OTHER, x->now(),
                                          XCB_WINDOW_NONE);
    const bool done =
        x->await({x->root(), window}, patience, [&] { return activeWindow(*x) == window && !isIconic(*x, window); });
    if (!done) {
        changeStates(*x, window, XCB_EWMH_WM_STATE_ADD, x->ewmh()->_NET_WM_STATE_DEMANDS_ATTENTION, XCB_ATOM_NONE);
    }
    return done;
}

void minimize(WindowId window) {
    const XSession x;
    if (x && isForeign(*x, window)) {
        request(*x, window, x->atom("WM_CHANGE_STATE"), iconicState);
    }
}

void setExtent(WindowId window, Extent extent) {
    const XSession x;
    if (x && isForeign(*x, window)) {
        changeStates(*x, window, extent == Extent::Maximized ? XCB_EWMH_WM_STATE_ADD : XCB_EWMH_WM_STATE_REMOVE,
                     x->ewmh()->_NET_WM_STATE_MAXIMIZED_VERT, x->ewmh()->_NET_WM_STATE_MAXIMIZED_HORZ);
    }
}

} // namespace tvx::desktop
