// The button of floating frames without the desktop's style: every colour of its bevel, its sign, where it stands.
#include "tests/ui/s/FloatTesting.h"

#include "s/FrameTheme.h"

#include <QAccessible>

#include <cstdlib>

using namespace frametest;

namespace {

/// The numbers of the platform's colours.
enum Color { face = 15, shadow = 16, text = 18, highlight = 20, darkShadow = 21, light = 22 };

class FloatButton : public FloatTest {
protected:
    void SetUp() override {
        setenv("TVX_GUI_USETHEMES", "0", 1);
        FloatTest::SetUp();
    }
    void TearDown() override {
        FloatTest::TearDown();
        unsetenv("TVX_GUI_USETHEMES");
    }

    /// Looks at the button of a frame.
    void look(CFrameWnd& frame, const CRect& place) {
        m_dc = std::make_unique<CWindowDC>(&frame);
        m_box = place;
        m_box.DeflateRect(2, 2);
    }
    void sees(int x, int y, Color color, const char* what) const {
        EXPECT_EQ(m_dc->GetPixel(x, y), ::GetSysColor(color)) << what;
    }
    /// The lines of the bevel: outer and inner ones, on top and left, at the bottom and at the right.
    void seesBevel(Color outer, Color inner, Color innerFar, Color outerFar) const {
        const CRect& box = m_box;
        for (const int along : {4, 8}) {
            sees(box.left + along, box.top, outer, "top");
            sees(box.left, box.top + along, outer, "left");
            sees(box.left + along, box.top + 1, inner, "inner top");
            sees(box.left + 1, box.top + along, inner, "inner left");
            sees(box.left + along, box.bottom - 2, innerFar, "inner bottom");
            sees(box.right - 2, box.top + along, innerFar, "inner right");
            sees(box.left + along, box.bottom - 1, outerFar, "bottom");
            sees(box.right - 1, box.top + along, outerFar, "right");
        }
        sees(box.left + 2, box.top + 2, face, "face");
        sees(box.right - 3, box.bottom - 3, face, "face");
    }
    /// Where the chevrons cross a line of the sign, counted from its centre.
    void seesSign(bool pushed, int line, const std::vector<int>& inked, const std::vector<int>& clear) const {
        CPoint center = m_box.CenterPoint();
        if (!pushed) {
            center.Offset(-1, -1);
        }
        for (const int x : inked) {
            sees(center.x + x, center.y + line, text, "sign");
        }
        for (const int x : clear) {
            sees(center.x + x, center.y + line, face, "between");
        }
    }

private:
    std::unique_ptr<CWindowDC> m_dc;
    CRect m_box;
};

TEST_F(FloatButton, ClassicInACaption) {
    PadFrame& frame = open();
    OpenHelp help(frame.GetFloatHelp());
    const CRect place = help.place(false);
    CRect window;
    frame.GetWindowRect(&window);
    const int width = ::GetSystemMetrics(SM_CXSIZE);
    EXPECT_EQ(place.right,
              window.Width() - 3 * width - 2 * ::GetSystemMetrics(SM_CXBORDER) - ::GetSystemMetrics(SM_CXFRAME));
    EXPECT_EQ(place.Width(), width);
    EXPECT_EQ(place.Height(), ::GetSystemMetrics(SM_CYSIZE));

    look(frame, place);
    seesBevel(highlight, light, shadow, darkShadow);
    seesSign(false, -3, {-4, -3, -1, 0}, {-5, -2, 1});
    seesSign(false, 0, {-1, 0, 2, 3}, {-2, 1, 4});
    seesSign(false, 3, {-4, -3, -1, 0}, {-5, -2, 1});

    const CRect onScreen = help.place(true);
    press(frame, onScreen.CenterPoint());
    look(frame, place);
    seesBevel(darkShadow, shadow, face, highlight);
    seesSign(true, 0, {-1, 0, 2, 3}, {-2, 1, 4});
    release(frame, window.CenterPoint());
    look(frame, place);
    seesBevel(highlight, light, shadow, darkShadow);

    frame.SetRipResourceId(0xFFFFFFFF);
    settle();
    look(frame, place);
    EXPECT_NE(CWindowDC(&frame).GetPixel(place.left + 4, place.top + 2), ::GetSysColor(highlight)) << "no resources";
    frame.SetRipResourceId(IDR_TESTMAIN);

    PadWindow& outside = floated(frame);
    look(outside, OpenHelp(outside.GetFloatHelp()).place(false));
    seesBevel(highlight, light, shadow, darkShadow);
    seesSign(false, -3, {-1, 0, 2, 3}, {-2, 1, 4});
    seesSign(false, 0, {-4, -3, -1, 0}, {-5, -2, 1});
}

TEST_F(FloatButton, ClassicInTheMenuBarOfTheMainFrame) {
    PadFrame& frame = open();
    frame.MDIMaximize();
    settle();
    widgetOf(*main)->menuWidget()->setMinimumHeight(24); // as with the fonts of most desktops
    settle();
    const CRect place = OpenHelp(main->GetFloatHelp()).place(false);
    EXPECT_EQ(place.top, ::GetSystemMetrics(SM_CYFRAME) + ::GetSystemMetrics(SM_CYCAPTION) +
                             (::GetSystemMetrics(SM_CYCAPTION) - ::GetSystemMetrics(SM_CYSIZE)) / 2);
    look(*main, place);
    seesBevel(highlight, light, shadow, darkShadow);
    seesSign(false, 0, {-1, 0, 2, 3}, {-2, 1, 4});
    frame.MDIRestore();
    settle();
    EXPECT_NE(CWindowDC(main).GetPixel(place.left + 4, place.top + 2), ::GetSysColor(highlight));
}

TEST_F(FloatButton, AssistiveToolsFindItAndPressIt) {
    PadFrame& frame = open();
    const auto find = [](const CWnd& window, const QString& name) -> QAccessibleInterface* {
        QAccessibleInterface* around = QAccessible::queryAccessibleInterface(window.GetState()->widget());
        for (int i = 0; i < around->childCount(); ++i) {
            QAccessibleInterface* child = around->child(i);
            if (child && child->role() == QAccessible::PushButton && child->text(QAccessible::Name) == name) {
                return child;
            }
        }
        return nullptr;
    };
    QAccessibleInterface* button = find(frame, QStringLiteral("Float Window"));
    ASSERT_NE(button, nullptr);
    const CRect place = OpenHelp(frame.GetFloatHelp()).place(true);
    EXPECT_EQ(button->rect(), QRect(place.left, place.top, place.Width(), place.Height()));
    button->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
    settle();
    ASSERT_EQ(Gui_ExternFrame::GetAll().size(), 1U);
    EXPECT_NE(find(*Gui_ExternFrame::GetAll().front(), QStringLiteral("Dock Window")), nullptr);

    open().MDIMaximize();
    settle();
    EXPECT_NE(find(*main, QStringLiteral("Float Window")), nullptr);
    active()->MDIRestore();
    settle();
    EXPECT_EQ(find(*main, QStringLiteral("Float Window")), nullptr);
}

} // namespace
