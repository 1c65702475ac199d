#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/Display.h"
#include "platform/win/Pipe.h"
#include "platform/win/Process.h"

#include <QKeyEvent>
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

/// Keeps the display's time of the keys that it gets.
class TimedWindow : public QWidget {
public:
    quint64 released = 0;

protected:
    void keyReleaseEvent(QKeyEvent* event) override {
        released = event->timestamp();
    }
};

/// The startup id of a child.
std::string startupIdOfChild() {
    SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
    STARTUPINFOA startup;
    HANDLE output = nullptr;
    CreatePipe(&output, &startup.hStdOutput, &inheritable, 0);
    startup.dwFlags = STARTF_USESTDHANDLES;
    PROCESS_INFORMATION child;
    std::string line = "sh -c \"echo $DESKTOP_STARTUP_ID\"";
    EXPECT_TRUE(CreateProcessA(nullptr, line.data(), nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup, &child));
    CloseHandle(startup.hStdOutput);
    std::string text;
    char buffer[256];
    for (DWORD count = 0; ReadFile(output, buffer, sizeof buffer, &count, nullptr);) {
        text.append(buffer, count);
    }
    CloseHandle(output);
    return text;
}

TEST(KeyboardOnDesktop, ChildrenAreStartedInTheNameOfTheLastKey) {
    ASSERT_TRUE(tvx::afx::ensureGui());
    EXPECT_EQ(startupIdOfChild(), "\n");
    TimedWindow window;
    window.show();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&window));
    press("a");
    ASSERT_TRUE(QTest::qWaitFor([&] { return window.released != 0; }));
    const std::string end = "_TIME" + std::to_string(window.released) + "\n";
    const std::string id = startupIdOfChild();
    EXPECT_TRUE(id.ends_with(end)) << id << " instead of " << end;
}

} // namespace
