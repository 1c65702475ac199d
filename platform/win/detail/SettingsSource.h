#pragma once

#include "platform/win/detail/RegistryNotices.h"
#include "platform/win/detail/RegistryStore.h"

#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

namespace tvx::registry {

/// Where settings are read from. The answers are the platform's numbers, for what the source does not have
/// `ERROR_FILE_NOT_FOUND`. Any thread may ask.
class Source {
public:
    Source() = default;
    virtual ~Source() = default;
    Source(const Source&) = delete;
    Source& operator=(const Source&) = delete;

    [[nodiscard]] virtual DWORD findKey(const KeyPath& key) = 0;
    [[nodiscard]] virtual DWORD readValue(const KeyPath& key, std::string_view name,
                                          std::shared_ptr<const Value>& value) = 0;
    /// The name of the key at `index` below `key`; `ERROR_NO_MORE_ITEMS` behind the last.
    [[nodiscard]] virtual DWORD keyAt(const KeyPath& key, DWORD index, Cursor& cursor, std::string& name) = 0;
    /// The value at `index` of `key`.
    [[nodiscard]] virtual DWORD valueAt(const KeyPath& key, DWORD index, Cursor& cursor, Value& value) = 0;
};

/// The sources of a root. What an earlier one has counts before what a later one has, value by value.
struct Chain {
    Hive written = Hive::User; ///< what is written goes into this store, which is the first source
    std::vector<Source*> sources;
};

/// The user's settings alone, the classes, and the settings of the machine.
[[nodiscard]] const Chain& userChain();
[[nodiscard]] const Chain& classesChain();
[[nodiscard]] const Chain& machineChain();

/// Does something with the locked store of a hive, and then tells the user what there is to tell.
template <typename Operation>
DWORD withStore(Hive hive, Operation operation) {
    Store& store = Store::of(hive);
    std::vector<std::string> notices;
    DWORD result = ERROR_SUCCESS;
    {
        const std::lock_guard lock(store.mutex);
        result = operation(store);
        notices = store.takeNotices();
    }
    deliver(notices);
    return result;
}

} // namespace tvx::registry
