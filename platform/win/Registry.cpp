#include "platform/win/Registry.h"

#include "platform/base/Text.h"
#include "platform/win/detail/RegistryNotices.h"
#include "platform/win/detail/RegistryStore.h"

#include <algorithm>
#include <cstring>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <unordered_map>

using namespace tvx::registry;

namespace {

struct OpenKey {
    Hive hive = Hive::User;
    KeyPath path;
    REGSAM access = KEY_ALL_ACCESS;
    bool isClass = false; ///< looked up in the machine's settings where the user has none
    Cursor keyCursor;     ///< guarded by the store's mutex, as is the next
    Cursor valueCursor;
};
using OpenKeyPointer = std::shared_ptr<OpenKey>;

KeyPath pathOf(std::string_view text) {
    KeyPath path;
    (void)append(path, text);
    return path;
}

/// The open keys by their handles. A handle is never given out twice, so a closed one is always known as such.
class HandleTable {
public:
    static HandleTable& instance() {
        static auto* const table = new HandleTable; // closing is allowed at any time
        return *table;
    }

    HKEY add(OpenKey key) {
        const std::lock_guard lock(m_mutex);
        m_last += 4;
        const HKEY handle = reinterpret_cast<HKEY>(m_last);
        m_keys.emplace(handle, std::make_shared<OpenKey>(std::move(key)));
        return handle;
    }
    OpenKeyPointer find(HKEY handle) {
        const std::lock_guard lock(m_mutex);
        const auto found = m_keys.find(handle);
        return found != m_keys.end() ? found->second : nullptr;
    }
    LSTATUS close(HKEY handle) {
        if (handle == HKEY_CLASSES_ROOT || handle == HKEY_CURRENT_USER || handle == HKEY_LOCAL_MACHINE) {
            return ERROR_SUCCESS;
        }
        const std::lock_guard lock(m_mutex);
        return m_keys.erase(handle) != 0 ? ERROR_SUCCESS : ERROR_INVALID_HANDLE;
    }

private:
    HandleTable() {
        m_keys[HKEY_CLASSES_ROOT] =
            std::make_shared<OpenKey>(OpenKey{Hive::User, pathOf("Software\\Classes"), KEY_ALL_ACCESS, true, {}, {}});
        m_keys[HKEY_CURRENT_USER] = std::make_shared<OpenKey>();
        m_keys[HKEY_LOCAL_MACHINE] = std::make_shared<OpenKey>(OpenKey{Hive::Machine, {}, KEY_READ, false, {}, {}});
    }

    std::mutex m_mutex;
    std::unordered_map<HKEY, OpenKeyPointer> m_keys;
    std::uintptr_t m_last = 0x100;
};

/// Does something with the locked store of a hive, and then tells the user what there is to tell.
template <typename Operation>
LSTATUS withStore(Hive hive, Operation operation) {
    Store& store = Store::of(hive);
    std::vector<std::string> notices;
    DWORD result = ERROR_SUCCESS;
    {
        const std::lock_guard lock(store.mutex);
        result = operation(store);
        notices = store.takeNotices();
    }
    deliver(notices);
    return static_cast<LSTATUS>(result);
}

/// Does something with an open key that must have been opened with `rights`.
template <typename Operation>
LSTATUS withKey(HKEY handle, REGSAM rights, Operation operation) {
    const OpenKeyPointer key = HandleTable::instance().find(handle);
    if (!key) {
        return ERROR_INVALID_HANDLE;
    }
    if ((key->access & rights) != rights) {
        return ERROR_ACCESS_DENIED;
    }
    return withStore(key->hive, [&](Store& store) { return operation(store, *key); });
}

std::string_view textOf(LPCSTR text) {
    return text ? text : "";
}

/// The key that a call names below an open one.
DWORD below(HKEY handle, LPCSTR subKey, REGSAM access, OpenKey& result) {
    const OpenKeyPointer key = HandleTable::instance().find(handle);
    if (!key) {
        return ERROR_INVALID_HANDLE;
    }
    result = {key->hive, key->path, access, key->isClass, {}, {}};
    return append(result.path, textOf(subKey));
}

LSTATUS findKey(OpenKey& key) {
    LSTATUS result = withStore(key.hive, [&](Store& store) { return store.findKey(key.path); });
    if (result == ERROR_FILE_NOT_FOUND && key.isClass && key.hive == Hive::User) {
        result = withStore(Hive::Machine, [&](Store& store) { return store.findKey(key.path); });
        if (result == ERROR_SUCCESS) {
            key.hive = Hive::Machine;
        }
    }
    const bool asksToWrite = (key.access & (KEY_SET_VALUE | KEY_CREATE_SUB_KEY)) != 0;
    return result == ERROR_SUCCESS && key.hive == Hive::Machine && asksToWrite ? ERROR_ACCESS_DENIED : result;
}

/// Hands a value's type and bytes to a caller by the rules of RegQueryValueExA.
DWORD copyValue(const Value& value, LPDWORD type, LPBYTE data, LPDWORD size) {
    const auto needed = static_cast<DWORD>(value.data.size());
    if (type) {
        *type = value.type;
    }
    if (!size) {
        return ERROR_SUCCESS;
    }
    const DWORD room = *size;
    *size = needed;
    if (!data) {
        return ERROR_SUCCESS;
    }
    if (room < needed) {
        return ERROR_MORE_DATA;
    }
    std::ranges::copy(value.data, reinterpret_cast<char*>(data));
    return ERROR_SUCCESS;
}

DWORD copyName(const std::string& name, LPSTR buffer, DWORD& size) {
    if (!tvx::text::copyWhole(name, buffer, size)) {
        return ERROR_MORE_DATA;
    }
    size = static_cast<DWORD>(name.size());
    return ERROR_SUCCESS;
}

} // namespace

LSTATUS RegCreateKeyExA(HKEY key, LPCSTR subKey, DWORD, LPSTR, DWORD, REGSAM access, LPSECURITY_ATTRIBUTES,
                        PHKEY result, LPDWORD disposition) {
    OpenKey opened;
    if (!result) {
        return ERROR_INVALID_PARAMETER;
    }
    if (const DWORD path = below(key, subKey, access, opened); path != ERROR_SUCCESS) {
        return static_cast<LSTATUS>(path);
    }
    bool created = false;
    LSTATUS status = findKey(opened);
    if (status == ERROR_FILE_NOT_FOUND) {
        status = withStore(opened.hive, [&](Store& store) { return store.createKey(opened.path, created); });
    }
    if (status != ERROR_SUCCESS) {
        return status;
    }
    *result = HandleTable::instance().add(std::move(opened));
    if (disposition) {
        *disposition = created ? REG_CREATED_NEW_KEY : REG_OPENED_EXISTING_KEY;
    }
    return ERROR_SUCCESS;
}

LSTATUS RegOpenKeyExA(HKEY key, LPCSTR subKey, DWORD, REGSAM access, PHKEY result) {
    OpenKey opened;
    if (!result) {
        return ERROR_INVALID_PARAMETER;
    }
    if (const DWORD path = below(key, subKey, access, opened); path != ERROR_SUCCESS) {
        return static_cast<LSTATUS>(path);
    }
    const LSTATUS status = findKey(opened);
    if (status == ERROR_SUCCESS) {
        *result = HandleTable::instance().add(std::move(opened));
    }
    return status;
}

LSTATUS RegCloseKey(HKEY key) {
    return HandleTable::instance().close(key);
}

LSTATUS RegQueryValueExA(HKEY key, LPCSTR name, LPDWORD, LPDWORD type, LPBYTE data, LPDWORD size) {
    if (data && !size) {
        return ERROR_INVALID_PARAMETER;
    }
    return withKey(key, KEY_QUERY_VALUE, [&](Store& store, const OpenKey& open) {
        std::shared_ptr<const Value> value;
        const DWORD result = store.readValue(open.path, textOf(name), value);
        return result == ERROR_SUCCESS ? copyValue(*value, type, data, size) : result;
    });
}

LSTATUS RegSetValueExA(HKEY key, LPCSTR name, DWORD, DWORD type, const BYTE* data, DWORD size) {
    if ((!data && size != 0) || !isValueName(textOf(name))) {
        return ERROR_INVALID_PARAMETER;
    }
    return withKey(key, KEY_SET_VALUE, [&](Store& store, const OpenKey& open) {
        const std::string_view bytes(reinterpret_cast<const char*>(data), size);
        return store.writeValue(open.path, {std::string(textOf(name)), type, std::string(bytes)});
    });
}

LSTATUS RegDeleteValueA(HKEY key, LPCSTR name) {
    return withKey(key, KEY_SET_VALUE,
                   [&](Store& store, const OpenKey& open) { return store.deleteValue(open.path, textOf(name)); });
}

LSTATUS RegDeleteKeyA(HKEY key, LPCSTR subKey) {
    OpenKey doomed;
    if (!subKey) {
        return ERROR_INVALID_PARAMETER;
    }
    if (const DWORD path = below(key, subKey, KEY_ALL_ACCESS, doomed); path != ERROR_SUCCESS) {
        return static_cast<LSTATUS>(path);
    }
    if (doomed.path.folded.empty()) {
        return ERROR_ACCESS_DENIED;
    }
    return withStore(doomed.hive, [&](Store& store) { return store.deleteKey(doomed.path); });
}

LSTATUS RegEnumKeyExA(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD, LPSTR, LPDWORD, PFILETIME) {
    if (!name || !nameSize) {
        return ERROR_INVALID_PARAMETER;
    }
    return withKey(key, KEY_ENUMERATE_SUB_KEYS, [&](Store& store, OpenKey& open) {
        std::string found;
        const DWORD result = store.keyAt(open.path, index, open.keyCursor, found);
        return result == ERROR_SUCCESS ? copyName(found, name, *nameSize) : result;
    });
}

LSTATUS RegEnumValueA(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD, LPDWORD type, LPBYTE data,
                      LPDWORD size) {
    if (!name || !nameSize || (data && !size)) {
        return ERROR_INVALID_PARAMETER;
    }
    return withKey(key, KEY_QUERY_VALUE, [&](Store& store, OpenKey& open) {
        Value value;
        DWORD result = store.valueAt(open.path, index, open.valueCursor, value);
        if (result == ERROR_SUCCESS) {
            result = copyName(value.name, name, *nameSize);
        }
        return result == ERROR_SUCCESS ? copyValue(value, type, data, size) : result;
    });
}

namespace tvx {

namespace {

/// Lets the store go after a transaction, and then tells the user what there is to tell.
void release(Store& store) {
    const std::vector<std::string> notices = store.takeNotices();
    store.mutex.unlock();
    deliver(notices);
}

} // namespace

LSTATUS RegistryTransaction::begin() {
    Store& store = Store::of(Hive::User);
    store.mutex.lock();
    const DWORD result = store.begin();
    m_isOpen = result == ERROR_SUCCESS;
    if (!m_isOpen) {
        release(store);
    }
    return static_cast<LSTATUS>(result);
}

LSTATUS RegistryTransaction::commit() {
    if (!m_isOpen) {
        return ERROR_INVALID_FUNCTION;
    }
    m_isOpen = false;
    Store& store = Store::of(Hive::User);
    const DWORD result = store.commit();
    release(store);
    return static_cast<LSTATUS>(result);
}

RegistryTransaction::~RegistryTransaction() {
    if (!m_isOpen) {
        return;
    }
    Store& store = Store::of(Hive::User);
    store.rollback();
    release(store);
}

} // namespace tvx
