#include "platform/afx/core/App.h"
#include "platform/win/Registry.h"

#include <array>
#include <cstring>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace {

/// An open key for as long as it is needed.
class Key {
public:
    enum class Way { Open, Change, Create };

    Key(LPCSTR path, Way way) {
        if (way == Way::Create) {
            m_result = RegCreateKeyExA(HKEY_CURRENT_USER, path, 0, nullptr, REG_OPTION_NON_VOLATILE,
                                       KEY_READ | KEY_WRITE, nullptr, &m_key, nullptr);
        } else {
            m_result = RegOpenKeyExA(HKEY_CURRENT_USER, path, 0, way == Way::Open ? KEY_READ : KEY_WRITE, &m_key);
        }
    }
    ~Key() {
        if (m_key) {
            RegCloseKey(m_key);
        }
    }
    Key(const Key&) = delete;
    Key& operator=(const Key&) = delete;

    LSTATUS result() const {
        return m_result;
    }
    operator HKEY() const {
        return m_key;
    }

private:
    HKEY m_key = nullptr;
    LSTATUS m_result = ERROR_SUCCESS;
};

CString sectionPath(const CString& profile, LPCSTR section) {
    return section ? profile + "\\" + section : profile;
}

/// The bytes of an entry of the type asked for.
std::optional<std::string> readEntry(const CString& path, LPCSTR entry, DWORD wanted) {
    const Key key(path, Key::Way::Open);
    if (key.result() != ERROR_SUCCESS) {
        return std::nullopt;
    }
    std::string bytes(256, '\0'); // most fit, and are read in one go
    DWORD type = REG_NONE;
    auto size = static_cast<DWORD>(bytes.size());
    LSTATUS result = ERROR_MORE_DATA;
    for (; result == ERROR_MORE_DATA; bytes.resize(size)) {
        // A longer value may come between asking for the size and reading.
        result = RegQueryValueExA(key, entry, nullptr, &type, reinterpret_cast<BYTE*>(bytes.data()), &size);
    }
    return result == ERROR_SUCCESS && type == wanted ? std::optional(bytes) : std::nullopt;
}

} // namespace

CString CWinApp::profilePath() const {
    CString path = "Software";
    for (const char* part : {m_pszRegistryKey, m_pszProfileName ? m_pszProfileName : AfxGetAppName()}) {
        if (part) {
            path += "\\";
            path += part;
        }
    }
    return path;
}

LSTATUS CWinApp::writeEntry(LPCSTR section, LPCSTR entry, DWORD type, std::string_view bytes) {
    const Key key(sectionPath(profilePath(), section), Key::Way::Create);
    if (key.result() != ERROR_SUCCESS) {
        return key.result();
    }
    return RegSetValueExA(key, entry, 0, type, reinterpret_cast<const BYTE*>(bytes.data()),
                          static_cast<DWORD>(bytes.size()));
}

UINT CWinApp::GetProfileInt(LPCSTR section, LPCSTR entry, int defaultValue) {
    const auto bytes = readEntry(sectionPath(profilePath(), section), entry, REG_DWORD);
    DWORD number = static_cast<DWORD>(defaultValue);
    if (bytes && bytes->size() == sizeof number) {
        std::memcpy(&number, bytes->data(), sizeof number);
    }
    return number;
}

CString CWinApp::GetProfileStringA(LPCSTR section, LPCSTR entry, LPCSTR defaultValue) {
    const auto bytes = readEntry(sectionPath(profilePath(), section), entry, REG_SZ);
    return bytes ? bytes->c_str() : defaultValue;
}

BOOL CWinApp::GetProfileBinary(LPCSTR section, LPCSTR entry, LPBYTE* data, UINT* size) {
    *data = nullptr;
    *size = 0;
    const auto bytes = readEntry(sectionPath(profilePath(), section), entry, REG_BINARY);
    if (!bytes) {
        return FALSE;
    }
    auto copy = std::make_unique<BYTE[]>(bytes->size());
    std::memcpy(copy.get(), bytes->data(), bytes->size());
    *size = static_cast<UINT>(bytes->size());
    *data = copy.release();
    return TRUE;
}

BOOL CWinApp::WriteProfileInt(LPCSTR section, LPCSTR entry, int value) {
    std::array<char, sizeof value> bytes{};
    std::memcpy(bytes.data(), &value, sizeof value);
    return writeEntry(section, entry, REG_DWORD, {bytes.data(), bytes.size()}) == ERROR_SUCCESS;
}

BOOL CWinApp::WriteProfileStringA(LPCSTR section, LPCSTR entry, LPCSTR value) {
    if (!entry) {
        return RegDeleteKeyA(HKEY_CURRENT_USER, sectionPath(profilePath(), section)) == ERROR_SUCCESS;
    }
    if (!value) {
        const Key key(sectionPath(profilePath(), section), Key::Way::Change);
        return key.result() == ERROR_SUCCESS && RegDeleteValueA(key, entry) == ERROR_SUCCESS;
    }
    return writeEntry(section, entry, REG_SZ, {value, std::strlen(value) + 1}) == ERROR_SUCCESS;
}

BOOL CWinApp::WriteProfileBinary(LPCSTR section, LPCSTR entry, LPBYTE data, UINT size) {
    return writeEntry(section, entry, REG_BINARY, {reinterpret_cast<const char*>(data), size}) == ERROR_SUCCESS;
}
