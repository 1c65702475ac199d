#include "s/CommandPalette.h"

#include "res/resource.h"
#include "s/PaletteList.h"
#include "s/Record.h"
#include "s/StringOf.h"

#include <algorithm>

struct Gui_CommandPalette::Record {
    explicit Record(CFrameWnd& frame) : frame(frame.m_hWnd), list(frame) {}

    HWND frame;
    PaletteList list;
    std::vector<const PaletteEntry*> shown;
    CEdit text;
    CListBox commands;
    UINT chosen = 0; ///< the command to run when the window has closed
    bool closing = false;
    bool ownsItself = false; ///< the object goes with its window

    [[nodiscard]] const PaletteEntry* selected() const {
        const int line = commands.GetCurSel();
        return line >= 0 ? shown[static_cast<std::size_t>(line)] : nullptr;
    }
};

// clang-format off
BEGIN_MESSAGE_MAP(Gui_CommandPalette, CDialog)
    ON_WM_ACTIVATE()
    ON_WM_DRAWITEM()
    ON_WM_MEASUREITEM()
    ON_EN_CHANGE(GUI_IDC_PALETTE_TEXT, &Gui_CommandPalette::OnChangeText)
    ON_LBN_SELCHANGE(GUI_IDC_PALETTE_COMMANDS, &Gui_CommandPalette::OnSelchangeCommands)
END_MESSAGE_MAP()
// clang-format on

int Gui_CommandPalette::Open(CFrameWnd* frame) {
    if (!frame || !frame->m_hWnd || !frame->GetMenu()) {
        return 0;
    }
    std::unique_ptr<Gui_CommandPalette> palette;
    tvx::allocating([&] { palette.reset(new Gui_CommandPalette(frame)); });
    if (!palette->Create(GUI_IDD_COMMANDS, frame)) {
        return 0;
    }
    palette->m_record->ownsItself = true;
    Gui_CommandPalette* window = palette.release();
    window->ShowWindow(SW_SHOW);
    window->SetActiveWindow();
    return 1;
}

Gui_CommandPalette::Gui_CommandPalette(CFrameWnd* frame) : m_record(MakeRecord<Record>(*frame)) {}

Gui_CommandPalette::~Gui_CommandPalette() = default;

void Gui_CommandPalette::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    DDX_Control(dx, GUI_IDC_PALETTE_TEXT, m_record->text);
    DDX_Control(dx, GUI_IDC_PALETTE_COMMANDS, m_record->commands);
}

BOOL Gui_CommandPalette::OnInitDialog() {
    CDialog::OnInitDialog();
    place();
    OnChangeText();
    return TRUE;
}

/// In the middle of the frame, a little below its top.
void Gui_CommandPalette::place() {
    CRect frame;
    CRect own;
    ::GetWindowRect(m_record->frame, &frame);
    GetWindowRect(&own);
    const int left = frame.left + (frame.Width() - own.Width()) / 2;
    const int top = frame.top + std::max((frame.Height() - own.Height()) / 4, 0);
    SetWindowPos(nullptr, left, top, 0, 0, SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
}

// The lines

void Gui_CommandPalette::OnChangeText() {
    CString typed;
    m_record->text.GetWindowText(typed);
    tvx::allocating([&] { m_record->shown = m_record->list.matches(typed.View()); });
    m_record->commands.ResetContent();
    for (const PaletteEntry* entry : m_record->shown) {
        m_record->commands.InsertString(-1, entry->spoken);
    }
    select(m_record->shown.empty() ? -1 : 0);
}

void Gui_CommandPalette::select(int line) {
    m_record->commands.SetCurSel(line);
    OnSelchangeCommands();
}

void Gui_CommandPalette::OnSelchangeCommands() {
    const PaletteEntry* entry = m_record->selected();
    CString prompt = entry ? PromptOf(entry->command.id) : StringOf(GUI_IDS_PALETTE_NOTHING);
    if (entry && !entry->isEnabled()) {
        prompt = StringOf(GUI_IDS_PALETTE_UNAVAILABLE) + " " + prompt;
    }
    SetDlgItemText(GUI_IDC_PALETTE_PROMPT, prompt);
}

void Gui_CommandPalette::OnMeasureItem(int /*id*/, MEASUREITEMSTRUCT* item) {
    item->itemHeight += item->itemHeight / 3;
}

void Gui_CommandPalette::OnDrawItem(int /*id*/, DRAWITEMSTRUCT* item) {
    if (item->itemID >= m_record->shown.size()) {
        return;
    }
    const PaletteEntry& entry = *m_record->shown[item->itemID];
    CDC& dc = *CDC::FromHandle(item->hDC);
    const bool isSelected = (item->itemState & ODS_SELECTED) != 0;
    const int ink = isSelected ? COLOR_HIGHLIGHTTEXT : entry.isEnabled() ? COLOR_WINDOWTEXT : COLOR_GRAYTEXT;
    CRect rect(item->rcItem);
    dc.FillSolidRect(rect, GetSysColor(isSelected ? COLOR_HIGHLIGHT : COLOR_WINDOW));
    dc.SetTextColor(GetSysColor(ink));
    dc.SetBkMode(TRANSPARENT);
    constexpr UINT format = DT_SINGLELINE | DT_VCENTER | DT_NOPREFIX;
    const int margin = rect.Height() / 4;
    rect.DeflateRect(margin, 0);
    if (entry.isChecked()) {
        dc.DrawText("✓", -1, rect, format);
    }
    rect.left += rect.Height();
    dc.DrawText(entry.key, rect, format | DT_RIGHT);
    rect.right -= dc.GetTextExtent(entry.key).cx + 2 * margin;
    dc.DrawText(entry.title, rect, format | DT_END_ELLIPSIS);
}

// What the user does

/// Moves the selection while the keyboard stays in the field.
bool Gui_CommandPalette::move(WPARAM key) {
    CRect area;
    m_record->commands.GetClientRect(&area);
    const int page = std::max(area.Height() / std::max(m_record->commands.GetItemHeight(0), 1) - 1, 1);
    const int last = m_record->commands.GetCount() - 1;
    int line = m_record->commands.GetCurSel();
    switch (key) {
    case VK_UP:
        line = line > 0 ? line - 1 : last;
        break;
    case VK_DOWN:
        line = line < last ? line + 1 : 0;
        break;
    case VK_PRIOR:
        line -= page;
        break;
    case VK_NEXT:
        line += page;
        break;
    case VK_HOME:
        line = 0;
        break;
    case VK_END:
        line = last;
        break;
    default:
        return false;
    }
    select(std::clamp(line, std::min(0, last), last));
    return true;
}

BOOL Gui_CommandPalette::PreTranslateMessage(MSG* message) {
    const bool hasModifier = GetKeyState(VK_SHIFT) < 0 || GetKeyState(VK_CONTROL) < 0;
    if (message->message == WM_KEYDOWN && !hasModifier && GetFocus() == &m_record->text && move(message->wParam)) {
        return TRUE;
    }
    if (message->message == WM_LBUTTONUP && message->hwnd == m_record->commands.m_hWnd) {
        const BOOL result = CDialog::PreTranslateMessage(message);
        const CPoint point(GET_X_LPARAM(message->lParam), GET_Y_LPARAM(message->lParam));
        BOOL outside = TRUE;
        m_record->commands.ItemFromPoint(point, outside);
        if (!outside) {
            PostMessage(WM_COMMAND, IDOK);
        }
        return result;
    }
    return CDialog::PreTranslateMessage(message);
}

void Gui_CommandPalette::OnActivate(UINT state, CWnd* other, BOOL minimized) {
    CDialog::OnActivate(state, other, minimized);
    if (state == WA_INACTIVE && !m_record->closing) {
        PostMessage(WM_CLOSE);
    }
}

void Gui_CommandPalette::OnOK() {
    const PaletteEntry* entry = m_record->selected();
    if (!entry || !entry->isEnabled()) {
        MessageBeep(MB_OK);
        return;
    }
    m_record->chosen = entry->command.id;
    OnCancel();
}

void Gui_CommandPalette::OnCancel() {
    m_record->closing = true;
    DestroyWindow();
}

void Gui_CommandPalette::PostNcDestroy() {
    const HWND frame = m_record->frame;
    const UINT chosen = m_record->chosen;
    if (m_record->ownsItself) {
        delete this;
    }
    if (chosen == 0 || !IsWindow(frame)) {
        return;
    }
    PaletteList::NoteRun(chosen);
    ::SetActiveWindow(frame);
    ::PostMessageA(frame, WM_COMMAND, chosen, 0);
}
