#include "s/SettingsKey.h"

#include <vector>

namespace {

std::optional<CString> textOf(HKEY key, const char* name, DWORD most) {
    DWORD size = 0;
    if (RegQueryValueExA(key, name, nullptr, nullptr, nullptr, &size) != ERROR_SUCCESS || size > most) {
        return std::nullopt;
    }
    std::vector<char> text(size + std::size_t{1}); // others may have stored a text without its zero
    if (RegQueryValueExA(key, name, nullptr, nullptr, reinterpret_cast<BYTE*>(text.data()), &size) != ERROR_SUCCESS) {
        return std::nullopt; // another process has made it longer meanwhile
    }
    return CString(text.data());
}

} // namespace

std::optional<CString> RegistryText(HKEY root, const char* path, const char* name) {
    HKEY key = nullptr;
    if (RegOpenKeyExA(root, path, 0, KEY_READ, &key) != ERROR_SUCCESS) {
        return std::nullopt;
    }
    std::optional<CString> text = textOf(key, name, UINT32_MAX);
    RegCloseKey(key);
    return text;
}

std::optional<CString> SettingsKey::text(const char* name, DWORD most) const {
    return textOf(m_key, name, most);
}

void SettingsKey::writeText(const char* name, const CString& text) const {
    RegSetValueExA(m_key, name, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.GetString()),
                   static_cast<DWORD>(text.GetLength() + 1));
}
