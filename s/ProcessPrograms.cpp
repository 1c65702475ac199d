#include "s/Process.h"

#include "s/BrowserChain.h"
#include "s/ProcessRecord.h"
#include "s/Profile.h"

// Programs that open documents.

int Gui_Process::RunWebBrowser(const char* url, const char* directory, int wait, unsigned long timeout) {
    return RunBrowserChain({.url = url, .directory = directory, .wait = wait, .timeout = timeout});
}

int Gui_Process::RunTextEditor(const char* fileName, const char* directory, int /*wait*/, unsigned long /*timeout*/) {
    m_record->lastError = 0;
    if (m_record->process != INVALID_HANDLE_VALUE) {
        return 0;
    }
    SetReleasePolicy(LeaveRunning, 0);
    CString editor;
    Gui_Profile::ReadTextEditorName(editor);
    return Run(editor + " " + fileName, directory, 0, 0);
}
