#pragma once

/// @file
/// Styles, messages and structures of tree controls, as CTreeCtrl and the control pass them. Texts are UTF-8.

#include "platform/afx/controls/ImageList.h"
#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/Message.h"
#include "platform/win/ResourceConstants.h"

/// An item of a tree: a number that is never used again. Asking for an item that has gone is harmless: the answer is
/// null, FALSE or empty.
DECLARE_HANDLE(HTREEITEM);

/// Extended style (TVM_SETEXTENDEDSTYLE): several items may be selected. The styles (TVS_...) are those of templates.
#define TVS_EX_MULTISELECT 0x0002

// What stands for an item that is none
#define TVI_ROOT (reinterpret_cast<HTREEITEM>(static_cast<std::intptr_t>(-0x10000)))  ///< The parent of the topmost.
#define TVI_FIRST (reinterpret_cast<HTREEITEM>(static_cast<std::intptr_t>(-0x0FFFF))) ///< Insert as the first child,
#define TVI_LAST (reinterpret_cast<HTREEITEM>(static_cast<std::intptr_t>(-0x0FFFE)))  ///< as the last one,
#define TVI_SORT (reinterpret_cast<HTREEITEM>(static_cast<std::intptr_t>(-0x0FFFD)))  ///< where the order wants it.

// Which fields of TVITEM count
#define TVIF_TEXT 0x0001
#define TVIF_IMAGE 0x0002
#define TVIF_PARAM 0x0004
#define TVIF_STATE 0x0008
#define TVIF_HANDLE 0x0010
#define TVIF_SELECTEDIMAGE 0x0020
#define TVIF_CHILDREN 0x0040
#define TVIF_DI_SETITEM 0x1000 ///< Put in by a handler of TVN_GETDISPINFO: keep the answer and do not ask again.

// States of an item
#define TVIS_SELECTED 0x0002
#define TVIS_BOLD 0x0010
#define TVIS_EXPANDED 0x0020
#define TVIS_EXPANDEDONCE 0x0040 ///< Was expanded: TVM_EXPAND does not tell again.

// What makes the control ask the parent (TVN_GETDISPINFO) each time that it shows an item
#define LPSTR_TEXTCALLBACK (reinterpret_cast<LPSTR>(static_cast<std::intptr_t>(-1)))
#define I_IMAGECALLBACK (-1)
#define I_CHILDRENCALLBACK (-1)

// TVM_EXPAND
#define TVE_COLLAPSE 0x0001
#define TVE_EXPAND 0x0002
#define TVE_TOGGLE 0x0003
#define TVE_COLLAPSERESET 0x8000 ///< With TVE_COLLAPSE: the children are removed as well.

// TVM_GETNEXTITEM; TVM_SELECTITEM with TVGN_CARET or TVGN_FIRSTVISIBLE
#define TVGN_ROOT 0x0000
#define TVGN_NEXT 0x0001
#define TVGN_PREVIOUS 0x0002
#define TVGN_PARENT 0x0003
#define TVGN_CHILD 0x0004
#define TVGN_FIRSTVISIBLE 0x0005
#define TVGN_NEXTVISIBLE 0x0006
#define TVGN_PREVIOUSVISIBLE 0x0007
#define TVGN_CARET 0x0009
#define TVGN_NEXTSELECTED 0x000B

// TVM_HITTEST
#define TVHT_NOWHERE 0x0001
#define TVHT_ONITEMICON 0x0002
#define TVHT_ONITEMLABEL 0x0004
#define TVHT_ONITEMINDENT 0x0008
#define TVHT_ONITEMBUTTON 0x0010
#define TVHT_ONITEMRIGHT 0x0020
#define TVHT_ONITEM (TVHT_ONITEMICON | TVHT_ONITEMLABEL)
#define TVHT_ABOVE 0x0100
#define TVHT_BELOW 0x0200
#define TVHT_TORIGHT 0x0400
#define TVHT_TOLEFT 0x0800

#define TVSIL_NORMAL 0 ///< The list of the pictures before labels.

// Messages
#define TV_FIRST 0x1100
#define TVM_INSERTITEMA (TV_FIRST + 0)
#define TVM_DELETEITEM (TV_FIRST + 1)
#define TVM_EXPAND (TV_FIRST + 2)
#define TVM_GETITEMRECT (TV_FIRST + 4)
#define TVM_GETCOUNT (TV_FIRST + 5)
#define TVM_GETIMAGELIST (TV_FIRST + 8)
#define TVM_SETIMAGELIST (TV_FIRST + 9)
#define TVM_GETNEXTITEM (TV_FIRST + 10)
#define TVM_SELECTITEM (TV_FIRST + 11)
#define TVM_GETITEMA (TV_FIRST + 12)
#define TVM_SETITEMA (TV_FIRST + 13)
#define TVM_EDITLABELA (TV_FIRST + 14)
#define TVM_GETEDITCONTROL (TV_FIRST + 15)
#define TVM_HITTEST (TV_FIRST + 17)
#define TVM_SORTCHILDREN (TV_FIRST + 19)
#define TVM_ENSUREVISIBLE (TV_FIRST + 20)
#define TVM_SORTCHILDRENCB (TV_FIRST + 21)
#define TVM_ENDEDITLABELNOW (TV_FIRST + 22)
#define TVM_SETEXTENDEDSTYLE (TV_FIRST + 44)
#define TVM_GETEXTENDEDSTYLE (TV_FIRST + 45)
#define TVM_GETSELECTEDCOUNT (TV_FIRST + 70)
#define TVM_INSERTITEM TVM_INSERTITEMA
#define TVM_GETITEM TVM_GETITEMA
#define TVM_SETITEM TVM_SETITEMA
#define TVM_EDITLABEL TVM_EDITLABELA

// Notifications, by WM_NOTIFY. What they carry stands in CTreeCtrl's manual.
#define TVN_SELCHANGINGA (static_cast<UINT>(-401))
#define TVN_SELCHANGEDA (static_cast<UINT>(-402))
#define TVN_GETDISPINFOA (static_cast<UINT>(-403))
#define TVN_ITEMEXPANDINGA (static_cast<UINT>(-405))
#define TVN_ITEMEXPANDEDA (static_cast<UINT>(-406))
#define TVN_DELETEITEMA (static_cast<UINT>(-409))
#define TVN_BEGINLABELEDITA (static_cast<UINT>(-410))
#define TVN_ENDLABELEDITA (static_cast<UINT>(-411))
#define TVN_KEYDOWN (static_cast<UINT>(-412))
#define TVN_SELCHANGING TVN_SELCHANGINGA
#define TVN_SELCHANGED TVN_SELCHANGEDA
#define TVN_GETDISPINFO TVN_GETDISPINFOA
#define TVN_ITEMEXPANDING TVN_ITEMEXPANDINGA
#define TVN_ITEMEXPANDED TVN_ITEMEXPANDEDA
#define TVN_DELETEITEM TVN_DELETEITEMA
#define TVN_BEGINLABELEDIT TVN_BEGINLABELEDITA
#define TVN_ENDLABELEDIT TVN_ENDLABELEDITA

// Who changed the selection (NMTREEVIEW::action)
#define TVC_UNKNOWN 0x0000 ///< The program.
#define TVC_BYMOUSE 0x0001
#define TVC_BYKEYBOARD 0x0002

/// An item as it is inserted, set or asked for.
struct TVITEMA {
    UINT mask;          ///< TVIF_...: the fields that count.
    HTREEITEM hItem;    ///< The item.
    UINT state;         ///< TVIS_...
    UINT stateMask;     ///< The states that are set. Asked for, all are answered.
    LPSTR pszText;      ///< The label; LPSTR_TEXTCALLBACK: ask for it. Asked for: the caller's buffer,
    int cchTextMax;     ///< of so many bytes.
    int iImage;         ///< A picture of the image list; I_IMAGECALLBACK: ask for it.
    int iSelectedImage; ///< The same for the item while it is selected.
    int cChildren;      ///< 1: show a button though there may be no children yet. I_CHILDRENCALLBACK: ask.
    LPARAM lParam;      ///< The host's.
};
using TVITEM = TVITEMA;
using TV_ITEM = TVITEMA;

/// A new item and its place.
struct TVINSERTSTRUCTA {
    HTREEITEM hParent;      ///< null as TVI_ROOT.
    HTREEITEM hInsertAfter; ///< A child of that, TVI_FIRST, TVI_LAST or TVI_SORT.
    TVITEMA item;
};
using TVINSERTSTRUCT = TVINSERTSTRUCTA;
using TV_INSERTSTRUCT = TVINSERTSTRUCTA;

/// What most notifications carry.
struct NMTREEVIEWA {
    NMHDR hdr;
    UINT action;     ///< TVC_... or TVE_...
    TVITEMA itemOld; ///< hItem, state and lParam; hItem is null where there is none.
    TVITEMA itemNew;
    POINT ptDrag; ///< Not used.
};
using NMTREEVIEW = NMTREEVIEWA;
using NM_TREEVIEW = NMTREEVIEWA;

/// What TVN_GETDISPINFO, TVN_BEGINLABELEDIT and TVN_ENDLABELEDIT carry.
struct NMTVDISPINFOA {
    NMHDR hdr;
    TVITEMA item; ///< TVN_GETDISPINFO: the handler fills the fields of `mask`. It may copy a text into the buffer at
                  ///< pszText or put a pointer of its own there.
};
using NMTVDISPINFO = NMTVDISPINFOA;
using TV_DISPINFO = NMTVDISPINFOA;

/// What TVN_KEYDOWN carries.
struct NMTVKEYDOWN {
    NMHDR hdr;
    WORD wVKey; ///< VK_...
    UINT flags; ///< Always 0.
};
using TV_KEYDOWN = NMTVKEYDOWN;

/// A question for what is at a point.
struct TVHITTESTINFO {
    POINT pt;        ///< In the control's client area, pixels.
    UINT flags;      ///< Receives TVHT_...
    HTREEITEM hItem; ///< Receives the item, null for none.
};

/// Compares the data of two items for TVM_SORTCHILDRENCB: negative, 0 or positive. The last argument is the sort's.
using PFNTVCOMPARE = int (*)(LPARAM first, LPARAM second, LPARAM sort);
/// What to sort and how.
struct TVSORTCB {
    HTREEITEM hParent; ///< Its children, without theirs.
    PFNTVCOMPARE lpfnCompare;
    LPARAM lParam; ///< Handed to the function.
};
