#include "s/SettingsKey.h"

#include <vector>

std::optional<CString> SettingsKey::text(const char* name, DWORD most) const {
    DWORD size = 0;
    if (RegQueryValueExA(m_key, name, nullptr, nullptr, nullptr, &size) != ERROR_SUCCESS || size > most) {
        return std::nullopt;
    }
    std::vector<char> text(size + std::size_t{1}); // others may have stored a text without its zero
    if (RegQueryValueExA(m_key, name, nullptr, nullptr, reinterpret_cast<BYTE*>(text.data()), &size) != ERROR_SUCCESS) {
        return std::nullopt; // another process has made it longer meanwhile
    }
    return CString(text.data());
}

void SettingsKey::writeText(const char* name, const CString& text) const {
    RegSetValueExA(m_key, name, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.GetString()),
                   static_cast<DWORD>(text.GetLength() + 1));
}
