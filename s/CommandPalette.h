#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

/// A small window over a frame in which a command of its menus is found by typing, and run.
///
/// @code
/// void CMainFrame::OnToolsCommands() {
///     Gui_CommandPalette::Open(this);
/// }
/// @endcode
///
/// Words of the command, their beginnings and the first letters of several find it: "dra rec" and "dr" find "Draw
/// Rectangle". The best match comes first, of equal ones what was run last. Commands that the frame's update handlers
/// grey cannot be chosen; the others run as from the menu, after the window has closed. It closes, too, with Esc and
/// when the user turns to another window.
///
/// Objects of this class make and delete themselves.
class GUI_API Gui_CommandPalette : public CDialog {
public:
    /// Opens the window over a frame, with the commands of the menu that it shows now.
    /// @param frame  gets the command; may end before that
    /// @return 1, or 0 when the frame has no menu or the window cannot be made
    static int Open(CFrameWnd* frame);
    ~Gui_CommandPalette() override;

    BOOL PreTranslateMessage(MSG* message) override;

protected:
    explicit Gui_CommandPalette(CFrameWnd* frame);
    BOOL OnInitDialog() override;
    void OnOK() override;
    void OnCancel() override;
    void DoDataExchange(CDataExchange* dx) override;
    void PostNcDestroy() override;
    afx_msg void OnActivate(UINT state, CWnd* other, BOOL minimized);
    afx_msg void OnDrawItem(int id, DRAWITEMSTRUCT* item);
    afx_msg void OnMeasureItem(int id, MEASUREITEMSTRUCT* item);
    afx_msg void OnChangeText();
    afx_msg void OnSelchangeCommands();
    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    void place();
    void select(int line);
    bool move(WPARAM key);

    std::unique_ptr<Record> m_record;
};
