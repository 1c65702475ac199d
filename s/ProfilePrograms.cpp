#include "s/Profile.h"

#include "s/ProgramSources.h"
#include "s/SettingsKey.h"

// Which programs open texts and pages.

namespace {

constexpr const char* editorEntry = "TextEditor";
constexpr const char* browserEntry = "Browser";
constexpr const char* systemEditorKey = "Software\\Microsoft\\Windows\\CurrentVersion\\App Paths\\WORDPAD.EXE";
constexpr const char* lastBrowserKey = "Software\\Classes\\Applications\\iexplore.exe\\shell\\open\\command";
constexpr const char* openCommand = "\\shell\\open\\command";
constexpr const char* defaultValue = "";
constexpr const char* lastEditor = "wordpad.exe";

/// Hands a command line over unless it is empty.
int found(const CString& command, CString& name) {
    if (command.IsEmpty()) {
        return 0;
    }
    name = command;
    return 1;
}

} // namespace

int ProgramSources::UserBrowser(CString& name) {
    return found(RegistryText(HKEY_CURRENT_USER, familyKey, browserEntry).value_or(CString()), name);
}

int ProgramSources::InstalledBrowser(CString& /*name*/) {
    return 0;
}

int ProgramSources::AssociatedBrowser(CString& name) {
    return found(AssociatedCommand(".htm").Trim(), name);
}

int ProgramSources::LastBrowser(CString& name) {
    return found(RegistryText(HKEY_LOCAL_MACHINE, lastBrowserKey, defaultValue).value_or(CString()).Trim(), name);
}

CString ProgramSources::AssociatedCommand(const char* extension) {
    const CString type = RegistryText(HKEY_CLASSES_ROOT, extension, defaultValue).value_or(CString());
    if (type.IsEmpty()) {
        return {};
    }
    return RegistryText(HKEY_CLASSES_ROOT, type + openCommand, defaultValue).value_or(CString());
}

int Gui_Profile::ReadTextEditorName(CString& name) {
    const SettingsKey family(familyKey);
    if (const std::optional<CString> editor = family.text(editorEntry)) {
        name = *editor;
    } else {
        GetDefaultTextEditorName(name);
    }
    return 1;
}

void Gui_Profile::WriteTextEditorName(const char* name) {
    SettingsKey(familyKey).writeText(editorEntry, name);
}

void Gui_Profile::GetDefaultTextEditorName(CString& name) {
    name = RegistryText(HKEY_LOCAL_MACHINE, systemEditorKey, defaultValue).value_or(CString());
    if (name.IsEmpty()) {
        name = lastEditor;
    }
}

int Gui_Profile::ReadWebBrowserName(CString& name) {
    using namespace ProgramSources;
    return UserBrowser(name) || InstalledBrowser(name) || AssociatedBrowser(name) || LastBrowser(name);
}

void Gui_Profile::WriteWebBrowserName(const char* name) {
    SettingsKey(familyKey).writeText(browserEntry, name);
}

void Gui_Profile::GetDefaultWebBrowserName(CString& name) {
    if (!ProgramSources::AssociatedBrowser(name)) {
        ProgramSources::LastBrowser(name);
    }
}
