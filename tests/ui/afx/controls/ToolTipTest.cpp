#include "platform/afx/controls/ToolTip.h"
#include "tests/ui/afx/Tips.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"

namespace {

/// A window with two areas side by side, which tells a tool-tip control of its messages.
class Areas : public CWnd {
public:
    Areas() {
        CreateEx(0, AfxRegisterWndClass(0), "Areas", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 20, 20, 400, 200, nullptr,
                 nullptr);
        widget()->setStyle(&style);
        EXPECT_TRUE(tips.Create(this));
        EXPECT_TRUE(tips.AddTool(this, "left", &left, 1));
        EXPECT_TRUE(tips.AddTool(this, "right", &right, 2));
        EXPECT_TRUE(waitForActive(*this));
        rest(*widget(), nowhere);
    }
    ~Areas() override {
        QToolTip::hideText();
        DestroyWindow();
    }
    QWidget* widget() const {
        return tvx::afx::peerOf(m_hWnd);
    }
    BOOL PreTranslateMessage(MSG* message) override {
        tips.RelayEvent(message);
        return CWnd::PreTranslateMessage(message);
    }
    const CRect left{10, 10, 60, 40};
    const CRect right{60, 10, 110, 40};
    static constexpr QPoint inLeft{30, 20};
    static constexpr QPoint inRight{80, 20};
    static constexpr QPoint nowhere{200, 100};
    QuickTips style;
    CToolTipCtrl tips;
};

} // namespace

TEST(ToolTip, ComesOverItsToolAndGoes) {
    Areas areas;
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("left"));
    rest(*areas.widget(), Areas::inRight);
    EXPECT_TRUE(isTip("right"));
    rest(*areas.widget(), Areas::nowhere);
    EXPECT_TRUE(isTip(""));
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("left"));
    QTest::mouseClick(areas.widget(), Qt::LeftButton, Qt::NoModifier, Areas::inLeft);
    EXPECT_TRUE(isTip(""));
    rest(*areas.widget(), Areas::inLeft + QPoint(5, 5));
    EXPECT_TRUE(isTip("")) << "not before the pointer has left";
    rest(*areas.widget(), Areas::nowhere);
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("left"));
    QEvent leave(QEvent::Leave);
    QCoreApplication::sendEvent(areas.widget(), &leave);
    EXPECT_TRUE(isTip(""));
    rest(*areas.widget(), Areas::inLeft + QPoint(5, 5));
    EXPECT_TRUE(isTip("left")) << "it has left the window";
    areas.tips.DestroyWindow();
    EXPECT_TRUE(isTip(""));
}

TEST(ToolTip, IsQuietInAWindowThatIsNotActive) {
    Areas areas;
    CWnd other;
    other.CreateEx(0, AfxRegisterWndClass(0), "Other", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 450, 20, 100, 100, nullptr,
                   nullptr);
    other.SetActiveWindow();
    ASSERT_TRUE(waitForActive(other));
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip(""));
    areas.tips.DestroyWindow();
    areas.tips.Create(&areas, TTS_ALWAYSTIP);
    areas.tips.AddTool(&areas, "right", &areas.right, 2);
    rest(*areas.widget(), Areas::inRight);
    EXPECT_TRUE(isTip("right"));
    other.DestroyWindow();
}

TEST(ToolTip, FollowsItsTool) {
    Areas areas;
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("left"));
    areas.tips.UpdateTipText("<b>R&D</b>", &areas, 1);
    EXPECT_TRUE(QTest::qWaitFor([] { return QToolTip::text().contains("&lt;b&gt;R&amp;D"); })) << "no mark-up";
    areas.tips.UpdateTipText(4711U, &areas, 1);
    EXPECT_TRUE(isTip("")) << "an unknown string";
    areas.tips.SetToolRect(&areas, 2, areas.left);
    areas.tips.SetToolRect(&areas, 1, areas.right);
    rest(*areas.widget(), Areas::inRight);
    EXPECT_TRUE(isTip("")) << "a tool without text";
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("right"));
    areas.tips.SetToolRect(&areas, 2, areas.right);
    EXPECT_TRUE(isTip(""));
    areas.tips.SetToolRect(&areas, 3, areas.left);
    areas.tips.UpdateTipText("third", &areas, 3);
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("")) << "a tool that was never added";
}

TEST(ToolTip, IsQuietWhileItIsNotActive) {
    Areas areas;
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("left"));
    areas.tips.Activate(TRUE);
    EXPECT_TRUE(isTip("left")) << "nothing changes";
    areas.tips.Activate(FALSE);
    EXPECT_TRUE(isTip(""));
    rest(*areas.widget(), Areas::inRight);
    EXPECT_TRUE(isTip(""));
    areas.tips.Activate(TRUE);
    rest(*areas.widget(), Areas::inLeft);
    EXPECT_TRUE(isTip("left"));
    CWnd none;
    CToolTipCtrl orphan;
    EXPECT_FALSE(orphan.Create(&none));
    EXPECT_FALSE(orphan.AddTool(&areas, "text", areas.left, 1));
    EXPECT_FALSE(areas.tips.AddTool(&none, "text", areas.left, 1));
    orphan.Activate(TRUE);
}
