// The desktop of a session in which no process can see another one's windows: a Wayland session, or none at all.
#include "s/Desktop.h"

#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

TEST(Desktop, KnowsNoOtherWindowsWithoutAnX11Display) {
    const SavedEnvironment environment;
    for (const char* session : {"wayland-0", ""}) {
        setenv("WAYLAND_DISPLAY", session, 1);
        for (const unsigned long window : {0UL, 0x400006UL, 0x80000001UL, ~0UL}) {
            EXPECT_EQ(Gui_Desktop::ShowWindow(window), 0) << session << ' ' << window;
        }
        EXPECT_EQ(GetForegroundWindow(), nullptr);
        EXPECT_TRUE(EnumWindows([](HWND, LPARAM) -> BOOL { return FALSE; }, 0)) << "there is a window";
    }
    EXPECT_EQ(Gui_Desktop::GetMainWindowID(), 0u);
}

TEST(Desktop, IdentifiesWindowsByTheirHandles) {
    const auto handle = reinterpret_cast<HWND>(std::uintptr_t{0x80000005});
    EXPECT_EQ(Gui_Desktop::GetDialogWindowID(handle), 0x80000005UL);
    EXPECT_EQ(Gui_Desktop::GetDialogWindowID(nullptr), 0UL);
    EXPECT_EQ(Gui_Desktop::GetDisplay(), nullptr);
}
