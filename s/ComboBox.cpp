#include "s/ComboBox.h"

#include "s/ControlLines.h"
#include "s/ListBox.h"

namespace {

constexpr LineMessages messages{CB_ADDSTRING, CB_DELETESTRING, CB_RESETCONTENT,   CB_GETCOUNT,
                                CB_GETLBTEXT, CB_GETLBTEXTLEN, CB_FINDSTRINGEXACT};

} // namespace

Gui_ComboBox::Gui_ComboBox() = default;
Gui_ComboBox::~Gui_ComboBox() = default;

int Gui_ComboBox::StringCompare(const CString* first, const CString* second) {
    return Gui_ListBox::StringCompare(first, second);
}

int Gui_ComboBox::MatchString(const CString& text, const CString& pattern) {
    return Gui_ListBox::MatchString(text, pattern);
}

void Gui_ComboBox::AddStringList(const CStringList& strings, int (*compare)(const CString*, const CString*)) {
    ControlLines lines(*this, messages);
    if ((GetStyle() & CBS_SORT) != 0 || !compare) {
        lines.add(strings);
    } else {
        lines.merge(strings, compare);
    }
}

int Gui_ComboBox::DeleteStringList(const CStringList& strings) {
    return ControlLines(*this, messages).remove(strings);
}

int Gui_ComboBox::DeleteUnmatched(const CString& pattern) {
    return ControlLines(*this, messages).removeUnmatched(pattern);
}

int Gui_ComboBox::GetContents(CStringList& strings) {
    return ControlLines(*this, messages).appendTo(strings);
}

int Gui_ComboBox::SelectStringExact(int start, const char* text) {
    return SetCurSel(ControlLines(*this, messages).find(start, text));
}

void Gui_ComboBox::SetSizeExact(int visibleItems) {
    const int count = GetCount();
    const int lines = visibleItems < 0 || visibleItems >= count ? count : visibleItems;
    CRect rect;
    GetWindowRect(&rect);
    constexpr int field = -1;
    const int height = (lines + 1) * GetItemHeight(0) + GetItemHeight(field) + 4;
    SetWindowPos(nullptr, 0, 0, rect.Width(), height, SWP_NOMOVE | SWP_NOZORDER | SWP_NOREDRAW | SWP_NOACTIVATE);
}
