#pragma once

/// @file
/// The tree of the docking toolkit.

#include "platform/afx/controls/TreeCtrl.h"

/// A tree in which several items may be selected, and whose items can be walked in their order: an item, then all that
/// is below it, then its next sibling, whether they are shown or not.
///
/// @code
/// for (HTREEITEM item = tree.GetRootItem(); item; item = tree.GetNextItem(item)) { ... }
/// @endcode
class TVX_PLATFORM_API SECTreeCtrl : public CTreeCtrl {
    DECLARE_DYNAMIC(SECTreeCtrl)

public:
    /// Switches the selection of several items on or off. What is selected stays, but for one item when it is switched
    /// off.
    void SetMultiSelect(BOOL on);
    /// Whether several items may be selected.
    BOOL IsMultiSelect() const {
        return (GetExtendedStyle() & TVS_EX_MULTISELECT) != 0;
    }
    /// The first selected item in the order of the tree, null for none.
    HTREEITEM GetFirstSelectedItem() const {
        return CTreeCtrl::GetNextItem(nullptr, TVGN_NEXTSELECTED);
    }
    /// The next selected one behind an item; null behind the last.
    HTREEITEM GetNextSelectedItem(HTREEITEM item) const {
        return CTreeCtrl::GetNextItem(item, TVGN_NEXTSELECTED);
    }
    using CTreeCtrl::GetNextItem;
    /// The next item in the order of the tree; null behind the last, and for an item that does not exist.
    HTREEITEM GetNextItem(HTREEITEM item) const;
    /// The item of a number in that order, which begins with 0; null for none. Goes through all before it.
    HTREEITEM GetIndexItem(int index) const;
    using CTreeCtrl::SelectItem;
    /// Marks an item as selected or not, and leaves the others as they are. Nobody is told. In a tree with one selected
    /// item it is selected instead of the other.
    BOOL SelectItem(HTREEITEM item, BOOL select) {
        return SetItemState(item, select ? TVIS_SELECTED : 0, TVIS_SELECTED);
    }
};
