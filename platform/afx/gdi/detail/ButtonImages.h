#pragma once

#include "platform/base/Types.h"

#include <QIcon>
#include <QImage>

namespace tvx::afx {

/// The pictures of a bitmap made for buttons and menus: its background, light grey (192, 192, 192) or magenta, becomes
/// transparent. Null image for a handle that is no bitmap.
[[nodiscard]] QImage buttonImages(HBITMAP bitmap);
/// Whether texts of the desktop are brighter than what they stand on.
[[nodiscard]] bool isDarkPalette();
/// An icon of such a picture. On a dark desktop what is drawn in dark greys is drawn in light ones.
[[nodiscard]] QIcon buttonIcon(const QImage& picture);
/// The whole bitmap as one picture; null icon for a handle that is none.
[[nodiscard]] QIcon buttonIcon(HBITMAP bitmap);
/// An icon of a style's sign for captions, which styles have in one dark colour. On a dark desktop it has that of
/// texts.
[[nodiscard]] QIcon signIcon(const QIcon& sign);

} // namespace tvx::afx
