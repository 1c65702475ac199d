// The protocol by which only one instance of an application runs.
#include "s/WinApp.h"

#include "platform/port/Env.h"
#include "platform/win/Process.h"
#include "platform/win/ProcessMark.h"
#include "s/Desktop.h"
#include "s/Process.h"
#include "s/Profile.h"
#include "s/SettingsKey.h"
#include "s/WinAppData.h"

#include <string>

namespace {

constexpr const char* processValue = "ProcessID";
constexpr const char* windowValue = "WindowID";
// Beside the two numbers: which of all the processes that ever had that id is meant.
constexpr const char* markValue = "ProcessMark";

bool isProtocolOff() {
    const char* checking = Port_Env::GetEnv("TVX_GUI_INSTANCECHECKING");
    return checking && *checking == '0';
}

/// A number of the running application's record; 0 when there is none.
unsigned long recorded(const char* valueName) {
    unsigned long value = 0;
    Gui_Profile::ReadFirstInstanceInfo(AfxGetAppName(), valueName, value);
    return value;
}

void record(const char* valueName, unsigned long value) {
    Gui_Profile::WriteFirstInstanceInfo(AfxGetAppName(), valueName, value);
}

std::string recordedMark() {
    return InstanceKey(AfxGetAppName()).text(markValue).value_or(CString()).GetString();
}

void recordMark(const std::string& mark) {
    InstanceKey(AfxGetAppName()).writeText(markValue, mark.c_str());
}

/// Whether the recorded process runs and is the one that was recorded, as far as that is known.
bool isFirstInstanceAlive(unsigned long processId) {
    return Gui_Process::IsActive(processId) && !tvx::isOtherProcess(static_cast<DWORD>(processId), recordedMark());
}

} // namespace

int Gui_WinApp::IsFirstInstance() {
    if (isProtocolOff()) {
        return 1;
    }
    const unsigned long first = recorded(processValue);
    return first == 0 || !isFirstInstanceAlive(first);
}

int Gui_WinApp::RegisterInstance() {
    if (isProtocolOff()) {
        return 1;
    }
    const DWORD process = GetCurrentProcessId();
    recordMark(tvx::processMark(process));
    record(processValue, process);
    record(windowValue, 0);
    m_data->registered = 1;
    return 1;
}

void Gui_WinApp::RegisterInstanceWindow(unsigned long windowId) {
    if (m_data->registered) {
        record(windowValue, windowId);
    }
}

int Gui_WinApp::ShowFirstInstanceWindow() {
    const unsigned long first = recorded(processValue);
    if (first == 0 || !isFirstInstanceAlive(first)) {
        return 0;
    }
    const unsigned long window = recorded(windowValue);
    return window != 0 ? Gui_Desktop::ShowWindow(window) : 0;
}

void Gui_WinApp::UnregisterInstance() {
    if (isProtocolOff() || recorded(processValue) != GetCurrentProcessId()) {
        return;
    }
    record(processValue, 0);
    record(windowValue, 0);
}
