#include "platform/afx/core/detail/Keys.h"
#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"

#include <QMenu>
#include <QTest>
#include <gtest/gtest.h>

namespace {

class Keys : public testing::Test {
protected:
    Keys() {
        EXPECT_TRUE(frame.CreateEx(0, AfxRegisterWndClass(0), "frame", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 200, 100,
                                   nullptr, nullptr));
        widget = tvx::afx::peerOf(frame.m_hWnd);
    }
    ~Keys() override {
        frame.DestroyWindow();
    }
    CWnd frame;
    QWidget* widget = nullptr;
};

// The Alt that opens a menu is released while the menu has the keyboard. An Alt that stayed down would keep every
// accelerator from matching afterwards.
TEST_F(Keys, AreFollowedWhileAMenuHasTheKeyboard) {
    QTest::keyPress(widget, Qt::Key_Alt, Qt::AltModifier);
    EXPECT_TRUE(tvx::afx::isKeyDown(VK_MENU));
    EXPECT_LT(GetAsyncKeyState(VK_MENU), 0);

    QMenu menu;
    menu.addAction("item");
    menu.popup(QPoint(0, 0));
    ASSERT_TRUE(QTest::qWaitForWindowExposed(&menu));
    QTest::keyRelease(&menu, Qt::Key_Alt);
    EXPECT_FALSE(tvx::afx::isKeyDown(VK_MENU));
    EXPECT_EQ(GetAsyncKeyState(VK_MENU), 0);
    menu.close();
}

// The Ctrl of a command is released before the command's dialog has the keyboard: the toolkit drops that release.
TEST_F(Keys, TellThatAModifierIsUp) {
    QTest::keyPress(widget, Qt::Key_Control, Qt::ControlModifier);
    QTest::keyPress(widget, Qt::Key_P, Qt::ControlModifier);
    EXPECT_TRUE(tvx::afx::isKeyDown(VK_CONTROL));
    QTest::keyPress(widget, Qt::Key_F8);
    EXPECT_FALSE(tvx::afx::isKeyDown(VK_CONTROL));
}

} // namespace
