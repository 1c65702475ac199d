#pragma once

#include "afxext.h"
#include "s/Export.h"

#include <memory>

class Gui_ConsoleEdit;
class Gui_ConsoleListBox;
struct Gui_ConsoleHistoryLine;

/// The view of the console's window. Its document template makes it (Gui_Console::Open); hosts have nothing to do with
/// it but its commands, which they may put into their menus: GUI_ID_CONSOLE_COPY copies the selected commands to the
/// clipboard, GUI_ID_CONSOLE_RUN runs them once more. ID_EDIT_CUT, ID_EDIT_COPY, ID_EDIT_PASTE and ID_FILE_CLOSE work,
/// too, while the console is active.
class GUI_API Gui_ConsoleView : public CFormView {
    DECLARE_DYNCREATE(Gui_ConsoleView)

public:
    ~Gui_ConsoleView() override;

    /// What Gui_Console tells the view.
    /// @{

    /// Shows a line at the end and brings it into view.
    void ShowLine(Gui_ConsoleHistoryLine* line);
    /// Shows the number of the next command.
    void ShowPrompt();
    /// Sets the check box; the lines stay.
    void SetShowStatus(int show);
    int GetShowStatus() const {
        return m_showStatus;
    }
    /// Takes all lines away: they are about to be deleted.
    void ForgetLines();
    /// @}

    void DoDataExchange(CDataExchange* dx) override;
    void OnInitialUpdate() override;

protected:
    Gui_ConsoleView();

    afx_msg void OnSize(UINT type, int width, int height);
    afx_msg void OnDestroy();
    afx_msg void OnSetFocus(CWnd* previous);
    afx_msg void OnShowStatus();
    afx_msg void OnCopyCommands();
    afx_msg void OnRunCommands();
    afx_msg void OnEditCopy();
    afx_msg void OnEditCut();
    afx_msg void OnEditPaste();
    afx_msg void OnFileClose();
    afx_msg void OnUpdateNever(CCmdUI* item);
    afx_msg void OnUpdateSelected(CCmdUI* item);
    afx_msg void OnUpdateEditCopy(CCmdUI* item);
    afx_msg void OnUpdateEditCut(CCmdUI* item);
    afx_msg void OnUpdateEditPaste(CCmdUI* item);
    DECLARE_MESSAGE_MAP()

private:
    enum class Fill { First, Again };
    void FillList(Fill fill);
    void Layout(int width, int height);
    void ShowSearch(const CString& text);
    bool InputHasFocus() const;
    bool InputHasSelection() const;
    bool HasSelectedCommand() const;

    CStatic m_promptLabel;
    CButton m_statusBox;
    CString m_prompt;
    int m_showStatus;
    std::unique_ptr<Gui_ConsoleEdit> m_input;
    std::unique_ptr<Gui_ConsoleListBox> m_list;
    bool m_hadFocus = false;
    CString m_search; ///< What the label shows instead of the prompt; empty: the prompt.
};
