#include "s/MenuStr.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

TEST(MenuStr, SplitsTexts) {
    struct Case {
        const char *text, *command, *accessKey, *shortCut;
    };
    const std::vector<Case> cases = {
        {"&Save As...\tCtrl+S", "Save As...", "S", "Ctrl+S"},
        {"Fish && Chips", "Fish & Chips", "&", ""},
        {"Print (&P)", "Print ", "P", ""},
        {"開く(&O)...\tCtrl+O", "開く", "O", "Ctrl+O"},
        {"&Übersicht", "Übersicht", "Ü", ""},
        {"Plain", "Plain", "", ""},
        {"", "", "", ""},
        {"Ends with &", "Ends with ", "", ""},
        {"a&(&b", "a", "(", ""},
        {"&(&b", "", "(", ""},
        {"a&\tb", "a\tb", "\t", "b"},
        {"(&O) all of it\tF1", "(&O) all of it\tF1", "O", "F1"},
        {"\tF1", "\tF1", "", "F1"},
        {"two\ttabs\there", "two", "", "tabs\there"},
    };
    for (const Case& c : cases) {
        const Gui_MenuStr text(c.text);
        EXPECT_STREQ(text, c.text);
        EXPECT_EQ(text.GetLength(), static_cast<int>(std::string(c.text).size()));
        EXPECT_STREQ(text.GetCommandText(), c.command) << c.text;
        EXPECT_STREQ(text.GetAccessKeyText(), c.accessKey) << c.text;
        EXPECT_STREQ(text.GetShortCutKeyText(), c.shortCut) << c.text;
    }
}

TEST(MenuStr, ReplacesItsParts) {
    Gui_MenuStr text("&New");
    text.ClearShortCutKeyText();
    EXPECT_STREQ(text, "&New");
    text.SetShortCutKeyText("F2");
    text.SetShortCutKeyText("Ctrl+N");
    EXPECT_STREQ(text, "&New\tCtrl+N");
    text.SetCommandText("&Create");
    EXPECT_STREQ(text.GetText(), "&Create\tCtrl+N");
    text.SetShortCutKeyText(text.GetShortCutKeyText());
    EXPECT_STREQ(text.GetText(), "&Create\tCtrl+N");
    text.ClearShortCutKeyText();
    text.SetCommandText("&Create");
    EXPECT_STREQ(text, "&Create\t");
    text.SetText(nullptr);
    EXPECT_STREQ(text, "");
    EXPECT_STREQ(Gui_MenuStr(nullptr), "");
}

TEST(MenuStr, TakesItemsOfMenusUpToTheirNinetyNinthCharacter) {
    CMenu menu;
    menu.CreateMenu();
    const std::string ascii(120, 'x');
    std::string japanese;
    for (int i = 0; i < 120; ++i) {
        japanese += "あ";
    }
    menu.AppendMenu(MF_STRING, 100, ascii.c_str());
    menu.AppendMenu(MF_STRING, 101, japanese.c_str());
    EXPECT_EQ(Gui_MenuStr(&menu, 0, MF_BYPOSITION).GetText(), ascii.substr(0, 99).c_str());
    Gui_MenuStr text;
    text.SetText(&menu, 101, MF_BYCOMMAND);
    EXPECT_EQ(text.GetText(), japanese.substr(0, 99 * 3).c_str());
    text.SetText(&menu, 102, MF_BYCOMMAND);
    EXPECT_STREQ(text, "");
    EXPECT_STREQ(Gui_MenuStr(nullptr, 0, MF_BYPOSITION), "");
}
