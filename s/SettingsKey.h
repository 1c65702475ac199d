#pragma once

#include "afxwin.h"

#include <cstdint>
#include <optional>

/// The key of what all applications of the family share, below the root of the current user.
inline constexpr const char* familyKey = "Software\\Tarvex\\Common";
/// The user's web browser in that key.
inline constexpr const char* browserEntry = "Browser";

/// The text of a value, up to its first zero, of a key that is only looked at.
/// @param path  below the root
/// @param name  null: the key's default value
/// @return nothing when there is no such key or value
[[nodiscard]] std::optional<CString> RegistryText(HKEY root, const char* path, const char* name);

/// A key of the user's settings, open for reading and writing; made when it is missing. Closes itself.
class SettingsKey {
public:
    /// @param path  below the root of the current user
    explicit SettingsKey(const char* path) {
        RegCreateKeyExA(HKEY_CURRENT_USER, path, 0, nullptr, REG_OPTION_NON_VOLATILE, KEY_READ | KEY_WRITE, nullptr,
                        &m_key, nullptr);
    }
    ~SettingsKey() {
        RegCloseKey(m_key);
    }
    SettingsKey(const SettingsKey&) = delete;
    SettingsKey& operator=(const SettingsKey&) = delete;

    /// The text of a value, up to its first zero.
    /// @param most  bytes that the stored value may have, a zero of its own included
    /// @return nothing when there is no such value, or a larger one
    [[nodiscard]] std::optional<CString> text(const char* name, DWORD most = UINT32_MAX) const;
    /// Stores a text. What cannot be stored is lost without a word, as in all that remembers for the user's comfort.
    void writeText(const char* name, const CString& text) const;

private:
    HKEY m_key = nullptr;
};

/// The key with the record of an application's first instance.
class InstanceKey : public SettingsKey {
public:
    /// @param appName  the application's name as given to the constructor of Gui_WinApp
    explicit InstanceKey(const char* appName) : SettingsKey(path(appName)) {}

private:
    static CString path(const char* appName) {
        CString text;
        text.Format("Software\\Tarvex\\%s\\%s", appName, "FirstInstance");
        return text;
    }
};
