#include "s/AccelMap.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>
#include <vector>

namespace {

Gui_Accel ctrl(char key, int command = 0) {
    return {FVIRTKEY | FCONTROL, static_cast<WORD>(key), static_cast<WORD>(command)};
}

Gui_Accel function(int number, int command = 0) {
    return {FVIRTKEY, static_cast<WORD>(VK_F1 + number - 1), static_cast<WORD>(command)};
}

int commandOf(const Gui_AccelMap& map, const Gui_Accel& accel) {
    unsigned short command = 99;
    const int found = map.GetCmdAt(accel, command);
    EXPECT_EQ(found != 0, command != 0);
    return command;
}

/// Number and texts of the keys of a command, in order.
std::vector<std::string> keysOf(const Gui_AccelMap& map, int command) {
    std::vector<std::string> texts;
    Gui_Accel accel;
    while (map.GetAccelAt(static_cast<WORD>(command), static_cast<int>(texts.size()), accel)) {
        EXPECT_EQ(accel.cmd, command);
        EXPECT_NE(accel.fVirt & FNOINVERT, 0);
        texts.emplace_back(accel.GetKeyText().GetString());
    }
    EXPECT_TRUE(accel.IsEmpty());
    return texts;
}

std::vector<tagACCEL> allOf(const Gui_AccelMap& map) {
    int count = -1;
    tagACCEL* table = nullptr;
    map.GetAll(count, table);
    const std::unique_ptr<tagACCEL[]> owner(table);
    EXPECT_EQ(table == nullptr, count == 0);
    return {table, table + count};
}

using Texts = std::vector<std::string>;

std::string itemText(const CMenu& menu, int command) {
    CString text;
    menu.GetMenuString(static_cast<UINT>(command), text, MF_BYCOMMAND);
    return text.GetString();
}

} // namespace

TEST(AccelMap, AKeyHasOneCommandAndACommandAnyNumberOfKeys) {
    Gui_AccelMap map;
    map.Add(ctrl('O', 1));
    map.Add(ctrl('O', 2));
    EXPECT_EQ(commandOf(map, ctrl('O')), 2);
    EXPECT_EQ(keysOf(map, 1), Texts{});
    Gui_Accel plain = ctrl('O', 3);
    plain.fVirt |= FNOINVERT; // the same key
    map.Add(plain);
    EXPECT_EQ(allOf(map).size(), 1u);
    map.Add(function(2, 3));
    map.Add(ctrl('A', 3));
    map.Add(ctrl('B', 4));
    EXPECT_EQ(keysOf(map, 3), (Texts{"Ctrl+A", "Ctrl+O", "F2"}));
    Gui_Accel accel(1, 1, 1);
    EXPECT_EQ(map.GetAccelAt(3, -1, accel), 0);

    map.Remove(ctrl('A', 77)); // whatever its command
    EXPECT_EQ(keysOf(map, 3), (Texts{"Ctrl+O", "F2"}));
    map.Remove(3);
    EXPECT_EQ(keysOf(map, 3), Texts{});
    EXPECT_EQ(keysOf(map, 4), Texts{"Ctrl+B"});
    EXPECT_EQ(commandOf(map, ctrl('O')), 0);
    map.RemoveAll();
    EXPECT_TRUE(allOf(map).empty());
}

TEST(AccelMap, ComesFromTablesAndBecomesOne) {
    const std::vector<tagACCEL> entries = {ctrl('O', 1), function(3, 2), ctrl('O', 5), {FALT, 'x', 6}};
    const HACCEL source = CreateAcceleratorTableA(entries.data(), static_cast<int>(entries.size()));
    const Gui_AccelMap map(source);
    EXPECT_EQ(commandOf(map, ctrl('O')), 5) << "the later one";
    EXPECT_EQ(commandOf(map, {FALT, 'x', 0}), 6);
    EXPECT_EQ(CopyAcceleratorTableA(source, nullptr, 0), 4) << "still there";
    EXPECT_EQ(allOf(Gui_AccelMap(entries.data(), 2)).size(), 2u);
    EXPECT_TRUE(allOf(Gui_AccelMap(nullptr, 2)).empty());

    const HACCEL made = map.CreateTable();
    ASSERT_NE(made, nullptr);
    std::vector<tagACCEL> copied(3);
    EXPECT_EQ(CopyAcceleratorTableA(made, nullptr, 0), 3);
    CopyAcceleratorTableA(made, copied.data(), 3);
    EXPECT_TRUE(std::equal(copied.begin(), copied.end(), allOf(map).begin(),
                           [](const Gui_Accel& a, const tagACCEL& b) { return a == b; }));
    EXPECT_TRUE(DestroyAcceleratorTable(made));
    EXPECT_TRUE(DestroyAcceleratorTable(source));
    for (const HACCEL none : {HACCEL(), made}) {
        EXPECT_EQ(Gui_AccelMap(none).CreateTable(), nullptr);
    }
}

TEST(AccelMap, HasOneOrderHoweverItWasFilled) {
    Gui_AccelMap upwards;
    Gui_AccelMap downwards;
    for (int i = 0; i < 200; ++i) {
        upwards.Add(Gui_Accel(FVIRTKEY, static_cast<WORD>(i), static_cast<WORD>(i % 3)));
        downwards.Add(Gui_Accel(FVIRTKEY, static_cast<WORD>(199 - i), static_cast<WORD>((199 - i) % 3)));
    }
    Gui_AccelMap copy(upwards);
    Gui_AccelMap assigned;
    assigned.Add(ctrl('X', 9));
    assigned = downwards;
    assigned = *&assigned;
    copy.Add(ctrl('X', 9)); // the original does not follow
    copy.Remove(ctrl('X'));
    const std::vector<tagACCEL> expected = allOf(upwards);
    ASSERT_EQ(expected.size(), 200u);
    for (const Gui_AccelMap* map : {&downwards, &copy, &assigned}) {
        const std::vector<tagACCEL> all = allOf(*map);
        ASSERT_EQ(all.size(), expected.size());
        EXPECT_TRUE(std::equal(all.begin(), all.end(), expected.begin(),
                               [](const Gui_Accel& a, const tagACCEL& b) { return a == b; }));
        EXPECT_EQ(keysOf(*map, 1), keysOf(upwards, 1));
    }
}

TEST(AccelMap, AnnotatesMenusAtAnyDepth) {
    CMenu menu;
    menu.CreateMenu();
    CMenu popup;
    popup.CreatePopupMenu();
    CMenu inner;
    inner.CreatePopupMenu();
    inner.AppendMenu(MF_STRING, 3, "&Deep");
    inner.AppendMenu(MF_STRING, 5, std::string(120, 'x').c_str());
    popup.AppendMenu(MF_STRING, 1, "&Save\tCtrl+S");
    popup.AppendMenu(MF_SEPARATOR);
    popup.AppendMenu(MF_STRING | MF_CHECKED, 2, "&Gone\tCtrl+G");
    popup.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(inner.Detach()), "&More\tkept");
    popup.AppendMenu(MF_STRING, 4, "Case\tctrl+k");
    menu.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(popup.Detach()), "&File");
    Gui_AccelMap map;
    for (const Gui_Accel& accel : {function(2, 1), ctrl('A', 1), ctrl('S', 1), function(9, 3), ctrl('K', 4)}) {
        map.Add(accel);
    }
    map.AnnotateMenu(&menu);
    EXPECT_EQ(itemText(menu, 1), "&Save\tCtrl+S") << "what it shows stays";
    EXPECT_EQ(itemText(menu, 2), "&Gone");
    EXPECT_EQ(menu.GetMenuState(2, MF_BYCOMMAND), 0u) << "made anew";
    EXPECT_EQ(itemText(menu, 3), "&Deep\tF9");
    EXPECT_EQ(itemText(menu, 4), "Case\tCtrl+K");
    EXPECT_EQ(itemText(menu, 5).size(), 99u);
    EXPECT_EQ(menu.GetSubMenu(0)->GetMenuItemCount(), 5u);
    EXPECT_EQ(menu.GetSubMenu(0)->GetMenuItemID(1), 0u) << "the separator";
    CString more;
    menu.GetSubMenu(0)->GetMenuString(3, more, MF_BYPOSITION);
    EXPECT_STREQ(more, "&More\tkept");

    map.Remove(ctrl('S'));
    map.AnnotateMenu(&menu);
    EXPECT_EQ(itemText(menu, 1), "&Save\tCtrl+A") << "the first of its keys";
    map.RemoveAll();
    map.AnnotateMenu(&menu);
    EXPECT_EQ(itemText(menu, 1), "&Save");
    map.AnnotateMenu(nullptr);
}
