#include "tests/ui/afx/frames/FrameTesting.h"

#include <QMdiArea>
#include <QMdiSubWindow>
#include <QToolBar>

#include <stdexcept>

using namespace frametest;

namespace {

/// The message whose handler fails in the frames below; 0 for none.
UINT failing = 0;

template <class Base>
class Failing : public Base {
protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == failing) {
            throw std::runtime_error("failed");
        }
        return Base::WindowProc(message, wParam, lParam);
    }
};

class FailingChild : public Failing<CMDIChildWnd> {
    DECLARE_DYNCREATE(FailingChild)
};

IMPLEMENT_DYNCREATE(FailingChild, CMDIChildWnd)

/// What a handler throws under a signal of the toolkit waits for the place of ours below.
class Guards : public FrameTest {
protected:
    void TearDown() override {
        failing = 0;
        FrameTest::TearDown();
    }
    static void expectStored(UINT message, const std::function<void()>& emitIt) {
        failing = message;
        EXPECT_NO_THROW(emitIt()) << "nothing may unwind the toolkit's own frames";
        failing = 0;
        EXPECT_THROW(tvx::afx::ExceptionCarrier::rethrow(), std::runtime_error);
    }
};

} // namespace

TEST_F(Guards, StandAroundMenusAndToolBarButtons) {
    auto* frame = new Failing<NoteFrame>;
    ASSERT_TRUE(frame->LoadFrame(IDR_TESTMAIN));
    AfxGetApp()->m_pMainWnd = frame;
    frame->ShowWindow(SW_SHOW);
    settle();
    auto* bar = qobject_cast<QMenuBar*>(widgetOf(*frame)->menuWidget());
    QMenu* menu = bar->actions()[1]->menu();
    ASSERT_NE(menu, nullptr);
    expectStored(WM_INITMENUPOPUP, [&] { menu->aboutToShow(); });
    expectStored(WM_MENUSELECT, [&] { menu->hovered(menu->actions().front()); });
    QAction* button = qobject_cast<QToolBar*>(frame->tools.GetState()->widget())->actions().front();
    expectStored(WM_COMMAND, [&] { button->triggered(); });
}

TEST_F(Guards, StandAroundTheActivationOfChildFrames) {
    BoardsFrame& frame = openBoards();
    const CMDIChildWnd* first = frame.CreateNewChild(RUNTIME_CLASS(FailingChild), IDR_TESTBOARD);
    ASSERT_NE(frame.CreateNewChild(RUNTIME_CLASS(FailingChild), IDR_TESTBOARD), nullptr);
    settle();
    auto* area = widgetOf(frame)->findChild<QMdiArea*>();
    auto* sub = qobject_cast<QMdiSubWindow*>(first->GetState()->widget());
    ASSERT_TRUE(area && sub);
    expectStored(WM_MDIACTIVATE, [&] { area->subWindowActivated(sub); });
}
