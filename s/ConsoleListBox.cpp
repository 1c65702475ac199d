#include "s/ConsoleControls.h"

#include "res/resource.h"
#include "s/ConsoleState.h"
#include "s/MainWindow.h"
#include "s/Msg.h"

#include <algorithm>
#include <string>

namespace {

/// "21> run b " or "Done. ": the blank behind a line keeps the next character off when the list is scrolled.
std::string DisplayText(const Gui_ConsoleHistoryLine& line) {
    std::string text;
    text.reserve(static_cast<std::size_t>(line.m_text.GetLength()) + 24);
    if (line.IsCommand()) {
        text.append(std::to_string(line.m_number)).append("> ");
    }
    text.append(line.m_text.View()).append(" ");
    return text;
}

/// A window's device context with its font.
class FontDC {
public:
    explicit FontDC(CWnd& window) : m_dc(&window), m_old(m_dc.SelectObject(window.GetFont())) {}
    ~FontDC() {
        m_dc.SelectObject(m_old);
    }
    FontDC(const FontDC&) = delete;
    FontDC& operator=(const FontDC&) = delete;
    CDC& operator*() {
        return m_dc;
    }

private:
    CClientDC m_dc;
    CFont* m_old;
};

} // namespace

// clang-format off
BEGIN_MESSAGE_MAP(Gui_ConsoleListBox, CListBox)
    ON_WM_CREATE()
    ON_WM_CONTEXTMENU()
    ON_WM_GETDLGCODE()
    ON_WM_KEYDOWN()
END_MESSAGE_MAP()
// clang-format on

int Gui_ConsoleListBox::OnCreate(CREATESTRUCT* cs) {
    if (CListBox::OnCreate(cs) == -1) {
        return -1;
    }
    FontDC dc(*this);
    SetItemHeight(0, static_cast<UINT>((*dc).GetTextExtent("A").cy));
    return 0;
}

// --- lines ---

void Gui_ConsoleListBox::AddLine(Gui_ConsoleHistoryLine* line) {
    SetRedraw(FALSE);
    AddString(reinterpret_cast<LPCSTR>(line));
    SetRedraw(TRUE);
    FontDC dc(*this);
    Measure(*dc, *line);
}

void Gui_ConsoleListBox::Measure(CDC& dc, const Gui_ConsoleHistoryLine& line) {
    int& widest = ConsoleState().m_widestLine;
    const std::string text = DisplayText(line);
    const int width = dc.GetTextExtent(text.c_str(), static_cast<int>(text.size())).cx;
    if (width > widest) {
        widest = width;
        SetHorizontalExtent(widest);
    }
}

// A command that takes long keeps the window from being painted: what it reports is shown while it runs, but not so
// often that a flood of lines is held up by it.
void Gui_ConsoleListBox::PaintNowAndThen() {
    constexpr std::chrono::milliseconds often(50);
    const auto now = std::chrono::steady_clock::now();
    if (ConsoleState().m_isRunning && now - m_painted > often) {
        UpdateWindow();
        m_painted = now;
    }
}

void Gui_ConsoleListBox::ShowEnd() {
    ScrollToEnd();
    PaintNowAndThen();
}

void Gui_ConsoleListBox::ScrollToEnd() {
    const int height = GetItemHeight(0);
    if (height <= 0) {
        return;
    }
    CRect client;
    GetClientRect(&client);
    // All lines are of one height: from there on the last one is whole in sight.
    const int wanted = std::max(GetCount() - client.Height() / height, 0);
    if (GetTopIndex() < wanted) {
        SetTopIndex(wanted);
    }
}

void Gui_ConsoleListBox::Fill(const Gui_ConsoleHistoryLineArray& lines) {
    const auto count = lines.GetSize();
    if (ConsoleState().m_widestLine > 0) {
        SetHorizontalExtent(ConsoleState().m_widestLine);
    }
    SetRedraw(FALSE);
    SendMessage(LB_INITSTORAGE, static_cast<WPARAM>(count));
    {
        FontDC dc(*this);
        for (INT_PTR i = 0; i < count; ++i) {
            AddString(reinterpret_cast<LPCSTR>(lines.LineAt(i)));
            Measure(*dc, *lines.LineAt(i));
        }
    }
    if (count > 0) {
        SetTopIndex(static_cast<int>(count) - 1);
    }
    SetRedraw(TRUE);
}

void Gui_ConsoleListBox::RemoveLines() {
    ResetContent();
    ConsoleState().m_widestLine = 0;
    SetHorizontalExtent(0);
}

Gui_ConsoleHistoryLine* Gui_ConsoleListBox::LineAt(int index) const {
    return index >= 0 && index < GetCount() ? static_cast<Gui_ConsoleHistoryLine*>(GetItemDataPtr(index)) : nullptr;
}

// --- the selection ---

std::vector<int> Gui_ConsoleListBox::Selected() const {
    std::vector<int> indexes(static_cast<std::size_t>(std::max(GetSelCount(), 0)));
    GetSelItems(static_cast<int>(indexes.size()), indexes.data());
    return indexes;
}

bool Gui_ConsoleListBox::HasSelection(bool anything) const {
    const std::vector<int> selected = Selected();
    return std::any_of(selected.begin(), selected.end(), [&](int index) {
        const Gui_ConsoleHistoryLine* line = LineAt(index);
        return anything || (line && line->IsCommand());
    });
}

std::vector<CString> Gui_ConsoleListBox::GetSelectedCommands() const {
    std::vector<CString> commands;
    for (const int index : Selected()) {
        const Gui_ConsoleHistoryLine* line = LineAt(index);
        if (line && line->IsCommand()) {
            commands.push_back(line->m_text);
        }
    }
    return commands;
}

// --- what is seen ---

void Gui_ConsoleListBox::DrawItem(DRAWITEMSTRUCT* item) {
    const Gui_ConsoleHistoryLine* line = LineAt(static_cast<int>(item->itemID));
    if (!line || (item->itemAction & (ODA_DRAWENTIRE | ODA_SELECT)) == 0) {
        return;
    }
    CDC& dc = *CDC::FromHandle(item->hDC);
    const COLORREF text = dc.GetTextColor();
    const COLORREF background = dc.GetBkColor();
    if ((item->itemState & ODS_SELECTED) != 0) {
        dc.SetTextColor(background);
        dc.SetBkColor(text);
    }
    dc.TextOut(item->rcItem.left, item->rcItem.top, DisplayText(*line).c_str());
    dc.SetTextColor(text);
    dc.SetBkColor(background);
}

CString Gui_ConsoleListBox::GetAccessibleText(int index) const {
    const Gui_ConsoleHistoryLine* line = LineAt(index);
    if (!line) {
        return {};
    }
    return line->IsCommand() ? CString(DisplayText(*line)).Trim()
                             : (Gui_Msg(GUI_IDS_CONSOLE_STATUS) << line->m_text).GetValue();
}

// --- the menu, and keys for its commands ---

void Gui_ConsoleListBox::OnContextMenu(CWnd*, CPoint point) {
    CMenu menu;
    CWnd* const owner = CWnd::FromHandle(MainWindowHandle());
    if (!owner || !menu.LoadMenu(GUI_IDM_CONSOLE)) {
        return;
    }
    const bool byKeyboard = point == CPoint(-1, -1);
    const CPoint place = byKeyboard ? MenuPoint() : point;
    menu.GetSubMenu(0)->TrackPopupMenu(TPM_RIGHTBUTTON, place.x, place.y, owner);
}

/// Below the current line, as far as that is in sight.
CPoint Gui_ConsoleListBox::MenuPoint() const {
    CRect client;
    GetClientRect(&client);
    CRect row;
    CPoint place = client.TopLeft();
    if (GetItemRect(GetCaretIndex(), &row) != LB_ERR) {
        place.y = std::clamp(row.bottom, client.top, client.bottom);
    }
    ClientToScreen(&place);
    return place;
}

UINT Gui_ConsoleListBox::OnGetDlgCode() {
    const MSG* message = GetCurrentMessage();
    return CListBox::OnGetDlgCode() | (message->wParam == VK_RETURN ? DLGC_WANTALLKEYS : 0);
}

void Gui_ConsoleListBox::OnKeyDown(UINT key, UINT repeat, UINT flags) {
    const bool control = GetKeyState(VK_CONTROL) < 0;
    const bool copies = control && (key == 'C' || key == VK_INSERT);
    if (copies || (!control && key == VK_RETURN)) {
        GetParent()->SendMessage(WM_COMMAND, copies ? GUI_ID_CONSOLE_COPY : GUI_ID_CONSOLE_RUN);
        return;
    }
    CListBox::OnKeyDown(key, repeat, flags);
}
