#pragma once

/// @file
/// A main frame with views that float, for tests.

#include "res/resource.h"
#include "s/ExternFrame.h"
#include "s/FloatChildFrame.h"
#include "s/FloatMainFrame.h"
#include "tests/ui/afx/frames/FrameTesting.h"

namespace frametest {

/// A view with a control that has the keyboard.
class PadView : public NoteView {
    DECLARE_DYNCREATE(PadView)

public:
    CEdit edit;
    void OnInitialUpdate() override;
    void OnActivateView(BOOL activate, CView* activated, CView* deactivated) override;
    static std::function<void()> whenActivated; ///< what a host does in the handler
};

/// The name of the hook that throws, as hosts' code may; it throws once.
extern std::string throwsIn;

class PadFrame : public Gui_FloatChildFrame {
    DECLARE_DYNCREATE(PadFrame)

public:
    void PreSetActiveView(CView* view) override;
    void PostSetActiveView(CView* view) override;

protected:
    PadFrame();
};

/// The window of a pad that floats.
class PadWindow : public Gui_ExternFrame {
    DECLARE_DYNCREATE(PadWindow)

public:
    static bool failsStatusBar;
    CStatusBar& status() {
        return m_statusBar;
    }
    CToolBar& tools() {
        return m_toolBar;
    }
    int CreateStatusBar() override;
    void PreLoadFrame(CView* view) override;
    void PostLoadFrame(CView* view) override;
    void PreSetActiveView(CView* view) override;
    void PostSetActiveView(CView* view) override;
};

/// The main frame; its own commands are noted.
class PadMain : public Gui_FloatMainFrame {
public:
    afx_msg void OnOrphan();

protected:
    DECLARE_MESSAGE_MAP()
};

/// Makes the protected parts known.
class OpenHelp : public Gui_FloatHelp {
public:
    explicit OpenHelp(const Gui_FloatHelp& help) : Gui_FloatHelp(help) {}
    CRect place(bool onScreen) {
        CRect rect;
        GetButtonRect(rect, onScreen);
        return rect;
    }
};

class FloatTest : public frametest::FrameTest {
protected:
    void SetUp() override;
    /// A new pad in a child frame of its own, active.
    PadFrame& open();
    PadView& viewOf(const CFrameWnd& frame) const {
        return static_cast<PadView&>(*frame.GetActiveView());
    }
    /// Floats a frame's view and answers its window.
    PadWindow& floated(PadFrame& frame);
    /// The child frame that is active.
    PadFrame* active() const;
    /// A press or release of the mouse on a frame, at a point of the screen.
    static void press(const CWnd& frame, CPoint at);
    static void release(const CWnd& frame, CPoint at);

    PadMain* main = nullptr;
};

} // namespace frametest
