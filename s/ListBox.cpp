#include "s/ListBox.h"

#include "s/ControlLines.h"
#include "s/Wildcard.h"

#include <algorithm>
#include <cstring>
#include <vector>

namespace {

constexpr LineMessages messages{LB_ADDSTRING, LB_DELETESTRING, LB_RESETCONTENT,   LB_GETCOUNT,
                                LB_GETTEXT,   LB_GETTEXTLEN,   LB_FINDSTRINGEXACT};

bool isMultiple(const CListBox& box) {
    return (box.GetStyle() & (LBS_MULTIPLESEL | LBS_EXTENDEDSEL)) != 0;
}

} // namespace

Gui_ListBox::Gui_ListBox() = default;
Gui_ListBox::~Gui_ListBox() = default;

int Gui_ListBox::StringCompare(const CString* first, const CString* second) {
    return std::strcmp(first->GetString(), second->GetString());
}

int Gui_ListBox::MatchString(const CString& text, const CString& pattern) {
    return MatchesWildcard(text.View(), pattern.View()) ? 1 : 0;
}

void Gui_ListBox::AddStringList(const CStringList& strings, int (*compare)(const CString*, const CString*)) {
    ControlLines lines(*this, messages);
    SendMessage(LB_INITSTORAGE, static_cast<WPARAM>(lines.count() + strings.GetCount()));
    if ((GetStyle() & LBS_SORT) != 0 || !compare) {
        lines.add(strings);
        return;
    }
    CStringList selected;
    if (isMultiple(*this)) {
        GetSelections(selected);
    } else if (const int current = GetCurSel(); current >= 0) {
        selected.AddTail(lines.text(current));
    }
    lines.merge(strings, compare);
    SelectStringListExact(selected);
}

int Gui_ListBox::DeleteStringList(const CStringList& strings) {
    return ControlLines(*this, messages).remove(strings);
}

int Gui_ListBox::DeleteUnmatched(const CString& pattern) {
    return ControlLines(*this, messages).removeUnmatched(pattern);
}

int Gui_ListBox::GetContents(CStringList& strings) {
    return ControlLines(*this, messages).appendTo(strings);
}

int Gui_ListBox::GetSelections(CStringList& strings) {
    const int count = GetSelCount();
    if (count <= 0) {
        return count;
    }
    std::vector<int> selected(static_cast<std::size_t>(count));
    selected.resize(static_cast<std::size_t>(std::max(GetSelItems(count, selected.data()), 0)));
    const ControlLines lines(*this, messages);
    for (const int line : selected) {
        strings.AddTail(lines.text(line));
    }
    return static_cast<int>(selected.size());
}

int Gui_ListBox::UnselectAll() {
    const int count = GetSelCount();
    if (count > 0) {
        SetSel(-1, FALSE);
    }
    return count;
}

int Gui_ListBox::SelectStringExact(int start, const char* text) {
    const int line = ControlLines(*this, messages).find(start, text);
    if (line < 0) {
        return -1;
    }
    return isMultiple(*this) ? SetSel(line, TRUE) : SetCurSel(line);
}

int Gui_ListBox::SelectStringListExact(const CStringList& strings) {
    int count = 0;
    for (POSITION at = strings.GetHeadPosition(); at;) {
        if (SelectStringExact(0, strings.GetNext(at)) != -1) {
            ++count;
        }
    }
    return count;
}

void Gui_ListBox::UpdateHorizontalExtent() {
    const ControlLines lines(*this, messages);
    CDC* dc = GetDC();
    int widest = 0;
    for (int line = 0, count = lines.count(); line < count; ++line) {
        const CString text = lines.text(line);
        CSize size;
        GetTextExtentPoint32A(*dc, text, text.GetLength(), &size);
        widest = std::max<int>(widest, size.cx);
    }
    ReleaseDC(dc);
    SetHorizontalExtent(widest);
}
