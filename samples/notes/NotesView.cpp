#include "NotesView.h"

#include "Resource.h"
#include "afxdlgs.h"
#include "platform/base/Text.h"
#include "s/Msg.h"
#include "s/Profile.h"

namespace {

/// The size of the letters until the user chooses a font, in tenths of a point.
constexpr int textSize = 110;

} // namespace

IMPLEMENT_DYNCREATE(CNotesView, CView)

// clang-format off
BEGIN_MESSAGE_MAP(CNotesView, CView)
    ON_WM_CREATE()
    ON_WM_SIZE()
    ON_WM_SETFOCUS()
    ON_WM_CONTEXTMENU()
    ON_EN_CHANGE(IDC_TEXT, &CNotesView::OnChange)
    ON_COMMAND(ID_EDIT_UNDO, &CNotesView::OnEditUndo)
    ON_COMMAND(ID_EDIT_CUT, &CNotesView::OnEditCut)
    ON_COMMAND(ID_EDIT_COPY, &CNotesView::OnEditCopy)
    ON_COMMAND(ID_EDIT_PASTE, &CNotesView::OnEditPaste)
    ON_COMMAND(ID_EDIT_CLEAR, &CNotesView::OnEditClear)
    ON_COMMAND(ID_EDIT_SELECT_ALL, &CNotesView::OnEditSelectAll)
    ON_COMMAND(ID_EDIT_FIND, &CNotesView::OnEditFind)
    ON_COMMAND(ID_EDIT_REPEAT, &CNotesView::OnEditRepeat)
    ON_COMMAND(ID_VIEW_FONT, &CNotesView::OnViewFont)
    ON_UPDATE_COMMAND_UI(ID_EDIT_UNDO, &CNotesView::OnUpdateUndo)
    ON_UPDATE_COMMAND_UI(ID_EDIT_CUT, &CNotesView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_EDIT_COPY, &CNotesView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_EDIT_CLEAR, &CNotesView::OnUpdateSelected)
    ON_UPDATE_COMMAND_UI(ID_EDIT_PASTE, &CNotesView::OnUpdatePaste)
    ON_UPDATE_COMMAND_UI(ID_INDICATOR_POSITION, &CNotesView::OnUpdatePosition)
END_MESSAGE_MAP()
// clang-format on

int CNotesView::OnCreate(CREATESTRUCT* cs) {
    constexpr DWORD style = WS_CHILD | WS_VISIBLE | WS_VSCROLL | ES_MULTILINE | ES_AUTOVSCROLL | ES_WANTRETURN;
    if (CView::OnCreate(cs) == -1 || !m_edit.Create(style, CRect(), this, IDC_TEXT)) {
        return -1;
    }
    m_edit.SetLimitText(0);
    m_edit.DragAcceptFiles();
    m_font.CreatePointFont(textSize, "Sans");
    LOGFONT font{};
    m_font.GetLogFont(&font);
    Gui_Profile::ReadLogFont(font, nullptr, nullptr); // leaves it where the user has chosen none
    setFont(font);
    return 0;
}

void CNotesView::OnSize(UINT type, int cx, int cy) {
    CView::OnSize(type, cx, cy);
    m_edit.MoveWindow(0, 0, cx, cy);
}

void CNotesView::OnSetFocus(CWnd*) {
    m_edit.SetFocus();
}

// --- the text ---

std::string CNotesView::GetText() const {
    CString text;
    m_edit.GetWindowText(text);
    return text.GetString();
}

void CNotesView::OnUpdate(CView*, LPARAM, CObject*) {
    m_edit.SetWindowText(GetDocument()->GetText().edited().c_str());
}

void CNotesView::SetSaved() {
    m_edit.SetModify(FALSE);
}

// Undone back to what was saved, the text has no changes.
void CNotesView::OnChange() {
    GetDocument()->SetModifiedFlag(m_edit.GetModify());
}

// --- the Edit menu ---

void CNotesView::OnEditUndo() {
    m_edit.Undo();
}

void CNotesView::OnEditCut() {
    m_edit.Cut();
}

void CNotesView::OnEditCopy() {
    m_edit.Copy();
}

void CNotesView::OnEditPaste() {
    m_edit.Paste();
}

void CNotesView::OnEditClear() {
    m_edit.Clear();
}

void CNotesView::OnEditSelectAll() {
    m_edit.SetSel(0, -1);
}

void CNotesView::OnUpdateUndo(CCmdUI* item) {
    item->Enable(m_edit.CanUndo());
}

void CNotesView::OnUpdateSelected(CCmdUI* item) {
    int start = 0;
    int end = 0;
    m_edit.GetSel(start, end);
    item->Enable(start != end);
}

void CNotesView::OnUpdatePaste(CCmdUI* item) {
    item->Enable(::IsClipboardFormatAvailable(CF_TEXT));
}

// The control leaves the menu of a right click to its parent.
void CNotesView::OnContextMenu(CWnd*, CPoint point) {
    if (point == CPoint(-1, -1)) { // asked for with the keyboard
        point = CPoint(10, 10);
        ClientToScreen(&point);
    }
    CMenu menu;
    menu.LoadMenu(IDR_CONTEXT);
    menu.GetSubMenu(0)->TrackPopupMenu(TPM_LEFTALIGN | TPM_RIGHTBUTTON, point.x, point.y, GetTopLevelFrame());
}

// --- finding ---

void CNotesView::OnEditFind() {
    const CString selected = m_edit.GetSelText();
    if (!selected.IsEmpty() && selected.FindOneOf("\r\n") < 0) {
        m_find.text = selected;
    }
    CFindDialog dialog(m_find, this);
    if (dialog.DoModal() == IDOK) {
        m_find = dialog.GetOptions();
        OnEditRepeat();
    }
}

// From behind the selection to the end, then from the beginning.
void CNotesView::OnEditRepeat() {
    if (m_find.text.IsEmpty()) {
        OnEditFind();
        return;
    }
    int start = 0;
    int end = 0;
    m_edit.GetSel(start, end);
    if (!findFrom(end) && !findFrom(0)) {
        Gui_Msg message(IDS_NOT_FOUND);
        message << m_find.text;
        AfxMessageBox(message, MB_OK | MB_ICONINFORMATION, IDS_NOT_FOUND);
    }
}

bool CNotesView::findFrom(int start) {
    FINDTEXTEX find{};
    find.chrg = {start, m_edit.GetTextLength()};
    find.lpstrText = m_find.text;
    const unsigned long flags = (m_find.wholeWord ? FR_WHOLEWORD : 0) | (m_find.matchCase ? FR_MATCHCASE : 0);
    if (m_edit.FindTextA(flags, &find) < 0) {
        return false;
    }
    m_edit.SetSel(find.chrgText.cpMin, find.chrgText.cpMax);
    return true;
}

// --- what it looks like ---

void CNotesView::setFont(const LOGFONT& font) {
    CFont former;
    former.Attach(m_font.Detach()); // the control uses it until it has the new one
    m_font.CreateFontIndirect(&font);
    m_edit.SetFont(&m_font);
}

void CNotesView::OnViewFont() {
    LOGFONT font{};
    m_edit.GetFont()->GetLogFont(&font);
    CFontDialog dialog(&font, CF_SCREENFONTS | CF_INITTOLOGFONTSTRUCT, nullptr, this);
    if (dialog.DoModal() == IDOK) {
        dialog.GetCurrentFont(&font);
        setFont(font);
        Gui_Profile::WriteLogFont(font, nullptr, nullptr);
    }
}

void CNotesView::OnUpdatePosition(CCmdUI* item) {
    int start = 0;
    int caret = 0;
    m_edit.GetSel(start, caret);
    const int line = m_edit.LineFromChar(caret);
    std::string before(static_cast<std::size_t>(caret - m_edit.LineIndex(line)), '\0');
    before.resize(static_cast<std::size_t>(m_edit.GetLine(line, before.data(), static_cast<int>(before.size()))));
    Gui_Msg text(IDS_POSITION);
    text << line + 1 << static_cast<int>(tvx::text::characterCount(before)) + 1;
    item->Enable();
    item->SetText(text);
}
