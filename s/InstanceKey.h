#pragma once

#include "afxwin.h"

/// The key with the record of an application's first instance, open for reading and writing; made when it is missing.
/// Closes itself.
class InstanceKey {
public:
    /// @param appName  the application's name as given to the constructor of Gui_WinApp
    explicit InstanceKey(const char* appName) {
        CString path;
        path.Format("Software\\Tarvex\\%s\\%s", appName, "FirstInstance");
        RegCreateKeyExA(HKEY_CURRENT_USER, path, 0, nullptr, REG_OPTION_NON_VOLATILE, KEY_READ | KEY_WRITE, nullptr,
                        &m_key, nullptr);
    }
    ~InstanceKey() {
        RegCloseKey(m_key);
    }
    InstanceKey(const InstanceKey&) = delete;
    InstanceKey& operator=(const InstanceKey&) = delete;

    operator HKEY() const {
        return m_key;
    }

private:
    HKEY m_key = nullptr;
};
