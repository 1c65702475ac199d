#include "MainFrame.h"

#include "Board.h"
#include "Indicators.h"
#include "OutputWindow.h"
#include "Resource.h"
#include "platform/base/Text.h"
#include "platform/win/Registry.h"
#include "s/BrowserPreference.h"
#include "s/Profile.h"
#include "s/QueryDlg.h"

IMPLEMENT_DYNCREATE(CMainFrame, Gui_FloatMainFrame)

// clang-format off
BEGIN_MESSAGE_MAP(CMainFrame, Gui_FloatMainFrame)
    ON_WM_CREATE()
    ON_WM_CLOSE()
    ON_COMMAND(ID_TOOLS_RUN_COMMAND, &CMainFrame::OnRunCommand)
    ON_COMMAND(ID_TOOLS_CONSOLE, &CMainFrame::OnConsole)
    ON_COMMAND(ID_TOOLS_WEB_BROWSER, &CMainFrame::OnWebBrowser)
    ON_COMMAND(ID_HELP_FINDER, &CMDIFrameWnd::OnHelpFinder)
    ON_COMMAND(ID_HELP_SEARCH, &CMainFrame::OnHelpSearch)
END_MESSAGE_MAP()
// clang-format on

BOOL CMainFrame::PreCreateWindow(CREATESTRUCT& cs) {
    cs.cx = 1000;
    cs.cy = 700;
    return Gui_FloatMainFrame::PreCreateWindow(cs);
}

int CMainFrame::OnCreate(CREATESTRUCT* cs) {
    if (Gui_FloatMainFrame::OnCreate(cs) == -1) {
        return -1;
    }
    constexpr DWORD style = WS_CHILD | WS_VISIBLE | CBRS_TOP | CBRS_TOOLTIPS | CBRS_FLYBY;
    if (!m_toolBar.CreateEx(this, TBSTYLE_FLAT, style) || !m_toolBar.LoadToolBar(IDR_MAINFRAME)) {
        return -1;
    }
    if (!m_statusBar.Create(this) || !m_statusBar.SetIndicators(indicators, std::size(indicators))) {
        return -1;
    }
    m_statusBar.SetToolTips(indicatorTips, std::size(indicatorTips));
    m_toolBar.EnableDocking(CBRS_ALIGN_ANY);
    EnableDocking(CBRS_ALIGN_ANY);
    DockControlBar(&m_toolBar);
    return 0;
}

void CMainFrame::ActivateFrame(int command) {
    if (!m_placed) {
        m_placed = true;
        WINDOWPLACEMENT placement;
        if (Gui_Profile::ReadWindowPlacement(placement, nullptr, nullptr)) {
            SetWindowPlacement(&placement);
            command = static_cast<int>(placement.showCmd);
        }
        Gui_Profile::ReadBarState(this, nullptr);
    }
    Gui_FloatMainFrame::ActivateFrame(command);
}

void CMainFrame::saveWindows() {
    // Together: where another program holds the settings, this is waited for once.
    tvx::RegistryTransaction together;
    if (together.begin() != ERROR_SUCCESS) {
        return;
    }
    WINDOWPLACEMENT placement;
    if (GetWindowPlacement(&placement)) {
        Gui_Profile::WriteWindowPlacement(placement, nullptr, nullptr);
    }
    Gui_Profile::WriteBarState(this, nullptr);
    (void)together.commit();
}

void CMainFrame::OnClose() {
    saveWindows();
    Gui_FloatMainFrame::OnClose();
}

void CMainFrame::OnRunCommand() {
    CString title;
    CString prompt;
    title.LoadString(IDS_RUN_TITLE);
    prompt.LoadString(IDS_RUN_PROMPT);
    Gui_QueryDlg query;
    query.SetTitle(title);
    query.SetPrompt(prompt);
    query.SetAnswer(m_lastCommand);
    query.SetAnswerFieldWidth(50);
    query.SetHelpId(HID_BASE_COMMAND + ID_TOOLS_RUN_COMMAND);
    if (query.DoModal() != IDOK) {
        return;
    }
    const CString command = query.GetAnswer();
    if (!command.IsEmpty()) {
        m_lastCommand = command;
        COutputWindow::Run(command, this);
    }
}

void CMainFrame::OnConsole() {
    theApp.GetConsole().Open();
}

void CMainFrame::OnWebBrowser() {
    Gui_BrowserPreference preference;
    preference.GetModalPreferenceDialog().DoModal();
}

void CMainFrame::OnHelpSearch() {
    CString title;
    CString prompt;
    title.LoadString(IDS_SEARCH_TITLE);
    prompt.LoadString(IDS_SEARCH_PROMPT);
    Gui_QueryDlg query;
    query.SetTitle(title);
    query.SetPrompt(prompt);
    query.SetAnswer(m_lastKeyword);
    query.SetAnswerFieldWidth(30);
    query.SetHelpId(HID_BASE_COMMAND + ID_HELP_SEARCH);
    if (query.DoModal() == IDOK && !query.GetAnswer().IsEmpty()) {
        m_lastKeyword = query.GetAnswer();
        // Keywords begin with a capital letter in the board's help, and have no other.
        const int first = static_cast<int>(tvx::text::characterLength(m_lastKeyword.GetString()));
        m_lastKeyword = m_lastKeyword.Left(first).MakeUpper() + m_lastKeyword.Mid(first).MakeLower();
        WinHelp(reinterpret_cast<DWORD_PTR>(m_lastKeyword.GetString()), HELP_KEY);
    }
}
