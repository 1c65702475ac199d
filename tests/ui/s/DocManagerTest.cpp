// The dialogs of File Open and Save As, as the application object shapes them.
#include "s/DocManager.h"

#include "afxdlgs.h"
#include "tests/ui/afx/InDialog.h"
#include "tests/ui/s/WindowTestApp.h"

#include <QFileDialog>
#include <QLineEdit>
#include <QTest>

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>

namespace {

/// A kind of files that has its texts from the test.
class Kind : public CMultiDocTemplate {
public:
    Kind(const char* name, const char* extension)
        : CMultiDocTemplate(0, nullptr, nullptr, nullptr), m_name(name), m_extension(extension) {}
    BOOL GetDocString(CString& text, DocStringIndex index) const override {
        text = index == filterName ? m_name : index == filterExt ? m_extension : "";
        return !text.IsEmpty();
    }

private:
    const char* m_name;
    const char* m_extension;
};

class DocManager : public testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(windowTestApp.InitApplication());
        windowTestApp.AddDocTemplate(new Kind("Drawings", ".brd"));
        windowTestApp.AddDocTemplate(new Kind("Notes", ".nts"));
        windowTestApp.asked.clear();
        // File dialogs of other tests have left the program in folders that are gone.
        std::filesystem::current_path(std::filesystem::temp_directory_path());
        std::filesystem::create_directory("docs");
        for (const char* name : {"docs/a.brd", "docs/b.nts"}) {
            std::ofstream(name) << "x";
        }
    }

    void TearDown() override {
        delete windowTestApp.m_pDocManager;
        windowTestApp.m_pDocManager = nullptr;
    }

    /// Asks for a file; the dialog is looked at, then left by a typed name or, without one, by Esc.
    static int prompt(CString& name, bool opens, const char* typed, std::function<void(QFileDialog&)> look = {}) {
        inDialog([typed, look = std::move(look)] {
            auto& dialog = dynamic_cast<QFileDialog&>(*QApplication::activeModalWidget());
            if (look) {
                look(dialog);
            }
            auto* edit = dialog.findChild<QLineEdit*>("fileNameEdit");
            if (typed) {
                edit->setText(typed);
            }
            QTest::keyClick(edit, typed ? Qt::Key_Return : Qt::Key_Escape);
        });
        return windowTestApp.DoPromptFileName(name, opens ? AFX_IDS_OPENFILE : AFX_IDS_SAVEFILE,
                                              OFN_SHOWHELP | (opens ? OFN_FILEMUSTEXIST : 0), opens, nullptr);
    }
    static CString fullName(const char* name) {
        return std::filesystem::absolute(name).c_str();
    }
};

void takeFilter(QFileDialog& dialog, int number) {
    dialog.selectNameFilter(dialog.nameFilters().at(number));
}

} // namespace

TEST_F(DocManager, IsInstalledAtTheStartAndAsksForEachPart) {
    EXPECT_TRUE(windowTestApp.m_pDocManager->IsKindOf(RUNTIME_CLASS(Gui_DocManager)));
    CString name = fullName("docs/a.brd");
    EXPECT_EQ(prompt(name, true, "b.nts",
                     [](QFileDialog& dialog) {
                         EXPECT_EQ(dialog.windowTitle(), "Open");
                         EXPECT_EQ(dialog.nameFilters().size(), 3);
                         EXPECT_TRUE(dialog.directory().path().endsWith("/docs"));
                         EXPECT_EQ(dialog.findChild<QLineEdit*>("fileNameEdit")->text(), "a.brd");
                         takeFilter(dialog, 1);
                     }),
              1);
    EXPECT_STREQ(name.Right(11), "\\docs\\b.nts");
    EXPECT_EQ(windowTestApp.asked,
              (std::vector<std::string>{"owner", "title", "flags", "filter", "folder", "extension", "name", "path"}));
}

TEST_F(DocManager, TheNextDialogBeginsWithTheAcceptedFilter) {
    const auto expectFilter = [](int number) {
        return [number](QFileDialog& dialog) {
            EXPECT_EQ(dialog.selectedNameFilter(), dialog.nameFilters().at(number));
            takeFilter(dialog, 0);
        };
    };
    const CString first = fullName("docs/a.brd");
    CString name = first;
    EXPECT_EQ(prompt(name, true, "a.brd", [](QFileDialog& dialog) { takeFilter(dialog, 2); }), 1);
    name = "elsewhere";
    EXPECT_EQ(prompt(name, false, nullptr, expectFilter(2)), 0);
    EXPECT_STREQ(name, "elsewhere");
    EXPECT_EQ(prompt(name = first, true, "a.brd", expectFilter(2)), 1);
    EXPECT_EQ(prompt(name, false, nullptr, expectFilter(0)), 0);
}
