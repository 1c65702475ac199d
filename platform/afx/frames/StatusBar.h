#pragma once

/// @file
/// CStatusBar: the line at the bottom of a frame.

#include "platform/afx/frames/ControlBar.h"

// Styles of a pane
#define SBPS_NORMAL 0x0000       // with a border, sunken where the desktop draws borders so
#define SBPS_NOBORDERS 0x0100    // without a border
#define SBPS_POPOUT 0x0200       // with a raised border
#define SBPS_DISABLED 0x04000000 // without its text, which stays
#define SBPS_STRETCH 0x08000000  // takes the room that the others leave; several share it

/// Asks for the place of pane wParam, which goes to the RECT behind lParam, in the bar's client area. Answers whether
/// there is such a pane.
#define SB_GETRECT 0x040A

/// A status bar: a row of panes with texts. The first pane usually shows the prompts of commands, the others states,
/// such as the lock keys.
///
/// A text without room for all of it ends in "…", and a tip shows the whole. No pane keeps the frame from being made
/// narrow: those that stretch give way first, then the ones at the end are cut off.
///
/// @code
/// static const UINT indicators[] = {ID_SEPARATOR, ID_INDICATOR_CAPS, ID_INDICATOR_NUM, ID_INDICATOR_SCRL};
/// m_statusBar.Create(this);
/// m_statusBar.SetIndicators(indicators, 4);
/// @endcode
class TVX_PLATFORM_API CStatusBar : public CControlBar {
    DECLARE_DYNAMIC(CStatusBar)

public:
    CStatusBar() = default;

    /// Creates a bar without panes at the bottom of a frame.
    BOOL Create(CWnd* parent, DWORD style = WS_CHILD | WS_VISIBLE | CBRS_BOTTOM, UINT id = AFX_IDW_STATUS_BAR);
    /// @param paneStyle kept; the bar is drawn in the desktop's style
    BOOL CreateEx(CWnd* parent, DWORD paneStyle = 0, DWORD style = WS_CHILD | WS_VISIBLE | CBRS_BOTTOM,
                  UINT id = AFX_IDW_STATUS_BAR);
    using CWnd::Create;
    using CWnd::CreateEx;
    /// Makes the panes. Each shows, while its update handler enables it, the string of its number and is as wide as
    /// that; ID_SEPARATOR is a pane without text, which stretches when it is the first.
    /// @param ids null makes `count` panes that SetPaneInfo fills in
    BOOL SetIndicators(const UINT* ids, int count);

    /// Index of a pane's number, -1 when there is none.
    int CommandToIndex(UINT id) const;
    /// Number of a pane; 0 for an index outside the bar.
    UINT GetItemID(int index) const;
    /// Place of a pane in the bar's client area (SB_GETRECT), as far as it is inside; empty for an index outside.
    void GetItemRect(int index, RECT* rect) const;
    /// Text of a pane; empty for an index outside the bar.
    /// @{
    CString GetPaneText(int index) const;
    void GetPaneText(int index, CString& text) const;
    /// @}
    /// Shows a text in a pane.
    /// @param update TRUE shows it at once, also while the host works without looking for messages: nothing else of the
    ///     window is painted then. Of texts that come faster than anybody could see them a part is shown so, the last
    ///     one with the next message. FALSE keeps it until the pane is painted for another reason, or until it is set
    ///     with TRUE
    /// @return FALSE for an index outside the bar
    virtual BOOL SetPaneText(int index, LPCSTR text, BOOL update = TRUE);
    /// SBPS_... style of a pane; 0 for an index outside the bar.
    UINT GetPaneStyle(int index) const;
    /// Changes the style of a pane and shows it so. An index outside the bar changes nothing.
    void SetPaneStyle(int index, UINT style);
    /// Number, SBPS_... style and width of the text area in pixels.
    void GetPaneInfo(int index, UINT& id, UINT& style, int& width) const;
    /// Changes number, SBPS_... style and width (pixels) of a pane; its text stays. An index outside the bar changes
    /// nothing.
    void SetPaneInfo(int index, UINT id, UINT style, int width);

    void OnUpdateCmdUI(CFrameWnd* target, BOOL disable) override;
    CSize CalcFixedLayout(BOOL stretch, BOOL horizontal) override;

    /// Texts set and asked for as a window's are those of the first pane.
    afx_msg LRESULT OnSetText(WPARAM, LPARAM text);
    afx_msg LRESULT OnGetText(WPARAM size, LPARAM buffer);
    afx_msg LRESULT OnGetTextLength(WPARAM, LPARAM);

protected:
    DECLARE_MESSAGE_MAP()

private:
    struct Pane {
        UINT id = 0;
        UINT style = SBPS_NORMAL;
        int width = 0;
        CString text;
    };
    bool has(int index) const {
        return index >= 0 && index < static_cast<int>(m_panes.size());
    }
    void showPanes();
    void shapePane(int index);
    std::vector<Pane> m_panes;
};
