#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// A combo box with operations on whole lists of strings, as Gui_ListBox has them, and a size that fits its items.
///
/// @code
/// Gui_ComboBox m_materials; // CBS_DROPDOWNLIST | WS_VSCROLL
///
/// m_materials.AddStringList(names, Gui_ComboBox::StringCompare);
/// m_materials.SetSizeExact(12);
/// m_materials.SelectStringExact(-1, "Steel");
/// @endcode
///
/// It adds no data to CComboBox: any combo box of a dialog can be subclassed with it (DDX_Control). Items are found by
/// their whole text without regard to case (CB_FINDSTRINGEXACT).
class GUI_API Gui_ComboBox : public CComboBox {
public:
    Gui_ComboBox();
    ~Gui_ComboBox() override;

    /// As Gui_ListBox::StringCompare.
    static int StringCompare(const CString* first, const CString* second);
    /// As Gui_ListBox::MatchString.
    static int MatchString(const CString& text, const CString& pattern);

    /// Adds strings. A combo box that sorts (CBS_SORT), and any without @p compare, places each string itself.
    /// Otherwise the strings and the present items are put in the order of @p compare, and nothing is selected then.
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
    /// Selects the item that equals a text, searched behind item @p start and then from the first one on; when there is
    /// none, nothing is selected.
    /// @param start -1 searches from the first item on
    /// @return the item selected, -1 for none
    int SelectStringExact(int start, const char* text);

    /// Gives the open list room for a number of items; the width stays.
    /// @param visibleItems negative, or more than there are, stands for all items
    void SetSizeExact(int visibleItems);
};
