#include "s/Accel.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

std::string text(int flags, int key) {
    return Gui_Accel(static_cast<BYTE>(flags), static_cast<WORD>(key), 7).GetKeyText().GetString();
}

} // namespace

// The names are those of a machine without a display, which knows the English keyboard only.
TEST(Accel, NamesKeysWithTheirModifiers) {
    struct Case {
        int flags, key;
        const char* expected;
    };
    const std::vector<Case> cases = {
        {FVIRTKEY | FCONTROL | FSHIFT, VK_F5, "Ctrl+Shift+F5"},
        {FVIRTKEY | FCONTROL | FALT | FSHIFT | FNOINVERT, 'G', "Ctrl+Alt+Shift+G"},
        {FVIRTKEY | FALT, VK_LEFT, "Alt+Left Arrow"},
        {FVIRTKEY, VK_DOWN, "Down Arrow"},
        {FVIRTKEY, VK_DELETE, "Delete"},
        {FVIRTKEY | FCONTROL, VK_HOME, "Ctrl+Home"},
        {FVIRTKEY | FCONTROL, 0, "Ctrl+"},
        {FCONTROL, 'o', "Ctrl+O"},
        {FALT, 'o', "o"},
        {FSHIFT, 'o', "O"},
        {FCONTROL, 0x00E4, "Ctrl+Ä"},
        {0, 0x3042, "あ"},
        {FCONTROL, 0, "Ctrl+"},
        {0, 0, ""},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(text(c.flags, c.key), c.expected) << "flags " << c.flags << ", key " << c.key;
    }
}

TEST(Accel, PacksKeyAndFlagsWithoutTheCommand) {
    Gui_Accel accel(0x09, 0x4F, 100);
    EXPECT_EQ(accel.EncodeFlagsAndKey(), 0x4F000Bu);
    EXPECT_EQ(Gui_Accel(0x0B, 0x4F, 3).EncodeFlagsAndKey(), 0x4F000Bu);
    EXPECT_EQ(Gui_Accel(0xFF, 0xFFFF, 3).EncodeFlagsAndKey(), 0xFFFF00FFu);
    accel.DecodeFlagsAndKey(0x4F000B);
    EXPECT_TRUE(accel == (tagACCEL{0x0B, 0x4F, 100}));
}

TEST(Accel, IsTheSystemsEntryByAnotherName) {
    const tagACCEL entry{FVIRTKEY, VK_F2, 5};
    Gui_Accel accel(entry);
    EXPECT_TRUE(accel == entry && accel == Gui_Accel(&entry));
    for (const tagACCEL& other : {tagACCEL{0, VK_F2, 5}, tagACCEL{FVIRTKEY, VK_F3, 5}, tagACCEL{FVIRTKEY, VK_F2, 6}}) {
        EXPECT_TRUE(accel != other);
        EXPECT_FALSE(accel == other);
        EXPECT_EQ(Gui_Accel(other).IsEmpty(), 0);
    }
    tagACCEL* pointer = accel;
    pointer->cmd = 6;
    EXPECT_EQ(accel.cmd, 6);
    accel.Clear();
    EXPECT_EQ(accel.IsEmpty(), 1);
    accel = entry;
    EXPECT_EQ(accel.key, VK_F2);
    EXPECT_EQ(Gui_Accel().IsEmpty(), 1);
}
