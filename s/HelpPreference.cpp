#include "s/HelpPreference.h"

#include "afx.h"
#include "platform/port/Env.h"
#include "s/SettingsKey.h"
#include "s/String.h"

#include <optional>

namespace {

/// What is stored in the settings that applications of one registry key share; empty when there is nothing.
CString commonSetting(const char* entry) {
    const CWinApp* const app = AfxGetApp();
    if (!app) {
        return {};
    }
    CString path = "Software";
    if (app->m_pszRegistryKey) {
        path += CString("\\") + app->m_pszRegistryKey;
    }
    path += "\\Common\\Settings";
    return RegistryText(HKEY_CURRENT_USER, path, entry).value_or(CString());
}

} // namespace

Gui_HelpPreference::~Gui_HelpPreference() = default;

bool Gui_HelpPreference::IsAlwaysGoToWeb() {
    if (Port_Env::GetEnv("TVX_GUI_HELP_ALWAYS_TO_WEB")) {
        return true;
    }
    int number = 0;
    return Gui_String(commonSetting("AlwayOnWeb")).GetIntValue(number, 10) && number == 1;
}

Port::StringBase<char> Gui_HelpPreference::GetUrlPrefix() {
    return tvx::allocating([] {
        const char* const location = Port_Env::GetEnv("TVX_GUI_HELP_WEB_LOCATION");
        return Port::StringBase<char>(location ? location : commonSetting("HelpUrlPrefix").GetString());
    });
}
