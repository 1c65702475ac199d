#include "s/ConsoleControls.h"

#include "platform/base/Text.h"
#include "res/resource.h"
#include "s/ConsoleState.h"
#include "s/Msg.h"

#include <string>

namespace {

constexpr UINT lineFeed = 10;
constexpr UINT carriageReturn = 13;
constexpr UINT backspace = 8;

CString TextOf(HWND window) {
    CString text;
    CWnd::FromHandle(window)->GetWindowText(text);
    return text;
}

} // namespace

// clang-format off
BEGIN_MESSAGE_MAP(Gui_ConsoleEdit, CEdit)
    ON_WM_CHAR()
    ON_WM_KEYDOWN()
    ON_WM_KILLFOCUS()
    ON_WM_GETDLGCODE()
    ON_MESSAGE(WM_PASTE, &Gui_ConsoleEdit::OnPaste)
END_MESSAGE_MAP()
// clang-format on

// --- running ---

void Gui_ConsoleEdit::OnChar(UINT character, UINT repeat, UINT flags) {
    if (character == carriageReturn || character == lineFeed) {
        // What stands there is not what is being searched for.
        const bool runs = !m_search || m_search->found;
        EndSearch();
        if (runs) {
            Run();
        }
    } else if (!OnSearchChar(character)) {
        CEdit::OnChar(character, repeat, flags);
    }
}

void Gui_ConsoleEdit::Run() {
    CString typed;
    GetWindowText(typed);
    CString input = typed;
    input.Trim();
    if (input.IsEmpty()) {
        return;
    }
    // The command may close the console, and with it this object.
    const HWND field = m_hWnd;
    if (ResolveAndRunCommand(input) != 1 || !::IsWindow(field)) {
        return;
    }
    if (Gui_ConsoleRecall* recall = ConsoleState().m_recall.get()) {
        recall->Leave();
    }
    // What was typed while it ran stays.
    const CString now = TextOf(field);
    const bool grown = now.GetLength() > typed.GetLength() && now.Left(typed.GetLength()) == typed;
    if (grown || now == typed) {
        const CString rest = now.Mid(typed.GetLength());
        ::SetWindowTextA(field, rest);
        ::SendMessageA(field, EM_SETSEL, static_cast<WPARAM>(rest.GetLength()), rest.GetLength());
    }
}

// --- the clipboard ---

bool Gui_ConsoleEdit::CanPaste() {
    return ::IsClipboardFormatAvailable(CF_TEXT) != FALSE;
}

LRESULT Gui_ConsoleEdit::OnPaste(WPARAM, LPARAM) {
    EndSearch();
    if (!CanPaste() || !::OpenClipboard(m_hWnd)) {
        return 0;
    }
    CString text;
    if (const HANDLE block = ::GetClipboardData(CF_TEXT)) {
        text = static_cast<const char*>(::GlobalLock(block));
        ::GlobalUnlock(block);
    }
    ::CloseClipboard();
    // One line takes several, whatever ends them.
    text.Replace("\r\n", " ");
    text.Replace('\n', ' ');
    text.Replace('\r', ' ');
    if (!text.IsEmpty()) {
        ReplaceSel(text);
    }
    return 0;
}

// --- walking ---

void Gui_ConsoleEdit::Show(const CString& text) {
    SetWindowText(text);
    SetSel(text.GetLength(), text.GetLength());
}

bool Gui_ConsoleEdit::OnWalkKey(UINT key) {
    Gui_ConsoleRecall* const recall = ConsoleState().m_recall.get();
    if ((key != VK_UP && key != VK_DOWN) || !recall) {
        return false;
    }
    CString text;
    GetWindowText(text);
    if (key == VK_UP ? recall->Older(text) : recall->Newer(text)) {
        Show(text);
    }
    return true;
}

void Gui_ConsoleEdit::OnKeyDown(UINT key, UINT repeat, UINT flags) {
    if (!OnSearchKey(key) && !OnWalkKey(key)) {
        CEdit::OnKeyDown(key, repeat, flags);
    }
}

void Gui_ConsoleEdit::OnKillFocus(CWnd* next) {
    EndSearch();
    CEdit::OnKillFocus(next);
}

UINT Gui_ConsoleEdit::OnGetDlgCode() {
    const bool escapes = m_search && GetCurrentMessage()->wParam == VK_ESCAPE;
    return CEdit::OnGetDlgCode() | (escapes ? DLGC_WANTALLKEYS : 0);
}

// --- searching ---

bool Gui_ConsoleEdit::OnSearchKey(UINT key) {
    const Gui_ConsoleRecall* const recall = ConsoleState().m_recall.get();
    const bool control = ::GetKeyState(VK_CONTROL) < 0;
    const bool shift = ::GetKeyState(VK_SHIFT) < 0;
    if (control && key == 'R' && recall) {
        if (m_search) {
            Search(shift ? 1 : -1);
            return true;
        }
        m_search = SearchState();
        GetWindowText(m_search->before);
        m_search->place = recall->GetNewest();
        ShowPattern(true);
        return true;
    }
    if (!m_search) {
        return false;
    }
    switch (key) {
    case VK_ESCAPE:
        GiveUpSearch();
        return true;
    case VK_UP:
    case VK_DOWN:
        Search(key == VK_UP ? -1 : 1);
        return true;
    case VK_LEFT:
    case VK_RIGHT:
    case VK_HOME:
    case VK_END:
    case VK_DELETE:
        EndSearch();
        break;
    default:
        break;
    }
    return false;
}

bool Gui_ConsoleEdit::OnSearchChar(UINT character) {
    const bool control = ::GetKeyState(VK_CONTROL) < 0 && ::GetKeyState(VK_MENU) >= 0;
    if (!m_search || control) {
        return m_search.has_value();
    }
    if (character == backspace) {
        const std::string_view pattern = m_search->pattern.GetString();
        m_search->pattern.Truncate(static_cast<int>(tvx::text::previousCharacter(pattern, pattern.size())));
        SearchAgain();
    } else if (character >= ' ') {
        std::string pattern = m_search->pattern.GetString();
        tvx::text::append(pattern, character);
        m_search->pattern = pattern.c_str();
        SearchAgain();
    }
    return true;
}

/// Looks from the newest command on: the pattern has changed.
void Gui_ConsoleEdit::SearchAgain() {
    const Gui_ConsoleRecall* const recall = ConsoleState().m_recall.get(); // null when the host has ended the console
    m_search->place = recall ? recall->GetNewest() : -1;
    if (m_search->pattern.IsEmpty()) {
        Show(m_search->before);
        ShowPattern(true);
        return;
    }
    Search(0);
}

/// Shows the command that is found, what was searched for selected.
/// @param step  -1: an older one, 1: a newer one, 0: the first from where the search stands
void Gui_ConsoleEdit::Search(int step) {
    if (m_search->pattern.IsEmpty()) {
        return; // nothing has been asked for yet
    }
    const Gui_ConsoleRecall* const recall = ConsoleState().m_recall.get();
    CString now;
    GetWindowText(now);
    CString text = now;
    int place = m_search->place + step;
    bool found = false;
    // Equal commands are one to who looks for another one.
    while (recall && recall->Search(m_search->pattern, place, step > 0 ? 1 : -1, text)) {
        found = step == 0 || text != now;
        if (found) {
            break;
        }
        place += step;
    }
    if (!found) {
        ::MessageBeep(MB_OK);
    } else {
        m_search->place = place;
        SetWindowText(text);
        const CString folded = tvx::text::foldCase(text.GetString()).c_str();
        const int at = folded.Find(tvx::text::foldCase(m_search->pattern.GetString()).c_str());
        SetSel(at, at + m_search->pattern.GetLength());
    }
    ShowPattern(found);
}

void Gui_ConsoleEdit::ShowPattern(bool found) {
    m_search->found = found;
    Gui_Msg text(found ? GUI_IDS_CONSOLE_SEARCH : GUI_IDS_CONSOLE_NOT_FOUND);
    showSearch((text << m_search->pattern).GetValue());
}

void Gui_ConsoleEdit::GiveUpSearch() {
    const CString before = m_search->before;
    EndSearch();
    Show(before);
}

void Gui_ConsoleEdit::EndSearch() {
    if (!m_search) {
        return;
    }
    m_search.reset();
    SetSel(GetWindowTextLength(), GetWindowTextLength());
    showSearch({});
}
