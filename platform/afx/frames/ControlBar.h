#pragma once

/// @file
/// CControlBar: what tool bars, status bars and dialog bars have in common.

#include "platform/afx/frames/Frame.h"

// Styles of bars, set with SetBarStyle or in the style of their creation. Sides are in Frame.h.
#define CBRS_BORDER_LEFT 0x0100
#define CBRS_BORDER_TOP 0x0200
#define CBRS_BORDER_RIGHT 0x0400
#define CBRS_BORDER_BOTTOM 0x0800
#define CBRS_BORDER_ANY 0x0F00
#define CBRS_BORDER_3D 0x00400000
#define CBRS_TOOLTIPS 0x0010
#define CBRS_FLYBY 0x0020
#define CBRS_FLOAT_MULTI 0x0040
#define CBRS_HIDE_INPLACE 0x0008
#define CBRS_SIZE_DYNAMIC 0x0004
#define CBRS_SIZE_FIXED 0x0002
#define CBRS_FLOATING 0x0001
#define CBRS_GRIPPER 0x00400000
#define CBRS_ORIENT_HORZ (CBRS_ALIGN_TOP | CBRS_ALIGN_BOTTOM)
#define CBRS_ORIENT_VERT (CBRS_ALIGN_LEFT | CBRS_ALIGN_RIGHT)
#define CBRS_LEFT (CBRS_ALIGN_LEFT | CBRS_BORDER_RIGHT)
#define CBRS_TOP (CBRS_ALIGN_TOP | CBRS_BORDER_BOTTOM)
#define CBRS_RIGHT (CBRS_ALIGN_RIGHT | CBRS_BORDER_LEFT)
#define CBRS_BOTTOM (CBRS_ALIGN_BOTTOM | CBRS_BORDER_TOP)
#define CBRS_NOALIGN 0x00000000

/// A bar at the edge of a frame. It is a member of the frame's object or of another window's; its window is created in
/// the frame's OnCreate and ends with the frame's.
///
/// While the application is idle a bar updates its elements: each goes as a CCmdUI through the frame's command routing.
class TVX_PLATFORM_API CControlBar : public CWnd {
    DECLARE_DYNAMIC(CControlBar)

public:
    CControlBar() = default;
    ~CControlBar() override;

    /// Number of elements: buttons, panes.
    int GetCount() const {
        return m_nCount;
    }
    /// The CBRS_... bits. Of a docked bar they tell the side that it is docked at now.
    DWORD GetBarStyle() const;
    /// Replaces the CBRS_... bits. The side takes effect when the frame lays itself out.
    void SetBarStyle(DWORD style);
    /// Allows the bar to be moved by the user and docked at these sides (CBRS_ALIGN_...); 0 lets it float only.
    void EnableDocking(DWORD sides);
    /// The sides that EnableDocking allowed.
    DWORD GetDockSides() const {
        return m_dockSides;
    }
    /// Whether the bar is a small window of its own at the moment.
    BOOL IsFloating() const;
    /// Whether the bar is shown, or will be once its frame is.
    virtual BOOL IsVisible() const;
    /// The frame that the bar belongs to, null before creation.
    CFrameWnd* GetDockingFrame() const;
    /// The side (AFX_IDW_DOCKBAR_...) that the bar is docked at, 0 when it floats or has no fixed side.
    UINT GetDockSide() const;
    /// The size the bar asks for in pixels.
    virtual CSize CalcFixedLayout(BOOL stretch, BOOL horizontal);
    /// Updates the state of every element through `target`. With `disable` elements whose command nobody handles are
    /// greyed.
    virtual void OnUpdateCmdUI(CFrameWnd* target, BOOL disable) = 0;
    /// Shows or hides the bar when the frame next lays itself out.
    void DelayShow(BOOL show);

    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    BOOL PreTranslateMessage(MSG* message) override;
    void PostNcDestroy() override;

    /// Whether the object is deleted when its window has ended. FALSE at first: bars are members.
    BOOL m_bAutoDelete = FALSE;

    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnDestroy();
    afx_msg LRESULT OnIdleUpdateCmdUI(WPARAM disable, LPARAM);
    afx_msg LRESULT OnInitialUpdate(WPARAM, LPARAM);
    /// Answers what help mode is to explain at a point of the bar: the context of a button's command or of the bar.
    afx_msg LRESULT OnHelpHitTest(WPARAM, LPARAM point);

protected:
    friend class CFrameWnd;

    int m_nCount = 0;
    DWORD m_dwStyle = 0;
    DWORD m_dockSides = 0;
    /// Whether EnableDocking was called, so that the bar may float.
    bool m_dockable = false;
    /// What DelayShow asked for.
    enum class Delayed { None, Show, Hide };
    Delayed m_delayed = Delayed::None;

    DECLARE_MESSAGE_MAP()
};
