#pragma once

#include "platform/win/detail/RegistryConnection.h"
#include "platform/win/detail/RegistryStore.h"

namespace tvx::registry {

/// What was read from a store, as long as nobody has written since.
struct Store::Memory {
    /// More is not kept: who reads that many settings is not reading them again.
    static constexpr std::size_t most = 20'000;

    /// How it can be known that nobody has written.
    enum class Watch {
        None,    ///< not at all: a file of another machine, which the database is asked each time
        Log,     ///< by the head of the shared log
        Nothing, ///< it cannot happen: the store is a copy
    };

    /// What may be answered from memory; null when the database is to be asked. Must be called before the database is
    /// asked, so that what is kept is at least as new as the head it is kept under.
    Replies* current(const Connection& connection) {
        if (watch == Watch::None) {
            return nullptr;
        }
        const std::optional<LogHead> now = watch == Watch::Log ? connection.logHead() : head;
        if (!now) {
            return nullptr;
        }
        if (*now != head || replies.size() > most) {
            replies.clear();
            head = *now;
        }
        return &replies;
    }

    Watch watch = Watch::None;
    LogHead head{};
    Replies replies;
};

} // namespace tvx::registry
