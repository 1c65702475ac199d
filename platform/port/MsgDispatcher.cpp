#include "platform/port/MsgDispatcher.h"

#include <algorithm>
#include <ranges>
#include <vector>

namespace {

/// Never destroyed: managers with static storage outlive `main`. Nor does it take memory: managers whose making fails
/// for want of it ask for it too.
union Managers {
    std::vector<Port_MsgMan*> list;
    constexpr Managers() : list() {}
    // NOLINTNEXTLINE(modernize-use-equals-default): that one would be deleted
    ~Managers() {}
};

/// The registered managers, the first to be asked last.
std::vector<Port_MsgMan*>& registered() {
    static Managers managers;
    return managers.list;
}

Port_MsgMan& builtIn() {
    static auto& manager = *new Port_MsgManDefault;
    return manager;
}

} // namespace

void Port_MsgDispatcher::addMsgMan(Port_MsgMan* manager) {
    removeMsgMan(manager);
    if (manager) {
        registered().push_back(manager);
    }
}

void Port_MsgDispatcher::removeMsgMan(Port_MsgMan* manager) {
    std::erase(registered(), manager);
}

void Port_MsgDispatcher::dispatch(const Port_Msg& msg) {
    const auto backwards = registered() | std::views::reverse;
    const auto ready = std::ranges::find_if(backwards, [](const Port_MsgMan* manager) { return manager->isReady(); });
    Port_MsgMan& manager = ready != backwards.end() ? **ready : builtIn();
    manager.take(msg);
}
