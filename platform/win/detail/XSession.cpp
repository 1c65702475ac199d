#include "platform/win/detail/XSession.h"

#include <poll.h>

#include <algorithm>
#include <cstring>

namespace tvx::detail {

XConnection::XConnection(std::string display)
    : m_display(std::move(display)), m_xcb(xcb_connect(m_display.c_str(), &m_screen)) {
    if (xcb_connection_has_error(m_xcb) == 0) {
        m_ready = xcb_ewmh_init_atoms_replies(&m_ewmh, xcb_ewmh_init_atoms(m_xcb, &m_ewmh), nullptr) != 0;
    }
}

XConnection::~XConnection() {
    if (m_ready) {
        xcb_ewmh_connection_wipe(&m_ewmh);
    }
    xcb_disconnect(m_xcb);
}

xcb_window_t XConnection::root() const {
    return m_ewmh.screens[m_screen]->root;
}

xcb_atom_t XConnection::atom(const char* name) const {
    const auto cookie = xcb_intern_atom(m_xcb, 0, static_cast<std::uint16_t>(std::strlen(name)), name);
    const XReply<xcb_intern_atom_reply_t> reply(xcb_intern_atom_reply(m_xcb, cookie, nullptr));
    return reply ? reply->atom : xcb_atom_t{XCB_ATOM_NONE};
}

std::uint32_t XConnection::number(xcb_window_t window, xcb_atom_t property) const {
    return optionalNumber(window, property).value_or(0);
}

std::optional<std::uint32_t> XConnection::optionalNumber(xcb_window_t window, xcb_atom_t property) const {
    const std::string bytes = text(window, property);
    std::uint32_t value = 0;
    if (bytes.size() < sizeof value) {
        return std::nullopt;
    }
    std::memcpy(&value, bytes.data(), sizeof value);
    return value;
}

std::string XConnection::text(xcb_window_t window, xcb_atom_t property) const {
    constexpr std::uint32_t mostWords = 256;
    const auto cookie = xcb_get_property(m_xcb, 0, window, property, XCB_GET_PROPERTY_TYPE_ANY, 0, mostWords);
    const XReply<xcb_get_property_reply_t> reply(xcb_get_property_reply(m_xcb, cookie, nullptr));
    if (!reply) {
        return {};
    }
    const auto* bytes = static_cast<const char*>(xcb_get_property_value(reply.get()));
    return {bytes, static_cast<std::size_t>(xcb_get_property_value_length(reply.get()))};
}

xcb_timestamp_t XConnection::now() {
    // Adding nothing to a property changes nothing, but the display tells when.
    const xcb_window_t window = xcb_generate_id(m_xcb);
    const std::uint32_t events = XCB_EVENT_MASK_PROPERTY_CHANGE;
    xcb_create_window(m_xcb, XCB_COPY_FROM_PARENT, window, root(), 0, 0, 1, 1, 0, XCB_WINDOW_CLASS_INPUT_ONLY,
                      XCB_COPY_FROM_PARENT, XCB_CW_EVENT_MASK, &events);
    xcb_change_property(m_xcb, XCB_PROP_MODE_APPEND, window, XCB_ATOM_WM_NAME, XCB_ATOM_STRING, 8, 0, nullptr);
    xcb_destroy_window(m_xcb, window);
    xcb_flush(m_xcb);
    while (const XReply<xcb_generic_event_t> event{xcb_wait_for_event(m_xcb)}) {
        const auto* change = reinterpret_cast<const xcb_property_notify_event_t*>(event.get());
        if ((event->response_type & 0x7F) == XCB_PROPERTY_NOTIFY && change->window == window) {
            return change->time;
        }
    }
    return XCB_CURRENT_TIME;
}

bool XConnection::await(std::initializer_list<xcb_window_t> windows, std::chrono::milliseconds longest,
                        const std::function<bool()>& holds) {
    const auto end = std::chrono::steady_clock::now() + longest;
    listen(windows, XCB_EVENT_MASK_PROPERTY_CHANGE);
    bool held = holds();
    while (!held && waitForEvent(end)) {
        held = holds();
    }
    listen(windows, XCB_EVENT_MASK_NO_EVENT);
    return held;
}

bool XConnection::waitForEvent(std::chrono::steady_clock::time_point end) {
    using std::chrono::milliseconds;
    bool any = false;
    for (;;) {
        while (const XReply<xcb_generic_event_t> event{xcb_poll_for_event(m_xcb)}) {
            any = true;
        }
        const auto left = std::chrono::ceil<milliseconds>(end - std::chrono::steady_clock::now());
        if (any || left <= milliseconds::zero() || xcb_connection_has_error(m_xcb) != 0) {
            return any;
        }
        pollfd waiting{xcb_get_file_descriptor(m_xcb), POLLIN, 0};
        poll(&waiting, 1, static_cast<int>(left.count()));
    }
}

void XConnection::listen(std::initializer_list<xcb_window_t> windows, std::uint32_t events) {
    for (const xcb_window_t window : windows) {
        xcb_change_window_attributes(m_xcb, window, XCB_CW_EVENT_MASK, &events);
    }
    xcb_flush(m_xcb);
}

namespace {

std::mutex& connectionMutex() {
    static std::mutex mutex;
    return mutex;
}

// The kept connection, made anew when the display has gone or the environment names another one.
XConnection* connection() {
    static std::unique_ptr<XConnection> kept;
    const char* display = std::getenv("DISPLAY");
    if (!display || *display == '\0') {
        return nullptr;
    }
    if (!kept || !kept->works() || kept->display() != display) {
        kept = std::make_unique<XConnection>(display);
    }
    return kept->works() ? kept.get() : nullptr;
}

} // namespace

XSession::XSession() : m_lock(connectionMutex()), m_connection(connection()) {}

} // namespace tvx::detail
