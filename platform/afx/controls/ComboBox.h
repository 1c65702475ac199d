#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"

/// A field with a list that opens below it. CBS_DROPDOWN is typed into, CBS_DROPDOWNLIST only chooses. The height it is
/// created with is that of the open box. Lines and errors are as in CListBox.
class TVX_PLATFORM_API CComboBox : public CWnd {
    DECLARE_DYNAMIC(CComboBox)

public:
    /// Creates the control with CBS_... styles; `rect` is the place of the open box.
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    /// Number of lines.
    int GetCount() const {
        return static_cast<int>(SendMessage(CB_GETCOUNT));
    }
    /// Adds a line: at its place with CBS_SORT, else at the end. Answers the place.
    int AddString(LPCSTR text) {
        return static_cast<int>(SendMessage(CB_ADDSTRING, 0, reinterpret_cast<LPARAM>(text)));
    }
    /// Inserts a line before `index`, -1 for the end.
    int InsertString(int index, LPCSTR text) {
        return static_cast<int>(
            SendMessage(CB_INSERTSTRING, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(text)));
    }
    /// Adds a line for each drive: "[-c-]".
    /// @param attributes DDL_DRIVES | DDL_EXCLUSIVE; files cannot be listed, which is CB_ERR
    /// @param pattern    not looked at: drives have no other names
    /// @return the place of the last one
    int Dir(UINT attributes, LPCSTR pattern) {
        return static_cast<int>(SendMessage(CB_DIR, attributes, reinterpret_cast<LPARAM>(pattern)));
    }
    /// Removes a line and answers how many are left.
    int DeleteString(UINT index) {
        return static_cast<int>(SendMessage(CB_DELETESTRING, index));
    }
    /// Removes all lines and empties the field.
    void ResetContent() {
        SendMessage(CB_RESETCONTENT);
    }
    /// Bytes of a line, without the final zero.
    int GetLBTextLen(int index) const {
        return static_cast<int>(SendMessage(CB_GETLBTEXTLEN, static_cast<WPARAM>(index)));
    }
    /// Copies a line with its final zero; the buffer must hold GetLBTextLen + 1 bytes.
    int GetLBText(int index, LPSTR buffer) const {
        return static_cast<int>(
            SendMessage(CB_GETLBTEXT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(buffer)));
    }
    /// Empty for a line that does not exist.
    void GetLBText(int index, CString& text) const;
    /// The number a line carries, 0 from the start.
    DWORD_PTR GetItemData(int index) const {
        return static_cast<DWORD_PTR>(SendMessage(CB_GETITEMDATA, static_cast<WPARAM>(index)));
    }
    /// Gives a line a number to carry; CB_ERR for a line that does not exist.
    int SetItemData(int index, DWORD_PTR data) {
        return static_cast<int>(SendMessage(CB_SETITEMDATA, static_cast<WPARAM>(index), static_cast<LPARAM>(data)));
    }
    /// The number a line carries as a pointer; (void*)-1 (CB_ERR) for a line that does not exist.
    void* GetItemDataPtr(int index) const {
        return reinterpret_cast<void*>(GetItemData(index));
    }
    /// Gives a line a pointer to carry; it stays the caller's.
    int SetItemDataPtr(int index, void* data) {
        return SetItemData(index, reinterpret_cast<DWORD_PTR>(data));
    }
    /// The next line behind `after` (-1: from the first) that begins with the text, without case.
    int FindString(int after, LPCSTR text) const {
        return static_cast<int>(SendMessage(CB_FINDSTRING, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }
    /// The same for a line that is the whole text.
    int FindStringExact(int after, LPCSTR text) const {
        return static_cast<int>(
            SendMessage(CB_FINDSTRINGEXACT, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }

    /// The chosen line, -1 for none.
    int GetCurSel() const {
        return static_cast<int>(SendMessage(CB_GETCURSEL));
    }
    /// Chooses a line and shows it in the field; -1 chooses none and empties the field.
    int SetCurSel(int index) {
        return static_cast<int>(SendMessage(CB_SETCURSEL, static_cast<WPARAM>(index)));
    }
    /// Finds as FindString does and chooses the line found.
    int SelectString(int after, LPCSTR text) {
        return static_cast<int>(
            SendMessage(CB_SELECTSTRING, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }
    /// The selection in the field: start in the low half, end in the high one.
    DWORD GetEditSel() const {
        return static_cast<DWORD>(SendMessage(CB_GETEDITSEL));
    }
    /// Selects in the field from `start` to before `end`, in bytes; 0, -1 selects all.
    BOOL SetEditSel(int start, int end) {
        return static_cast<BOOL>(SendMessage(CB_SETEDITSEL, 0, MAKELONG(start, end)));
    }
    /// How many bytes the user may have in the field; 0 for no limit, as from the start. What would make it longer is
    /// refused as a whole. Texts that the program sets may be longer; the limit rests until one is short enough again.
    /// FALSE for a box that is not typed into.
    BOOL LimitText(int limit) {
        return static_cast<BOOL>(SendMessage(CB_LIMITTEXT, static_cast<WPARAM>(limit)));
    }
    /// Opens or closes the list.
    void ShowDropDown(BOOL open = TRUE) {
        SendMessage(CB_SHOWDROPDOWN, static_cast<WPARAM>(open));
    }
    /// Whether the list is open.
    BOOL GetDroppedState() const {
        return static_cast<BOOL>(SendMessage(CB_GETDROPPEDSTATE));
    }
    /// The place of the open box on the screen.
    void GetDroppedControlRect(RECT* rect) const {
        SendMessage(CB_GETDROPPEDCONTROLRECT, 0, reinterpret_cast<LPARAM>(rect));
    }
    /// Sets the least width of the open list in pixels and answers it. The list is never narrower than the box.
    int SetDroppedWidth(UINT width) {
        return static_cast<int>(SendMessage(CB_SETDROPPEDWIDTH, width));
    }
    /// Height of the list's lines in pixels; that of the field follows it.
    int GetItemHeight(int index) const {
        return static_cast<int>(SendMessage(CB_GETITEMHEIGHT, static_cast<WPARAM>(index)));
    }
    /// Sets the height of all lines and of the field in pixels, whatever `index` is: -1 (the field) or any line.
    /// Answers CB_OKAY.
    int SetItemHeight(int index, UINT height) {
        return static_cast<int>(SendMessage(CB_SETITEMHEIGHT, static_cast<WPARAM>(index), static_cast<LPARAM>(height)));
    }

    /// Paints a line, or with ODS_COMBOBOXEDIT the field, of an owner-drawn box.
    virtual void DrawItem(DRAWITEMSTRUCT* item);
    /// Sets the height of lines of an owner-drawn box, asked once when it is created.
    virtual void MeasureItem(MEASUREITEMSTRUCT* item);
    /// Frees what the data of a line that goes points to.
    virtual void DeleteItem(DELETEITEMSTRUCT* item);

protected:
    BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};
