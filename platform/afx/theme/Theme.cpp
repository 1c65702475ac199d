/// @file
/// The visual-styles module: what hosts find in it by name.
///
///     const HMODULE module = LoadLibraryA("uxtheme");
///     const auto isThemed = reinterpret_cast<BOOL (*)()>(GetProcAddress(module, "IsAppThemed"));
///
/// It knows parts of the class "WINDOW" only, and is used on the thread of the user interface.

#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/theme/detail/StyleParts.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <memory>
#include <vector>

namespace {

using tvx::afx::StyleParts;
using HTHEME = void*;

constexpr LONG ok = 0;
constexpr auto invalidHandle = static_cast<LONG>(0x80070006);
constexpr auto invalidArgument = static_cast<LONG>(0x80070057);

/// The data that were opened and not closed yet.
std::vector<std::unique_ptr<StyleParts>>& opened() {
    static std::vector<std::unique_ptr<StyleParts>> themes;
    return themes;
}

auto find(HTHEME theme) {
    return std::ranges::find(opened(), theme, [](const auto& owned) -> HTHEME { return owned.get(); });
}

const StyleParts* partsOf(HTHEME theme) {
    const auto found = find(theme);
    return found == opened().end() ? nullptr : found->get();
}

} // namespace

#define TVX_ENTRY_POINT extern "C" __attribute__((visibility("default")))

/// Whether the desktop has visual styles: always, where it can show windows.
TVX_ENTRY_POINT BOOL IsThemeActive() {
    return tvx::afx::ensureGui() ? TRUE : FALSE;
}

/// Whether the application's style draws the parts that this module offers.
TVX_ENTRY_POINT BOOL IsAppThemed() {
    return tvx::afx::ensureGui() && StyleParts::exist() ? TRUE : FALSE;
}

/// The data of a class of parts for a window; null when they are none. They follow the style that the application has
/// now: after a change they are to be closed and opened again.
TVX_ENTRY_POINT HTHEME OpenThemeData(HWND window, LPCSTR classes) {
    if (!classes || !tvx::text::equalNoCase(classes, "WINDOW") || !IsAppThemed()) {
        return nullptr;
    }
    return opened().emplace_back(std::make_unique<StyleParts>(window)).get();
}

TVX_ENTRY_POINT LONG CloseThemeData(HTHEME theme) {
    const auto found = find(theme);
    if (found == opened().end()) {
        return invalidHandle;
    }
    opened().erase(found);
    return ok;
}

/// A system colour (COLOR_...) as the style has it; the system's own without data.
TVX_ENTRY_POINT COLORREF GetThemeSysColor(HTHEME theme, int index) {
    const StyleParts* parts = partsOf(theme);
    return parts ? parts->color(index) : GetSysColor(index);
}

/// A system metric (SM_...), in pixels. The style's sizes are the system's, but for the height of caption buttons: the
/// room that they are centred in is the whole caption.
TVX_ENTRY_POINT int GetThemeSysSize(HTHEME, int index) {
    return GetSystemMetrics(index == SM_CYSIZE ? SM_CYCAPTION : index);
}

/// Draws a part: 15 or 16, the buttons that minimise in captions and in menu bars.
/// @param place where, in logical units
/// @param clip  draws nothing outside; null for no limit
TVX_ENTRY_POINT LONG DrawThemeBackground(HTHEME theme, HDC dc, int part, int state, const RECT* place,
                                         const RECT* clip) {
    const StyleParts* parts = partsOf(theme);
    if (!parts) {
        return invalidHandle;
    }
    return place && parts->draw(dc, part, state, *place, clip) ? ok : invalidArgument;
}
