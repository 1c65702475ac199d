#pragma once

/// @file
/// CToolBar: a row of buttons for commands.

#include "platform/afx/frames/ControlBar.h"

// Styles and states of a button
#define TBBS_BUTTON 0x0000
#define TBBS_SEPARATOR 0x0001
#define TBBS_CHECKBOX 0x0002
#define TBBS_GROUP 0x0004
#define TBBS_CHECKGROUP 0x0006
#define TBBS_DROPDOWN 0x0008
#define TBBS_CHECKED 0x00010000
#define TBBS_PRESSED 0x00020000
#define TBBS_DISABLED 0x00040000
#define TBBS_HIDDEN 0x00080000
#define TBBS_INDETERMINATE 0x00100000
#define TBBS_WRAPPED 0x00200000
#define TBSTYLE_TOOLTIPS 0x0100
#define TBSTYLE_FLAT 0x0800

class CToolBar;

/// The buttons of a tool bar, each named by its command. CToolBar::GetToolBarCtrl answers it. What update handlers say
/// of a command counts more: they are asked whenever the application is idle.
class TVX_PLATFORM_API CToolBarCtrl {
public:
    explicit CToolBarCtrl(CToolBar& bar) : m_bar(bar) {}

    /// Change a button's state. FALSE when the bar has no button of that command, as in the calls that ask.
    /// @{
    BOOL EnableButton(int id, BOOL enable = TRUE);
    BOOL CheckButton(int id, BOOL check = TRUE);
    BOOL HideButton(int id, BOOL hide = TRUE);
    /// @}
    BOOL IsButtonEnabled(int id) const;
    BOOL IsButtonChecked(int id) const;
    BOOL IsButtonHidden(int id) const;
    /// Buttons and separators.
    int GetButtonCount() const;

private:
    BOOL change(int id, UINT state, bool on);
    bool has(int id, UINT state) const;
    CToolBar& m_bar;
};

/// A tool bar: buttons with pictures from one bitmap, separators, and places for other controls.
///
/// Buttons send their commands to the frame; their states come from the commands' update handlers. The tip of a button
/// is the part of the command's string behind the line end. Colour (192, 192, 192) of the pictures is transparent.
///
/// @code
/// m_toolBar.CreateEx(this, TBSTYLE_FLAT, WS_CHILD | WS_VISIBLE | CBRS_TOP | CBRS_TOOLTIPS | CBRS_FLYBY);
/// m_toolBar.LoadToolBar(IDR_MAINFRAME);
/// m_toolBar.EnableDocking(CBRS_ALIGN_ANY);
/// EnableDocking(CBRS_ALIGN_ANY);
/// DockControlBar(&m_toolBar);
/// @endcode
class TVX_PLATFORM_API CToolBar : public CControlBar {
    DECLARE_DYNAMIC(CToolBar)

public:
    CToolBar() = default;

    /// Creates an empty bar in a frame.
    /// @param style WS_... and CBRS_... bits
    BOOL Create(CWnd* parent, DWORD style = WS_CHILD | WS_VISIBLE | CBRS_TOP, UINT id = AFX_IDW_TOOLBAR);
    using CWnd::Create;
    /// @param buttonStyle TBSTYLE_...: kept, bars are drawn in the desktop's style
    /// @param borders kept space around the buttons in pixels
    BOOL CreateEx(CWnd* parent, DWORD buttonStyle = TBSTYLE_FLAT, DWORD style = WS_CHILD | WS_VISIBLE | CBRS_ALIGN_TOP,
                  CRect borders = CRect(0, 0, 0, 0), UINT id = AFX_IDW_TOOLBAR);
    using CWnd::CreateEx;
    /// Loads buttons and bitmap of a tool-bar resource. FALSE when one of them is missing or damaged; the bar is
    /// unchanged then.
    BOOL LoadToolBar(LPCSTR name);
    BOOL LoadToolBar(UINT id);
    /// Loads the pictures: they stand side by side, each as wide as SetSizes said.
    BOOL LoadBitmap(LPCSTR name);
    BOOL LoadBitmap(UINT id);
    /// Takes pictures from a bitmap, which stays the caller's.
    BOOL SetBitmap(HBITMAP bitmap);
    /// Makes the buttons.
    /// @param ids   commands, ID_SEPARATOR (0) for a space; null makes buttons that SetButtonInfo fills in
    /// @param count number of buttons
    BOOL SetButtons(const UINT* ids, int count);
    /// Size of a button and of its picture in pixels. 24 x 22 and 16 x 15 at first.
    void SetSizes(SIZE button, SIZE image);
    /// The least height of the whole bar in pixels.
    void SetHeight(int height);

    /// Index of a command's button, -1 when there is none.
    int CommandToIndex(UINT id) const;
    /// Command of a button; 0 for a separator and for an index outside the bar.
    UINT GetItemID(int index) const;
    /// Place of a button in the bar's client area; empty for an index outside.
    virtual void GetItemRect(int index, RECT* rect) const;
    /// TBBS_... style (low half) and state (high half) of a button.
    UINT GetButtonStyle(int index) const;
    /// Changes style and state of a button. An index outside the bar changes nothing.
    void SetButtonStyle(int index, UINT style);
    /// Command, style and picture of a button; of a separator the picture's number is its width in pixels. All are 0
    /// for an index outside the bar.
    void GetButtonInfo(int index, UINT& id, UINT& style, int& image) const;
    /// Changes a button. A separator of a given width makes room for a control, which the host creates as the bar's
    /// child at GetItemRect.
    void SetButtonInfo(int index, UINT id, UINT style, int image);
    /// Shows a text below the picture of a button; null or empty takes it away. As soon as one button has a text, all
    /// make room for one. FALSE for an index outside the bar.
    BOOL SetButtonText(int index, LPCSTR text);
    /// Text of a button; empty when it has none and for an index outside the bar.
    CString GetButtonText(int index) const;

    /// The buttons by their commands; it lives as long as the bar.
    CToolBarCtrl& GetToolBarCtrl() const {
        return m_control;
    }

    void OnUpdateCmdUI(CFrameWnd* target, BOOL disable) override;
    CSize CalcFixedLayout(BOOL stretch, BOOL horizontal) override;

    afx_msg void OnDestroy();
    afx_msg LRESULT OnHelpHitTest(WPARAM, LPARAM point);

protected:
    DECLARE_MESSAGE_MAP()

private:
    struct Button {
        UINT id = 0;
        UINT style = 0;
        int image = 0;
        CString text;
    };
    bool has(int index) const {
        return index >= 0 && index < static_cast<int>(m_buttons.size());
    }
    void rebuild();
    void showState(int index);
    mutable CToolBarCtrl m_control{*this};
    std::vector<Button> m_buttons;
    CSize m_buttonSize{24, 22};
    CSize m_imageSize{16, 15};
    HBITMAP m_bitmap = nullptr;
    bool m_ownBitmap = false;
};
