#pragma once

#include "platform/win/Picture.h"

namespace tvx::detail {

/// What the pixels of a device-independent bitmap belong to: an icon's or cursor's are followed by a mask of one bit a
/// pixel, and their header counts both heights together.
enum class DibUse { Bitmap, IconImage };

/// Decodes a device-independent bitmap without file header, every bound checked.
[[nodiscard]] ResourceResult<Picture> decodeDib(ResourceBytes data, DibUse use);

} // namespace tvx::detail
