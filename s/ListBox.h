#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// A list box with operations on whole lists of strings: adding in an order of the host's, selecting and deleting by
/// text, filtering by wildcards, and a horizontal extent that fits.
///
/// @code
/// Gui_ListBox m_parts; // LBS_NOTIFY | LBS_EXTENDEDSEL | WS_HSCROLL | WS_VSCROLL
///
/// m_parts.AddStringList(names, Gui_ListBox::StringCompare);
/// m_parts.DeleteUnmatched("*.brd");
/// m_parts.UpdateHorizontalExtent();
/// @endcode
///
/// It adds no data to CListBox: any list box of a dialog can be subclassed with it (DDX_Control). Lists of strings are
/// read from head to tail, results are appended at the tail. Items are found by their whole text without regard to case
/// (LB_FINDSTRINGEXACT).
class GUI_API Gui_ListBox : public CListBox {
public:
    Gui_ListBox();
    ~Gui_ListBox() override;

    /// Compares two texts byte by byte: negative, 0 or positive. For AddStringList.
    static int StringCompare(const CString* first, const CString* second);
    /// Whether the whole text matches a pattern of "*" (any run of characters, also none), "?" (one character) and
    /// characters that stand for themselves, with regard to case. A pattern with more than ten "*" matches nothing.
    /// @return 1 or 0
    static int MatchString(const CString& text, const CString& pattern);

    /// Adds strings.
    ///
    /// A list box that sorts (LBS_SORT), and any without @p compare, places each string itself. Otherwise the strings
    /// and the present items are put in the order of @p compare, equal ones as they came, the new before the old. The
    /// selection stays, one item for each text selected; the data of items does not.
    void AddStringList(const CStringList& strings, int (*compare)(const CString*, const CString*));
    /// Deletes for each string the first item that equals it.
    /// @return how many were deleted
    int DeleteStringList(const CStringList& strings);
    /// Deletes the items that do not match a pattern of MatchString.
    /// @return how many were deleted
    int DeleteUnmatched(const CString& pattern);

    /// Appends the texts of all items.
    /// @return their number; 0 or less when there are none
    int GetContents(CStringList& strings);
    /// Appends the texts of the selected items, in the order of the items.
    /// @return their number; negative, with nothing appended, for a list box with single selection
    int GetSelections(CStringList& strings);

    /// Deselects all items.
    /// @return how many were selected; negative, with nothing done, for a list box with single selection
    int UnselectAll();
    /// Finds the item that equals a text, behind item @p start and then from the first one on, and selects it; with
    /// multiple selection beside those selected already.
    /// @param start -1 searches from the first item on
    /// @return -1 when there is none, otherwise what selecting it answered (LB_SETSEL, LB_SETCURSEL)
    int SelectStringExact(int start, const char* text);
    /// Selects the item that equals it for each of the strings. The second item is the first one looked at, the first
    /// item the last.
    /// @return how many were selected
    int SelectStringListExact(const CStringList& strings);

    /// Makes the list scroll horizontally as far as its widest item reaches (LB_SETHORIZONTALEXTENT). The texts are
    /// measured in the control's context as the platform hands it out.
    void UpdateHorizontalExtent();
};
