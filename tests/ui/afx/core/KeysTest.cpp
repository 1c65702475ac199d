#include "platform/afx/core/detail/Keys.h"
#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"

#include <QMenu>
#include <QTest>
#include <gtest/gtest.h>

#include <cstring>
#include <map>
#include <string>

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

std::string nameOf(LONG parameter) {
    char name[50] = "";
    const int length = GetKeyNameText(parameter, name, sizeof(name));
    EXPECT_EQ(static_cast<std::size_t>(length), std::strlen(name));
    return name;
}

// As a program names a virtual key: by its scan code, with the extended bit for the cursor block only.
std::string nameOfKey(UINT virtualKey) {
    const bool cursor =
        (virtualKey >= VK_PRIOR && virtualKey <= VK_DOWN) || virtualKey == VK_INSERT || virtualKey == VK_DELETE;
    return nameOf(static_cast<LONG>(MapVirtualKey(virtualKey, 0) << 16 | (cursor ? 1U << 24 : 0)));
}

TEST_F(Keys, HaveNamesThatTellThemApart) {
    const std::pair<Qt::Key, const char*> table[] = {{Qt::Key_A, "A"},
                                                     {Qt::Key_7, "7"},
                                                     {Qt::Key_F1, "F1"},
                                                     {Qt::Key_F11, "F11"},
                                                     {Qt::Key_F24, "F24"},
                                                     {Qt::Key_Space, "Space"},
                                                     {Qt::Key_Backtab, "Tab"},
                                                     {Qt::Key_Backspace, "Backspace"},
                                                     {Qt::Key_Enter, "Enter"},
                                                     {Qt::Key_Escape, "Esc"},
                                                     {Qt::Key_Pause, "Pause"},
                                                     {Qt::Key_Print, "Print Screen"},
                                                     {Qt::Key_Menu, "Menu"},
                                                     {Qt::Key_Home, "Home"},
                                                     {Qt::Key_Left, "Left"},
                                                     {Qt::Key_Delete, "Delete"},
                                                     {Qt::Key_CapsLock, "Caps Lock"},
                                                     {Qt::Key_NumLock, "Num Lock"},
                                                     {Qt::Key_Control, "Ctrl"},
                                                     {Qt::Key_Alt, "Alt"},
                                                     {Qt::Key_Shift, "Shift"},
                                                     {Qt::Key_Plus, "="},
                                                     {Qt::Key_Question, "/"},
                                                     {Qt::Key_Back, "Browser Back"},
                                                     {Qt::Key_MediaPlay, "Play/Pause"},
                                                     {Qt::Key_LaunchMail, "Mail"},
                                                     {Qt::Key_VolumeMute, "Mute"},
                                                     {Qt::Key_Select, "Select"},
                                                     {Qt::Key_Printer, "Print"},
                                                     {Qt::Key_Execute, "Execute"},
                                                     {Qt::Key_Cancel, "Break"}};
    for (const auto& [key, name] : table) {
        const QKeyEvent press(QEvent::KeyPress, key, Qt::NoModifier);
        EXPECT_EQ(nameOfKey(static_cast<UINT>(tvx::afx::virtualKey(press))), name);
        EXPECT_EQ(nameOf(static_cast<LONG>(tvx::afx::keyParameter(press, false))), name);
    }
    std::map<std::string, UINT> named;
    for (UINT key = 1; key < 256; ++key) {
        if (const std::string name = nameOfKey(key); !name.empty()) {
            EXPECT_TRUE(named.emplace(name, key).second) << name << " is " << key << " and " << named[name];
        }
    }
    EXPECT_GE(named.size(), 140U);
    EXPECT_EQ(nameOfKey(VK_NUMPAD7), "Num 7");
    EXPECT_EQ(nameOfKey(VK_DIVIDE), "Num /");
    EXPECT_EQ(nameOfKey(0xFF), "");
}

TEST_F(Keys, AreMappedToScanCodesAndCharacters) {
    EXPECT_EQ(MapVirtualKey(VK_HOME, 0), MapVirtualKey(VK_NUMPAD7, 0));
    EXPECT_EQ(MapVirtualKey(0x47, 1), static_cast<UINT>(VK_HOME));
    EXPECT_EQ(MapVirtualKey(0x38, 3), static_cast<UINT>(VK_MENU));
    EXPECT_EQ(MapVirtualKey(0xE038, 3), static_cast<UINT>(VK_MENU));
    EXPECT_EQ(MapVirtualKey('Q', 2), static_cast<UINT>('Q'));
    EXPECT_EQ(MapVirtualKey(VK_NUMPAD4, 2), static_cast<UINT>('4'));
    EXPECT_EQ(MapVirtualKey(VK_TAB, 2), static_cast<UINT>('\t'));
    EXPECT_EQ(MapVirtualKey(VK_F5, 2), 0U);
    char name[4] = "";
    EXPECT_EQ(GetKeyNameText(0x390000, name, sizeof(name)), 3);
    EXPECT_STREQ(name, "Spa");
    EXPECT_EQ(GetKeyNameText(0x390000, name, 0), 0);
}

} // namespace
