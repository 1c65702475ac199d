#include "KeyDifferences.h"

#include <memory>

namespace {

/// The keys of `one` that mean another command in `other`.
/// @param missing counts those only that mean none there
int countOneWay(const Gui_AccelMap& one, const Gui_AccelMap& other, bool missing) {
    int count = 0;
    tagACCEL* table = nullptr;
    one.GetAll(count, table);
    const std::unique_ptr<tagACCEL[]> owner(table);
    int differing = 0;
    for (int i = 0; i < count; ++i) {
        unsigned short command = 0;
        const bool has = other.GetCmdAt(Gui_Accel(table[i]), command) != 0;
        differing += !has || (!missing && command != table[i].cmd) ? 1 : 0;
    }
    return differing;
}

} // namespace

int CountDifferences(const Gui_AccelMap& one, const Gui_AccelMap& other) {
    return countOneWay(one, other, false) + countOneWay(other, one, true);
}
