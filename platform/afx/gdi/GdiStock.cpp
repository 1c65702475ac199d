#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QApplication>
#include <QPalette>

#include <array>

using namespace tvx::afx;

namespace {

constexpr int stockCount = DEFAULT_GUI_FONT + 1;
using StockTable = std::array<HGDIOBJ, stockCount>;

HGDIOBJ stockBrush(UINT style, COLORREF color) {
    BrushObject brush;
    brush.description = {style, color, 0};
    return addGdiObject(std::move(brush), GdiOwner::Stock);
}

HGDIOBJ stockPen(UINT style, COLORREF color) {
    return addGdiObject(PenObject{{style, {0, 0}, color}}, GdiOwner::Stock);
}

HGDIOBJ stockFont(LOGFONT description, BYTE pitchAndFamily) {
    description.lfPitchAndFamily = pitchAndFamily;
    return addGdiObject(FontObject{description}, GdiOwner::Stock);
}

StockTable makeStock() {
    StockTable table{};
    table[WHITE_BRUSH] = stockBrush(BS_SOLID, RGB(255, 255, 255));
    table[LTGRAY_BRUSH] = stockBrush(BS_SOLID, RGB(192, 192, 192));
    table[GRAY_BRUSH] = stockBrush(BS_SOLID, RGB(128, 128, 128));
    table[DKGRAY_BRUSH] = stockBrush(BS_SOLID, RGB(64, 64, 64));
    table[BLACK_BRUSH] = stockBrush(BS_SOLID, RGB(0, 0, 0));
    table[NULL_BRUSH] = stockBrush(BS_NULL, 0);
    table[WHITE_PEN] = stockPen(PS_SOLID, RGB(255, 255, 255));
    table[BLACK_PEN] = stockPen(PS_SOLID, RGB(0, 0, 0));
    table[NULL_PEN] = stockPen(PS_NULL, 0);
    constexpr int points = 80;
    constexpr BYTE fixedPitch = FIXED_PITCH | FF_MODERN;
    constexpr BYTE variable = VARIABLE_PITCH | FF_SWISS;
    table[OEM_FIXED_FONT] = stockFont(pointFont(90, "Terminal"), fixedPitch);
    table[ANSI_FIXED_FONT] = stockFont(pointFont(90, "Courier"), fixedPitch);
    table[SYSTEM_FIXED_FONT] = stockFont(pointFont(90, "FixedSys"), fixedPitch);
    table[ANSI_VAR_FONT] = stockFont(pointFont(points, "MS Sans Serif"), variable);
    table[DEFAULT_GUI_FONT] = stockFont(pointFont(points, "MS Shell Dlg"), variable);
    LOGFONT system = pointFont(points, "System");
    // A positive height is that of the cell, not of the characters in it.
    system.lfHeight = 16;
    table[SYSTEM_FONT] = stockFont(system, variable);
    table[DEVICE_DEFAULT_FONT] = table[SYSTEM_FONT];
    return table;
}

} // namespace

HGDIOBJ GetStockObject(int index) {
    static const StockTable table = makeStock();
    return index >= 0 && index < stockCount ? table[static_cast<std::size_t>(index)] : nullptr;
}

namespace {

struct PaletteColor {
    QPalette::ColorGroup group;
    QPalette::ColorRole role;
};

constexpr PaletteColor active(QPalette::ColorRole role) {
    return {QPalette::Active, role};
}

/// Where each system colour is found in the toolkit's palette, so that what hosts draw fits the controls beside it. A
/// caption is drawn in the highlight colours while active and in window colours while not.
constexpr PaletteColor systemColors[] = {
    active(QPalette::Button),               // COLOR_SCROLLBAR
    active(QPalette::Dark),                 // COLOR_BACKGROUND
    active(QPalette::Highlight),            // COLOR_ACTIVECAPTION
    {QPalette::Inactive, QPalette::Window}, // COLOR_INACTIVECAPTION
    active(QPalette::Window),               // COLOR_MENU
    active(QPalette::Base),                 // COLOR_WINDOW
    active(QPalette::Shadow),               // COLOR_WINDOWFRAME
    active(QPalette::WindowText),           // COLOR_MENUTEXT
    active(QPalette::Text),                 // COLOR_WINDOWTEXT
    active(QPalette::HighlightedText),      // COLOR_CAPTIONTEXT
    active(QPalette::Window),               // COLOR_ACTIVEBORDER
    active(QPalette::Window),               // COLOR_INACTIVEBORDER
    active(QPalette::Dark),                 // COLOR_APPWORKSPACE
    active(QPalette::Highlight),            // COLOR_HIGHLIGHT
    active(QPalette::HighlightedText),      // COLOR_HIGHLIGHTTEXT
    active(QPalette::Window),               // COLOR_BTNFACE
    active(QPalette::Dark),                 // COLOR_BTNSHADOW
    {QPalette::Disabled, QPalette::Text},   // COLOR_GRAYTEXT
    active(QPalette::ButtonText),           // COLOR_BTNTEXT
    {QPalette::Inactive, QPalette::Text},   // COLOR_INACTIVECAPTIONTEXT
    active(QPalette::Light),                // COLOR_BTNHIGHLIGHT
    active(QPalette::Shadow),               // COLOR_3DDKSHADOW
    active(QPalette::Midlight),             // COLOR_3DLIGHT
    active(QPalette::ToolTipText),          // COLOR_INFOTEXT
    active(QPalette::ToolTipBase),          // COLOR_INFOBK
    active(QPalette::Button),               // 25 is not in use
    active(QPalette::Link),                 // COLOR_HOTLIGHT
};

bool isSystemColor(int index) {
    return index >= 0 && index < static_cast<int>(std::size(systemColors));
}

} // namespace

COLORREF GetSysColor(int index) {
    if (!isSystemColor(index)) {
        return 0;
    }
    const PaletteColor& place = systemColors[index];
    const QColor color =
        // Without a display the palette is made of the window colour of the toolkit's own style.
        (ensureGui() ? QApplication::palette() : QPalette(QColor(0xEF, 0xEF, 0xEF))).color(place.group, place.role);
    return RGB(color.red(), color.green(), color.blue());
}

HBRUSH GetSysColorBrush(int index) {
    static const auto brushes = [] {
        std::array<HGDIOBJ, std::size(systemColors)> table{};
        for (std::size_t i = 0; i < table.size(); ++i) {
            BrushObject brush;
            brush.description = {static_cast<UINT>(BS_SOLID), GetSysColor(static_cast<int>(i)), 0};
            // The colour described is that of this moment; drawing looks the number up again, as the palette may
            // change.
            brush.systemColor = static_cast<int>(i);
            table[i] = addGdiObject(std::move(brush), GdiOwner::Stock);
        }
        return table;
    }();
    return isSystemColor(index) ? static_cast<HBRUSH>(brushes[static_cast<std::size_t>(index)]) : nullptr;
}
