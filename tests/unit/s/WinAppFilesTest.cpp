#include "TestApp.h"

#include "afxdlgs.h"
#include "s/FileName.h"

#include <gtest/gtest.h>
#include <string>

using namespace std::string_literals;

namespace {

/// A template that has its texts from the test and makes no documents.
class Template : public CMultiDocTemplate {
public:
    Template(const char* name, const char* extension)
        : CMultiDocTemplate(0, nullptr, nullptr, nullptr), m_name(name), m_extension(extension) {}
    BOOL GetDocString(CString& text, DocStringIndex index) const override {
        text = index == filterName ? m_name : index == filterExt ? m_extension : CString();
        return !text.IsEmpty();
    }

private:
    CString m_name;
    CString m_extension;
};

} // namespace

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

TEST(WinAppFiles, DialogsBeginWhereTheNameLies) {
    EXPECT_STREQ(theApp.GetInitialDirForFileDialog("C:\\plans\\a.brd"), "C:\\plans\\");
    EXPECT_STREQ(theApp.GetBaseNameForFileDialog("C:\\plans\\a.brd"), "a.brd");
    EXPECT_STREQ(theApp.GetInitialDirForFileDialog("/plans/a.brd").Right(7), "\\plans\\");
    char current[MAX_PATH];
    ASSERT_GT(GetCurrentDirectoryA(sizeof(current), current), 0U);
    EXPECT_STREQ(theApp.GetInitialDirForFileDialog("plans\\a.brd"), current);
    EXPECT_STREQ(theApp.GetBaseNameForFileDialog("plans\\a.brd"), "plans\\a.brd");
    EXPECT_STREQ(theApp.GetInitialDirForFileDialog(""), current);
}

TEST(WinAppFiles, ChosenNamesAreWhole) {
    CFileDialog dialog(TRUE, nullptr, "a.brd");
    EXPECT_STREQ(theApp.GetPathNameFromFileDialog(dialog), Gui_FileName("a.brd").GetFullName());
    CFileDialog odd(TRUE, nullptr, "/tmp/odd\\name");
    EXPECT_STREQ(theApp.GetPathNameFromFileDialog(odd), "/tmp/odd\\name");
}

TEST(WinAppFiles, NamesForMenusLoseTheirFirstFolders) {
    EXPECT_STREQ(theApp.GetAbbreviatedFileName("C:\\plans\\old\\gears\\a.brd", 20, TRUE), "C:\\...\\gears\\a.brd");
    EXPECT_STREQ(theApp.GetAbbreviatedFileName("C:\\plans\\gear wheel.brd", 5, TRUE), "gear wheel.brd");
    EXPECT_STREQ(theApp.GetAbbreviatedFileName("/tmp/odd\\name", 5, TRUE), "/tmp/odd\\name");
}

TEST(WinAppFiles, TheTitleIsAStringOfTheResources) {
    EXPECT_STREQ(theApp.GetTitleForFileDialog(20079), "Web Browser");
    EXPECT_STREQ(theApp.GetTitleForFileDialog(20050), "");
}

TEST(WinAppFiles, TemplatesBringTheirEntriesAndTheDefaultExtension) {
    EXPECT_STREQ(theApp.GetDefaultExtForFileDialog(nullptr), "");
    EXPECT_TRUE(theApp.GetFilterForFileDialog(nullptr, 0).IsEmpty());

    auto* const notes = new Template("Notes", ".nts");
    for (CDocTemplate* added : {new Template("Drawings", ".brd"), new Template("Console", ""), notes}) {
        theApp.AddDocTemplate(added);
    }
    EXPECT_EQ(theApp.GetFilterForFileDialog(nullptr, 0).View(), "Drawings\0*.brd\0Notes\0*.nts\0\0"s);
    EXPECT_TRUE(theApp.GetFilterForFileDialog(nullptr, 1).View().ends_with("*.nts\0All Files (*.*)\0*.*\0\0"s));
    EXPECT_EQ(theApp.GetFilterForFileDialog(notes, 0).View(), "Notes\0*.nts\0\0"s);
    EXPECT_STREQ(theApp.GetDefaultExtForFileDialog(nullptr), "brd");
    EXPECT_STREQ(theApp.GetDefaultExtForFileDialog(notes), "nts");
}
