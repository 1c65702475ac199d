#pragma once

/// @file
/// Command targets: objects that have a message map, and the road a command takes through them.

#include "platform/afx/core/Message.h"
#include "platform/base/Export.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

class CCmdTarget;
class CMenu;
class CWnd;

namespace tvx::afx {

/// One message or command on its way through a message map.
struct MessageCall {
    UINT message = 0;      ///< WM_...; WM_COMMAND for commands and their updates.
    WPARAM wParam = 0;     ///< Of window messages only, as `lParam`.
    LPARAM lParam = 0;     ///< See `wParam`.
    LRESULT result = 0;    ///< What a window message's handler answered.
    UINT id = 0;           ///< The command or control, for commands and notifications.
    void* extra = nullptr; ///< A CCmdUI for updates, an NMHDR with result for WM_NOTIFY.
};

/// Calls the handler behind one message-map entry. Answers whether the call is finished with it.
using MessageHandler = bool (*)(CCmdTarget& target, MessageCall& call);

} // namespace tvx::afx

/// One line of a message map.
struct AFX_MSGMAP_ENTRY {
    UINT nMessage;                ///< The window message; WM_COMMAND for commands and control notifications.
    int nCode;                    ///< Notification code, CN_COMMAND or CN_UPDATE_COMMAND_UI.
    UINT nID;                     ///< First identifier of the range; 0 for plain window messages.
    UINT nLastID;                 ///< Last identifier of the range.
    tvx::afx::MessageHandler pfn; ///< Null in the entry that ends the map.
    const UINT* registered;       ///< Where a registered message's number stands, for such entries.
};

/// The message map of one class, linked to that of its base class.
struct AFX_MSGMAP {
    const AFX_MSGMAP* (*pfnGetBaseMap)(); ///< Null in the map of CCmdTarget, where every search ends.
    const AFX_MSGMAP_ENTRY* lpEntries;    ///< In the order they are written; the first that fits is taken.
};

/// Filled by OnCmdMsg instead of calling the handler, when only its existence is asked for.
struct AFX_CMDHANDLERINFO {
    CCmdTarget* pTarget = nullptr;          ///< Whose map has the handler.
    tvx::afx::MessageHandler pmf = nullptr; ///< The handler, to be compared at most.
};

/// State of one user-interface element of a command: a menu item, a tool-bar button, a status pane, a control.
///
/// The framework makes one when an element is about to be shown or the application is idle, and routes it to the
/// command's ON_UPDATE_COMMAND_UI handler, which calls the members below. Where no handler exists, the element is
/// disabled when no handler for the command itself exists either.
class TVX_PLATFORM_API CCmdUI {
public:
    CCmdUI() = default;
    virtual ~CCmdUI() = default;

    UINT m_nID = 0;                  ///< The command.
    UINT m_nIndex = 0;               ///< Position in the menu, tool bar or status bar.
    CMenu* m_pMenu = nullptr;        ///< The menu, when the element is a menu item.
    CMenu* m_pSubMenu = nullptr;     ///< The popup below it, when the item opens one.
    CMenu* m_pParentMenu = nullptr;  ///< The menu that m_pMenu is a popup of; null for bars and context menus.
    CWnd* m_pOther = nullptr;        ///< The bar or dialog, when the element is no menu item.
    BOOL m_bEnableChanged = FALSE;   ///< Set by Enable: the handler has decided, nothing is greyed for want of one.
    BOOL m_bContinueRouting = FALSE; ///< Set by ContinueRouting.
    UINT m_nIndexMax = 0;            ///< Number of elements of the menu or bar.

    /// Enables or greys the element.
    virtual void Enable(BOOL on = TRUE);
    /// Sets the check mark: 0 off, 1 on, 2 indeterminate (buttons only).
    virtual void SetCheck(int check = 1);
    /// Sets the round mark of an exclusive choice.
    virtual void SetRadio(BOOL on = TRUE);
    /// Replaces the element's text.
    virtual void SetText(LPCSTR text);
    /// Lets routing go on to the next target as if this handler had not been there.
    void ContinueRouting();

    /// Routes this element's update through `target`. With `disableIfNoHandler` an element whose command nobody
    /// handles is greyed. Answers whether an update handler was found.
    BOOL DoUpdate(CCmdTarget* target, BOOL disableIfNoHandler);
};

/// Base of everything that handles messages and commands: windows, documents, the application.
class TVX_PLATFORM_API CCmdTarget : public CObject {
    DECLARE_DYNAMIC(CCmdTarget)

public:
    CCmdTarget() = default;
    ~CCmdTarget() override = default;

    /// Sends a command, or with CN_UPDATE_COMMAND_UI its update, along this target's road. With `info` the handler is
    /// only looked up. Answers whether somebody handled it.
    /// @param extra the CCmdUI for updates, else null.
    virtual BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info);

    /// Shows the wait cursor until EndWaitCursor is called as often. Where something may throw in between, a
    /// CWaitCursor is better. Like the others it goes to CWinApp::DoWaitCursor.
    void BeginWaitCursor();
    /// Ends what one BeginWaitCursor began; without one it does nothing.
    void EndWaitCursor();
    /// Shows the wait cursor again after something has changed it, if it is to be shown at all. Message boxes put it
    /// back by themselves.
    void RestoreWaitCursor();

    /// The first entry of this object's map chain for a window message, or null.
    const AFX_MSGMAP_ENTRY* FindMessageEntry(UINT message, UINT code, UINT id) const;

protected:
    virtual const AFX_MSGMAP* GetMessageMap() const;
    static const AFX_MSGMAP* GetThisMessageMap();
};

/// Shows the wait cursor as long as it lives.
///
/// @code
/// CWaitCursor wait;
/// ReadTheWholeFile();
/// @endcode
class TVX_PLATFORM_API CWaitCursor {
public:
    /// May be nested: the cursor goes with the last one.
    CWaitCursor();
    ~CWaitCursor();
    CWaitCursor(const CWaitCursor&) = delete;
    CWaitCursor& operator=(const CWaitCursor&) = delete;
    /// Shows the wait cursor again after something has changed it.
    void Restore();
};
