#include "s/Help.h"

#include "afxwin.h"
#include "platform/port/Env.h"
#include "s/HelpMap.h"

#include <cstdlib>
#include <cstring>

namespace {

void ask(DWORD_PTR context, UINT command = HELP_CONTEXT) {
    if (CWinApp* const app = AfxGetModuleState()->m_pCurrentWinApp) {
        app->WinHelp(context, command);
    }
}

void setPath(CWinApp& app, const char* name) {
    char* const copy = strdup(name);
    if (!copy) {
        AfxThrowMemoryException();
    }
    std::free(const_cast<char*>(app.m_pszHelpFilePath));
    app.m_pszHelpFilePath = copy;
}

} // namespace

void Gui_Help::OnCommand(unsigned int id) {
    ask(HID_BASE_COMMAND + id);
}

void Gui_Help::OnDialog(unsigned int id) {
    ask(HID_BASE_RESOURCE + id);
}

void Gui_Help::OnPrompt(unsigned int id) {
    ask(HID_BASE_PROMPT + id);
}

void Gui_Help::OnFrameControl(unsigned int id) {
    ask(HID_BASE_CONTROL + id);
}

void Gui_Help::OnContents(unsigned int) {
    ask(0, HELP_FINDER);
}

int Gui_Help::SetHelpFileName(const char* name) {
    CWinApp* const app = AfxGetModuleState()->m_pCurrentWinApp;
    if (!app || !name) {
        return 0;
    }
    CString package = name;
    package.Replace(".hlp", "");
    package.Replace(".map", "");
    CString map = name;
    map.Replace(".hlp", ".map");
    const bool hasMap = !GetMapFileForPackage(package.GetString()).IsEmpty();
    const char* const helpFile = hasMap ? nullptr : Port_Env::GetHelpFileName(name, 1);
    setPath(*app, helpFile ? helpFile : map.GetString());
    return hasMap || helpFile ? 1 : 0;
}
