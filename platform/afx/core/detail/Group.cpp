#include "platform/afx/core/detail/Group.h"

#include "platform/afx/core/detail/Window.h"

#include <algorithm>

namespace tvx::afx {

std::vector<Window*> dialogGroup(const Window& control) {
    if (!control.parent()) {
        return {};
    }
    const auto& siblings = control.parent()->children();
    auto first = std::find(siblings.begin(), siblings.end(), &control);
    const auto startsGroup = [](const Window* window) { return (window->style() & WS_GROUP) != 0; };
    auto last = std::find_if(std::next(first), siblings.end(), startsGroup);
    while (first != siblings.begin() && !startsGroup(*first)) {
        --first;
    }
    return {first, last};
}

} // namespace tvx::afx
