#include "FamilyOptions.h"

#include "s/Profile.h"

#include <array>
#include <cstring>

namespace {

constexpr const char* folderEntry = "DocumentFolder";
constexpr const char* alwaysEntry = "AlwayOnWeb"; // spelled so in the settings that all applications read
constexpr const char* locationEntry = "HelpUrlPrefix";

/// The settings that all applications of the family share.
CString commonKey() {
    return CString("Software\\") + AfxGetApp()->m_pszRegistryKey + "\\Common\\Settings";
}

CString readCommon(const char* entry) {
    HKEY key = nullptr;
    if (RegOpenKeyExA(HKEY_CURRENT_USER, commonKey(), 0, KEY_READ, &key) != ERROR_SUCCESS) {
        return {};
    }
    std::array<char, 2048> text{};
    DWORD size = text.size() - 1;
    DWORD type = 0;
    const LONG result = RegQueryValueExA(key, entry, nullptr, &type, reinterpret_cast<BYTE*>(text.data()), &size);
    RegCloseKey(key);
    return result == ERROR_SUCCESS && type == REG_SZ ? CString(text.data()) : CString();
}

void writeCommon(const char* entry, const CString& text) {
    HKEY key = nullptr;
    if (RegCreateKeyExA(HKEY_CURRENT_USER, commonKey(), 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr) !=
        ERROR_SUCCESS) {
        return;
    }
    if (text.IsEmpty()) {
        RegDeleteValueA(key, entry);
    } else {
        RegSetValueExA(key, entry, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.GetString()),
                       static_cast<DWORD>(text.GetLength() + 1));
    }
    RegCloseKey(key);
}

} // namespace

FamilyOptions FamilyOptions::Read() {
    FamilyOptions options;
    Gui_Profile::ReadString(options.documentFolder, folderEntry, nullptr);
    options.alwaysOnWeb = readCommon(alwaysEntry) == "1";
    options.webLocation = readCommon(locationEntry);
    return options;
}

void FamilyOptions::Write() const {
    Gui_Profile::WriteString(documentFolder.IsEmpty() ? nullptr : documentFolder.GetString(), folderEntry, nullptr);
    writeCommon(alwaysEntry, alwaysOnWeb ? "1" : "");
    writeCommon(locationEntry, webLocation);
}
