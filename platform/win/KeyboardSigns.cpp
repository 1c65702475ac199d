#include "platform/win/KeyboardSigns.h"

#include "platform/win/detail/XSession.h"

#include <cstdint>
#include <cstring>
#include <dlfcn.h>
#include <span>
#include <string_view>
#include <utility>

namespace tvx {

namespace {

constexpr std::pair<std::uint32_t, char32_t> deadKeys[] = {
    {0xFE50, U'`'}, {0xFE51, U'´'}, {0xFE52, U'^'}, {0xFE53, U'~'}, {0xFE54, U'¯'}, {0xFE55, U'˘'},
    {0xFE56, U'˙'}, {0xFE57, U'¨'}, {0xFE58, U'°'}, {0xFE59, U'˝'}, {0xFE5A, U'ˇ'}, {0xFE5B, U'¸'},
};

/// The display numbers the signs of older alphabets in a way of its own. The table is in a library that the toolkit
/// uses with every display, so it is there when it is wanted.
char32_t oldSign(std::uint32_t symbol) {
    using Convert = std::uint32_t (*)(std::uint32_t);
    static const auto convert = [] {
        void* library = ::dlopen("libxkbcommon.so.0", RTLD_NOW | RTLD_LOCAL);
        return library ? reinterpret_cast<Convert>(::dlsym(library, "xkb_keysym_to_utf32")) : nullptr;
    }();
    return convert ? static_cast<char32_t>(convert(symbol)) : 0;
}

char32_t signOf(std::uint32_t symbol) {
    if ((symbol >= 0x20 && symbol <= 0x7E) || (symbol >= 0xA0 && symbol <= 0xFF)) {
        return symbol;
    }
    for (const auto& [dead, sign] : deadKeys) {
        if (dead == symbol) {
            return sign;
        }
    }
    const char32_t sign = symbol != 0 ? oldSign(symbol) : 0;
    return sign > 0x20 && sign != 0x7F ? sign : 0; // some keys have control characters
}

/// The number that the display gave to the first event of its keyboard extension; 0 where it has none.
std::uint8_t firstKeyboardEvent() {
    const detail::XSession session;
    if (!session) {
        return 0;
    }
    constexpr std::string_view name = "XKEYBOARD";
    const detail::XReply<xcb_query_extension_reply_t> reply(xcb_query_extension_reply(
        session->xcb(), xcb_query_extension(session->xcb(), name.size(), name.data()), nullptr));
    return reply && reply->present != 0 ? reply->first_event : 0;
}

} // namespace

std::vector<std::array<KeySigns, 2>> keyboardSigns() {
    const detail::XSession session;
    if (!session) {
        return {};
    }
    const xcb_setup_t* setup = xcb_get_setup(session->xcb());
    const std::size_t first = setup->min_keycode;
    const std::size_t count = setup->max_keycode - first + 1U;
    const detail::XReply<xcb_get_keyboard_mapping_reply_t> reply(xcb_get_keyboard_mapping_reply(
        session->xcb(), xcb_get_keyboard_mapping(session->xcb(), setup->min_keycode, static_cast<std::uint8_t>(count)),
        nullptr));
    if (!reply || reply->keysyms_per_keycode < 2) {
        return {};
    }
    const std::size_t width = reply->keysyms_per_keycode;
    const std::span symbols(xcb_get_keyboard_mapping_keysyms(reply.get()), width * count);
    std::vector<std::array<KeySigns, 2>> keys(first + count);
    for (std::size_t key = 0; key < count; ++key) {
        // A layout's symbols come in pairs: without and with Shift.
        const auto layout = [&, row = symbols.subspan(key * width, width)](std::size_t at) {
            return KeySigns{signOf(row[at]), signOf(row[at + 1])};
        };
        keys[first + key] = {layout(0), layout(width >= 4 ? 2 : 0)};
    }
    return keys;
}

bool isKeyboardChange(const void* event) {
    static const std::uint8_t first = firstKeyboardEvent();
    constexpr std::uint8_t sent = 0x80; // by another program
    const auto* bytes = static_cast<const std::uint8_t*>(event);
    const std::uint8_t type = bytes[0] & static_cast<std::uint8_t>(~sent);
    // The extension's events share one number; 0 is another keyboard, 1 another map.
    return type == XCB_MAPPING_NOTIFY || (first != 0 && type == first && bytes[1] <= 1);
}

} // namespace tvx
