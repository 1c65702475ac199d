#include "s/KeyIndex.h"

#include <algorithm>
#include <memory>

std::vector<Gui_Accel> AccelsOf(const Gui_AccelMap& map) {
    int count = 0;
    tagACCEL* table = nullptr;
    map.GetAll(count, table);
    const std::unique_ptr<tagACCEL[]> owner(table);
    return tvx::allocating([&] { return std::vector<Gui_Accel>(table, table + count); });
}

KeyIndex::KeyIndex(const Gui_AccelMap& map) : m_accels(AccelsOf(map)) {
    // They come by their keys, which remains the order within a command.
    std::stable_sort(m_accels.begin(), m_accels.end(),
                     [](const Gui_Accel& first, const Gui_Accel& second) { return first.cmd < second.cmd; });
}

std::span<const Gui_Accel> KeyIndex::keysOf(UINT command) const {
    const auto before = [](const Gui_Accel& accel, UINT wanted) { return accel.cmd < wanted; };
    const auto first = std::lower_bound(m_accels.begin(), m_accels.end(), command, before);
    auto last = first;
    while (last != m_accels.end() && last->cmd == command) {
        ++last;
    }
    return {first, last};
}
