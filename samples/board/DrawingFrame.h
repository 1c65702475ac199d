#pragma once

#include "s/ExternFrame.h"
#include "s/FloatChildFrame.h"

/// The frame of a drawing in the main window.
class CDrawingFrame : public Gui_FloatChildFrame {
    DECLARE_DYNCREATE(CDrawingFrame)

protected:
    CDrawingFrame();
};

/// The window of a drawing that floats on the desktop. It has the menu, the keys and the buttons of drawings, and shows
/// the pointer's place in its status bar as the main window does.
class CDrawingWindow : public Gui_ExternFrame {
    DECLARE_DYNCREATE(CDrawingWindow)

public:
    int CreateStatusBar() override;
    void PostLoadFrame(CView* view) override;
    afx_msg BOOL OnHelpInfo(HELPINFO* info);

protected:
    DECLARE_MESSAGE_MAP()
};
