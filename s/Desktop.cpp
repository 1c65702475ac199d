#include "s/Desktop.h"

#include "s/MainWindow.h"

namespace {

HWND handleOf(unsigned long windowId) {
    return reinterpret_cast<HWND>(static_cast<std::uintptr_t>(windowId));
}

unsigned long identifierOf(HWND window) {
    return static_cast<unsigned long>(reinterpret_cast<std::uintptr_t>(window));
}

/// Lets this thread pass on the activation as the thread of the foreground window may.
class ForegroundInput {
public:
    ForegroundInput()
        : m_own(GetCurrentThreadId()),
          m_foreground(GetWindowThreadProcessId(GetForegroundWindow(), nullptr)),
          m_attached(m_foreground != m_own && AttachThreadInput(m_own, m_foreground, TRUE)) {}
    ~ForegroundInput() {
        if (m_attached) {
            AttachThreadInput(m_own, m_foreground, FALSE);
        }
    }
    ForegroundInput(const ForegroundInput&) = delete;
    ForegroundInput& operator=(const ForegroundInput&) = delete;

private:
    DWORD m_own;
    DWORD m_foreground;
    bool m_attached;
};

} // namespace

unsigned long Gui_Desktop::GetMainWindowID() {
    return identifierOf(MainWindowHandle());
}

unsigned long Gui_Desktop::GetDialogWindowID(HWND dialog) {
    return identifierOf(dialog);
}

int Gui_Desktop::ShowWindow(unsigned long windowId) {
    const HWND window = handleOf(windowId);
    if (!IsWindow(window)) {
        return 0;
    }
    if (IsIconic(window)) {
        ::ShowWindow(window, SW_RESTORE);
    }
    const ForegroundInput input;
    SetForegroundWindow(window);
    return 1;
}

_XDisplay* Gui_Desktop::GetDisplay() {
    return nullptr;
}
