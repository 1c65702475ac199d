#include "s/Edit.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

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

/// The characters of a text as a search compares them. None changes its place by that, but its bytes may.
std::string compared(std::string_view text, Case sense) {
    return sense == Case::Match ? std::string(text) : tvx::text::foldCase(text);
}

/// Finds a text in characters that come one by one, and never looks at one again: of what has matched so far it knows
/// how much still does when the next one does not fit.
class Matcher {
public:
    explicit Matcher(std::string_view wanted) {
        for (std::size_t at = 0; at < wanted.size();) {
            m_wanted.push_back(tvx::text::decode(wanted, at));
        }
        m_begins.resize(m_wanted.size());
        m_shorter.push_back(0);
        for (std::size_t i = 1; i < m_wanted.size(); ++i) {
            advance(m_wanted[i]);
            m_shorter.push_back(m_matched);
        }
        m_matched = 0;
    }

    /// Takes the character that begins at `place`. Whether the text that is looked for ends with it.
    bool take(char32_t character, std::size_t place) {
        m_begins[m_taken++ % m_begins.size()] = place;
        advance(character);
        return m_matched == m_wanted.size();
    }
    /// Where the text begins that has just been found.
    std::size_t begin() const {
        return m_begins[m_taken % m_begins.size()];
    }

private:
    void advance(char32_t character) {
        while (m_matched > 0 && (m_matched == m_wanted.size() || m_wanted[m_matched] != character)) {
            m_matched = m_shorter[m_matched - 1];
        }
        m_matched += m_wanted[m_matched] == character ? 1 : 0;
    }

    std::u32string m_wanted;
    std::vector<std::size_t> m_shorter; ///< for each length that matches, the next shorter one that does as well
    std::vector<std::size_t> m_begins;  ///< of the latest characters, in turns
    std::size_t m_matched = 0;
    std::size_t m_taken = 0;
};

bool isAccepted(std::string_view text, const Found& found, Place place) {
    const bool wordEnd = found.end == text.size() || isSpaceAt(text, found.end);
    return place == Place::Any || (wordEnd && isWordStart(text, found.start));
}

/// Nothing stands everywhere, but not everywhere as a word.
Found findNothing(std::string_view text, std::size_t start, Place place) {
    for (std::size_t at = start; at < text.size(); at += tvx::text::characterLength(text, at)) {
        if (isAccepted(text, {at, at}, place)) {
            return {at, at};
        }
    }
    return {std::string_view::npos, std::string_view::npos};
}

Found findFrom(std::string_view text, std::size_t start, const Search& search) {
    if (search.wanted.empty()) {
        return findNothing(text, start, search.place);
    }
    Matcher matcher(compared(search.wanted, search.sense));
    const std::string folded = compared(text.substr(start), search.sense);
    std::size_t foldedAt = 0;
    for (std::size_t at = start; at < text.size();) {
        const std::size_t place = at;
        at += tvx::text::characterLength(text, at);
        if (matcher.take(tvx::text::decode(folded, foldedAt), place)) {
            const Found found{matcher.begin(), at};
            if (isAccepted(text, found, search.place)) {
                return found;
            }
        }
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
    const auto [first, end] = tvx::allocating(
        [&] { return findFrom(text.View(), static_cast<std::size_t>(start), searchFor(find->lpstrText, flags)); });
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
constexpr std::size_t longestCharacter = 4;

int limitOf(CEdit& edit) {
    if (edit.GetLimitText() == 0) {
        edit.SetLimitText((edit.GetStyle() & ES_MULTILINE) != 0 ? limitOfLines : limitOfLine);
    }
    return static_cast<int>(std::min<UINT>(edit.GetLimitText(), INT_MAX));
}

/// A text as the control will hold and count it: with one line, or with "\r\n" between its lines. Of one that is
/// larger than the limit only an end is taken, which is larger too and may begin within a character.
std::string asHeld(const CEdit& edit, std::string_view text, std::size_t limit) {
    const bool manyLines = (edit.GetStyle() & ES_MULTILINE) != 0;
    if (!manyLines) {
        text = text.substr(0, text.find_first_of("\r\n"));
    }
    text = text.substr(text.size() - std::min(text.size(), limit + longestCharacter));
    std::string held;
    held.reserve(text.size());
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char c = text[at];
        if (c == '\r' || c == '\n') {
            held += "\r\n";
            at += text.substr(at).starts_with("\r\n") ? 1 : 0;
        } else {
            held += c == '\0' ? ' ' : c;
        }
    }
    return held;
}

/// The end of a text that the limit has room for, cut between characters and not within a line end.
std::string_view lastPart(std::string_view text, std::size_t limit) {
    std::size_t start = text.size() - std::min(text.size(), limit);
    while (tvx::text::characterStart(text, start) != start) {
        ++start;
    }
    const bool splitsLineEnd = start > 0 && text[start - 1] == '\r' && text.substr(start).starts_with('\n');
    return text.substr(splitsLineEnd ? start + 1 : start);
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
    const auto limit = static_cast<std::size_t>(limitOf(edit));
    const std::string held = tvx::allocating([&] { return asHeld(edit, text.View(), limit); });
    const auto old = static_cast<std::size_t>(edit.GetWindowTextLength());
    if (held.size() + old > limit) {
        const int dropped = dropOldest(edit, static_cast<int>(std::min(held.size() + old - limit, old)));
        start = std::max(start - dropped, 0);
        end = std::max(end - dropped, 0);
        view.textDropped();
    }
    const int length = edit.GetWindowTextLength();
    edit.SetSel(length, length, TRUE);
    edit.ReplaceSel(CString(lastPart(held, limit)), FALSE);
    if (selected) {
        edit.SetSel(start, end, TRUE);
    }
    view.restore();
}
