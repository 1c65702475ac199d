#pragma once

/// @file
/// Dialogs made from resource templates.

#include "platform/afx/core/Wnd.h"

#include <optional>

namespace tvx {
struct DialogTemplate;
}

/// A dialog: a window whose controls a resource template describes.
///
/// Derive a class, bind its members to controls in DoDataExchange, and run it:
///
/// @code
/// class CScaleDlg : public CDialog {
/// public:
///     enum { IDD = IDD_SCALE };
///     explicit CScaleDlg(CWnd* parent = nullptr) : CDialog(IDD, parent) {}
///     int m_scale = 100;
///
/// protected:
///     void DoDataExchange(CDataExchange* dx) override {
///         CDialog::DoDataExchange(dx);
///         DDX_Text(dx, IDC_SCALE, m_scale);
///         DDV_MinMaxInt(dx, m_scale, 1, 400);
///     }
/// };
///
/// CScaleDlg dialog(this);
/// if (dialog.DoModal() == IDOK)
///     SetScale(dialog.m_scale);
/// @endcode
///
/// A modal dialog is an object on the stack; its window lives from DoModal's beginning to its end. A modeless one is
/// made with Create and usually deletes itself in PostNcDestroy; its OnOK and OnCancel must be overridden to call
/// DestroyWindow. Templates with WS_CHILD give child dialogs, as property pages are.
class TVX_PLATFORM_API CDialog : public CWnd {
    DECLARE_DYNAMIC(CDialog)

public:
    /// For modeless dialogs, which name their template in Create.
    CDialog() = default;
    /// @param templateName the template's name or number (MAKEINTRESOURCE)
    /// @param parent the window to stand over; null, for modal ones, for the dialog or frame that the user works in
    explicit CDialog(LPCSTR templateName, CWnd* parent = nullptr);
    explicit CDialog(UINT templateId, CWnd* parent = nullptr);
    ~CDialog() override;

    /// Creates a modeless (or child) dialog. It is shown at once only if the template says WS_VISIBLE.
    /// @param parent owner, or parent of a child dialog; null for the application's main window
    /// @return FALSE when the template is missing or damaged, which standard error tells, or creation was refused
    BOOL Create(LPCSTR templateName, CWnd* parent = nullptr);
    BOOL Create(UINT templateId, CWnd* parent = nullptr);

    /// Shows the dialog and waits until EndDialog; no other window of the application reacts meanwhile.
    /// @return EndDialog's argument, IDOK or IDCANCEL mostly. -1 when the dialog could not be shown (no display, no
    /// template: standard error tells) and when the application is quitting. An exception that a handler lets out comes
    /// out here, with the window gone.
    virtual int DoModal();
    /// Ends a modal dialog once the current handler is done; called in OnInitDialog, the dialog is never seen. Hides a
    /// modeless one.
    void EndDialog(int result);

    /// Moves the keyboard to the control behind or before the one that has it. Only controls with WS_TABSTOP that are
    /// seen and enabled count, the last is followed by the first, and text is selected as by Tab.
    /// @{
    void NextDlgCtrl() const;
    void PrevDlgCtrl() const;
    /// @}
    /// Moves the keyboard to this control and selects its text, as validating handlers do; null changes nothing.
    /// SetFocus alone leaves the selection as it was.
    void GotoDlgCtrl(CWnd* control);
    /// The default button that Enter presses: its number in the low half, DC_HASDEFID in the high one; 0 for none.
    DWORD GetDefID() const;
    /// Makes another button the default one, 0 none. While a push button has the keyboard, Enter presses that one.
    void SetDefID(UINT id);
    /// Turns dialog units into pixels of this dialog's font.
    void MapDialogRect(RECT* rect) const;

    BOOL PreTranslateMessage(MSG* message) override;
    /// The dialog's own handlers, then, for plain commands, those of its owner and of the application.
    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;

protected:
    /// Called when all controls stand, before the dialog is seen. The base version fills them by UpdateData(FALSE).
    /// @return TRUE to give the keyboard to the first control with WS_TABSTOP, FALSE when it was given already
    virtual BOOL OnInitDialog();
    /// The button IDOK. The base version ends the dialog with IDOK if UpdateData(TRUE) accepts what was typed in.
    virtual void OnOK();
    /// The button IDCANCEL, Esc and the close button. The base version ends the dialog with IDCANCEL.
    virtual void OnCancel();
    /// Called for a dialog whose template has DS_SETFONT before its controls are made; the font may be changed.
    virtual void OnSetFont(CFont* font) {}

    /// The template that the window is made of; none, which standard error tells, when it is missing or damaged. For
    /// the layer itself.
    virtual std::optional<tvx::DialogTemplate> describe() const;
    afx_msg LRESULT OnCommandHelp(WPARAM wParam, LPARAM lParam);
    afx_msg LRESULT HandleInitDialog(WPARAM wParam, LPARAM lParam);
    DECLARE_MESSAGE_MAP()

    /// The number that the application's help is asked for when the help key is pressed in the dialog
    /// (HID_BASE_RESOURCE is added); 0: the windows behind it are asked. That of the template at first.
    UINT m_nIDHelp = 0;
    LPCSTR m_lpszTemplateName = nullptr;
    CWnd* m_pParentWnd = nullptr;

private:
    BOOL createFrom(const tvx::DialogTemplate& description, CWnd* parent, bool modal);
    void initialise(const tvx::DialogTemplate& description, CWnd* parent);
    int m_modalResult = -1;
    bool m_modal = false;
    bool m_ended = false;
};
