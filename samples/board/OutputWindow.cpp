#include "OutputWindow.h"

#include "platform/win/Error.h"
#include "s/Edit.h"
#include "s/Msg.h"

namespace {

/// The program has written something, or ended.
constexpr UINT outputMessage = WM_APP + 1;

/// More than anybody reads, and little enough to be laid out at once.
constexpr int mostText = 200000;

/// What a program reports that was stopped, as if by the interrupt keys.
constexpr unsigned long stopped = 0xC000013A;

CString stateText(unsigned long exitCode) {
    if (exitCode == 259) {
        return Gui_Msg(IDS_RUNNING).GetValue();
    }
    if (Gui_Process::IsAbortExitCode(exitCode)) {
        return Gui_Msg(IDS_STOPPED).GetValue();
    }
    if (Gui_Process::IsCrashExitCode(exitCode)) {
        return Gui_Msg(IDS_CRASHED).GetValue();
    }
    Gui_Msg text(IDS_ENDED);
    text << static_cast<int>(exitCode);
    return text.GetValue();
}

} // namespace

// clang-format off
BEGIN_MESSAGE_MAP(COutputWindow, CDialog)
    ON_WM_SIZE()
    ON_BN_CLICKED(IDC_STOP, &COutputWindow::OnStop)
    ON_MESSAGE(outputMessage, &COutputWindow::OnOutput)
END_MESSAGE_MAP()
// clang-format on

void COutputWindow::Run(const CString& command, CWnd* parent) {
    auto* window = new COutputWindow;
    if (!window->m_process.Run(command, nullptr, 1, 1)) {
        Gui_Msg message(IDS_NOT_STARTED);
        message << command << tvx::errorText(static_cast<DWORD>(window->m_process.GetError())).c_str();
        delete window;
        AfxMessageBox(message, MB_ICONEXCLAMATION);
        return;
    }
    if (!window->Create(IDD_OUTPUT, parent)) {
        delete window;
        return;
    }
    window->SetWindowText(command);
    window->ShowWindow(SW_SHOW);
}

void COutputWindow::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    DDX_Control(dx, IDC_OUTPUT, m_output);
    DDX_Control(dx, IDC_STATE, m_state);
    DDX_Control(dx, IDC_STOP, m_stop);
}

BOOL COutputWindow::OnInitDialog() {
    CDialog::OnInitDialog();
    CRect client;
    GetClientRect(&client);
    m_size = client.Size();
    m_output.SetLimitText(2 * mostText); // room for what comes before old lines go
    showState();
    m_process.NotifyWindow(m_hWnd, outputMessage);
    return TRUE;
}

LRESULT COutputWindow::OnOutput(WPARAM, LPARAM) {
    m_process.AppendOutput(m_output, nullptr);
    dropOldLines();
    showState();
    m_process.NotifyWindow(m_hWnd, outputMessage);
    return 0;
}

// Whole lines go, so that the first one shown is no rest of one. The library drops what exceeds a limit, and keeps what
// the user looks at or has selected.
void COutputWindow::dropOldLines() {
    const int excess = m_output.GetWindowTextLength() - mostText;
    const int kept = excess > 0 ? m_output.LineIndex(m_output.LineFromChar(excess) + 1) : -1;
    if (kept > 0) {
        m_output.SetLimitText(static_cast<UINT>(m_output.GetWindowTextLength() - kept));
        Gui_Edit::AppendText(m_output, "");
        m_output.SetLimitText(2 * mostText);
    }
}

void COutputWindow::showState() {
    const unsigned long code = m_process.GetExitCode();
    const CString text = stateText(code);
    CString shown;
    m_state.GetWindowText(shown);
    if (shown != text) {
        m_state.SetWindowText(text);
    }
    m_stop.EnableWindow(code == 259);
}

void COutputWindow::OnStop() {
    m_process.Terminate(stopped);
}

void COutputWindow::OnOK() {
    // Enter closes nothing that is still being read.
}

void COutputWindow::OnCancel() {
    DestroyWindow();
}

void COutputWindow::PostNcDestroy() {
    delete this;
}

void COutputWindow::OnSize(UINT type, int width, int height) {
    CDialog::OnSize(type, width, height);
    CWnd* close = GetDlgItem(IDCANCEL);
    if (type == SIZE_MINIMIZED || !close || !m_output.m_hWnd || m_size.cx == 0) {
        return;
    }
    const int moreX = width - m_size.cx;
    const int moreY = height - m_size.cy;
    place(m_output, 0, 0, moreX, moreY);
    place(m_state, 0, moreY, moreX, 0);
    place(m_stop, moreX, moreY, 0, 0);
    place(*close, moreX, moreY, 0, 0);
    m_size = CSize(width, height);
}

void COutputWindow::place(CWnd& control, int moveX, int moveY, int growX, int growY) {
    CRect rect;
    control.GetWindowRect(&rect);
    ScreenToClient(&rect);
    rect.OffsetRect(moveX, moveY);
    rect.right += growX;
    rect.bottom += growY;
    control.MoveWindow(&rect);
}
