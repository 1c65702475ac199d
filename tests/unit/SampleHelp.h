#pragma once

#include "afxwin.h"
#include "s/HelpMap.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <string>

/// The help of a sample application, in a program that has the application's resources: whatever can be asked about has
/// a page.
class SampleHelp : public testing::Test {
protected:
    explicit SampleHelp(const char* package) : m_package(package) {}
    void SetUp() override {
        ASSERT_TRUE(m_map.Read(GetMapFileForPackage(m_package.c_str())));
        Gui_HelpMap::String type;
        EXPECT_TRUE(std::string(m_map.GetContents(type).c_str()).ends_with("/" + m_package + "/index.html"));
    }
    void expectTopic(UINT context) const {
        EXPECT_NE(m_map.Find("topic", std::to_string(context).c_str()), Gui_HelpMap::End()) << context;
    }
    /// Expects a page for each command of these menus, at any depth. Answers how many commands they have.
    int expectTopics(std::initializer_list<UINT> menus) {
        int commands = 0;
        for (const UINT id : menus) {
            CMenu menu;
            EXPECT_TRUE(menu.LoadMenu(id));
            commands += expectTopics(menu);
        }
        return commands;
    }
    /// Expects a page for each dialog. Answers how many there are.
    int expectTopicsOfDialogs() {
        int dialogs = 0;
        for (UINT id = 1; id < 1000; ++id) {
            if (FindResource(nullptr, MAKEINTRESOURCE(id), RT_DIALOG)) {
                expectTopic(HID_BASE_RESOURCE + id);
                ++dialogs;
            }
        }
        return dialogs;
    }

private:
    int expectTopics(CMenu& menu) {
        int commands = 0;
        for (int i = 0; i < static_cast<int>(menu.GetMenuItemCount()); ++i) {
            if (CMenu* const popup = menu.GetSubMenu(i)) {
                commands += expectTopics(*popup);
            } else if (const UINT id = menu.GetMenuItemID(i); id != 0) { // separators have none
                expectTopic(HID_BASE_COMMAND + id);
                ++commands;
            }
        }
        return commands;
    }

    std::string m_package;
    Gui_HelpMap m_map;
};
