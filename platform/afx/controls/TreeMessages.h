#pragma once

/// @file
/// The messages, notifications and structures of trees. Hosts use CTreeCtrl, which makes calls of the messages.

#include "platform/afx/controls/ImageList.h"
#include "platform/afx/core/Message.h"

/// An item of a tree. Not a pointer: the number of an item that has gone names nothing, and no later item gets it.
DECLARE_HANDLE(HTREEITEM);

// Places among the children of an item; TVI_ROOT is the parent of the outermost ones
#define TVI_ROOT (reinterpret_cast<HTREEITEM>(static_cast<LONG_PTR>(-0x10000)))
#define TVI_FIRST (reinterpret_cast<HTREEITEM>(static_cast<LONG_PTR>(-0x0FFFF)))
#define TVI_LAST (reinterpret_cast<HTREEITEM>(static_cast<LONG_PTR>(-0x0FFFE)))
#define TVI_SORT (reinterpret_cast<HTREEITEM>(static_cast<LONG_PTR>(-0x0FFFD)))

// Which fields of an item count
#define TVIF_TEXT 0x0001
#define TVIF_IMAGE 0x0002
#define TVIF_PARAM 0x0004
#define TVIF_STATE 0x0008
#define TVIF_HANDLE 0x0010
#define TVIF_SELECTEDIMAGE 0x0020
#define TVIF_CHILDREN 0x0040

// States of an item
#define TVIS_SELECTED 0x0002
#define TVIS_BOLD 0x0010
#define TVIS_EXPANDED 0x0020
#define TVIS_EXPANDEDONCE 0x0040 ///< It was expanded before, so that it has been asked for its children.

// What is asked for by TVN_GETDISPINFO when it is to be seen
#ifndef LPSTR_TEXTCALLBACK
#define LPSTR_TEXTCALLBACK (reinterpret_cast<LPSTR>(static_cast<LONG_PTR>(-1)))
#endif
#define I_CHILDRENCALLBACK (-1)

// Expand
#define TVE_COLLAPSE 0x0001
#define TVE_EXPAND 0x0002
#define TVE_TOGGLE 0x0003

// GetNextItem
#define TVGN_ROOT 0x0000
#define TVGN_NEXT 0x0001
#define TVGN_PREVIOUS 0x0002
#define TVGN_PARENT 0x0003
#define TVGN_CHILD 0x0004
#define TVGN_FIRSTVISIBLE 0x0005
#define TVGN_NEXTVISIBLE 0x0006
#define TVGN_CARET 0x0009
#define TVGN_NEXTSELECTED 0x000B

// Parts of a tree, for HitTest
#define TVHT_NOWHERE 0x0001
#define TVHT_ONITEMICON 0x0002
#define TVHT_ONITEMLABEL 0x0004
#define TVHT_ONITEMINDENT 0x0008
#define TVHT_ONITEMBUTTON 0x0010
#define TVHT_ONITEMRIGHT 0x0020
#define TVHT_ONITEM (TVHT_ONITEMICON | TVHT_ONITEMLABEL)

#define TVSIL_NORMAL 0

/// Several items can be selected at a time.
#define TVS_EX_MULTISELECT 0x0002

#define TVM_INSERTITEM 0x1100
#define TVM_DELETEITEM 0x1101
#define TVM_EXPAND 0x1102
#define TVM_GETITEMRECT 0x1104
#define TVM_GETCOUNT 0x1105
#define TVM_GETIMAGELIST 0x1108
#define TVM_SETIMAGELIST 0x1109
#define TVM_GETNEXTITEM 0x110A
#define TVM_SELECTITEM 0x110B
#define TVM_GETITEM 0x110C
#define TVM_SETITEM 0x110D
#define TVM_EDITLABEL 0x110E
#define TVM_HITTEST 0x1111
#define TVM_SORTCHILDREN 0x1113
#define TVM_ENSUREVISIBLE 0x1114
#define TVM_SETEXTENDEDSTYLE 0x112C
#define TVM_GETEXTENDEDSTYLE 0x112D
#define TVM_GETSELECTEDCOUNT 0x1146

// Notifications, by WM_NOTIFY to the parent
#define TVN_SELCHANGING (static_cast<UINT>(-401)) ///< NMTREEVIEW; an answer other than 0 keeps the selection.
#define TVN_SELCHANGED (static_cast<UINT>(-402))  ///< NMTREEVIEW
#define TVN_GETDISPINFO (static_cast<UINT>(-403)) ///< NMTVDISPINFO, to be filled by its mask.
#define TVN_ITEMEXPANDING (static_cast<UINT>(-405)) ///< NMTREEVIEW; an answer other than 0 leaves it as it is.
#define TVN_ITEMEXPANDED (static_cast<UINT>(-406))  ///< NMTREEVIEW
#define TVN_DELETEITEM (static_cast<UINT>(-409))    ///< NMTREEVIEW; itemOld is the item that goes.
#define TVN_BEGINLABELEDIT (static_cast<UINT>(-410)) ///< NMTVDISPINFO; an answer other than 0 keeps it from being edited.
#define TVN_ENDLABELEDIT (static_cast<UINT>(-411))   ///< NMTVDISPINFO; pszText is null when the edit was given up; an
                                                     ///< answer other than 0 takes the text over.

#ifndef NM_CLICK
#define NM_CLICK (static_cast<UINT>(-2))
#define NM_DBLCLK (static_cast<UINT>(-3)) ///< An answer other than 0: the click does not expand or collapse the item.
#define NM_RETURN (static_cast<UINT>(-4))
#define NM_RCLICK (static_cast<UINT>(-5))
#endif

// Why the selection changed
#define TVC_UNKNOWN 0x0000
#define TVC_BYMOUSE 0x0001
#define TVC_BYKEYBOARD 0x0002

/// An item, as far as its mask says.
struct TVITEM {
    UINT mask;           ///< TVIF_...
    HTREEITEM hItem;     ///< The item that is asked about or changed.
    UINT state;          ///< TVIS_...
    UINT stateMask;      ///< Which states are set or asked for.
    LPSTR pszText;       ///< The text, or the buffer for it; LPSTR_TEXTCALLBACK: the parent is asked.
    int cchTextMax;      ///< Bytes of that buffer.
    int iImage;          ///< Picture of the image list.
    int iSelectedImage;  ///< The same while the item is selected.
    int cChildren;       ///< 0: none; 1: shown as having some, inserted or not; I_CHILDRENCALLBACK: the parent is asked.
    LPARAM lParam;       ///< The host's.
};
using TVITEMA = TVITEM;

/// An item to be inserted, and where.
struct TVINSERTSTRUCT {
    HTREEITEM hParent;      ///< TVI_ROOT or null: an outermost item.
    HTREEITEM hInsertAfter; ///< A child of it, TVI_FIRST, TVI_LAST or TVI_SORT.
    TVITEM item;
};

/// What most notifications of trees carry.
struct NMTREEVIEW {
    NMHDR hdr;
    UINT action;    ///< TVC_... or TVE_...
    TVITEM itemOld; ///< What was selected, for changes of the selection; hItem null for none.
    TVITEM itemNew; ///< The item that it is about.
    POINT ptDrag;   ///< Not used.
};

/// What is asked for by TVN_GETDISPINFO, and the text of label edits.
struct NMTVDISPINFO {
    NMHDR hdr;
    TVITEM item;
};

/// A point, and what of a tree is there.
struct TVHITTESTINFO {
    POINT pt;        ///< In client coordinates.
    UINT flags;      ///< TVHT_...
    HTREEITEM hItem; ///< The item there, null for none.
};
