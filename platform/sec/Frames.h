#pragma once

/// @file
/// The frames of the docking toolkit: a frame that stands alone, and a main frame with the child frames in it. They
/// draw their captions themselves, so that classes derived from them may add to these; see WS_EX_OWNCAPTION.

#include "platform/afx/frames/MdiFrame.h"

#include <memory>

namespace tvx::sec {
class SheetTabs;
}

/// A frame of its own on the desktop. Bars dock in it as in any frame.
class TVX_PLATFORM_API SECFrameWnd : public CFrameWnd {
    DECLARE_DYNCREATE(SECFrameWnd)

public:
    BOOL PreCreateWindow(CREATESTRUCT& cs) override;

protected:
    DECLARE_MESSAGE_MAP()
};

/// A child frame of a workbook.
class TVX_PLATFORM_API SECWorksheet : public CMDIChildWnd {
    DECLARE_DYNCREATE(SECWorksheet)

protected:
    DECLARE_MESSAGE_MAP()
};

/// A main frame whose child frames have a row of tabs at the lower edge, one for each frame that is seen, in the order
/// in which they were made. A click on one activates the frame. The row is there while there are child frames.
class TVX_PLATFORM_API SECWorkbook : public CMDIFrameWnd {
    DECLARE_DYNCREATE(SECWorkbook)

public:
    /// Makes the object; LoadFrame makes the window.
    SECWorkbook();
    ~SECWorkbook() override;

    /// Gives the tab of a child frame an icon; at first a tab shows that of the frame.
    /// @param sheet  a child frame of this workbook; others change nothing
    /// @param icon   stays the caller's; null brings the frame's own back
    /// @param redraw whether the tab shows it at once, else when the row is next brought up to date
    void SetSheetIcon(CMDIChildWnd* sheet, HICON icon, BOOL redraw = TRUE);

    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    BOOL CreateClient(CREATESTRUCT* cs, CMenu* windowMenu) override;
    /// Forgets the row of tabs, which goes with the client window.
    afx_msg void OnDestroy();

protected:
    DECLARE_MESSAGE_MAP()

private:
    tvx::sec::SheetTabs* m_tabs = nullptr; ///< a widget of the client window's
};
