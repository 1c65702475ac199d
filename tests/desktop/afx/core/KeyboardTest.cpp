#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/Display.h"

#include <QTest>
#include <QWidget>

#include <cstdlib>
#include <gtest/gtest.h>
#include <string>

namespace {

void press(const char* key) {
    ASSERT_EQ(std::system((std::string("xdotool key ") + key).c_str()), 0);
}

// The lock keys may be pressed in any program, so the display is asked, not what this process has seen.
TEST(KeyboardOnDesktop, LockKeysAreOnUntilTheyArePressedAgain) {
    EXPECT_FALSE(tvx::keyLocks().caps);
    press("Caps_Lock");
    EXPECT_TRUE(tvx::keyLocks().caps);
    EXPECT_FALSE(tvx::keyLocks().num);
    press("Num_Lock");
    EXPECT_TRUE(tvx::keyLocks().num);
    press("Caps_Lock");
    EXPECT_FALSE(tvx::keyLocks().caps);
    EXPECT_TRUE(tvx::keyLocks().num);

    ASSERT_TRUE(tvx::afx::ensureGui());
    QWidget window;
    window.show();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&window));
    EXPECT_EQ(GetKeyState(VK_NUMLOCK) & 1, 1);
    EXPECT_EQ(GetKeyState(VK_CAPITAL), 0);
    press("Num_Lock");
    EXPECT_TRUE(QTest::qWaitFor([] { return GetKeyState(VK_NUMLOCK) == 0; }));
}

} // namespace
