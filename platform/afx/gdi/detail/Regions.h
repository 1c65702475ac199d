#pragma once

#include "platform/afx/gdi/detail/Raster.h"

#include <QRegion>

namespace tvx::afx {

/// NULLREGION, SIMPLEREGION or COMPLEXREGION.
[[nodiscard]] int regionKind(const QRegion& region);
[[nodiscard]] QRegion regionOf(const Spans& spans);
/// Two regions combined by RGN_...; RGN_COPY is the first.
[[nodiscard]] QRegion combined(const QRegion& first, const QRegion& second, int mode);

} // namespace tvx::afx
