#pragma once

namespace tvx::afx {

/// The SB_... code of WM_HSCROLL and WM_VSCROLL for what the user did to a bar.
/// @param action  the toolkit's QAbstractSlider::SliderAction
[[nodiscard]] int scrollCodeOf(int action);

} // namespace tvx::afx
