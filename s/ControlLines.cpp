#include "s/ControlLines.h"

#include "s/Wildcard.h"

#include <algorithm>
#include <vector>

int ControlLines::count() const {
    return static_cast<int>(m_control.SendMessage(m_messages.count));
}

CString ControlLines::text(int line) const {
    const auto index = static_cast<WPARAM>(line);
    const auto length = static_cast<int>(m_control.SendMessage(m_messages.textLength, index));
    CString text;
    if (length > 0) {
        char* buffer = text.GetBufferSetLength(length);
        m_control.SendMessage(m_messages.text, index, reinterpret_cast<LPARAM>(buffer));
        text.ReleaseBufferSetLength(length);
    }
    return text;
}

int ControlLines::find(int after, const char* text) const {
    return static_cast<int>(m_control.SendMessage(m_messages.findExact, static_cast<WPARAM>(after),
                                                  reinterpret_cast<LPARAM>(text ? text : "")));
}

int ControlLines::appendTo(CStringList& texts) const {
    const int lines = count();
    for (int line = 0; line < lines; ++line) {
        texts.AddTail(text(line));
    }
    return lines;
}

void ControlLines::add(const CStringList& texts) {
    for (POSITION at = texts.GetHeadPosition(); at;) {
        m_control.SendMessage(m_messages.add, 0, reinterpret_cast<LPARAM>(texts.GetNext(at).GetString()));
    }
}

namespace {

/// The texts of a list, to be put in order without copying them. They stay where they are.
std::vector<const CString*> pointersTo(const CStringList& texts) {
    std::vector<const CString*> pointers;
    pointers.reserve(static_cast<std::size_t>(texts.GetCount()));
    for (POSITION at = texts.GetHeadPosition(); at;) {
        pointers.push_back(&texts.GetNext(at));
    }
    return pointers;
}

} // namespace

void ControlLines::merge(const CStringList& texts, CompareTexts compare) {
    CStringList present;
    appendTo(present);
    std::vector<const CString*> all = pointersTo(texts);
    const std::vector<const CString*> old = pointersTo(present);
    all.insert(all.end(), old.begin(), old.end());
    std::ranges::stable_sort(all, [&](const CString* a, const CString* b) { return compare(a, b) < 0; });
    m_control.SendMessage(m_messages.removeAll);
    for (const CString* text : all) {
        m_control.SendMessage(m_messages.add, 0, reinterpret_cast<LPARAM>(text->GetString()));
    }
}

int ControlLines::remove(const CStringList& texts) {
    int removed = 0;
    for (POSITION at = texts.GetHeadPosition(); at;) {
        const int line = find(0, texts.GetNext(at));
        if (line >= 0 && m_control.SendMessage(m_messages.remove, static_cast<WPARAM>(line)) >= 0) {
            ++removed;
        }
    }
    return removed;
}

int ControlLines::removeUnmatched(const CString& pattern) {
    int removed = 0;
    // Backwards, since removing a line moves those behind it.
    for (int line = count() - 1; line >= 0; --line) {
        if (!MatchesWildcard(text(line).View(), pattern.View())) {
            m_control.SendMessage(m_messages.remove, static_cast<WPARAM>(line));
            ++removed;
        }
    }
    return removed;
}
