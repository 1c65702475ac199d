#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

/// A modal dialog that asks for one line of text: a title, a prompt, a field for the answer, OK, Cancel and, when there
/// is help for the question, a Help button. It lays itself out around the prompt, in any language.
///
/// @code
/// Gui_QueryDlg query(this);
/// query.SetTitle("Run Command");
/// query.SetPrompt("Command:");
/// query.SetAnswer(m_lastCommand);
/// query.SetAnswerFieldWidth(40);
/// if (query.DoModal() == IDOK)
///     RunCommand(query.GetAnswer());
/// @endcode
///
/// An object on the stack, which can be asked several times: it keeps what was set and the last answer. Everything is
/// set before DoModal; changes while the dialog is open show the next time.
class GUI_API Gui_QueryDlg : public CDialog {
public:
    /// A query with the application's name as title, an empty prompt and answer, a field of 20 characters, no help.
    /// @param parent the window to stand over; null for the application's main window
    explicit Gui_QueryDlg(CWnd* parent = nullptr);
    ~Gui_QueryDlg() override;

    /// The dialog's caption, copied; null counts as empty, here and below.
    void SetTitle(const char* title);
    /// The question, shown left of the field. It is shown as it is: "&" marks no mnemonic. Line ends in it begin new
    /// lines, and a prompt too wide for the screen is wrapped.
    void SetPrompt(const char* prompt);
    /// What stands in the field when the dialog opens.
    void SetAnswer(const char* answer);
    /// The answer: what was set, or what the user left in the field after DoModal answered IDOK. Cancel changes
    /// nothing.
    CString GetAnswer() const;
    /// The field's width in average characters; 0 and negative numbers change nothing. The user can type more than
    /// fits.
    void SetAnswerFieldWidth(int characters);
    /// The number that the Help button passes to the application's WinHelpA, with HELP_CONTEXT; 0 hides the button.
    void SetHelpId(unsigned int id);

protected:
    BOOL OnInitDialog() override;
    void OnOK() override;
    afx_msg void OnHelpButton();
    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    void layOut();

    std::unique_ptr<Record> m_record;
};
