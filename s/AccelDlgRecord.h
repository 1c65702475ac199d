#pragma once

#include "platform/afx/controls/HotKey.h"
#include "s/AccelDlg.h"
#include "s/AccelMap.h"
#include "s/MenuCommands.h"

#include <optional>
#include <string>
#include <vector>

/// The key in a hot-key control, empty for none, without a command.
[[nodiscard]] Gui_Accel AccelOf(const CHotKeyCtrl& control);

/// A message about a key and its owner.
[[nodiscard]] CString KeyMessage(UINT id, const CString& key, const CString& owner = CString());

/// Enables or disables a button. One that is disabled hands the keyboard to an heir.
void EnableButton(CWnd& button, bool on, CWnd& heir);

/// What the dialog holds besides its controls' texts.
struct Gui_AccelDlg::Record {
    Record(CMenu* tree, HACCEL table) : map(table), resetTo(map), menu(tree ? tree->m_hMenu : nullptr) {}

    Gui_AccelMap map;
    Gui_AccelMap resetTo;
    HMENU menu;           ///< the object around it may be a temporary one
    int idle = 1;         ///< 0 while the user types a key
    bool finding = false; ///< whether the next key pressed is looked for
    Gui_Accel typed;      ///< the key typed before, for the one typed now

    /// The commands in the order of the list, and what the filter looks at: label and keys without case. The texts are
    /// made when a filter is typed, and empty until then.
    std::vector<MenuCommand> commands;
    std::vector<std::string> filterTexts;
    /// The commands that the list shows, by their places in `commands`.
    std::vector<int> shown;
    /// The map before each change, for Undo.
    std::vector<Gui_AccelMap> before;

    CListBox commandList;
    CListBox keyList;
    CHotKeyCtrl hotKey;
    CHotKeyCtrl findField;
    CButton remove;
    CButton assign;
    CButton specify;
    CEdit filter;
    CString specifyText; ///< the button's text while no key is typed

    /// The selected command's place in `commands`; nothing when none is selected.
    [[nodiscard]] std::optional<int> selected() const;
    /// The key typed, for the selected command; empty without key or command.
    [[nodiscard]] Gui_Accel typedAccel() const;
    /// The label of a command as the list shows it; nothing when the menu does not have it.
    [[nodiscard]] std::optional<CString> labelOf(UINT command) const;
    /// The same for display in a sentence, also of commands that the menu does not have.
    [[nodiscard]] CString nameOf(UINT command) const;
    /// Who has a key, for display.
    [[nodiscard]] CString ownerText(const Gui_Accel& key) const;
    /// The first item of the menu bar that Alt and this key open; nothing when there is none.
    [[nodiscard]] std::optional<CString> menuOpenedBy(const Gui_Accel& key) const;
};
