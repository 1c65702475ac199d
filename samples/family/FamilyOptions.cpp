#include "FamilyOptions.h"

#include "s/HelpPreference.h"
#include "s/Profile.h"

namespace {

constexpr const char* folderEntry = "DocumentFolder";
constexpr const char* alwaysEntry = "AlwayOnWeb"; // spelled so in the settings that all applications read
constexpr const char* locationEntry = "HelpUrlPrefix";

/// The settings that all applications of the family share.
CString commonKey() {
    return CString("Software\\") + AfxGetApp()->m_pszRegistryKey + "\\Common\\Settings";
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
    Gui_HelpPreference help;
    options.alwaysOnWeb = help.IsAlwaysGoToWeb() ? TRUE : FALSE;
    options.webLocation = help.GetUrlPrefix().c_str();
    return options;
}

void FamilyOptions::Write(const FamilyOptions& before) const {
    if (documentFolder != before.documentFolder) {
        Gui_Profile::WriteString(documentFolder.IsEmpty() ? nullptr : documentFolder.GetString(), folderEntry, nullptr);
    }
    if (alwaysOnWeb != before.alwaysOnWeb) {
        writeCommon(alwaysEntry, alwaysOnWeb ? "1" : "");
    }
    if (webLocation != before.webLocation) {
        writeCommon(locationEntry, webLocation);
    }
}
