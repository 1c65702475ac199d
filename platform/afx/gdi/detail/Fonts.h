#pragma once

#include "platform/afx/gdi/GdiTypes.h"
#include "platform/afx/gdi/detail/Advances.h"
#include "platform/base/Export.h"

#include <QFont>
#include <QFontMetrics>
#include <QSize>

#include <memory>
#include <string_view>

/// @file
/// Font descriptions made into fonts. All of them have full hinting, no kerning and no ligatures: advances are then
/// whole pixels, text drawn piece by piece equals text drawn as a whole, and what is measured is what is drawn.

namespace tvx::afx {

/// A font as one context draws with it, in device pixels.
struct RealizedFont {
    explicit RealizedFont(const QFont& font) : font(font), metrics(font), advances(QFontMetricsF(font)) {}
    QFont font;
    QFontMetrics metrics;
    Advances advances;
    double angle = 0; ///< of the base line in degrees, counter-clockwise
};

/// The installed family that stands for a face name, chosen by pitch and family bits when the name is empty or unknown.
[[nodiscard]] TVX_PLATFORM_API QString familyFor(std::string_view faceName, BYTE pitchAndFamily);
/// Whether a face stands for that of labels and dialogs ("MS Shell Dlg" and its like) and is not itself installed.
[[nodiscard]] bool isInterfaceFace(std::string_view faceName);

/// The font for a description whose height and width are in device pixels. Fonts are kept: asking again is cheap.
/// Null without a connection to the desktop.
[[nodiscard]] TVX_PLATFORM_API std::shared_ptr<const RealizedFont> realizeFont(const LOGFONTA& description);

/// What a toolkit control draws with when it is given this font.
[[nodiscard]] TVX_PLATFORM_API QFont controlFont(const LOGFONTA& description);

/// The description of a dialog's or the default font: 8 points are 11 pixels.
[[nodiscard]] TVX_PLATFORM_API LOGFONTA pointFont(int tenthsOfPoint, std::string_view faceName);

/// The description of a font of the toolkit's, for characters of this height in pixels.
[[nodiscard]] TVX_PLATFORM_API LOGFONT describeFont(const QFont& font, int height);

/// The size of 4 by 8 dialog units in pixels, for a font: half its average letter's width, and its height.
[[nodiscard]] TVX_PLATFORM_API QSize dialogBaseUnits(const QFont& font);

} // namespace tvx::afx
