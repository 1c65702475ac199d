#pragma once

#include <xcb/xcb.h>
#include <xcb/xcb_ewmh.h>

#include <chrono>
#include <cstdlib>
#include <functional>
#include <initializer_list>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

namespace tvx::detail {

/// Replies and events are the caller's and come from `malloc`.
struct FreeReply {
    void operator()(void* reply) const {
        std::free(reply);
    }
};
template <class T>
using XReply = std::unique_ptr<T, FreeReply>;

/// The connection to the X display that the environment names, kept from the first question on, because making one
/// costs as much as twenty questions.
class XConnection {
public:
    explicit XConnection(std::string display);
    ~XConnection();
    XConnection(const XConnection&) = delete;
    XConnection& operator=(const XConnection&) = delete;

    [[nodiscard]] bool works() const {
        return m_ready && xcb_connection_has_error(m_xcb) == 0;
    }
    [[nodiscard]] const std::string& display() const {
        return m_display;
    }
    [[nodiscard]] xcb_connection_t* xcb() const {
        return m_xcb;
    }
    [[nodiscard]] xcb_ewmh_connection_t* ewmh() {
        return &m_ewmh;
    }
    [[nodiscard]] int screen() const {
        return m_screen;
    }
    [[nodiscard]] xcb_window_t root() const;
    /// The atom of a name that the protocol does not number itself.
    [[nodiscard]] xcb_atom_t atom(const char* name) const;

    /// The first 32-bit number of a property, 0 when the window or the property is missing.
    [[nodiscard]] std::uint32_t number(xcb_window_t window, xcb_atom_t property) const;
    /// The same, where 0 is a number like others.
    [[nodiscard]] std::optional<std::uint32_t> optionalNumber(xcb_window_t window, xcb_atom_t property) const;
    /// The bytes of a property, up to 1 KiB.
    [[nodiscard]] std::string text(xcb_window_t window, xcb_atom_t property) const;
    /// The display's time at this moment. Window managers refuse requests that seem older than what the user did last.
    [[nodiscard]] xcb_timestamp_t now();
    /// Looks again whenever a property of one of the windows changes, until `holds` or the time is over.
    bool await(std::initializer_list<xcb_window_t> windows, std::chrono::milliseconds longest,
               const std::function<bool()>& holds);

private:
    bool waitForEvent(std::chrono::steady_clock::time_point end);
    void listen(std::initializer_list<xcb_window_t> windows, std::uint32_t events);

    std::string m_display;
    int m_screen = 0;
    xcb_connection_t* m_xcb;
    xcb_ewmh_connection_t m_ewmh{};
    bool m_ready = false;
};

/// The use of the connection for one question: one thread at a time. False when no display answers.
class XSession {
public:
    XSession();

    explicit operator bool() const {
        return m_connection != nullptr;
    }
    XConnection* operator->() const {
        return m_connection;
    }
    XConnection& operator*() const {
        return *m_connection;
    }

private:
    std::unique_lock<std::mutex> m_lock;
    XConnection* m_connection = nullptr;
};

} // namespace tvx::detail
