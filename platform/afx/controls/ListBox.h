#pragma once

#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Wnd.h"

/// A list of lines, of which one or several are selected. Lines count from 0; LB_ERR (-1) answers a line that does not
/// exist. The parent is told by LBN_... notifications when the style has LBS_NOTIFY, of what the user does only.
///
/// An owner-drawn list (LBS_OWNERDRAWFIXED) without LBS_HASSTRINGS holds data instead of texts: what is added is a
/// pointer or number, and DeleteItem (or WM_DELETEITEM) tells when it goes.
class TVX_PLATFORM_API CListBox : public CWnd {
    DECLARE_DYNAMIC(CListBox)

public:
    /// Creates the control with LBS_... styles.
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    // --- lines ---

    /// Number of lines.
    int GetCount() const {
        return static_cast<int>(SendMessage(LB_GETCOUNT));
    }
    /// Adds a line: at its place with LBS_SORT, else at the end. Answers the place.
    int AddString(LPCSTR text) {
        return static_cast<int>(SendMessage(LB_ADDSTRING, 0, reinterpret_cast<LPARAM>(text)));
    }
    /// Inserts a line before `index`, -1 for the end, whatever the order.
    int InsertString(int index, LPCSTR text) {
        return static_cast<int>(
            SendMessage(LB_INSERTSTRING, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(text)));
    }
    /// Removes a line and answers how many are left.
    int DeleteString(UINT index) {
        return static_cast<int>(SendMessage(LB_DELETESTRING, index));
    }
    /// Removes all lines.
    void ResetContent() {
        SendMessage(LB_RESETCONTENT);
    }
    /// Bytes of a line, without the final zero.
    int GetTextLen(int index) const {
        return static_cast<int>(SendMessage(LB_GETTEXTLEN, static_cast<WPARAM>(index)));
    }
    /// Copies a line with its final zero; the buffer must hold GetTextLen + 1 bytes.
    int GetText(int index, LPSTR buffer) const {
        return static_cast<int>(SendMessage(LB_GETTEXT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(buffer)));
    }
    /// Empty for a line that does not exist.
    void GetText(int index, CString& text) const;
    /// The number a line carries, 0 from the start.
    DWORD_PTR GetItemData(int index) const {
        return static_cast<DWORD_PTR>(SendMessage(LB_GETITEMDATA, static_cast<WPARAM>(index)));
    }
    /// Gives a line a number to carry; LB_ERR for a line that does not exist.
    int SetItemData(int index, DWORD_PTR data) {
        return static_cast<int>(SendMessage(LB_SETITEMDATA, static_cast<WPARAM>(index), static_cast<LPARAM>(data)));
    }
    /// The number a line carries as a pointer; (void*)-1 (LB_ERR) for a line that does not exist.
    void* GetItemDataPtr(int index) const {
        return reinterpret_cast<void*>(GetItemData(index));
    }
    /// Gives a line a pointer to carry; it stays the caller's.
    int SetItemDataPtr(int index, void* data) {
        return SetItemData(index, reinterpret_cast<DWORD_PTR>(data));
    }
    /// The next line behind `after` (-1: from the first) that begins with the text, without case; goes on at the top.
    int FindString(int after, LPCSTR text) const {
        return static_cast<int>(SendMessage(LB_FINDSTRING, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }
    /// The same for a line that is the whole text.
    int FindStringExact(int after, LPCSTR text) const {
        return static_cast<int>(
            SendMessage(LB_FINDSTRINGEXACT, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }

    // --- selection ---

    /// The selected line of a single selection, -1 for none; the focused line of a multiple one.
    int GetCurSel() const {
        return static_cast<int>(SendMessage(LB_GETCURSEL));
    }
    /// Selects and shows a line; -1 takes the selection away. For single selections.
    int SetCurSel(int index) {
        return static_cast<int>(SendMessage(LB_SETCURSEL, static_cast<WPARAM>(index)));
    }
    /// Finds as FindString does and selects the line found.
    int SelectString(int after, LPCSTR text) {
        return static_cast<int>(
            SendMessage(LB_SELECTSTRING, static_cast<WPARAM>(after), reinterpret_cast<LPARAM>(text)));
    }
    /// Positive when the line is selected.
    int GetSel(int index) const {
        return static_cast<int>(SendMessage(LB_GETSEL, static_cast<WPARAM>(index)));
    }
    /// Selects a line (-1: all) of a multiple selection, or takes it out.
    int SetSel(int index, BOOL select = TRUE) {
        return static_cast<int>(SendMessage(LB_SETSEL, static_cast<WPARAM>(select), index));
    }
    /// Number of selected lines; LB_ERR for single selections.
    int GetSelCount() const {
        return static_cast<int>(SendMessage(LB_GETSELCOUNT));
    }
    /// Stores the selected lines of a multiple selection, at most `capacity`; answers how many.
    int GetSelItems(int capacity, int* indices) const {
        return static_cast<int>(
            SendMessage(LB_GETSELITEMS, static_cast<WPARAM>(capacity), reinterpret_cast<LPARAM>(indices)));
    }
    /// Selects the lines from `first` to `last` of a multiple selection, or takes them out.
    int SelItemRange(BOOL select, int first, int last) {
        return static_cast<int>(select ? SendMessage(LB_SELITEMRANGEEX, static_cast<WPARAM>(first), last)
                                       : SendMessage(LB_SELITEMRANGEEX, static_cast<WPARAM>(last), first));
    }
    /// The line that the keyboard stands on.
    int GetCaretIndex() const {
        return static_cast<int>(SendMessage(LB_GETCARETINDEX));
    }
    /// Moves the keyboard's line and shows it; the selection stays.
    int SetCaretIndex(int index, BOOL scroll = TRUE) {
        return static_cast<int>(SendMessage(LB_SETCARETINDEX, static_cast<WPARAM>(index), scroll));
    }
    /// Sets the line at which the next extension by Shift begins; what is selected now stays.
    void SetAnchorIndex(int index) {
        SendMessage(LB_SETANCHORINDEX, static_cast<WPARAM>(index));
    }
    /// The line at which an extension by Shift begins, -1 before there was any.
    int GetAnchorIndex() const {
        return static_cast<int>(SendMessage(LB_GETANCHORINDEX));
    }

    // --- what is seen ---

    /// The first line that is seen.
    int GetTopIndex() const {
        return static_cast<int>(SendMessage(LB_GETTOPINDEX));
    }
    /// Scrolls so that this line is the first, as far as there are lines behind it.
    int SetTopIndex(int index) {
        return static_cast<int>(SendMessage(LB_SETTOPINDEX, static_cast<WPARAM>(index)));
    }
    /// Height of lines in pixels.
    int GetItemHeight(int index) const {
        return static_cast<int>(SendMessage(LB_GETITEMHEIGHT, static_cast<WPARAM>(index)));
    }
    /// All lines have one height, in pixels.
    int SetItemHeight(int index, UINT height) {
        return static_cast<int>(SendMessage(LB_SETITEMHEIGHT, static_cast<WPARAM>(index), static_cast<LPARAM>(height)));
    }
    /// The place of a line in client coordinates, seen or not.
    int GetItemRect(int index, RECT* rect) const {
        return static_cast<int>(
            SendMessage(LB_GETITEMRECT, static_cast<WPARAM>(index), reinterpret_cast<LPARAM>(rect)));
    }
    /// The line nearest to a point of the client area; `outside` tells whether it lies beside it.
    UINT ItemFromPoint(CPoint point, BOOL& outside) const;
    /// The width in pixels that can be scrolled through; the style must have WS_HSCROLL.
    void SetHorizontalExtent(int width) {
        SendMessage(LB_SETHORIZONTALEXTENT, static_cast<WPARAM>(width));
    }
    /// The width set by SetHorizontalExtent, in pixels.
    int GetHorizontalExtent() const {
        return static_cast<int>(SendMessage(LB_GETHORIZONTALEXTENT));
    }
    /// Sets the tab stops of a list with LBS_USETABSTOPS, in horizontal dialog units of the list's font and in rising
    /// order; the numbers are copied. One stop is the distance of all; behind the last of several, and with none, they
    /// stand 32 units apart. Answers TRUE.
    BOOL SetTabStops(int count, int* stops) {
        return static_cast<BOOL>(
            SendMessage(LB_SETTABSTOPS, static_cast<WPARAM>(count), reinterpret_cast<LPARAM>(stops)));
    }

    // --- owner drawing, when the parent did not answer ---

    /// Paints a line into the context and rectangle of `item`.
    virtual void DrawItem(DRAWITEMSTRUCT* item);
    /// Sets the height of lines, asked once when the control is created.
    virtual void MeasureItem(MEASUREITEMSTRUCT* item);
    /// Frees what the data of a line that goes points to.
    virtual void DeleteItem(DELETEITEMSTRUCT* item);

    /// What assistive tools say of a line. The base answers the line's text; a class whose lines have none (owner-drawn
    /// without LBS_HASSTRINGS) answers what it draws. Called for the lines that such a tool asks for only.
    /// @param index of an existing line
    virtual CString GetAccessibleText(int index) const;

protected:
    BOOL OnChildNotify(UINT message, WPARAM wParam, LPARAM lParam, LRESULT* result) override;
};
