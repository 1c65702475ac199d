#include "s/Edit.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <string_view>

BEGIN_MESSAGE_MAP(Gui_Edit, CEdit)
ON_WM_RBUTTONUP()
END_MESSAGE_MAP()

Gui_Edit::Gui_Edit() = default;
Gui_Edit::~Gui_Edit() = default;

int Gui_Edit::GetTextLength() const {
    return GetWindowTextLength();
}

CString Gui_Edit::GetSelText() {
    int start = 0;
    int end = 0;
    GetSel(start, end);
    CString text;
    if (start != end) {
        GetWindowText(text);
    }
    return text.Mid(start, end - start);
}

void Gui_Edit::OnRButtonUp(UINT, CPoint point) {
    ClientToScreen(&point);
    if (CWnd* parent = GetParent()) {
        parent->PostMessage(WM_CONTEXTMENU, 0, MAKELPARAM(point.x, point.y));
    }
}

// Finding

namespace {

enum class Case { Ignore, Match };
enum class Place { Any, WholeWord };

struct Search {
    std::string_view wanted;
    Case sense = Case::Ignore;
    Place place = Place::Any;
};

struct Found {
    std::size_t start = 0;
    std::size_t end = 0;
};

bool isSpace(char32_t c) {
    return c == ' ' || (c >= 0x09 && c <= 0x0D) || c == 0x85 || c == 0xA0 || c == 0x1680 ||
           (c >= 0x2000 && c <= 0x200A) || c == 0x2028 || c == 0x2029 || c == 0x202F || c == 0x205F || c == 0x3000;
}

bool isSpaceAt(std::string_view text, std::size_t at) {
    return isSpace(tvx::text::decode(text, at));
}

/// Whether a word can begin here: behind white space or at the start of the text.
bool isWordStart(std::string_view text, std::size_t at) {
    return at == 0 || isSpaceAt(text, tvx::text::characterStart(text, at - 1));
}

/// Bytes of as many characters as `model` has. Letters that are equal without case need not have the same length.
std::size_t lengthOfCharacters(std::string_view text, std::string_view model) {
    std::size_t length = 0;
    for (std::size_t at = 0; at < model.size(); at += tvx::text::characterLength(model, at)) {
        length += tvx::text::characterLength(text, length);
    }
    return length;
}

/// Where a match that begins at `at` ends; npos when none does.
std::size_t matchEnd(std::string_view text, std::size_t at, const Search& search) {
    const std::string_view rest = text.substr(at);
    if (search.sense == Case::Match) {
        return rest.starts_with(search.wanted) ? at + search.wanted.size() : std::string_view::npos;
    }
    if (!tvx::text::startsWithNoCase(rest, search.wanted)) {
        return std::string_view::npos;
    }
    return at + lengthOfCharacters(rest, search.wanted);
}

Found findFrom(std::string_view text, std::size_t start, const Search& search) {
    bool wordStart = search.place == Place::Any || isWordStart(text, start);
    for (std::size_t at = start; at < text.size(); at += tvx::text::characterLength(text, at)) {
        const std::size_t end = wordStart ? matchEnd(text, at, search) : std::string_view::npos;
        const bool wordEnd = search.place == Place::Any || end == text.size();
        if (end != std::string_view::npos && (wordEnd || isSpaceAt(text, end))) {
            return {at, end};
        }
        wordStart = search.place == Place::Any || isSpaceAt(text, at);
    }
    return {std::string_view::npos, std::string_view::npos};
}

Search searchFor(const char* wanted, unsigned long flags) {
    Search search{wanted};
    if (flags == FR_MATCHCASE || flags == (FR_MATCHCASE | FR_WHOLEWORD)) {
        search.sense = Case::Match;
    }
    if (flags == FR_WHOLEWORD || flags == (FR_MATCHCASE | FR_WHOLEWORD)) {
        search.place = Place::WholeWord;
    }
    return search;
}

} // namespace

int Gui_Edit::FindTextA(unsigned long flags, _findtextexa* find) {
    CString text;
    GetWindowText(text);
    const LONG start = find->chrg.cpMin;
    if (start < 0 || start >= text.GetLength() || !find->lpstrText) {
        return -1;
    }
    const auto [first, end] = findFrom(text.View(), static_cast<std::size_t>(start), searchFor(find->lpstrText, flags));
    if (first == std::string_view::npos) {
        return -1;
    }
    find->chrgText = {static_cast<LONG>(first), static_cast<LONG>(end)};
    return find->chrgText.cpMax > find->chrg.cpMax ? -1 : find->chrgText.cpMin;
}

// Appending

namespace {

constexpr int limitOfLines = 60000;
constexpr int limitOfLine = 30000;

int limitOf(CEdit& edit) {
    if (edit.GetLimitText() == 0) {
        edit.SetLimitText((edit.GetStyle() & ES_MULTILINE) != 0 ? limitOfLines : limitOfLine);
    }
    return static_cast<int>(std::min<UINT>(edit.GetLimitText(), INT_MAX));
}

/// The end of `text` that the limit has room for, cut between characters, as the control can take it.
CString lastPart(const CString& text, int limit) {
    std::size_t start = static_cast<std::size_t>(std::max(text.GetLength() - limit, 0));
    while (tvx::text::characterStart(text.View(), start) != start) {
        ++start;
    }
    CString part(text.View().substr(start));
    part.Replace('\0', ' ');
    return part;
}

/// What the user sees of a control of many lines. When that is not the end, or something is selected, it stays while
/// the text changes around it.
class View {
public:
    explicit View(CEdit& edit, bool isSelected)
        : m_edit(edit), m_first(edit.GetFirstVisibleLine()), m_lines(edit.GetLineCount()) {
        m_stays = isSelected || (edit.IsWindowVisible() && !seesEnd());
    }
    /// Call it when the oldest text has gone, and before the new one comes.
    void textDropped() {
        m_first = std::max(m_first - (m_lines - m_edit.GetLineCount()), 0);
    }
    void restore() {
        // To the very end: the caret's line can be in sight with the bar a line short of it.
        const int first = m_stays ? m_first : m_edit.GetLineCount();
        m_edit.LineScroll(first - m_edit.GetFirstVisibleLine());
    }

private:
    bool seesEnd() const {
        SCROLLINFO bar{};
        bar.cbSize = sizeof(bar);
        return !m_edit.GetScrollInfo(SB_VERT, &bar) || bar.nPos + std::max<int>(bar.nPage, 1) > bar.nMax;
    }

    CEdit& m_edit;
    int m_first;
    int m_lines;
    bool m_stays = false;
};

/// Deletes at least `bytes` from the beginning of the text, in whole characters. The result is how many went.
int dropOldest(CEdit& edit, int bytes) {
    const int before = edit.GetWindowTextLength();
    int dropped = 0;
    // A position within a character is moved to its beginning, so the last one may still be there.
    for (int end = bytes; dropped < bytes && dropped < before; ++end) {
        edit.SetSel(0, end - dropped, TRUE);
        edit.ReplaceSel("");
        dropped = before - edit.GetWindowTextLength();
    }
    return dropped;
}

} // namespace

void Gui_Edit::AppendText(const CString& text) {
    AppendText(*this, text);
}

void Gui_Edit::AppendText(CEdit& edit, const CString& text) {
    int start = 0;
    int end = 0;
    edit.GetSel(start, end);
    const bool selected = start != end;
    View view(edit, selected);
    const int limit = limitOf(edit);
    const CString added = lastPart(text, limit);
    const int excess = added.GetLength() - (limit - edit.GetWindowTextLength());
    if (excess > 0) {
        const int dropped = dropOldest(edit, excess);
        start = std::max(start - dropped, 0);
        end = std::max(end - dropped, 0);
        view.textDropped();
    }
    const int length = edit.GetWindowTextLength();
    edit.SetSel(length, length, TRUE);
    edit.ReplaceSel(added, FALSE);
    if (selected) {
        edit.SetSel(start, end, TRUE);
    }
    view.restore();
}
