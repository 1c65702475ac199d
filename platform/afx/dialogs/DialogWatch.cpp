#include "platform/afx/dialogs/DialogWatch.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace tvx {

namespace {

std::vector<DialogWatch*>& watches() {
    // Never destroyed: windows may be taken down by static destructors.
    static auto* all = new std::vector<DialogWatch*>;
    return *all;
}

} // namespace

DialogWatch::DialogWatch(std::function<void()> opens) : m_opens(std::move(opens)) {
    watches().push_back(this);
}

DialogWatch::~DialogWatch() {
    std::erase(watches(), this);
}

void tellDialogOpens() {
    const auto all = watches();
    for (DialogWatch* watch : all) {
        if (std::ranges::find(watches(), watch) != watches().end()) {
            // A copy, which outlives a watch that the function ends.
            const auto opens = watch->m_opens;
            opens();
        }
    }
}

} // namespace tvx
