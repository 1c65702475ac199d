#pragma once

#include "platform/afx/ControlMessages.h"
#include "platform/afx/Wnd.h"

/// A field with a list that opens below it. CBS_DROPDOWN is typed into, CBS_DROPDOWNLIST only chooses. The height it is
/// created with is that of the open box. Lines and errors are as in CListBox.
class TVX_PLATFORM_API CComboBox : public CWnd {
    DECLARE_DYNAMIC(CComboBox)

public:
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    int GetCount() const {
        return static_cast<int>(SendMessage(CB_GETCOUNT));
    }
    int AddString(LPCSTR text) {
        return static_cast<int>(SendMessage(CB_ADDSTRING, 0, reinterpret_cast<LPARAM>(text)));
    }
    int InsertString(int index, LPCSTR text) {
        return static_cast<int>(
            SendMessage(CB_INSERTSTRING, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(text)));
    }
    int DeleteString(UINT index) {
        return static_cast<int>(SendMessage(CB_DELETESTRING, index));
    }
    void ResetContent() {
        SendMessage(CB_RESETCONTENT);
    }
    int GetLBTextLen(int index) const {
        return static_cast<int>(SendMessage(CB_GETLBTEXTLEN, static_cast<WPARAM>(index)));
    }
    int GetLBText(int index, LPSTR buffer) const {
        return static_cast<int>(
            SendMessage(CB_GETLBTEXT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(buffer)));
    }
    /// Empty for a line that does not exist.
    void GetLBText(int index, CString& text) const;
    DWORD_PTR GetItemData(int index) const {
        return static_cast<DWORD_PTR>(SendMessage(CB_GETITEMDATA, static_cast<WPARAM>(index)));
    }
    int SetItemData(int index, DWORD_PTR data) {
        return static_cast<int>(SendMessage(CB_SETITEMDATA, static_cast<WPARAM>(index), static_cast<LPARAM>(data)));
    }
    void* GetItemDataPtr(int index) const {
        return reinterpret_cast<void*>(GetItemData(index));
    }
    int SetItemDataPtr(int index, void* data) {
        return SetItemData(index, reinterpret_cast<DWORD_PTR>(data));
    }
    int FindString(int after, LPCSTR text) const {
        return static_cast<int>(SendMessage(CB_FINDSTRING, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }
    int FindStringExact(int after, LPCSTR text) const {
        return static_cast<int>(
            SendMessage(CB_FINDSTRINGEXACT, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }

    /// The chosen line, -1 for none.
    int GetCurSel() const {
        return static_cast<int>(SendMessage(CB_GETCURSEL));
    }
    int SetCurSel(int index) {
        return static_cast<int>(SendMessage(CB_SETCURSEL, static_cast<WPARAM>(index)));
    }
    int SelectString(int after, LPCSTR text) {
        return static_cast<int>(
            SendMessage(CB_SELECTSTRING, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }
    /// The selection in the field: start in the low half, end in the high one.
    DWORD GetEditSel() const {
        return static_cast<DWORD>(SendMessage(CB_GETEDITSEL));
    }
    BOOL SetEditSel(int start, int end) {
        return static_cast<BOOL>(SendMessage(CB_SETEDITSEL, 0, MAKELONG(start, end)));
    }
    BOOL LimitText(int limit) {
        return static_cast<BOOL>(SendMessage(CB_LIMITTEXT, static_cast<WPARAM>(limit)));
    }
    /// Opens or closes the list.
    void ShowDropDown(BOOL open = TRUE) {
        SendMessage(CB_SHOWDROPDOWN, static_cast<WPARAM>(open));
    }
    BOOL GetDroppedState() const {
        return static_cast<BOOL>(SendMessage(CB_GETDROPPEDSTATE));
    }
    /// The place of the open box on the screen.
    void GetDroppedControlRect(RECT* rect) const {
        SendMessage(CB_GETDROPPEDCONTROLRECT, 0, reinterpret_cast<LPARAM>(rect));
    }
    int SetDroppedWidth(UINT width) {
        return static_cast<int>(SendMessage(CB_SETDROPPEDWIDTH, width));
    }
    int GetItemHeight(int index) const {
        return static_cast<int>(SendMessage(CB_GETITEMHEIGHT, static_cast<WPARAM>(index)));
    }
    int SetItemHeight(int index, UINT height) {
        return static_cast<int>(SendMessage(CB_SETITEMHEIGHT, static_cast<WPARAM>(index), static_cast<LPARAM>(height)));
    }

    virtual void DrawItem(DRAWITEMSTRUCT* item);
    virtual void MeasureItem(MEASUREITEMSTRUCT* item);
    virtual void DeleteItem(DELETEITEMSTRUCT* item);

protected:
    BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};
