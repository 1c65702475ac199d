#include "s/Profile.h"

#include "platform/base/Text.h"
#include "platform/port/Version.h"
#include "s/SettingsKey.h"

#include <optional>
#include <string>
#include <string_view>
#include <utility>

namespace {

constexpr const char* defaultSection = "Settings";
constexpr const char* defaultVersion = "10.1";
constexpr int versionLength = 4;
// Bytes of a number in the record of the first instance: all releases read it into a buffer of this size.
constexpr DWORD longestNumber = 20;

CString installedVersion() {
    const std::string version = Port::Version::getValue("version").c_str();
    std::size_t length = 0;
    for (int i = 0; i < versionLength; ++i) {
        length += tvx::text::characterLength(version, length);
    }
    return length == 0 ? CString(defaultVersion) : CString(std::string_view(version).substr(0, length));
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
    InstanceKey(appName).writeText(valueName, text);
}

int Gui_Profile::ReadFirstInstanceInfo(const char* appName, const char* valueName, unsigned long& value) {
    const std::optional<CString> text = InstanceKey(appName).text(valueName, longestNumber);
    if (!text) {
        return 0;
    }
    const char* end = nullptr;
    const LONG number = tvx::text::toInt32(*text, &end);
    if (*end != '\0') {
        return 0;
    }
    value = static_cast<DWORD>(number);
    return 1;
}
