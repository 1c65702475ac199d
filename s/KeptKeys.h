#pragma once

#include "s/AccelMap.h"

#include <string_view>

/// The text in which a user's keys are kept (Gui_AccelProfile tells its form).

/// Puts kept keys over the application's own ones in a map. Lines that are not understood are passed over.
void ApplyKeptKeys(std::string_view text, Gui_AccelMap& map);
/// The text that makes the user's keys of the application's own; empty where they are the same.
[[nodiscard]] CString KeptKeysText(const Gui_AccelMap& map, const Gui_AccelMap& own);
