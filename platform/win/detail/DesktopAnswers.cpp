#include "platform/win/detail/DesktopAnswers.h"

#include "platform/win/detail/XSession.h"

#include <algorithm>
#include <cstring>
#include <span>
#include <thread>

namespace tvx::detail {

namespace {

xcb_connection_t* xcbOf(void* connection) {
    return static_cast<xcb_connection_t*>(connection);
}

xcb_atom_t atomOf(xcb_connection_t* xcb, const char* name) {
    const auto cookie = xcb_intern_atom(xcb, 0, static_cast<std::uint16_t>(std::strlen(name)), name);
    const XReply<xcb_intern_atom_reply_t> reply(xcb_intern_atom_reply(xcb, cookie, nullptr));
    return reply ? reply->atom : xcb_atom_t{XCB_ATOM_NONE};
}

XReply<xcb_get_property_reply_t> propertyOf(xcb_connection_t* xcb, xcb_window_t window, xcb_atom_t property) {
    constexpr std::uint32_t longest = 1024; // in units of four bytes; window managers know some 80 hints
    const auto cookie = xcb_get_property(xcb, 0, window, property, XCB_GET_PROPERTY_TYPE_ANY, 0, longest);
    return XReply<xcb_get_property_reply_t>(xcb_get_property_reply(xcb, cookie, nullptr));
}

std::span<const std::uint32_t> numbersIn(const XReply<xcb_get_property_reply_t>& reply) {
    if (!reply || reply->format != 32) {
        return {};
    }
    return {static_cast<const std::uint32_t*>(xcb_get_property_value(reply.get())), reply->value_len};
}

} // namespace

DesktopAnswers::DesktopAnswers(void* connection) : m_connection(connection) {
    xcb_connection_t* xcb = xcbOf(connection);
    const xcb_screen_t& screen = *xcb_setup_roots_iterator(xcb_get_setup(xcb)).data;
    m_root = screen.root;
    m_atoms = {atomOf(xcb, "_NET_SUPPORTED"), atomOf(xcb, "_NET_SUPPORTING_WM_CHECK"),
               atomOf(xcb, "_NET_REQUEST_FRAME_EXTENTS"), atomOf(xcb, "_NET_FRAME_EXTENTS")};
    m_window = xcb_generate_id(xcb);
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_create_window(xcb, XCB_COPY_FROM_PARENT, m_window, m_root, 0, 0, 1, 1, 0, XCB_WINDOW_CLASS_INPUT_OUTPUT,
                      screen.root_visual, XCB_CW_EVENT_MASK, &events);
}

DesktopAnswers::~DesktopAnswers() {
    xcb_destroy_window(xcbOf(m_connection), m_window);
}

/// Both properties stay behind when a window manager dies; the window that the one names does not.
bool DesktopAnswers::isKnown() const {
    xcb_connection_t* xcb = xcbOf(m_connection);
    const auto check = propertyOf(xcb, m_root, m_atoms.managerCheck);
    if (numbersIn(check).empty() || numbersIn(propertyOf(xcb, numbersIn(check)[0], m_atoms.managerCheck)).empty()) {
        return false;
    }
    const auto hints = propertyOf(xcb, m_root, m_atoms.supported);
    return std::ranges::find(numbersIn(hints), m_atoms.request) != numbersIn(hints).end();
}

bool DesktopAnswers::ask() {
    if (!isKnown()) {
        return false;
    }
    xcb_client_message_event_t message{};
    message.response_type = XCB_CLIENT_MESSAGE;
    message.format = 32;
    message.window = m_window;
    message.type = m_atoms.request;
    xcb_send_event(xcbOf(m_connection), 0, m_root,
                   XCB_EVENT_MASK_SUBSTRUCTURE_REDIRECT | XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY,
                   reinterpret_cast<const char*>(&message));
    return xcb_flush(xcbOf(m_connection)) > 0;
}

std::optional<DesktopAnswers::Borders> DesktopAnswers::waitForBorders(std::chrono::milliseconds patience) {
    const auto end = std::chrono::steady_clock::now() + patience;
    if (!ask()) {
        return std::nullopt;
    }
    do {
        const auto reply = propertyOf(xcbOf(m_connection), m_window, m_atoms.borders);
        if (const auto widths = numbersIn(reply); widths.size() == 4) {
            return Borders{widths[0], widths[1], widths[2], widths[3]};
        }
        std::this_thread::sleep_for(std::chrono::milliseconds(1));
    } while (std::chrono::steady_clock::now() < end);
    return std::nullopt;
}

std::uint32_t DesktopAnswers::windowOf(const void* event) const {
    constexpr std::uint8_t sentBySomebody = 0x80;
    const auto& changed = *static_cast<const xcb_property_notify_event_t*>(event);
    const bool tells =
        (changed.response_type & ~sentBySomebody) == XCB_PROPERTY_NOTIFY && changed.atom == m_atoms.borders;
    return tells ? changed.window : 0;
}

} // namespace tvx::detail
