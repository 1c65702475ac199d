#include "platform/afx/core/App.h"

#include "platform/afx/core/AskedFor.h"
#include "platform/afx/core/CommandLineInfo.h"
#include "platform/afx/core/StartCode.h"
#include "platform/afx/core/detail/HelpRequest.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Exception.h"
#include "platform/base/SystemPath.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/Module.h"
#include "platform/win/Process.h"
#include "platform/win/Resource.h"

#include <QApplication>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CWinApp, CWinThread)

// clang-format off
BEGIN_MESSAGE_MAP(CWinApp, CWinThread)
    ON_COMMAND(ID_APP_EXIT, &CWinApp::OnAppExit)
    ON_UPDATE_COMMAND_UI(ID_FILE_MRU_FILE1, &CWinApp::OnUpdateRecentFileMenu)
    ON_COMMAND_EX_RANGE(ID_FILE_MRU_FILE1, ID_FILE_MRU_FILE16, &CWinApp::OnOpenRecentFile)
END_MESSAGE_MAP()
// clang-format on

namespace {

/// Constant before main, so that application objects of any source file may be made.
CWinApp* theApplication = nullptr;

AFX_MODULE_STATE& moduleState() {
    static AFX_MODULE_STATE state;
    return state;
}

/// Texts of the application object are replaced with free and strdup, as hosts do.
void replaceText(LPCSTR& place, const char* text) {
    if (place != text) {
        std::free(const_cast<char*>(place));
        place = text ? strdup(text) : nullptr;
    }
}

} // namespace

CWinApp* AfxGetApp() {
    return theApplication;
}

CWnd* AfxGetMainWnd() {
    CWinThread* thread = AfxGetThread();
    return thread ? thread->GetMainWnd() : nullptr;
}

AFX_MODULE_STATE* AfxGetModuleState() {
    AFX_MODULE_STATE& state = moduleState();
    state.m_hCurrentInstanceHandle = AfxGetInstanceHandle();
    state.m_hCurrentResourceHandle = AfxGetResourceHandle();
    state.m_pCurrentWinApp = theApplication;
    return &state;
}

LPCSTR AfxGetAppName() {
    return moduleState().m_lpszCurrentAppName;
}

// --- life ---

CWinApp::CWinApp(LPCSTR appName) {
    theApplication = this;
    replaceText(m_pszAppName, appName);
    replaceText(moduleState().m_lpszCurrentAppName, appName);
}

CWinApp::~CWinApp() {
    DeleteDocManager();
    DeleteRecentFileList();
    for (LPCSTR* text : {&m_pszAppName, &m_pszExeName, &m_pszHelpFilePath, &m_pszProfileName, &m_pszRegistryKey}) {
        replaceText(*text, nullptr);
    }
    std::free(m_lpCmdLine);
    m_lpCmdLine = nullptr;
    if (theApplication == this) {
        theApplication = nullptr;
    }
}

BOOL CWinApp::InitApplication() {
    return TRUE;
}

BOOL CWinApp::InitInstance() {
    return TRUE;
}

int CWinApp::Run() {
    if (!m_pMainWnd && hasDisplay()) {
        AfxPostQuitMessage(0); // nothing is there that could end the application
    }
    return CWinThread::Run();
}

int CWinApp::ExitInstance() {
    SaveStdProfileSettings();
    return 0;
}

namespace {

/// Lets every shown frame bring its tool bars, status bar and title up to date.
void updateFrames() {
    // An update handler may end any window, its own frame too.
    for (const HWND frame : Window::topLevelHandles()) {
        const CWnd* object = CWnd::FromHandlePermanent(frame);
        if (!object || !object->IsFrameWnd() || !object->IsWindowVisible()) {
            continue;
        }
        SendMessageA(frame, WM_IDLEUPDATECMDUI, TRUE, 0);
        if (CWnd* still = CWnd::FromHandlePermanent(frame)) {
            still->SendMessageToDescendants(WM_IDLEUPDATECMDUI, TRUE, 0, TRUE, TRUE);
        }
    }
}

} // namespace

BOOL CWinApp::OnIdle(LONG count) {
    if (count == 0) {
        // Once more: the next turn drops the temporary objects that update handlers have made.
        updateFrames();
        return TRUE;
    }
    return CWinThread::OnIdle(count);
}

BOOL CWinApp::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    return CWinThread::OnCmdMsg(id, code, extra, info);
}

void CWinApp::OnAppExit() {
    // The same road as the close button of the main window, so that documents are asked about.
    if (m_pMainWnd) {
        m_pMainWnd->SendMessage(WM_CLOSE);
    } else {
        AfxPostQuitMessage(0);
    }
}

void CWinApp::HideApplication() {
    if (m_pMainWnd) {
        m_pMainWnd->ShowWindow(SW_HIDE);
    }
}

void CWinApp::DoWaitCursor(int code) {
    if (!QCoreApplication::instance()) {
        return;
    }
    const int before = m_waitDepth;
    m_waitDepth = std::max(0, m_waitDepth + code);
    if (before == 0 && m_waitDepth > 0) {
        QApplication::setOverrideCursor(Qt::WaitCursor);
    } else if (before > 0 && m_waitDepth == 0) {
        QApplication::restoreOverrideCursor();
    } else if (code == 0 && m_waitDepth > 0) {
        QApplication::changeOverrideCursor(Qt::WaitCursor);
    }
}

void CWinApp::WinHelpA(DWORD_PTR, UINT command) {
    if (command != HELP_QUIT) {
        const HelpAnswer answer;
        AfxMessageBox(AFX_IDP_FAILED_TO_LAUNCH_HELP, MB_OK | MB_ICONEXCLAMATION, 0);
    }
}

void CWinApp::WinHelpInternal(DWORD_PTR data, UINT command) {
    WinHelpA(data, command);
}

void CWinApp::OnHelp() {
    explainAtKeyboard(m_pMainWnd ? m_pMainWnd->m_hWnd : nullptr);
}

void CWinApp::OnHelpIndex() {
    WinHelpInternal(0, HELP_INDEX);
}

void CWinApp::OnHelpFinder() {
    WinHelpInternal(0, HELP_FINDER);
}

void CWinApp::OnHelpUsing() {
    WinHelpInternal(0, HELP_HELPONHELP);
}

void CWinApp::OnContextHelp() {
    if (m_pMainWnd && m_pMainWnd->IsFrameWnd()) {
        m_pMainWnd->SendMessage(WM_COMMAND, ID_CONTEXT_HELP);
    }
}

namespace {

/// Takes the wait cursor away as long as it lives, for the time that the user is asked something.
class WaitCursorPause {
public:
    WaitCursorPause() {
        change(Qt::ArrowCursor);
    }
    ~WaitCursorPause() {
        change(Qt::WaitCursor);
    }
    WaitCursorPause(const WaitCursorPause&) = delete;
    WaitCursorPause& operator=(const WaitCursorPause&) = delete;

private:
    static void change(Qt::CursorShape shape) {
        if (QCoreApplication::instance() && QApplication::overrideCursor()) {
            QApplication::changeOverrideCursor(shape);
        }
    }
};

} // namespace

int CWinApp::DoMessageBox(LPCSTR text, UINT type, UINT helpId) {
    const CWnd* over = CWnd::GetActiveWindow();
    if (!over) {
        over = GetMainWnd();
    }
    const WaitCursorPause pause;
    const BoxHelp help(helpId != 0 ? HID_BASE_PROMPT + helpId : 0);
    return ::MessageBoxA(over ? over->m_hWnd : nullptr, text, m_pszAppName ? m_pszAppName : AfxGetAppName(), type);
}

HCURSOR CWinApp::LoadCursor(LPCSTR name) const {
    return ::LoadCursorA(AfxFindResourceHandle(name, RT_GROUP_CURSOR), name);
}

HCURSOR CWinApp::LoadCursor(UINT id) const {
    return LoadCursor(MAKEINTRESOURCE(id));
}

HCURSOR CWinApp::LoadStandardCursor(LPCSTR name) const {
    return ::LoadCursorA(nullptr, name);
}

HICON CWinApp::LoadIcon(LPCSTR name) const {
    return ::LoadIconA(AfxFindResourceHandle(name, RT_GROUP_ICON), name);
}

HICON CWinApp::LoadIcon(UINT id) const {
    return LoadIcon(MAKEINTRESOURCE(id));
}

HICON CWinApp::LoadStandardIcon(LPCSTR name) const {
    return ::LoadIconA(nullptr, name);
}

// --- settings location ---

void CWinApp::SetRegistryKey(LPCSTR key) {
    replaceText(m_pszRegistryKey, key);
    replaceText(m_pszProfileName, m_pszAppName);
}

void CWinApp::SetRegistryKey(UINT id) {
    CString key;
    if (key.LoadString(id)) {
        SetRegistryKey(key.GetString());
    }
}

// --- command line ---

namespace {

std::vector<std::string>& arguments() {
    static std::vector<std::string> words;
    return words;
}

} // namespace

void CWinApp::ParseCommandLine(CCommandLineInfo& info) {
    const auto& words = arguments();
    for (std::size_t i = 0; i < words.size(); ++i) {
        const auto [text, isSwitch] = takeApart(words[i].c_str());
        info.ParseParam(text, isSwitch ? TRUE : FALSE, i + 1 == words.size() ? TRUE : FALSE);
    }
}

void CWinApp::rememberCommandLine(int argc, char** argv) {
    arguments().assign(argv + std::min(argc, 1), argv + argc);
    std::string line;
    for (const std::string& word : arguments()) {
        line += line.empty() ? "" : " ";
        const bool quoted = word.empty() || word.find_first_of(" \t") != std::string::npos;
        line += quoted ? '"' + word + '"' : word;
    }
    std::free(m_lpCmdLine);
    m_lpCmdLine = strdup(line.c_str());
}

// --- the entry point's work ---

namespace {

void nameModule(CWinApp& app) {
    const std::filesystem::path program = tvx::moduleFileName(nullptr);
    replaceText(app.m_pszExeName, program.stem().c_str());
    CString title;
    if (!app.m_pszAppName) {
        replaceText(app.m_pszAppName, title.LoadString(AFX_IDS_APP_TITLE) ? title.GetString() : app.m_pszExeName);
    }
    if (!AfxGetAppName()) {
        replaceText(moduleState().m_lpszCurrentAppName, app.m_pszExeName);
    }
    if (!app.m_pszHelpFilePath) {
        const auto help = program.parent_path() / (std::string(app.m_pszExeName) + ".hlp");
        replaceText(app.m_pszHelpFilePath, tvx::driveName(help.string()).c_str());
    }
}

int startCode = 0;
int askedFor = 0;

int runApplication(CWinApp& app) {
    startCode = 0;
    if (!app.InitApplication()) {
        return 1;
    }
    if (!app.InitInstance()) {
        if (app.m_pMainWnd) {
            app.m_pMainWnd->DestroyWindow();
        }
        const int exitCode = app.ExitInstance();
        if (exitCode != 0 || startCode != 0) {
            return exitCode != 0 ? exitCode : startCode;
        }
        // A start that failed for want of a display must not look like one that had nothing to do.
        return wasDisplayMissed() ? 1 : 0;
    }
    return app.Run();
}

} // namespace

void tvx::afx::setStartCode(int exitCode) {
    startCode = exitCode;
}

AskedFor::AskedFor() {
    ++askedFor;
}

AskedFor::~AskedFor() {
    --askedFor;
}

bool AskedFor::isNow() {
    return askedFor > 0;
}

namespace {

/// Whoever started the application may want it to begin without a window.
void rememberStart(CWinApp& app) {
    STARTUPINFOA startup;
    GetStartupInfoA(&startup);
    if (startup.dwFlags & STARTF_USESHOWWINDOW) {
        app.m_nCmdShow = startup.wShowWindow;
    }
}

} // namespace

int AfxWinMain(int argc, char** argv) {
    CWinApp* app = AfxGetApp();
    if (!app) {
        std::fputs("This program has no application object.\n", stderr);
        return 1;
    }
    app->m_hInstance = AfxGetInstanceHandle();
    app->rememberCommandLine(argc, argv);
    rememberStart(*app);
    nameModule(*app);
    try {
        return runApplication(*app);
    } catch (CException* error) {
        error->ReportError(MB_ICONSTOP);
        error->Delete();
    } catch (const std::exception& error) {
        std::fprintf(stderr, "%s: %s\n", app->m_pszExeName, error.what());
    }
    return 1;
}
