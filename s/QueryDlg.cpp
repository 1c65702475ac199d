#include "s/QueryDlg.h"

#include "res/resource.h"
#include "s/QueryLayout.h"
#include "s/Record.h"

#include <algorithm>

struct Gui_QueryDlg::Record {
    CString title;
    CString prompt;
    CString answer;
    int fieldWidth = 20; ///< average characters
    unsigned int helpId = 0;
};

BEGIN_MESSAGE_MAP(Gui_QueryDlg, CDialog)
ON_BN_CLICKED(GUI_IDC_HELP_BUTTON, &Gui_QueryDlg::OnHelpButton)
END_MESSAGE_MAP()

Gui_QueryDlg::Gui_QueryDlg(CWnd* parent) : CDialog(GUI_IDD_QUERY, parent), m_record(MakeRecord<Record>()) {
    m_record->title = AfxGetAppName();
}

Gui_QueryDlg::~Gui_QueryDlg() = default;

void Gui_QueryDlg::SetTitle(const char* title) {
    m_record->title = title;
}

void Gui_QueryDlg::SetPrompt(const char* prompt) {
    m_record->prompt = prompt;
}

void Gui_QueryDlg::SetAnswer(const char* answer) {
    m_record->answer = answer;
}

CString Gui_QueryDlg::GetAnswer() const {
    return m_record->answer;
}

void Gui_QueryDlg::SetAnswerFieldWidth(int characters) {
    if (characters > 0) {
        m_record->fieldWidth = characters;
    }
}

void Gui_QueryDlg::SetHelpId(unsigned int id) {
    m_record->helpId = id;
}

BOOL Gui_QueryDlg::OnInitDialog() {
    CDialog::OnInitDialog();
    SetWindowText(m_record->title);
    SetDlgItemText(GUI_IDC_QUERY_PROMPT, m_record->prompt);
    SetDlgItemText(GUI_IDC_QUERY_ANSWER, m_record->answer);
    layOut();
    return TRUE;
}

void Gui_QueryDlg::OnOK() {
    GetDlgItemText(GUI_IDC_QUERY_ANSWER, m_record->answer);
    CDialog::OnOK();
}

void Gui_QueryDlg::OnHelpButton() {
    CWinApp* app = AfxGetApp();
    if (m_record->helpId != 0 && app) {
        app->WinHelpA(m_record->helpId, HELP_CONTEXT);
    }
}

// Layout

namespace {

CSize clientSize(const CWnd& control) {
    CRect client;
    control.GetClientRect(&client);
    return client.Size();
}

int lineHeight(const CDC& dc) {
    TEXTMETRIC metrics{};
    dc.GetTextMetrics(&metrics);
    return metrics.tmHeight + metrics.tmExternalLeading;
}

/// The room that the prompt takes. It is measured in the context as the platform hands it out, and in the font that the
/// control draws with when that is the larger one.
CSize promptSize(CWnd& control, const CString& text, int widest) {
    CDC* dc = control.GetDC();
    CSize size(dc->GetTextExtent(text).cx, lineHeight(*dc));
    CFont* systemFont = dc->SelectObject(control.GetFont());
    CRect drawn(0, 0, widest, 0);
    dc->DrawText(text, &drawn, DT_CALCRECT | DT_NOPREFIX);
    const bool wraps = size.cx > widest || drawn.Width() > widest;
    const bool plain = !wraps && text.FindOneOf("\r\n") < 0;
    if (wraps) {
        drawn = CRect(0, 0, widest, 0);
        dc->DrawText(text, &drawn, DT_CALCRECT | DT_NOPREFIX | DT_WORDBREAK);
    }
    dc->SelectObject(systemFont);
    control.ReleaseDC(dc);
    return plain ? CSize(std::max<int>(size.cx, drawn.Width()), std::max<int>(size.cy, drawn.Height()))
                 : CSize(wraps ? widest : drawn.Width(), drawn.Height());
}

int fieldWidth(CWnd& field, int characters) {
    TEXTMETRIC metrics{};
    CDC* dc = field.GetDC();
    dc->GetTextMetrics(&metrics);
    field.ReleaseDC(dc);
    // No field is wider than the widest screen.
    return std::min(characters, 0x7FFF) * metrics.tmAveCharWidth;
}

/// The height of a dialog around a client area: a high caption must not take all the room below the buttons.
int leastHeight(const CWnd& dialog, int client) {
    CRect window;
    dialog.GetWindowRect(&window);
    return client + window.Height() - clientSize(dialog).cy;
}

void place(CWnd& control, CPoint corner) {
    control.SetWindowPos(nullptr, corner.x, corner.y, 0, 0, SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
}

} // namespace

void Gui_QueryDlg::layOut() {
    CWnd& prompt = *GetDlgItem(GUI_IDC_QUERY_PROMPT);
    CWnd& field = *GetDlgItem(GUI_IDC_QUERY_ANSWER);
    CWnd& help = *GetDlgItem(GUI_IDC_HELP_BUTTON);
    const DWORD units = static_cast<DWORD>(GetDialogBaseUnits());
    QueryMeasures measures;
    measures.margin = CSize(7 * (LOWORD(units) / 4), 7 * (HIWORD(units) / 8));
    measures.widest = GetSystemMetrics(SM_CXFULLSCREEN) - 4 * measures.margin.cx;
    measures.promptClient = clientSize(prompt);
    measures.field = CSize(fieldWidth(field, m_record->fieldWidth), clientSize(field).cy);
    measures.prompt = promptSize(prompt, m_record->prompt, WidestPrompt(measures));
    measures.button = clientSize(*GetDlgItem(IDOK));
    measures.hasHelp = m_record->helpId != 0;
    const QueryLayout layout = LayOutQuery(measures);
    prompt.MoveWindow(&layout.prompt);
    field.MoveWindow(&layout.field);
    place(*GetDlgItem(IDOK), layout.ok);
    place(*GetDlgItem(IDCANCEL), layout.cancel);
    place(help, layout.help);
    help.ShowWindow(measures.hasHelp ? SW_SHOW : SW_HIDE);
    const int least = leastHeight(*this, layout.ok.y + measures.button.cy + measures.margin.cy);
    SetWindowPos(nullptr, 0, 0, layout.dialog.cx, std::max<int>(layout.dialog.cy, least),
                 SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
}
