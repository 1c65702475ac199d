#include "tools/settings/SettingsTree.h"

namespace settings {

namespace {

std::string reason(LSTATUS result) {
    return result == ERROR_FILE_NOT_FOUND ? "it does not exist." : tvx::errorText(static_cast<DWORD>(result));
}

LSTATUS openKey(const KeyName& name, Key::Way way, HKEY& key) {
    if (way == Key::Way::Create) {
        return RegCreateKeyExA(name.root, name.path.c_str(), 0, nullptr, REG_OPTION_NON_VOLATILE, KEY_READ | KEY_WRITE,
                               nullptr, &key, nullptr);
    }
    const REGSAM access = way == Key::Way::Read ? KEY_READ : KEY_READ | KEY_WRITE;
    return RegOpenKeyExA(name.root, name.path.c_str(), 0, access, &key);
}

void applyOne(const Change& change) {
    switch (change.kind) {
    case Change::Kind::MakeKey:
        Key(change.key, Key::Way::Create);
        break;
    case Change::Kind::DeleteKey:
        removeTree(change.key);
        break;
    case Change::Kind::SetValue:
        Key(change.key, Key::Way::Create).set(change.setting);
        break;
    case Change::Kind::DeleteValue:
        Key(change.key, Key::Way::Write).remove(change.setting.name);
        break;
    }
}

/// What a text asks to delete may be gone already.
bool isAlreadyDone(const Change& change, const Failure& failure) {
    return failure.result() == ERROR_FILE_NOT_FOUND &&
           (change.kind == Change::Kind::DeleteKey || change.kind == Change::Kind::DeleteValue);
}

} // namespace

Failure::Failure(LSTATUS result, const std::string& subject)
    : std::runtime_error(subject + ": " + reason(result)), m_result(result) {}

Key::Key(const KeyName& name, Way way) : m_name(name) {
    const LSTATUS result = openKey(name, way, m_key);
    if (result != ERROR_SUCCESS) {
        throw failure(result, {});
    }
}

Key::~Key() {
    RegCloseKey(m_key);
}

Failure Key::failure(LSTATUS result, const std::string& value) const {
    return {result, writeKeyName(m_name) + (value.empty() ? "" : ", " + value)};
}

std::vector<std::string> Key::subKeys() const {
    std::vector<std::string> names;
    for (std::string name(1024, '\0');;) {
        auto size = static_cast<DWORD>(name.size());
        const LSTATUS result = RegEnumKeyExA(m_key, static_cast<DWORD>(names.size()), name.data(), &size, nullptr,
                                             nullptr, nullptr, nullptr);
        if (result == ERROR_NO_MORE_ITEMS) {
            return names;
        }
        if (result != ERROR_SUCCESS) {
            throw failure(result, {});
        }
        names.push_back(name.substr(0, size));
    }
}

std::vector<Setting> Key::settings() const {
    std::vector<Setting> found;
    for (std::string name(4 * 16384, '\0');;) {
        auto size = static_cast<DWORD>(name.size());
        const LSTATUS result = RegEnumValueA(m_key, static_cast<DWORD>(found.size()), name.data(), &size, nullptr,
                                             nullptr, nullptr, nullptr);
        if (result == ERROR_NO_MORE_ITEMS) {
            return found;
        }
        if (result != ERROR_SUCCESS) {
            throw failure(result, {});
        }
        found.push_back(setting(name.substr(0, size)));
    }
}

Setting Key::setting(const std::string& name) const {
    Setting found{name, REG_NONE, std::string(256, '\0')};
    LSTATUS result = ERROR_MORE_DATA;
    while (result == ERROR_MORE_DATA) {
        auto size = static_cast<DWORD>(found.data.size());
        result = RegQueryValueExA(m_key, name.c_str(), nullptr, &found.type, reinterpret_cast<BYTE*>(found.data.data()),
                                  &size);
        if (result == ERROR_SUCCESS || result == ERROR_MORE_DATA) {
            found.data.resize(size);
        }
    }
    if (result != ERROR_SUCCESS) {
        throw failure(result, name.empty() ? "@" : "\"" + name + "\"");
    }
    return found;
}

void Key::set(const Setting& setting) const {
    const LSTATUS result =
        RegSetValueExA(m_key, setting.name.c_str(), 0, setting.type, reinterpret_cast<const BYTE*>(setting.data.data()),
                       static_cast<DWORD>(setting.data.size()));
    if (result != ERROR_SUCCESS) {
        throw failure(result, "\"" + setting.name + "\"");
    }
}

void Key::remove(const std::string& name) const {
    const LSTATUS result = RegDeleteValueA(m_key, name.c_str());
    if (result != ERROR_SUCCESS) {
        throw failure(result, "\"" + name + "\"");
    }
}

KeyName below(const KeyName& key, const std::string& name) {
    return {key.root, key.path.empty() ? name : key.path + "\\" + name};
}

void removeTree(const KeyName& key) {
    for (const std::string& name : Key(key, Key::Way::Write).subKeys()) {
        removeTree(below(key, name));
    }
    const LSTATUS result = RegDeleteKeyA(key.root, key.path.c_str());
    if (result != ERROR_SUCCESS) {
        throw Failure(result, writeKeyName(key));
    }
}

std::string writeTree(const KeyName& name) {
    if (!canWriteKey(name)) {
        throw Failure(ERROR_INVALID_NAME, writeKeyName(name));
    }
    const Key key(name, Key::Way::Read);
    const std::vector<std::string> subKeys = key.subKeys();
    const std::vector<Setting> settings = key.settings();
    std::string text;
    // A key that only holds others is made with them.
    if (!settings.empty() || subKeys.empty()) {
        text = writeKey(name);
        for (const Setting& setting : settings) {
            text += writeSetting(setting);
        }
        text += "\n";
    }
    for (const std::string& subKey : subKeys) {
        text += writeTree(below(name, subKey));
    }
    return text;
}

void apply(const std::vector<Change>& changes, const std::string& place) {
    tvx::RegistryTransaction transaction;
    LSTATUS result = transaction.begin();
    if (result != ERROR_SUCCESS) {
        throw Failure(result, place);
    }
    for (const Change& change : changes) {
        try {
            applyOne(change);
        } catch (const Failure& failure) {
            if (!isAlreadyDone(change, failure)) {
                throw Failure(failure.result(),
                              place + ":" + std::to_string(change.line) + ": " + writeKeyName(change.key));
            }
        }
    }
    result = transaction.commit();
    if (result != ERROR_SUCCESS) {
        throw Failure(result, place);
    }
}

} // namespace settings
