// The application's help: whatever can be asked about has a page.
#include "Resource.h"
#include "afxwin.h"
#include "s/HelpMap.h"

#include <gtest/gtest.h>

#include <string>

namespace {

class BoardHelp : public testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(m_map.Read(GetMapFileForPackage("board")));
    }
    void expectTopic(UINT context) const {
        EXPECT_NE(m_map.Find("topic", std::to_string(context).c_str()), Gui_HelpMap::End()) << context;
    }
    /// Expects a page for each command of a menu, at any depth.
    void expectTopics(CMenu& menu) {
        for (int i = 0; i < static_cast<int>(menu.GetMenuItemCount()); ++i) {
            if (CMenu* const popup = menu.GetSubMenu(i)) {
                expectTopics(*popup);
            } else if (const UINT id = menu.GetMenuItemID(i); id != 0) { // separators have none
                expectTopic(HID_BASE_COMMAND + id);
                ++m_commands;
            }
        }
    }

    Gui_HelpMap m_map;
    int m_commands = 0;
};

TEST_F(BoardHelp, HasAPageForEachCommandOfItsMenus) {
    for (const UINT id : {IDR_MAINFRAME, IDR_BOARDTYPE, IDR_CONTEXT}) {
        CMenu menu;
        ASSERT_TRUE(menu.LoadMenu(id));
        expectTopics(menu);
    }
    EXPECT_GT(m_commands, 50);
    for (const UINT prompt : {AFX_IDS_SCSIZE, AFX_IDS_SCMOVE, AFX_IDS_SCMINIMIZE, AFX_IDS_SCMAXIMIZE, AFX_IDS_SCCLOSE,
                              AFX_IDS_SCRESTORE, AFX_IDS_MDICHILD}) {
        expectTopic(HID_BASE_COMMAND + prompt);
    }
}

TEST_F(BoardHelp, HasAPageForEachDialogAndTheDrawingsWindow) {
    int dialogs = 0;
    for (UINT id = 1; id < 1000; ++id) {
        if (FindResource(nullptr, MAKEINTRESOURCE(id), RT_DIALOG)) {
            expectTopic(HID_BASE_RESOURCE + id);
            ++dialogs;
        }
    }
    EXPECT_EQ(dialogs, 2);
    expectTopic(HID_BASE_RESOURCE + IDR_BOARDTYPE);
    Gui_HelpMap::String type;
    EXPECT_TRUE(std::string(m_map.GetContents(type).c_str()).ends_with("/board/index.html"));
}

} // namespace
