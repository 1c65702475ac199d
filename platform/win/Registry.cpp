#include "platform/win/Registry.h"

#include "platform/base/Text.h"
#include "platform/win/detail/RegistryNotices.h"
#include "platform/win/detail/RegistryStore.h"
#include "platform/win/detail/SettingsSource.h"

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
    const Chain* chain = nullptr;
    std::size_t found = 0; ///< the first source that has the key
    KeyPath path;
    REGSAM access = KEY_ALL_ACCESS;
    Cursor keyCursor; ///< guarded by the store's mutex, as is the next
    Cursor valueCursor;

    [[nodiscard]] Source& source() const {
        return *chain->sources[found];
    }
    [[nodiscard]] bool asksToWrite() const {
        return (access & (KEY_SET_VALUE | KEY_CREATE_SUB_KEY)) != 0;
    }
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
        add(HKEY_CLASSES_ROOT, classesChain(), pathOf("Software\\Classes"), KEY_ALL_ACCESS);
        add(HKEY_CURRENT_USER, userChain(), {}, KEY_ALL_ACCESS);
        add(HKEY_LOCAL_MACHINE, machineChain(), {}, KEY_READ);
    }

    void add(HKEY root, const Chain& chain, KeyPath path, REGSAM access) {
        m_keys[root] = std::make_shared<OpenKey>(OpenKey{&chain, 0, std::move(path), access, {}, {}});
    }

    std::mutex m_mutex;
    std::unordered_map<HKEY, OpenKeyPointer> m_keys;
    std::uintptr_t m_last = 0x100;
};

/// The open key that a call is about, which must have been opened with `rights`.
/// @return why it cannot be used, or `ERROR_SUCCESS`
LSTATUS openKey(HKEY handle, REGSAM rights, OpenKeyPointer& key) {
    key = HandleTable::instance().find(handle);
    if (!key) {
        return ERROR_INVALID_HANDLE;
    }
    return (key->access & rights) == rights ? ERROR_SUCCESS : ERROR_ACCESS_DENIED;
}

/// Reads something of an open key.
template <typename Operation>
LSTATUS reading(HKEY handle, REGSAM rights, Operation operation) {
    OpenKeyPointer key;
    const LSTATUS usable = openKey(handle, rights, key);
    return usable == ERROR_SUCCESS ? static_cast<LSTATUS>(operation(*key)) : usable;
}

/// Changes something of an open key.
template <typename Operation>
LSTATUS writing(HKEY handle, REGSAM rights, Operation operation) {
    return reading(handle, rights, [&](OpenKey& key) {
        return withStore(key.chain->written, [&](Store& store) { return operation(store, key); });
    });
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
    result = {key->chain, 0, key->path, access, {}, {}};
    return append(result.path, textOf(subKey));
}

/// Finds the first source that has the key.
DWORD findKey(OpenKey& key) {
    DWORD result = ERROR_FILE_NOT_FOUND;
    for (key.found = 0; key.found < key.chain->sources.size(); ++key.found) {
        result = key.source().findKey(key.path);
        if (result != ERROR_FILE_NOT_FOUND) {
            return result;
        }
    }
    key.found = 0;
    return result;
}

/// Whether a key that was found can be written where it is.
bool isWritable(const OpenKey& key) {
    return key.found == 0 && key.chain->written == Hive::User;
}

/// Asks each source from the key's first on: one that has the key need not have the value.
DWORD readValue(const OpenKey& key, std::string_view name, std::shared_ptr<const Value>& value) {
    const DWORD first = key.source().readValue(key.path, name, value);
    DWORD result = first;
    const bool isMissing = first == ERROR_FILE_NOT_FOUND;
    for (std::size_t next = key.found + 1; isMissing && next < key.chain->sources.size(); ++next) {
        result = key.chain->sources[next]->readValue(key.path, name, value);
        if (result == ERROR_SUCCESS) {
            return result;
        }
    }
    return first;
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
    DWORD status = findKey(opened);
    if (status == ERROR_FILE_NOT_FOUND || (status == ERROR_SUCCESS && opened.asksToWrite() && !isWritable(opened))) {
        opened.found = 0;
        status = withStore(opened.chain->written, [&](Store& store) { return store.createKey(opened.path, created); });
    }
    if (status == ERROR_SUCCESS && opened.asksToWrite() && !isWritable(opened)) {
        status = ERROR_ACCESS_DENIED;
    }
    if (status != ERROR_SUCCESS) {
        return static_cast<LSTATUS>(status);
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
    DWORD status = findKey(opened);
    if (status == ERROR_SUCCESS && opened.asksToWrite() && !isWritable(opened)) {
        status = ERROR_ACCESS_DENIED;
    }
    if (status == ERROR_SUCCESS) {
        *result = HandleTable::instance().add(std::move(opened));
    }
    return static_cast<LSTATUS>(status);
}

LSTATUS RegCloseKey(HKEY key) {
    return HandleTable::instance().close(key);
}

LSTATUS RegQueryValueExA(HKEY key, LPCSTR name, LPDWORD, LPDWORD type, LPBYTE data, LPDWORD size) {
    if (data && !size) {
        return ERROR_INVALID_PARAMETER;
    }
    return reading(key, KEY_QUERY_VALUE, [&](const OpenKey& open) {
        std::shared_ptr<const Value> value;
        const DWORD result = readValue(open, textOf(name), value);
        return result == ERROR_SUCCESS ? copyValue(*value, type, data, size) : result;
    });
}

LSTATUS RegSetValueExA(HKEY key, LPCSTR name, DWORD, DWORD type, const BYTE* data, DWORD size) {
    if ((!data && size != 0) || !isValueName(textOf(name))) {
        return ERROR_INVALID_PARAMETER;
    }
    return writing(key, KEY_SET_VALUE, [&](Store& store, const OpenKey& open) {
        const std::string_view bytes(reinterpret_cast<const char*>(data), size);
        return store.writeValue(open.path, {std::string(textOf(name)), type, std::string(bytes)});
    });
}

LSTATUS RegDeleteValueA(HKEY key, LPCSTR name) {
    return writing(key, KEY_SET_VALUE,
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
    return static_cast<LSTATUS>(
        withStore(doomed.chain->written, [&](Store& store) { return store.deleteKey(doomed.path); }));
}

LSTATUS RegEnumKeyExA(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD, LPSTR, LPDWORD, PFILETIME) {
    if (!name || !nameSize) {
        return ERROR_INVALID_PARAMETER;
    }
    return reading(key, KEY_ENUMERATE_SUB_KEYS, [&](OpenKey& open) {
        std::string found;
        const DWORD result = open.source().keyAt(open.path, index, open.keyCursor, found);
        return result == ERROR_SUCCESS ? copyName(found, name, *nameSize) : result;
    });
}

LSTATUS RegEnumValueA(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD, LPDWORD type, LPBYTE data,
                      LPDWORD size) {
    if (!name || !nameSize || (data && !size)) {
        return ERROR_INVALID_PARAMETER;
    }
    return reading(key, KEY_QUERY_VALUE, [&](OpenKey& open) {
        Value value;
        DWORD result = open.source().valueAt(open.path, index, open.valueCursor, value);
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
