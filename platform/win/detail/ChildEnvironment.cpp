#include "platform/win/detail/ChildEnvironment.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cstdlib>
#include <string_view>
#include <unistd.h>

namespace tvx::win {

namespace {

constexpr const char* changedByBundle = "TVX_BUNDLE_VARIABLES";
constexpr std::string_view usersValue = "TVX_USER_";
constexpr const char* startHidden = "TVX_START_HIDDEN";
constexpr const char* startupId = "DESKTOP_STARTUP_ID";

/// What was meant for this process alone: how it was started, by whom, and with which action of the user's.
constexpr std::array<std::string_view, 6> ownVariables{changedByBundle,
                                                       startHidden,
                                                       startupId,
                                                       "XDG_ACTIVATION_TOKEN",
                                                       "GIO_LAUNCHED_DESKTOP_FILE",
                                                       "GIO_LAUNCHED_DESKTOP_FILE_PID"};

std::atomic<DWORD> lastInputTime;
std::atomic<unsigned> startCount;

/// Never given twice on a display, and with the time of what the user did to start the child at its end: that is how
/// the window manager knows that the child's window is wanted in front.
std::string newStartupId(DWORD time) {
    std::array<char, 256> host{};
    ::gethostname(host.data(), host.size() - 1);
    return "tarvex-" + std::to_string(::getpid()) + "-" + std::to_string(++startCount) + "-" + host.data() + "_TIME" +
           std::to_string(time);
}

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
    if (std::ranges::find(ownVariables, name) != ownVariables.end()) {
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
    } else if (const DWORD time = lastInputTime; time != 0) {
        add(std::string(startupId) + "=" + newStartupId(time));
    }
    m_block.push_back(nullptr);
}

void ChildEnvironment::add(std::string variable) {
    m_own.push_back(std::move(variable));
    m_block.push_back(m_own.back().data());
}

void keepLastInputTime(DWORD time) {
    lastInputTime = time;
}

StartShow askedStartShow() {
    return std::getenv(startHidden) ? StartShow::Hidden : StartShow::Normal;
}

} // namespace tvx::win
