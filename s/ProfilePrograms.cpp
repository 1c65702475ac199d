#include "s/Profile.h"

#include "s/Programs.h"
#include "s/SettingsKey.h"

// Which programs open texts and pages.

namespace {

constexpr const char* editorEntry = "TextEditor";
constexpr const char* systemEditorKey = "Software\\Microsoft\\Windows\\CurrentVersion\\App Paths\\WORDPAD.EXE";
constexpr const char* lastEditor = "wordpad.exe";

} // namespace

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
    name = RegistryText(HKEY_LOCAL_MACHINE, systemEditorKey, nullptr).value_or(CString());
    if (name.IsEmpty()) {
        name = lastEditor;
    }
}

int Gui_Profile::ReadWebBrowserName(CString& name) {
    using namespace Programs;
    return UserBrowser(name) || InstalledBrowser(name) || AssociatedBrowser(name) || LastBrowser(name);
}

void Gui_Profile::WriteWebBrowserName(const char* name) {
    SettingsKey(familyKey).writeText(browserEntry, name);
}

void Gui_Profile::GetDefaultWebBrowserName(CString& name) {
    if (!Programs::AssociatedBrowser(name)) {
        Programs::LastBrowser(name);
    }
}
