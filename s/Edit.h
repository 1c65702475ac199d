#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// An edit control for texts that grow, as logs and the output of programs do: it appends within the control's limit,
/// finds text, and lets its parent show the menu of a right click.
///
/// @code
/// Gui_Edit m_output; // ES_MULTILINE | ES_READONLY | ES_AUTOVSCROLL | ES_AUTOHSCROLL
///
/// m_output.SetLimitText(100000);
/// m_output.AppendText("Meshing part 3 of 12\r\n");
/// @endcode
///
/// It adds no data to CEdit: any edit control of a dialog can be subclassed with it (DDX_Control). Lengths and
/// positions are bytes of UTF-8, a line's end counting as the two of "\r\n".
class GUI_API Gui_Edit : public CEdit {
public:
    Gui_Edit();
    ~Gui_Edit() override;

    /// The length of the control's text.
    int GetTextLength() const;
    /// The selected text; empty when nothing is selected.
    CString GetSelText();

    /// Finds a text from a position on.
    ///
    /// A whole word stands between white space or the ends of the text; the character before `find->chrg.cpMin` counts.
    /// @param flags FR_WHOLEWORD (2), FR_MATCHCASE (4) or both (6). Every other value, also one with further bits,
    ///     looks for any place without regard to case
    /// @param find  `chrg` is the range to search: its end only limits what is accepted and must be a real position.
    ///     `lpstrText` is what to find. `chrgText` receives the first place found, even one beyond the range's end
    /// @return where the text was found; -1 when it was not, when the place found reaches beyond the range's end, and
    ///     when the range begins outside the text
    int FindTextA(unsigned long flags, _findtextexa* find);

    /// Appends a text and drops the oldest text that the control's limit has no room for; of a text larger than the
    /// limit the end is kept and nothing else. The limit is kept in what the control holds: a line end counts two
    /// however it is written, and of a text for one line only the first counts. What was selected stays selected as
    /// far as it is still there, otherwise the caret stands behind the new text. The view follows the new text when the
    /// end was in sight and nothing selected; else the lines that the user looks at stay where they are.
    ///
    /// A control without a limit (`SetLimitText(0)`) gets one: 60000, of one line 30000. Zero bytes become blanks.
    /// Nothing can be undone afterwards.
    static void AppendText(CEdit& edit, const CString& text);
    /// The same for this control.
    void AppendText(const CString& text);

protected:
    /// Asks the parent for a context menu (WM_CONTEXTMENU, posted, with screen coordinates); the control shows none.
    afx_msg void OnRButtonUp(UINT flags, CPoint point);
    DECLARE_MESSAGE_MAP()
};
