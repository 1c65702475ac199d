#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

/// The text of a menu item: the command, in which "&" marks the access key, then, behind a tab, the name of the
/// shortcut.
///
/// @code
/// Gui_MenuStr text(menu, 0, MF_BYPOSITION);  // "&Open...\tCtrl+O"
/// text.GetCommandText();                     // "Open..."
/// text.SetShortCutKeyText("F3");             // "&Open...\tF3"
/// menu->ModifyMenu(0, MF_BYPOSITION, ID_FILE_OPEN, text);
/// @endcode
class GUI_API Gui_MenuStr {
public:
    /// The empty text.
    Gui_MenuStr();
    /// @param text  copied; null counts as empty
    Gui_MenuStr(const char* text);
    /// The text of an item, at most its first 99 characters; empty when there is no such item.
    /// @param menu   may be null
    /// @param item   a position or a command, as @p flags say
    /// @param flags  MF_BYPOSITION or MF_BYCOMMAND
    Gui_MenuStr(const CMenu* menu, int item, unsigned int flags);
    ~Gui_MenuStr();
    Gui_MenuStr(const Gui_MenuStr&) = delete;
    Gui_MenuStr& operator=(const Gui_MenuStr&) = delete;

    /// Takes another text, as the constructors do.
    /// @{
    void SetText(const char* text);
    void SetText(const CMenu* menu, int item, unsigned int flags);
    /// @}

    /// The whole text.
    CString GetText() const;
    /// The whole text, valid until it is changed.
    operator const char*() const;
    /// Length of the whole text in bytes.
    int GetLength() const;

    /// The command without marks and shortcut: "&&" gives "&", and what begins with "(&" is left out, as in "開く(&O)".
    /// Where nothing would be left because the text begins with that or with the tab, it is the whole text.
    CString GetCommandText() const;
    /// The character behind the first "&"; empty when there is none.
    CString GetAccessKeyText() const;
    /// What stands behind the first tab; empty when there is none.
    CString GetShortCutKeyText() const;

    /// Replaces the command, marks included; a tab and the shortcut, which may be empty, follow.
    void SetCommandText(const char* text);
    /// Replaces the shortcut, or appends it.
    void SetShortCutKeyText(const char* text);
    /// Removes the shortcut and its tab.
    void ClearShortCutKeyText();

private:
    std::unique_ptr<CString> m_text;
};
