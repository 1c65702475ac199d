#include "s/Programs.h"

#include "s/Msg.h"
#include "s/SettingsKey.h"

namespace {

constexpr const char* lastBrowserKey = "Software\\Classes\\Applications\\iexplore.exe\\shell\\open\\command";
constexpr const char* openCommand = "\\shell\\open\\command";
constexpr const char* placeholder = "%1";

int found(const CString& command, CString& name) {
    if (command.IsEmpty()) {
        return 0;
    }
    name = command;
    return 1;
}

} // namespace

int Programs::UserBrowser(CString& name) {
    return found(RegistryText(HKEY_CURRENT_USER, familyKey, browserEntry).value_or(CString()), name);
}

int Programs::InstalledBrowser(CString& /*name*/) {
    return 0;
}

int Programs::AssociatedBrowser(CString& name) {
    return found(AssociatedCommand(".htm").Trim(), name);
}

int Programs::LastBrowser(CString& name) {
    return found(RegistryText(HKEY_LOCAL_MACHINE, lastBrowserKey, nullptr).value_or(CString()).Trim(), name);
}

CString Programs::AssociatedCommand(const char* extension) {
    const CString type = RegistryText(HKEY_CLASSES_ROOT, extension, nullptr).value_or(CString());
    if (type.IsEmpty()) {
        return {};
    }
    return RegistryText(HKEY_CLASSES_ROOT, type + openCommand, nullptr).value_or(CString());
}

CString Programs::CommandLineFor(const CString& program, const char* document) {
    if (program.Find(placeholder) < 0) {
        return program + " " + document;
    }
    Gui_Msg commandLine(program);
    commandLine << document;
    return commandLine.GetValue();
}
