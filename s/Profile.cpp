#include "s/Profile.h"

#include "platform/base/Text.h"
#include "platform/port/Version.h"
#include "s/SettingsKey.h"

#include <cstring>
#include <utility>

namespace {

constexpr const char* defaultSection = "Settings";
constexpr const char* defaultVersion = "10.1";
constexpr int versionLength = 4;

CString installedVersion() {
    const CString version = CString(Port::Version::getValue("version").c_str()).Left(versionLength);
    return version.IsEmpty() ? CString(defaultVersion) : version;
}

} // namespace

int Gui_Profile::ReadString(CString& value, const char* entry, const char* section) {
    const CString text = AfxGetApp()->GetProfileStringA(section ? section : defaultSection, entry, nullptr);
    if (text.IsEmpty()) {
        return 0;
    }
    value = text;
    return 1;
}

void Gui_Profile::WriteString(const char* value, const char* entry, const char* section) {
    AfxGetApp()->WriteProfileStringA(section ? section : defaultSection, entry, value);
}

CString Gui_Profile::GetKeyLocation(CString appName, bool underSuite, bool perApplication, bool versioned) {
    if (underSuite && !versioned) {
        return {};
    }
    const CString name = perApplication ? std::move(appName) : CString("Common");
    if (underSuite) {
        return "NEV\\" + installedVersion() + "\\" + name;
    }
    CString location = "Common";
    if (versioned) {
        location += "\\" + installedVersion();
    }
    if (perApplication) {
        location += "\\" + name;
    }
    return location;
}

void Gui_Profile::WriteFirstInstanceInfo(const char* appName, const char* valueName, unsigned long value) {
    CString text;
    text.Format("%d", static_cast<int>(value));
    RegSetValueExA(InstanceKey(appName), valueName, 0, REG_SZ, reinterpret_cast<const BYTE*>(text.GetString()),
                   static_cast<DWORD>(text.GetLength() + 1));
}

int Gui_Profile::ReadFirstInstanceInfo(const char* appName, const char* valueName, unsigned long& value) {
    char text[20] = {};
    DWORD size = sizeof text;
    if (RegQueryValueExA(InstanceKey(appName), valueName, nullptr, nullptr, reinterpret_cast<BYTE*>(text), &size) !=
        ERROR_SUCCESS) {
        return 0;
    }
    text[sizeof text - 1] = '\0'; // others may have stored a text without its zero
    const char* end = text;
    const LONG number = tvx::text::toInt32(text, &end);
    if (*end != '\0') {
        return 0;
    }
    value = static_cast<DWORD>(number);
    return 1;
}
