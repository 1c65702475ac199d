#include "s/ConsoleView.h"

#include "res/resource.h"
#include "s/ConsoleControls.h"
#include "s/ConsoleState.h"
#include "s/MainWindow.h"
#include "s/Msg.h"
#include "s/StringOf.h"

#include <cstring>

IMPLEMENT_DYNCREATE(Gui_ConsoleView, CFormView)

// clang-format off
BEGIN_MESSAGE_MAP(Gui_ConsoleView, CFormView)
    ON_WM_SIZE()
    ON_WM_DESTROY()
    ON_WM_SETFOCUS()
    ON_BN_CLICKED(GUI_IDC_CONSOLE_SHOW_STATUS, &Gui_ConsoleView::OnShowStatus)
    ON_COMMAND(GUI_ID_CONSOLE_COPY, &Gui_ConsoleView::OnCopyCommands)
    ON_COMMAND(GUI_ID_CONSOLE_RUN, &Gui_ConsoleView::OnRunCommands)
    ON_COMMAND(ID_EDIT_COPY, &Gui_ConsoleView::OnEditCopy)
    ON_COMMAND(ID_EDIT_CUT, &Gui_ConsoleView::OnEditCut)
    ON_COMMAND(ID_EDIT_PASTE, &Gui_ConsoleView::OnEditPaste)
    ON_COMMAND(ID_FILE_CLOSE, &Gui_ConsoleView::OnFileClose)
    ON_UPDATE_COMMAND_UI(ID_WINDOW_NEW, &Gui_ConsoleView::OnUpdateNever)
    ON_UPDATE_COMMAND_UI(ID_FILE_SAVE, &Gui_ConsoleView::OnUpdateNever)
    ON_UPDATE_COMMAND_UI(ID_FILE_SAVE_AS, &Gui_ConsoleView::OnUpdateNever)
    ON_UPDATE_COMMAND_UI(GUI_ID_CONSOLE_COPY, &Gui_ConsoleView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(GUI_ID_CONSOLE_RUN, &Gui_ConsoleView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_EDIT_COPY, &Gui_ConsoleView::OnUpdateEditCopy)
    ON_UPDATE_COMMAND_UI(ID_EDIT_CUT, &Gui_ConsoleView::OnUpdateEditCut)
    ON_UPDATE_COMMAND_UI(ID_EDIT_PASTE, &Gui_ConsoleView::OnUpdateEditPaste)
END_MESSAGE_MAP()
// clang-format on

Gui_ConsoleView::Gui_ConsoleView()
    : CFormView(GUI_IDD_CONSOLE),
      m_showStatus(ConsoleState().m_showStatus),
      m_input(std::make_unique<Gui_ConsoleEdit>()),
      m_list(std::make_unique<Gui_ConsoleListBox>()) {
    m_input->showSearch = [this](const CString& text) { ShowSearch(text); };
    ConsoleState().m_view = this;
}

Gui_ConsoleView::~Gui_ConsoleView() {
    // A view whose window was never made.
    if (ConsoleState().m_view == this) {
        ConsoleState().m_view = nullptr;
    }
}

void Gui_ConsoleView::DoDataExchange(CDataExchange* dx) {
    CFormView::DoDataExchange(dx);
    DDX_Control(dx, GUI_IDC_CONSOLE_PROMPT, m_promptLabel);
    DDX_Control(dx, GUI_IDC_CONSOLE_SHOW_STATUS, m_statusBox);
    DDX_Text(dx, GUI_IDC_CONSOLE_PROMPT, m_prompt);
    DDX_Check(dx, GUI_IDC_CONSOLE_SHOW_STATUS, m_showStatus);
}

void Gui_ConsoleView::OnInitialUpdate() {
    CFormView::OnInitialUpdate();
    GetDocument()->SetTitle(StringOf(GUI_IDR_CONSOLE).Trim());
    ShowPrompt();
    UpdateData(FALSE);
    m_list->SubclassDlgItem(GUI_IDC_CONSOLE_LINES, this);
    m_input->SubclassDlgItem(GUI_IDC_CONSOLE_INPUT, this);
    m_list->SetWindowText(GetDocument()->GetTitle());
    CRect client;
    GetClientRect(&client);
    Layout(client.Width(), client.Height());
    FillList(Fill::First);
}

// The keyboard begins in the field; later it goes back to where it was.
void Gui_ConsoleView::OnSetFocus(CWnd* previous) {
    if (!m_hadFocus && m_input->m_hWnd) {
        m_input->SetFocus();
        m_hadFocus = InputHasFocus();
    } else {
        CFormView::OnSetFocus(previous);
    }
}

void Gui_ConsoleView::OnDestroy() {
    CFormView::OnDestroy();
    Gui_ConsoleState& state = ConsoleState();
    if (state.m_view == this) {
        state.m_showStatus = m_showStatus;
        state.m_view = nullptr;
    }
}

// --- layout ---

void Gui_ConsoleView::OnSize(UINT type, int width, int height) {
    CFormView::OnSize(type, width, height);
    if (m_list->m_hWnd && m_statusBox.m_hWnd && m_input->m_hWnd) {
        CRect client; // scroll bars that came or went have changed the size meanwhile
        GetClientRect(&client);
        Layout(client.Width(), client.Height());
        Invalidate();
    }
}

// The field stands at the bottom, with its prompt; above it the box, and the lines have the rest. Distances are dialog
// units of the system's font.
void Gui_ConsoleView::Layout(int width, int height) {
    const LONG units = ::GetDialogBaseUnits();
    const int h = LOWORD(units) / 4;
    const int v = HIWORD(units) / 8;
    CRect field;
    CRect label;
    CRect box;
    const auto place = [this](const CWnd& control, CRect& rect) {
        control.GetWindowRect(&rect);
        ScreenToClient(&rect);
    };
    place(*m_input, field);
    place(m_promptLabel, label);
    place(m_statusBox, box);
    const int top = height - field.Height() - 7 * v;
    const int boxTop = top - box.Height() - 5 * v;
    m_input->MoveWindow(field.left, top, width - field.left - 7 * h, field.Height());
    m_promptLabel.MoveWindow(label.left, top + v, label.Width(), label.Height());
    m_statusBox.MoveWindow(box.left, boxTop, box.Width(), box.Height());
    m_list->MoveWindow(7 * h, 7 * v, width - 14 * h, boxTop - 7 * v - 5 * v);
}

// --- lines and prompt ---

void Gui_ConsoleView::FillList(Fill fill) {
    if (fill == Fill::Again) {
        m_list->RemoveLines();
    }
    if (const Gui_ConsoleHistory* history = ConsoleState().m_history.get()) {
        m_list->Fill(m_showStatus ? history->GetLines() : history->GetCommands());
    }
}

void Gui_ConsoleView::ShowLine(Gui_ConsoleHistoryLine* line) {
    if (m_list->m_hWnd) {
        m_list->AddLine(line);
        m_list->ShowEnd();
    }
}

void Gui_ConsoleView::ShowPrompt() {
    CString number;
    number.Format("%lu", NextCommandNumber());
    m_prompt = (Gui_Msg(GUI_IDS_CONSOLE_PROMPT) << number).GetValue();
    if (m_promptLabel.m_hWnd && m_search.IsEmpty()) {
        m_promptLabel.SetWindowText(m_prompt);
    }
}

void Gui_ConsoleView::ShowSearch(const CString& text) {
    m_search = text;
    m_promptLabel.SetWindowText(text.IsEmpty() ? m_prompt : text);
}

void Gui_ConsoleView::SetShowStatus(int show) {
    m_showStatus = show;
    UpdateData(FALSE);
}

void Gui_ConsoleView::ForgetLines() {
    if (m_list->m_hWnd) {
        m_list->RemoveLines();
    }
}

// The box alone is read: the label may show a search in place of the prompt.
void Gui_ConsoleView::OnShowStatus() {
    m_showStatus = m_statusBox.GetCheck();
    FillList(Fill::Again);
}

// --- commands ---

void Gui_ConsoleView::OnCopyCommands() {
    CString text;
    for (const CString& command : m_list->GetSelectedCommands()) {
        text += command + "\r\n";
    }
    if (!::OpenClipboard(MainWindowHandle())) {
        return;
    }
    ::EmptyClipboard();
    const auto size = static_cast<std::size_t>(text.GetLength());
    if (const HGLOBAL block = ::GlobalAlloc(GMEM_MOVEABLE | GMEM_ZEROINIT, size + 1)) {
        std::memcpy(::GlobalLock(block), text.GetString(), size);
        ::GlobalUnlock(block);
        ::SetClipboardData(CF_TEXT, block);
    }
    ::CloseClipboard();
}

void Gui_ConsoleView::OnRunCommands() {
    const HWND window = m_hWnd;
    for (const CString& command : m_list->GetSelectedCommands()) {
        // One of them may close the console.
        if (!::IsWindow(window)) {
            return;
        }
        ResolveAndRunCommand(command);
    }
}

void Gui_ConsoleView::OnEditCopy() {
    if (InputHasFocus()) {
        m_input->Copy();
    } else {
        OnCopyCommands();
    }
}

void Gui_ConsoleView::OnEditCut() {
    m_input->Cut();
}

void Gui_ConsoleView::OnEditPaste() {
    m_input->Paste();
}

void Gui_ConsoleView::OnFileClose() {
    GetParentFrame()->DestroyWindow();
}

// --- what can be done ---

bool Gui_ConsoleView::InputHasFocus() const {
    return m_input->m_hWnd && ::GetFocus() == m_input->m_hWnd;
}

bool Gui_ConsoleView::InputHasSelection() const {
    int start = 0;
    int end = 0;
    m_input->GetSel(start, end);
    return InputHasFocus() && start != end;
}

bool Gui_ConsoleView::HasSelectedCommand() const {
    return m_list->m_hWnd && m_list->HasSelection(m_showStatus == 0);
}

void Gui_ConsoleView::OnUpdateNever(CCmdUI* item) {
    item->Enable(FALSE);
}

void Gui_ConsoleView::OnUpdateSelected(CCmdUI* item) {
    item->Enable(HasSelectedCommand());
}

void Gui_ConsoleView::OnUpdateEditCopy(CCmdUI* item) {
    item->Enable(InputHasFocus() ? InputHasSelection() : HasSelectedCommand());
}

void Gui_ConsoleView::OnUpdateEditCut(CCmdUI* item) {
    item->Enable(InputHasSelection());
}

void Gui_ConsoleView::OnUpdateEditPaste(CCmdUI* item) {
    item->Enable(InputHasFocus() && Gui_ConsoleEdit::CanPaste());
}
