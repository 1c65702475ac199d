// Names of folders that are completed while they are typed.
#include "platform/afx/controls/AutoComplete.h"
#include "tests/ui/afx/controls/ControlTesting.h"
#include "tests/unit/base/FileTestFolder.h"

#include <QListView>

namespace {

namespace fs = std::filesystem;

class FolderCompletion : public ControlTest<CEdit> {
protected:
    FolderCompletion() {
        std::string pattern = (fs::temp_directory_path() / "folders.XXXXXX").string();
        folder = ::mkdtemp(pattern.data());
        for (const char* name : {"plan", "Plans", "pictures", "other", ".plain"}) {
            fs::create_directory(folder / name);
        }
        std::ofstream(folder / "plan.txt").put('x');
    }
    ~FolderCompletion() override {
        fs::remove_all(folder);
    }
    void make(DWORD style) override {
        control.Create(style | WS_BORDER | ES_AUTOHSCROLL, place, &dialog, controlId);
        ASSERT_EQ(SHAutoComplete(control, SHACF_FILESYS_DIRS), 0);
    }
    QListView* list() const {
        for (QWidget* window : QApplication::topLevelWidgets()) {
            auto* found = qobject_cast<QListView*>(window);
            if (found && found->isVisible()) {
                return found;
            }
        }
        return nullptr;
    }
    QStringList lines() const {
        QStringList texts;
        for (int row = 0; list() && row < list()->model()->rowCount(); ++row) {
            texts.append(list()->model()->index(row, 0).data().toString());
        }
        return texts;
    }
    [[nodiscard]] bool offers(const QStringList& names) const {
        return QTest::qWaitFor([&] { return lines() == names; });
    }
    /// Replaces the text by a name in the folder.
    void typeName(const char* name) {
        key(Qt::Key_A, Qt::ControlModifier);
        type((folder.string() + "/" + name).c_str());
    }
    std::string typed() const {
        return textOf(&control).substr(folder.string().size() + 1);
    }

    fs::path folder;
};

} // namespace

TEST_F(FolderCompletion, ListsFoldersThatBeginAsTyped) {
    with(shown, [&] {
        typeName("P");
        EXPECT_TRUE(offers({"pictures", "plan", "Plans"}));
        type("l");
        EXPECT_TRUE(offers({"plan", "Plans"}));
        type("x");
        EXPECT_TRUE(offers({}));
        typeName(".");
        EXPECT_TRUE(offers({".plain"}));
        key(Qt::Key_Escape);
        EXPECT_EQ(list(), nullptr);
        typeName("none/p");
        typeName("");
        EXPECT_TRUE(offers({"other", "pictures", "plan", "Plans"}));
        control.SetWindowText("set by the program");
        type("x");
        EXPECT_EQ(list(), nullptr);
    });
    CEdit area;
    EXPECT_LT(SHAutoComplete(area, SHACF_FILESYS_DIRS), 0);
}

TEST_F(FolderCompletion, KeysAndClicksChooseAndTheDialogGetsTheOthers) {
    with(shown, [&] {
        typeName("p");
        EXPECT_TRUE(offers({"pictures", "plan", "Plans"}));
        key(Qt::Key_Down);
        key(Qt::Key_Down);
        key(Qt::Key_Enter);
        EXPECT_EQ(typed(), "plan");
        EXPECT_EQ(list(), nullptr);
        typeName("PL");
        EXPECT_TRUE(offers({"plan", "Plans"}));
        key(Qt::Key_Tab); // as far as all agree
        EXPECT_EQ(typed(), "plan");
        EXPECT_EQ(dialog.focus(), controlId);
        typeName("p");
        EXPECT_TRUE(offers({"pictures", "plan", "Plans"}));
        QListView* view = list();
        QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, view->visualRect(view->model()->index(2, 0)).center());
        EXPECT_EQ(typed(), "Plans");
    });
    dialog.script = [&] {
        control.SetFocus();
        typeName("o");
        EXPECT_TRUE(offers({"other"}));
        key(Qt::Key_Enter); // no line is chosen: it is the dialog's
    };
    EXPECT_EQ(dialog.DoModal(), IDOK);
}
