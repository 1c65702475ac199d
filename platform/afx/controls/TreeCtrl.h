#pragma once

#include "platform/afx/controls/TreeMessages.h"
#include "platform/afx/core/Wnd.h"

class CEdit;

/// A tree of items, each with a label, a picture where the tree has an image list, and a number of the host's.
///
/// An item that has not been shown costs a record in a table and nothing else: 100,000 are inserted and opened at once.
/// Nothing is laid out before the window is painted or a question depends on it (GetItemRect, EnsureVisible).
///
/// | notification | carries | answer |
/// |---|---|---|
/// | TVN_SELCHANGING, TVN_SELCHANGED | NMTREEVIEW: the old and the new caret item, `action` TVC_... | TRUE to the first
/// one forbids it | | TVN_ITEMEXPANDING, TVN_ITEMEXPANDED | NMTREEVIEW: itemNew, `action` TVE_... | TRUE to the first
/// one forbids it; children may be inserted in it | | TVN_GETDISPINFO | NMTVDISPINFO | fields of item.mask filled in |
/// | TVN_DELETEITEM | NMTREEVIEW: itemOld, whose item has gone already; children first | |
/// | TVN_BEGINLABELEDIT | NMTVDISPINFO | TRUE forbids it |
/// | TVN_ENDLABELEDIT | NMTVDISPINFO: the new text, null when the user gave it up | TRUE takes the text |
/// | TVN_KEYDOWN | NMTVKEYDOWN | |
/// | NM_CLICK, NM_DBLCLK, NM_RCLICK, NM_RETURN | NMHDR | TRUE to NM_DBLCLK: the item is not opened; to NM_RCLICK: no
/// WM_CONTEXTMENU follows |
///
/// A handler may do what it likes with the tree, its window included.
///
/// With TVS_EX_MULTISELECT the user selects with Ctrl and Shift as in lists, and is told of once for each action. The
/// caret item is then the one with the keyboard. Programs mark items by SetItemState and TVIS_SELECTED; nobody is told.
///
/// Not offered: dragging of items, check boxes and state images, insertion marks, hot tracking, custom drawing, items
/// of several heights, full-row selection. In dialogs Enter is the default button's.
class TVX_PLATFORM_API CTreeCtrl : public CWnd {
    DECLARE_DYNAMIC(CTreeCtrl)

public:
    /// Creates the control with TVS_... styles; `rect` is its place in the parent's client area, in pixels.
    BOOL Create(DWORD style, const RECT& rect, CWnd* parent, UINT id);
    using CWnd::Create;

    // --- items ---

    /// Inserts an item. The answers are the new item, null when the parent or the sibling before it does not exist.
    HTREEITEM InsertItem(TVINSERTSTRUCT* item) {
        return reinterpret_cast<HTREEITEM>(SendMessage(TVM_INSERTITEMA, 0, reinterpret_cast<LPARAM>(item)));
    }
    /// @param mask TVIF_...: the arguments that count
    HTREEITEM InsertItem(UINT mask, LPCSTR text, int image, int selectedImage, UINT state, UINT stateMask, LPARAM data,
                         HTREEITEM parent, HTREEITEM after);
    HTREEITEM InsertItem(LPCSTR text, HTREEITEM parent = TVI_ROOT, HTREEITEM after = TVI_LAST) {
        return InsertItem(TVIF_TEXT, text, 0, 0, 0, 0, 0, parent, after);
    }
    HTREEITEM InsertItem(LPCSTR text, int image, int selectedImage, HTREEITEM parent = TVI_ROOT,
                         HTREEITEM after = TVI_LAST) {
        return InsertItem(TVIF_TEXT | TVIF_IMAGE | TVIF_SELECTEDIMAGE, text, image, selectedImage, 0, 0, 0, parent,
                          after);
    }
    /// Removes an item with all below it. When the caret item is among them its next sibling becomes it, else the one
    /// before, else the parent, and the parent window is told.
    BOOL DeleteItem(HTREEITEM item) {
        return SendMessage(TVM_DELETEITEM, 0, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// Removes all items; TVN_SELCHANGED does not come.
    BOOL DeleteAllItems() {
        return DeleteItem(TVI_ROOT);
    }
    /// Number of items, shown or not.
    UINT GetCount() const {
        return static_cast<UINT>(SendMessage(TVM_GETCOUNT));
    }

    // --- walking; null where there is none ---

    /// @param code TVGN_...
    HTREEITEM GetNextItem(HTREEITEM item, UINT code) const {
        return reinterpret_cast<HTREEITEM>(SendMessage(TVM_GETNEXTITEM, code, reinterpret_cast<LPARAM>(item)));
    }
    /// The first of the topmost items.
    HTREEITEM GetRootItem() const {
        return GetNextItem(nullptr, TVGN_ROOT);
    }
    HTREEITEM GetChildItem(HTREEITEM item) const {
        return GetNextItem(item, TVGN_CHILD);
    }
    HTREEITEM GetNextSiblingItem(HTREEITEM item) const {
        return GetNextItem(item, TVGN_NEXT);
    }
    HTREEITEM GetPrevSiblingItem(HTREEITEM item) const {
        return GetNextItem(item, TVGN_PREVIOUS);
    }
    HTREEITEM GetParentItem(HTREEITEM item) const {
        return GetNextItem(item, TVGN_PARENT);
    }
    /// The item in the first line of the window.
    HTREEITEM GetFirstVisibleItem() const {
        return GetNextItem(nullptr, TVGN_FIRSTVISIBLE);
    }
    /// The item in the line below, scrolled into sight or not.
    HTREEITEM GetNextVisibleItem(HTREEITEM item) const {
        return GetNextItem(item, TVGN_NEXTVISIBLE);
    }
    /// The caret item.
    HTREEITEM GetSelectedItem() const {
        return GetNextItem(nullptr, TVGN_CARET);
    }
    /// Number of selected items.
    UINT GetSelectedCount() const {
        return static_cast<UINT>(SendMessage(TVM_GETSELECTEDCOUNT));
    }
    /// Whether an item has children, or is said to have some.
    BOOL ItemHasChildren(HTREEITEM item) const;

    // --- properties of an item ---

    /// Fills the fields of `item->mask` for `item->hItem`. FALSE for an item that does not exist.
    BOOL GetItem(TVITEM* item) const {
        return SendMessage(TVM_GETITEMA, 0, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// Sets them.
    BOOL SetItem(const TVITEM* item) {
        return SendMessage(TVM_SETITEMA, 0, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// The label, however long; empty for an item that does not exist.
    CString GetItemText(HTREEITEM item) const;
    BOOL SetItemText(HTREEITEM item, LPCSTR text);
    /// The host's number, 0 from the start.
    DWORD_PTR GetItemData(HTREEITEM item) const;
    BOOL SetItemData(HTREEITEM item, DWORD_PTR data);
    BOOL GetItemImage(HTREEITEM item, int& image, int& selectedImage) const;
    BOOL SetItemImage(HTREEITEM item, int image, int selectedImage);
    /// The states (TVIS_...) of `mask`.
    UINT GetItemState(HTREEITEM item, UINT mask) const;
    /// Sets the states of `mask` to those of `state`. TVIS_EXPANDED is Expand's.
    BOOL SetItemState(HTREEITEM item, UINT state, UINT mask);

    // --- selection, expansion, place ---

    /// Makes an item the caret item and the one that is selected, and shows it; null: none. The parent is told, and may
    /// forbid it: FALSE then.
    BOOL SelectItem(HTREEITEM item) {
        return Select(item, TVGN_CARET);
    }
    /// The same with TVGN_CARET; with TVGN_FIRSTVISIBLE the item is scrolled to the first line, as far as there are
    /// lines behind it.
    BOOL Select(HTREEITEM item, UINT code) {
        return SendMessage(TVM_SELECTITEM, code, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// Opens or closes an item. FALSE when nothing changed: it has no children, is so already, or the parent forbade
    /// it, which is told of the first time (TVIS_EXPANDEDONCE) only.
    /// @param code TVE_...
    BOOL Expand(HTREEITEM item, UINT code) {
        return SendMessage(TVM_EXPAND, code, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// Opens what the item is in and scrolls it into sight. TRUE when something had to be done.
    BOOL EnsureVisible(HTREEITEM item) {
        return SendMessage(TVM_ENSUREVISIBLE, 0, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// Sorts the children of an item (TVI_ROOT: the topmost items) by their labels without regard to case.
    BOOL SortChildren(HTREEITEM item) {
        return SendMessage(TVM_SORTCHILDREN, 0, reinterpret_cast<LPARAM>(item)) != 0;
    }
    /// Sorts children by a function of the host's, equal ones as they were.
    BOOL SortChildrenCB(TVSORTCB* sort) {
        return SendMessage(TVM_SORTCHILDRENCB, 0, reinterpret_cast<LPARAM>(sort)) != 0;
    }
    /// The item at a point of the client area, null for none.
    HTREEITEM HitTest(TVHITTESTINFO* info) const {
        return reinterpret_cast<HTREEITEM>(SendMessage(TVM_HITTEST, 0, reinterpret_cast<LPARAM>(info)));
    }
    HTREEITEM HitTest(CPoint point, UINT* flags = nullptr) const;
    /// The place of an item in client coordinates, seen or not. FALSE for one in a closed item.
    /// @param textOnly the label instead of the whole line
    BOOL GetItemRect(HTREEITEM item, RECT* rect, BOOL textOnly) const;

    // --- pictures ---

    /// The image list, null for none. @param kind TVSIL_NORMAL
    CImageList* GetImageList(UINT kind) const;
    /// Shows pictures of a list, which stays the caller's; null: none. Answers the list before.
    CImageList* SetImageList(CImageList* list, int kind);

    // --- labels that the user changes ---

    /// Has the user change a label (TVS_EDITLABELS) and answers the field, which is ended by Enter, Esc, or when it
    /// loses the keyboard. Null when the parent forbade it.
    CEdit* EditLabel(HTREEITEM item);
    /// The field while a label is changed, else null.
    CEdit* GetEditControl() const;
    /// Ends it. FALSE when no label is changed.
    /// @param cancel gives the new text up
    BOOL EndEditLabelNow(BOOL cancel) {
        return SendMessage(TVM_ENDEDITLABELNOW, static_cast<WPARAM>(cancel)) != 0;
    }

    // --- extended styles ---

    /// Sets the extended styles of `mask` (0: all) and answers those before. @param style TVS_EX_...
    DWORD SetExtendedStyle(DWORD mask, DWORD style) {
        return static_cast<DWORD>(SendMessage(TVM_SETEXTENDEDSTYLE, mask, static_cast<LPARAM>(style)));
    }
    DWORD GetExtendedStyle() const {
        return static_cast<DWORD>(SendMessage(TVM_GETEXTENDEDSTYLE));
    }
};
