#pragma once

/// @file
/// Menus: the calls on menu handles, and CMenu, the object around one.
///
/// A menu is a list of items, known by a handle. It belongs to nobody until it is given to a window (SetMenu) or put
/// into another menu as a popup; then it ends with that. Texts hold "&" before the access key and a tab before the name
/// of the shortcut. What is shown is made from the list each time a menu opens, so changes are seen at once.

#include "platform/base/Export.h"
#include "platform/base/Geometry.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"
#include "platform/base/Types.h"

class CBitmap;
class CWnd;

// State and kind of an item, and whether a call means it by command or by position
#define MF_BYCOMMAND 0x00000000
#define MF_BYPOSITION 0x00000400
#define MF_STRING 0x00000000
#define MF_ENABLED 0x00000000
#define MF_GRAYED 0x00000001
#define MF_DISABLED 0x00000002
#define MF_BITMAP 0x00000004
#define MF_UNCHECKED 0x00000000
#define MF_CHECKED 0x00000008
#define MF_USECHECKBITMAPS 0x00000200
#define MF_POPUP 0x00000010
#define MF_MENUBARBREAK 0x00000020
#define MF_MENUBREAK 0x00000040
#define MF_UNHILITE 0x00000000
#define MF_HILITE 0x00000080
#define MF_OWNERDRAW 0x00000100
#define MF_SEPARATOR 0x00000800
#define MF_DEFAULT 0x00001000
#define MF_SYSMENU 0x00002000
#define MF_HELP 0x00004000
#define MF_MOUSESELECT 0x00008000
/// The mark of a checked item is round.
#define MFT_RADIOCHECK 0x00000200

// TrackPopupMenu
#define TPM_LEFTBUTTON 0x0000
#define TPM_RIGHTBUTTON 0x0002
#define TPM_LEFTALIGN 0x0000
#define TPM_CENTERALIGN 0x0004
#define TPM_RIGHTALIGN 0x0008
#define TPM_TOPALIGN 0x0000
#define TPM_VCENTERALIGN 0x0010
#define TPM_BOTTOMALIGN 0x0020
#define TPM_NONOTIFY 0x0080
#define TPM_RETURNCMD 0x0100

/// An empty menu bar. Null only when there are no handles left.
TVX_PLATFORM_API HMENU CreateMenu();
/// An empty popup. Bars and popups are the same kind of menu here: either may be used as the other.
TVX_PLATFORM_API HMENU CreatePopupMenu();
/// A copy of a menu resource of one module (null: the application). Null when there is none or it is damaged.
TVX_PLATFORM_API HMENU LoadMenuA(HINSTANCE module, LPCSTR name);
/// Ends a menu and the popups in it. FALSE for what is no menu.
TVX_PLATFORM_API BOOL DestroyMenu(HMENU menu);
/// Whether a handle is a menu's. A handle is never given out again soon, so that one kept too long is found out.
TVX_PLATFORM_API BOOL IsMenu(HMENU menu);

/// Adds an item at the end.
/// @param flags MF_...: kind and first state
/// @param id    the command; the popup's handle with MF_POPUP
/// @param text  the text; null for separators
TVX_PLATFORM_API BOOL AppendMenuA(HMENU menu, UINT flags, UINT_PTR id, LPCSTR text);
/// Adds an item before the item `position` (a command, which may be in a popup below; an index with MF_BYPOSITION,
/// -1 for the end).
TVX_PLATFORM_API BOOL InsertMenuA(HMENU menu, UINT position, UINT flags, UINT_PTR id, LPCSTR text);
/// Replaces an item. A popup that stood there is destroyed unless it is put in again.
TVX_PLATFORM_API BOOL ModifyMenuA(HMENU menu, UINT position, UINT flags, UINT_PTR id, LPCSTR text);
/// Takes an item out; a popup lives on.
TVX_PLATFORM_API BOOL RemoveMenu(HMENU menu, UINT position, UINT flags);
/// Takes an item out and destroys its popup.
TVX_PLATFORM_API BOOL DeleteMenu(HMENU menu, UINT position, UINT flags);
/// Greys, disables or enables an item. Answers the state before, -1 when there is no such item.
TVX_PLATFORM_API BOOL EnableMenuItem(HMENU menu, UINT item, UINT flags);
/// Sets or takes away an item's check mark. Answers the state before, 0xFFFFFFFF when there is no such item.
TVX_PLATFORM_API DWORD CheckMenuItem(HMENU menu, UINT item, UINT flags);
/// Marks one item of a range with the round mark and unmarks the others.
TVX_PLATFORM_API BOOL CheckMenuRadioItem(HMENU menu, UINT first, UINT last, UINT checked, UINT flags);
/// Draws one item bold; -1 none. `byPosition` tells what `item` is.
TVX_PLATFORM_API BOOL SetMenuDefaultItem(HMENU menu, UINT item, UINT byPosition);
/// Number of items, -1 for what is no menu.
TVX_PLATFORM_API int GetMenuItemCount(HMENU menu);
/// The command of an item: 0 for a separator, 0xFFFFFFFF for a popup or when there is no such item.
TVX_PLATFORM_API UINT GetMenuItemID(HMENU menu, int position);
/// State bits of an item, 0xFFFFFFFF when there is none. Of a popup the low byte has the state, the high one the number
/// of its items.
TVX_PLATFORM_API UINT GetMenuState(HMENU menu, UINT item, UINT flags);
/// Copies an item's text, at most size - 1 bytes and never half a character, and answers how many; without a buffer the
/// whole length.
TVX_PLATFORM_API int GetMenuStringA(HMENU menu, UINT item, LPSTR buffer, int size, UINT flags);
/// The popup of an item, null when it has none.
TVX_PLATFORM_API HMENU GetSubMenu(HMENU menu, int position);
/// Gives an item a picture at its left; null takes it away. The bitmaps stay the caller's.
TVX_PLATFORM_API BOOL SetMenuItemBitmaps(HMENU menu, UINT position, UINT flags, HBITMAP unchecked, HBITMAP checked);

/// Shows a popup at a point of the screen and waits until an item is chosen or the menu is closed.
/// @param owner gets WM_INITMENUPOPUP, WM_MENUSELECT and, after the menu has closed, WM_COMMAND
/// @return whether the menu was shown; with TPM_RETURNCMD the chosen command, 0 for none, and no WM_COMMAND
TVX_PLATFORM_API BOOL TrackPopupMenu(HMENU menu, UINT flags, int x, int y, int reserved, HWND owner, const RECT* rect);

/// The menu of a top-level window, null when it has none.
TVX_PLATFORM_API HMENU GetMenu(HWND window);
/// Gives a window another menu (null: none). The previous one is the caller's to destroy.
TVX_PLATFORM_API BOOL SetMenu(HWND window, HMENU menu);
/// The menu of a window's caption; with `revert` it gets its first items back and null is answered.
TVX_PLATFORM_API HMENU GetSystemMenu(HWND window, BOOL revert);
/// Shows changes of the window's menu bar. They are seen without it too.
TVX_PLATFORM_API BOOL DrawMenuBar(HWND window);

/// The same calls by the names without their suffix.
/// @{
inline BOOL AppendMenu(HMENU menu, UINT flags, UINT_PTR id, LPCSTR text) {
    return AppendMenuA(menu, flags, id, text);
}
inline BOOL InsertMenu(HMENU menu, UINT position, UINT flags, UINT_PTR id, LPCSTR text) {
    return InsertMenuA(menu, position, flags, id, text);
}
inline BOOL ModifyMenu(HMENU menu, UINT position, UINT flags, UINT_PTR id, LPCSTR text) {
    return ModifyMenuA(menu, position, flags, id, text);
}
inline int GetMenuString(HMENU menu, UINT item, LPSTR buffer, int size, UINT flags) {
    return GetMenuStringA(menu, item, buffer, size, flags);
}
inline HMENU LoadMenu(HINSTANCE module, LPCSTR name) {
    return LoadMenuA(module, name);
}
/// @}

/// The object around a menu. It owns the menu it holds and destroys it in its destructor; a menu that belongs to a
/// window or another menu is detached first, or looked at with FromHandle.
///
/// @code
/// CMenu menu;
/// menu.LoadMenu(IDR_CONTEXT);
/// menu.GetSubMenu(0)->TrackPopupMenu(TPM_LEFTALIGN, point.x, point.y, this);
/// @endcode
class TVX_PLATFORM_API CMenu : public CObject {
    DECLARE_DYNCREATE(CMenu)

public:
    /// The menu's handle, null when there is none.
    HMENU m_hMenu = nullptr;

    CMenu() = default;
    /// Destroys the menu it holds.
    ~CMenu() override;
    CMenu(const CMenu&) = delete;
    CMenu& operator=(const CMenu&) = delete;

    /// The handle, null when there is none; it stays this object's.
    operator HMENU() const {
        return m_hMenu;
    }
    /// The same by name.
    HMENU GetSafeHmenu() const {
        return m_hMenu;
    }
    /// Whether both stand for one menu: two objects may, if one of them is temporary.
    BOOL operator==(const CMenu& other) const {
        return m_hMenu == other.m_hMenu;
    }

    /// The object of a menu, or a temporary one that is gone when the application is next idle. Null for what is no
    /// menu.
    static CMenu* FromHandle(HMENU menu);
    /// The object that holds the menu, null when none does.
    static CMenu* FromHandlePermanent(HMENU menu);
    /// Deletes the temporary objects. The idle loop does this.
    static void DeleteTempMap();
    /// Takes a menu over. FALSE for what is no menu and when one is held already.
    BOOL Attach(HMENU menu);
    /// Gives the menu up without destroying it and answers it.
    HMENU Detach();

    /// An empty menu bar.
    BOOL CreateMenu();
    /// An empty popup.
    BOOL CreatePopupMenu();
    /// A menu resource, looked for in the whole chain of modules.
    BOOL LoadMenu(LPCSTR name);
    BOOL LoadMenu(UINT id);
    /// Ends the menu and its popups.
    BOOL DestroyMenu();

    /// Items. Arguments and results are those of the calls of the same names above; without a menu each call fails as
    /// it does for an item that is not there.
    /// @{

    BOOL AppendMenu(UINT flags, UINT_PTR id = 0, LPCSTR text = nullptr);
    BOOL InsertMenu(UINT position, UINT flags, UINT_PTR id = 0, LPCSTR text = nullptr);
    BOOL ModifyMenu(UINT position, UINT flags, UINT_PTR id = 0, LPCSTR text = nullptr);
    BOOL RemoveMenu(UINT position, UINT flags);
    BOOL DeleteMenu(UINT position, UINT flags);
    UINT EnableMenuItem(UINT item, UINT flags);
    UINT CheckMenuItem(UINT item, UINT flags);
    BOOL CheckMenuRadioItem(UINT first, UINT last, UINT checked, UINT flags);
    /// SetMenuDefaultItem.
    BOOL SetDefaultItem(UINT item, BOOL byPosition = FALSE);
    BOOL SetMenuItemBitmaps(UINT position, UINT flags, const CBitmap* unchecked, const CBitmap* checked);
    /// Number of items; UINT(-1) when there is no menu.
    UINT GetMenuItemCount() const;
    UINT GetMenuItemID(int position) const;
    UINT GetMenuState(UINT item, UINT flags) const;
    int GetMenuString(UINT item, LPSTR buffer, int size, UINT flags) const;
    /// The whole text of an item; empty when there is none.
    int GetMenuString(UINT item, CString& text, UINT flags) const;
    /// The popup of an item as FromHandle answers it; null when it has none.
    CMenu* GetSubMenu(int position) const;
    /// @}
    /// Shows this popup; see the call of the same name.
    BOOL TrackPopupMenu(UINT flags, int x, int y, CWnd* owner, const RECT* rect = nullptr);
};
