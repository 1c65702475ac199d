#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

class Gui_Accel;
class Gui_AccelMap;

/// "Keyboard Accelerators": the user gives the commands of a frame's menus other keys.
///
/// @code
/// Gui_AccelDlg dialog(GetMenu(), m_hAccelTable, this);
/// if (dialog.DoModal() == IDOK) {
///     dialog.ApplyChangesToFrameWindow(this);
/// }
/// @endcode
///
/// It lists the commands of the menu and its popups with their keys. A key that is assigned is taken away from whoever
/// had it, which is said; Undo takes assignments and removals back one by one, Reset all of them. Commands are found by
/// words of their names or keys, or by pressing a key.
///
/// The dialog changes a copy of the accelerators. After OK the host applies them, while the dialog object lives; Cancel
/// leaves everything as it was. What the Help button does is the host's: a derived class has
/// ON_BN_CLICKED(GUI_IDC_HELP_BUTTON, ...).
///
/// docs/keyboard.md tells how keys are kept over restarts.
class GUI_API Gui_AccelDlg : public CDialog {
public:
    /// @param menu    the menu tree whose commands are listed; must live as long as the dialog. Null has no commands
    /// @param table   the accelerators to begin with, copied; null for none
    /// @param parent  the window to stand over; null for the application's main window
    Gui_AccelDlg(CMenu* menu, HACCEL table, CWnd* parent);
    ~Gui_AccelDlg() override;

    /// Gives a frame the accelerators of the dialog, none when there are none, and writes them into its menu. The
    /// frame's former table is destroyed.
    void ApplyChangesToFrameWindow(CFrameWnd* frame);
    /// A copy of the dialog's accelerators, which the caller deletes.
    Gui_AccelMap* GetAccelMap() const;

    /// Has Reset go back to these keys, such as the application's own; else it goes back to those the dialog opened
    /// with. To be called before DoModal.
    void SetResetAccels(const Gui_AccelMap& accels);

    BOOL PreTranslateMessage(MSG* message) override;

protected:
    BOOL OnInitDialog() override;
    void DoDataExchange(CDataExchange* dx) override;
    afx_msg void OnSelchangeCommandlist();
    afx_msg void OnSelchangeCurrentkeylist();
    afx_msg void OnRemovebutton();
    afx_msg void OnAssignbutton();
    afx_msg void OnSpecifybutton();
    afx_msg void OnTypedKey();
    afx_msg void OnFindKey();
    afx_msg void OnKeyToFind();
    afx_msg void OnChangeFilter();
    afx_msg void OnUndo();
    afx_msg void OnReset();
    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    void fillCommands();
    void fillKeys();
    void describeKey();
    void refreshKeyState();
    void showCommand();
    void select(int command);
    void changed(const CString& note);
    void restore(const Gui_AccelMap& map);
    void showFindField(bool show);
    void findKey(const Gui_Accel& pressed);
    void setNote(const CString& text);

    std::unique_ptr<Record> m_record;
};
