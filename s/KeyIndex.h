#pragma once

#include "s/AccelMap.h"

#include <span>
#include <vector>

/// All accelerators of a map, in the order of Gui_AccelMap::GetAll.
[[nodiscard]] std::vector<Gui_Accel> AccelsOf(const Gui_AccelMap& map);

/// The accelerators of a map by their commands. The map is a table by keys: whoever asks for the keys of each command
/// of a menu makes an index once.
class KeyIndex {
public:
    /// Changes of the map do not show later.
    explicit KeyIndex(const Gui_AccelMap& map);

    /// The keys of a command, in the order of Gui_AccelMap::GetAccelAt.
    [[nodiscard]] std::span<const Gui_Accel> keysOf(UINT command) const;

private:
    std::vector<Gui_Accel> m_accels;
};
