#include "TestApp.h"

#include <gtest/gtest.h>
#include <string>

using namespace std::string_literals;

TEST(WinAppFiles, FilterEntriesFollowEachOther) {
    CString filter;
    Gui_WinApp::AddFileFilter(filter, "Drawings", "*.brd");
    EXPECT_EQ(filter.View(), "Drawings\0*.brd\0\0"s);
    Gui_WinApp::AddFileFilter(filter, "Notes", "*.nts");
    EXPECT_EQ(filter.View(), "Drawings\0*.brd\0Notes\0*.nts\0\0"s);
    Gui_WinApp::AddFileFilter(filter, AFX_IDS_ALLFILTER, "*.*");
    CString allFiles;
    ASSERT_TRUE(allFiles.LoadString(AFX_IDS_ALLFILTER));
    EXPECT_TRUE(filter.View().ends_with("*.nts\0"s + allFiles.GetString() + "\0*.*\0\0"s));
}

TEST(WinAppFiles, ATextOfOtherOriginKeepsItsEnd) {
    CString filter("x\0", 2);
    Gui_WinApp::AddFileFilter(filter, "Drawings", "*.brd");
    EXPECT_EQ(filter.View(), "x\0Drawings\0*.brd\0\0"s);
}

TEST(WinAppFiles, TheHelpButtonIsTakenAwayAndNothingElse) {
    EXPECT_EQ(theApp.GetFlagsForFileDialog(0xFFFFFFFF), 0xFFFFFFEFu);
    EXPECT_EQ(theApp.GetFlagsForFileDialog(0x6), 0x6u);
}

TEST(WinAppFiles, TheTitleIsAStringOfTheResources) {
    EXPECT_STREQ(theApp.GetTitleForFileDialog(20079), "Web Browser");
    EXPECT_STREQ(theApp.GetTitleForFileDialog(20050), "");
}
