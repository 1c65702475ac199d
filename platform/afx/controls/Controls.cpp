#include "platform/afx/controls/Controls.h"
#include "platform/afx/controls/HotKey.h"

#include "platform/afx/controls/detail/ListBoxWindow.h"
#include "platform/afx/controls/detail/StaticWindow.h"

#include <cstring>
#include <vector>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CStatic, CWnd)
IMPLEMENT_DYNAMIC(CButton, CWnd)
IMPLEMENT_DYNAMIC(CEdit, CWnd)
IMPLEMENT_DYNAMIC(CListBox, CWnd)
IMPLEMENT_DYNAMIC(CComboBox, CWnd)
IMPLEMENT_DYNAMIC(CScrollBar, CWnd)
IMPLEMENT_DYNAMIC(CHotKeyCtrl, CWnd)

BOOL CStatic::Create(LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("Static", text, style, rect, parent, id);
}

void CStatic::SetLabelled(const CWnd* window) {
    if (auto* label = dynamic_cast<StaticWindow*>(GetState())) {
        label->setLabelled(window ? window->GetState() : nullptr);
    }
}

BOOL CButton::Create(LPCSTR text, DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("Button", text, style, rect, parent, id);
}

BOOL CEdit::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("Edit", nullptr, style, rect, parent, id);
}

BOOL CListBox::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("ListBox", nullptr, style, rect, parent, id);
}

BOOL CComboBox::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("ComboBox", nullptr, style, rect, parent, id);
}

BOOL CScrollBar::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("ScrollBar", nullptr, style, rect, parent, id);
}

BOOL CHotKeyCtrl::Create(DWORD style, const RECT& rect, CWnd* parent, UINT id) {
    return CWnd::Create("msctls_hotkey32", nullptr, style, rect, parent, id);
}

// --- owner drawing ---

namespace {

/// Calls the member of a list-like control that a reflected message is for. FALSE for other messages.
template <class Control>
BOOL callOwner(Control& control, UINT message, LPARAM lParam) {
    switch (message) {
    case WM_DRAWITEM:
        control.DrawItem(reinterpret_cast<DRAWITEMSTRUCT*>(lParam));
        return TRUE;
    case WM_MEASUREITEM:
        control.MeasureItem(reinterpret_cast<MEASUREITEMSTRUCT*>(lParam));
        return TRUE;
    case WM_DELETEITEM:
        control.DeleteItem(reinterpret_cast<DELETEITEMSTRUCT*>(lParam));
        return TRUE;
    default:
        return FALSE;
    }
}

} // namespace

void CButton::DrawItem(DRAWITEMSTRUCT*) {}

BOOL CButton::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
    if (message != WM_DRAWITEM) {
        return CWnd::OnChildNotify(message, wParam, lParam, result);
    }
    DrawItem(reinterpret_cast<DRAWITEMSTRUCT*>(lParam));
    return TRUE;
}

void CListBox::DrawItem(DRAWITEMSTRUCT*) {}
void CListBox::MeasureItem(MEASUREITEMSTRUCT*) {}
void CListBox::DeleteItem(DELETEITEMSTRUCT*) {}

CString CListBox::GetAccessibleText(int index) const {
    CString text;
    const auto* list = dynamic_cast<const ListBoxWindow*>(GetState());
    if (list && list->hasStrings()) {
        GetText(index, text);
    }
    return text;
}

BOOL CListBox::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
    return callOwner(*this, message, lParam) || CWnd::OnChildNotify(message, wParam, lParam, result);
}

void CComboBox::DrawItem(DRAWITEMSTRUCT*) {}
void CComboBox::MeasureItem(MEASUREITEMSTRUCT*) {}
void CComboBox::DeleteItem(DELETEITEMSTRUCT*) {}

BOOL CComboBox::OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) {
    return callOwner(*this, message, lParam) || CWnd::OnChildNotify(message, wParam, lParam, result);
}

// --- edit ---

void CEdit::GetSel(int& start, int& end) const {
    DWORD first = 0;
    DWORD last = 0;
    SendMessage(EM_GETSEL, reinterpret_cast<WPARAM>(&first), reinterpret_cast<LPARAM>(&last));
    start = static_cast<int>(first);
    end = static_cast<int>(last);
}

void CEdit::SetSel(int start, int end, BOOL noScroll) {
    SendMessage(EM_SETSEL, static_cast<WPARAM>(start), end);
    if (!noScroll) {
        SendMessage(EM_SCROLLCARET);
    }
}

int CEdit::GetLine(int line, LPSTR buffer, int size) const {
    // The message wants the size in the buffer's first word, so a smaller buffer needs a longer one beside it.
    std::vector<char> copy(std::max<std::size_t>(static_cast<std::size_t>(std::max(size, 0)), sizeof(WORD)));
    const WORD capacity = static_cast<WORD>(std::min(std::max(size, 0), 0xFFFF));
    std::memcpy(copy.data(), &capacity, sizeof(capacity));
    const auto length =
        static_cast<int>(SendMessage(EM_GETLINE, static_cast<WPARAM>(line), reinterpret_cast<LPARAM>(copy.data())));
    std::memcpy(buffer, copy.data(), static_cast<std::size_t>(length));
    return length;
}

// --- lists ---

namespace {

/// The text of a line by the messages of its kind of control; empty when there is no such line.
void copyLine(const CWnd& control, UINT lengthMessage, UINT textMessage, int index, CString& text) {
    const LRESULT length = control.SendMessage(lengthMessage, static_cast<WPARAM>(index));
    text.Empty();
    if (length >= 0) {
        LPSTR buffer = text.GetBufferSetLength(static_cast<int>(length));
        control.SendMessage(textMessage, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(buffer));
        text.ReleaseBufferSetLength(static_cast<int>(length));
    }
}

} // namespace

void CListBox::GetText(int index, CString& text) const {
    copyLine(*this, LB_GETTEXTLEN, LB_GETTEXT, index, text);
}

UINT CListBox::ItemFromPoint(CPoint point, BOOL& outside) const {
    const auto answer = static_cast<DWORD>(SendMessage(LB_ITEMFROMPOINT, 0, MAKELONG(point.x, point.y)));
    outside = HIWORD(answer) != 0 ? TRUE : FALSE;
    return LOWORD(answer);
}

void CComboBox::GetLBText(int index, CString& text) const {
    copyLine(*this, CB_GETLBTEXTLEN, CB_GETLBTEXT, index, text);
}
