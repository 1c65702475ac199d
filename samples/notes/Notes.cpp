#include "Notes.h"

#include "MainFrame.h"
#include "NotesDoc.h"
#include "NotesPreferences.h"
#include "NotesView.h"
#include "Resource.h"
#include "platform/port/CmdOpcodes.h"
#include "platform/port/MsgDispatcher.h"
#include "s/BrowserPreference.h"
#include "s/FileName.h"
#include "s/Help.h"
#include "s/Locale.h"
#include "samples/family/FamilyOptions.h"
#include "samples/family/FamilyResource.h"

#include <cstring>

// --- the command line ---

void CNotesCommandLine::ParseParam(const char* param, BOOL isSwitch, BOOL isLast) {
    if (isSwitch) {
        const UT_CMDOPCODES options(GetCmdOpcodes());
        const char* name = options.optionname(param);
        m_single |= name && std::strcmp(name, "single") == 0;
    }
    Gui_CommandLineInfo::ParseParam(param, isSwitch, isLast); // takes the text's name
}

CString CNotesCommandLine::GetCmdOpcodes() const {
    CString text;
    text.LoadString(IDS_CMD_OPCODES);
    return text;
}

CString CNotesCommandLine::GetUsageText() const {
    CString text;
    text.LoadString(IDS_USAGE);
    return text;
}

// --- the application ---

CNotesApp theApp;

// clang-format off
BEGIN_MESSAGE_MAP(CNotesApp, Gui_WinApp)
    ON_COMMAND(ID_FILE_NEW, &CWinApp::OnFileNew)
    ON_COMMAND(ID_FILE_OPEN, &CWinApp::OnFileOpen)
    ON_COMMAND(ID_TOOLS_KEYBOARD, &CNotesApp::OnToolsKeyboard)
    ON_COMMAND(ID_TOOLS_PREFERENCES, &CNotesApp::OnToolsPreferences)
    ON_COMMAND(ID_TOOLS_WEB_BROWSER, &CNotesApp::OnToolsWebBrowser)
END_MESSAGE_MAP()
// clang-format on

CNotesApp::CNotesApp() : Gui_WinApp("notes") {}

BOOL CNotesApp::InitInstance() {
    Port_MsgDispatcher::addMsgMan(&m_messages);
    Gui_Locale::SetAppResourceHandle();
    SetRegistryKey("Tarvex");
    LoadStdProfileSettings();

    CNotesCommandLine info;
    ParseCommandLine(info);
    if (!ProcessCommandLine(info)) {
        return FALSE;
    }
    if (info.m_single) {
        if (!IsFirstInstance()) {
            ShowFirstInstanceWindow();
            return FALSE;
        }
        RegisterInstance();
        m_single = true;
    }
    Gui_Help::SetHelpFileName("notes.map");
    if (info.m_bShowSplash) {
        m_splash = std::make_unique<Gui_SplashDlg>(nullptr);
        m_splash->Create(nullptr);
    }
    return ShowMainFrame(info);
}

int CNotesApp::ExitInstance() {
    if (m_single) {
        UnregisterInstance();
    }
    return Gui_WinApp::ExitInstance();
}

// The template makes the main window with the first document, and shows it: the frame finds its own place and records
// its window for the one instance.
BOOL CNotesApp::ShowMainFrame(CNotesCommandLine& info) {
    AddDocTemplate(new CSingleDocTemplate(IDR_MAINFRAME, RUNTIME_CLASS(CNotesDoc), RUNTIME_CLASS(CMainFrame),
                                          RUNTIME_CLASS(CNotesView)));
    if (!ProcessShellCommand(info)) {
        return FALSE;
    }
    auto* frame = static_cast<CMainFrame*>(m_pMainWnd);
    m_keyboard = std::make_unique<CKeyboard>(*frame);
    frame->DragAcceptFiles();
    frame->UpdateWindow();
    return TRUE;
}

HICON CNotesApp::GetAppIcon() {
    return LoadIcon(IDR_MAINFRAME);
}

CString CNotesApp::GetAppVersion() {
    CString version;
    version.LoadString(IDS_VERSION);
    return version;
}

// A text with a folder of its own goes before the folder that the user has chosen.
CString CNotesApp::GetInitialDirForFileDialog(const CString& fileName) {
    const CString folder = FamilyOptions::Read().documentFolder;
    const bool counts = !folder.IsEmpty() && !Gui_FileName(fileName).HasAbsolutePath();
    return counts ? folder : Gui_WinApp::GetInitialDirForFileDialog(fileName);
}

void CNotesApp::OnToolsPreferences() {
    CNotesPreferences(m_pMainWnd).DoModal();
}

void CNotesApp::OnToolsKeyboard() {
    m_keyboard->Edit();
}

void CNotesApp::OnToolsWebBrowser() {
    Gui_BrowserPreference preference;
    preference.GetModalPreferenceDialog().DoModal();
}

BOOL CNotesApp::PreTranslateMessage(MSG* message) {
    if (m_splash) {
        m_splash->CheckMessage(message, m_pMainWnd);
    }
    return Gui_WinApp::PreTranslateMessage(message);
}

BOOL CNotesApp::OnIdle(LONG count) {
    if (m_splash && !m_splash->CheckTimeout(m_pMainWnd)) {
        m_splash.reset();
    }
    return Gui_WinApp::OnIdle(count);
}
