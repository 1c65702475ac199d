#include "Board.h"

#include "BoardDoc.h"
#include "BoardPages.h"
#include "BoardView.h"
#include "DrawingFrame.h"
#include "MainFrame.h"
#include "Resource.h"
#include "platform/port/CmdOpcodes.h"
#include "platform/port/MsgDispatcher.h"
#include "s/CommandPalette.h"
#include "s/Desktop.h"
#include "s/FileName.h"
#include "s/Help.h"
#include "s/Locale.h"
#include "samples/family/FamilyOptions.h"
#include "samples/family/FamilyResource.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <utility>

// --- the command line ---

void CBoardCommandLine::ParseParam(const char* param, BOOL isSwitch, BOOL isLast) {
    if (isSwitch) {
        const UT_CMDOPCODES options(GetCmdOpcodes());
        const char* name = options.optionname(param);
        m_gridFollows = name && std::strcmp(name, "grid") == 0;
        m_single |= name && std::strcmp(name, "single") == 0;
    } else if (m_gridFollows) {
        m_gridFollows = false;
        m_grid = static_cast<int>(std::clamp(std::strtol(param, nullptr, 10), 0L, 1000L));
        return;
    }
    const CString before = m_strFileName;
    Gui_CommandLineInfo::ParseParam(param, isSwitch, isLast);
    // The framework keeps the first plain word only, and takes words that are values of its own switches itself.
    if (!isSwitch && m_strFileName != before) {
        m_drawings.push_back(m_strFileName);
        m_strFileName.Empty();
    }
}

CString CBoardCommandLine::GetCmdOpcodes() const {
    CString text;
    text.LoadString(IDS_CMD_OPCODES);
    return text;
}

CString CBoardCommandLine::GetUsageText() const {
    CString text;
    text.LoadString(IDS_USAGE);
    return text;
}

// --- the application ---

CBoardApp theApp;

// clang-format off
BEGIN_MESSAGE_MAP(CBoardApp, Gui_WinApp)
    ON_COMMAND(ID_FILE_NEW, &CWinApp::OnFileNew)
    ON_COMMAND(ID_FILE_OPEN, &CWinApp::OnFileOpen)
    ON_COMMAND(ID_TOOLS_KEYBOARD, &CBoardApp::OnToolsKeyboard)
    ON_COMMAND(ID_TOOLS_COMMANDS, &CBoardApp::OnToolsCommands)
    ON_COMMAND(ID_TOOLS_PREFERENCES, &CBoardApp::OnToolsPreferences)
END_MESSAGE_MAP()
// clang-format on

CBoardApp::CBoardApp() : Gui_WinApp("board") {}

BOOL CBoardApp::InitInstance() {
    Port_MsgDispatcher::addMsgMan(&m_messages);
    Gui_Locale::SetAppResourceHandle();
    SetRegistryKey("Tarvex");
    LoadStdProfileSettings();

    CBoardCommandLine info;
    ParseCommandLine(info);
    if (!ProcessCommandLine(info)) {
        return FALSE;
    }
    m_options = Options::Read();
    m_options.gridDistance = info.m_grid.value_or(m_options.gridDistance);
    if (info.m_single) {
        if (!IsFirstInstance()) {
            ShowFirstInstanceWindow();
            return FALSE;
        }
        RegisterInstance();
        m_single = true;
    }
    Gui_Help::SetHelpFileName("board.map");
    if (info.m_bShowSplash) {
        m_splash = std::make_unique<Gui_SplashDlg>(nullptr);
        m_splash->Create(nullptr);
    }
    return ShowMainFrame(info);
}

int CBoardApp::ExitInstance() {
    if (m_single) {
        UnregisterInstance();
    }
    return Gui_WinApp::ExitInstance();
}

BOOL CBoardApp::ShowMainFrame(CBoardCommandLine& info) {
    auto* drawings = new CMultiDocTemplate(IDR_BOARDTYPE, RUNTIME_CLASS(CBoardDoc), RUNTIME_CLASS(CDrawingFrame),
                                           RUNTIME_CLASS(CBoardView));
    AddDocTemplate(drawings);
    m_console.Init();
    auto* frame = new CMainFrame;
    m_pMainWnd = frame;
    if (!frame->LoadFrame(IDR_MAINFRAME)) {
        return FALSE;
    }
    m_keyboard = std::make_unique<CKeyboard>(*frame, *drawings);
    if (!OpenDrawings(info)) {
        return FALSE;
    }
    frame->DragAcceptFiles();
    frame->ActivateFrame(m_nCmdShow);
    frame->UpdateWindow();
    RegisterInstanceWindow(Gui_Desktop::GetMainWindowID());
    return TRUE;
}

CString CBoardApp::DrawingName(const CString& word) {
    const Gui_FileName name(word);
    if (name.HasExtension() || name.Exists()) {
        return word;
    }
    Gui_FileName drawing(name);
    drawing.SetExtension("brd");
    return drawing.IsFile() ? drawing.GetFullName() : word;
}

// One drawing that cannot be opened does not keep the others from being shown.
BOOL CBoardApp::OpenDrawings(CBoardCommandLine& info) {
    if (info.m_drawings.empty()) {
        return ProcessShellCommand(info);
    }
    BOOL opened = FALSE;
    for (const CString& drawing : info.m_drawings) {
        info.m_nShellCommand = CCommandLineInfo::FileOpen;
        info.m_strFileName = DrawingName(drawing);
        opened |= ProcessShellCommand(info);
    }
    return opened;
}

void CBoardApp::SetOptions(const Options& options) {
    const Options before = std::exchange(m_options, options);
    m_console.SetOptions(options);
    POSITION first = GetFirstDocTemplatePosition();
    CDocTemplate* const drawings = GetNextDocTemplate(first);
    for (POSITION at = drawings->GetFirstDocPosition(); at;) {
        CDocument* const drawing = drawings->GetNextDoc(at);
        for (POSITION view = drawing->GetFirstViewPosition(); view;) {
            static_cast<CBoardView*>(drawing->GetNextView(view))->OptionsChanged(before);
        }
    }
}

HICON CBoardApp::GetAppIcon() {
    return LoadIcon(IDR_MAINFRAME);
}

CString CBoardApp::GetAppVersion() {
    CString version;
    version.LoadString(IDS_VERSION);
    return version;
}

CFrameWnd* CBoardApp::WorkFrame() const {
    CFrameWnd* floating = AfxGetRoutingFrame();
    return floating ? floating : static_cast<CFrameWnd*>(m_pMainWnd);
}

HWND CBoardApp::GetOwnerForFileDialog() {
    const CFrameWnd* frame = WorkFrame();
    return frame ? frame->m_hWnd : nullptr;
}

// A document with a folder of its own goes before the folder that the user has chosen.
CString CBoardApp::GetInitialDirForFileDialog(const CString& fileName) {
    const CString folder = FamilyOptions::Read().documentFolder;
    const bool counts = !folder.IsEmpty() && !Gui_FileName(fileName).HasAbsolutePath();
    return counts ? folder : Gui_WinApp::GetInitialDirForFileDialog(fileName);
}

void CBoardApp::OnToolsPreferences() {
    CBoardPreferences(WorkFrame()).DoModal();
}

void CBoardApp::OnToolsKeyboard() {
    m_keyboard->Edit();
}

void CBoardApp::OnToolsCommands() {
    Gui_CommandPalette::Open(WorkFrame());
}

BOOL CBoardApp::PreTranslateMessage(MSG* message) {
    if (m_splash) {
        m_splash->CheckMessage(message, m_pMainWnd);
    }
    return Gui_WinApp::PreTranslateMessage(message);
}

BOOL CBoardApp::OnIdle(LONG count) {
    if (m_splash && !m_splash->CheckTimeout(m_pMainWnd)) {
        m_splash.reset();
    }
    return Gui_WinApp::OnIdle(count);
}
