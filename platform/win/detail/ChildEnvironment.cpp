#include "platform/win/detail/ChildEnvironment.h"

#include <algorithm>
#include <cstdlib>
#include <string_view>
#include <unistd.h>

namespace tvx::win {

namespace {

constexpr const char* changedByBundle = "TVX_BUNDLE_VARIABLES";
constexpr std::string_view usersValue = "TVX_USER_";
constexpr const char* startHidden = "TVX_START_HIDDEN";

/// The variables that the bundle's start script has changed for the application.
std::vector<std::string> bundleVariables() {
    const char* value = std::getenv(changedByBundle);
    std::string_view list = value ? value : "";
    std::vector<std::string> names;
    while (!list.empty()) {
        const std::size_t end = std::min(list.find(':'), list.size());
        if (end > 0) {
            names.emplace_back(list.substr(0, end));
        }
        list.remove_prefix(std::min(end + 1, list.size()));
    }
    return names;
}

bool isKept(std::string_view variable, const std::vector<std::string>& changed) {
    const std::string_view name = variable.substr(0, variable.find('='));
    if (name == changedByBundle || name == startHidden) {
        return false;
    }
    return std::ranges::none_of(changed, [name](const std::string& other) {
        return name == other || (name.starts_with(usersValue) && name.substr(usersValue.size()) == other);
    });
}

} // namespace

ChildEnvironment::ChildEnvironment(StartShow show) {
    const std::vector<std::string> changed = bundleVariables();
    for (char** variable = environ; variable && *variable; ++variable) {
        if (isKept(*variable, changed)) {
            m_block.push_back(*variable);
        }
    }
    for (const std::string& name : changed) {
        if (const char* value = std::getenv((std::string(usersValue) + name).c_str())) {
            add(name + "=" + value);
        }
    }
    if (show == StartShow::Hidden) {
        add(std::string(startHidden) + "=1");
    }
    m_block.push_back(nullptr);
}

void ChildEnvironment::add(std::string variable) {
    m_own.push_back(std::move(variable));
    m_block.push_back(m_own.back().data());
}

StartShow askedStartShow() {
    return std::getenv(startHidden) ? StartShow::Hidden : StartShow::Normal;
}

} // namespace tvx::win
