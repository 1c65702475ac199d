#include "platform/afx/dialogs/FileDialog.h"
#include "tests/ui/afx/InDialog.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QComboBox>
#include <QFileDialog>
#include <QHeaderView>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QTreeView>

#include <stdexcept>

using namespace frametest;

using FileDialogs = FrameTest;

namespace {

QFileDialog* shownDialog() {
    return qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
}

/// Types a name into the dialog and presses Enter, or Esc for an empty one.
void answer(const std::string& name) {
    later([name] {
        QFileDialog* dialog = shownDialog();
        ASSERT_NE(dialog, nullptr);
        auto* edit = dialog->findChild<QLineEdit*>("fileNameEdit");
        if (name.empty()) {
            QTest::keyClick(edit, Qt::Key_Escape);
            return;
        }
        edit->setText(QString::fromStdString(name));
        QTest::keyClick(edit, Qt::Key_Return);
    });
}

} // namespace

TEST_F(FileDialogs, OpenAnswersTheParts) {
    write(file("some.picture.brd"), "x");
    CFileDialog dialog(TRUE, "brd", nullptr, OFN_HIDEREADONLY | OFN_FILEMUSTEXIST,
                       "Boards (*.brd)|*.brd|All Files (*.*)|*.*||");
    const std::string folder = file("").string();
    dialog.m_ofn.lpstrInitialDir = folder.c_str();
    dialog.GetOFN().lpstrTitle = "Pick a board";
    answer("some.picture.brd");
    ASSERT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(dialog.GetPathName(), driveName("some.picture.brd"));
    EXPECT_EQ(dialog.GetFileName(), "some.picture.brd");
    EXPECT_EQ(dialog.GetFileExt(), "brd");
    EXPECT_EQ(dialog.GetFileTitle(), "some.picture");
    EXPECT_EQ(dialog.m_ofn.nFilterIndex, 1U);
    POSITION at = dialog.GetStartPosition();
    EXPECT_EQ(dialog.GetNextPathName(at), dialog.GetPathName());
    EXPECT_EQ(at, nullptr);
}

TEST_F(FileDialogs, TheHelpKeyAsksForTheirPage) {
    openNote();
    for (const auto& [isOpen, number] : {std::pair(TRUE, AFX_IDD_FILEOPEN), std::pair(FALSE, AFX_IDD_FILESAVE)}) {
        testApplication.help.clear();
        later([] {
            QTest::keyClick(shownDialog()->findChild<QLineEdit*>("fileNameEdit"), Qt::Key_F1);
            QTest::keyClick(shownDialog(), Qt::Key_Escape);
        });
        CFileDialog(isOpen).DoModal();
        const std::pair<DWORD_PTR, UINT> asked(HID_BASE_RESOURCE + number, HELP_CONTEXT);
        EXPECT_EQ(testApplication.help, std::vector{asked});
    }
}

TEST_F(FileDialogs, CancelChangesNothing) {
    CFileDialog dialog(TRUE, nullptr, "first");
    answer("");
    EXPECT_EQ(dialog.DoModal(), IDCANCEL);
    EXPECT_EQ(dialog.GetPathName(), "first");
}

TEST_F(FileDialogs, SaveCompletesTheExtension) {
    CFileDialog dialog(FALSE, "brd", file("start.brd").c_str(), OFN_OVERWRITEPROMPT, "Boards|*.brd||");
    later([] {
        QFileDialog* shown = shownDialog();
        ASSERT_NE(shown, nullptr);
        EXPECT_EQ(shown->selectedNameFilter(), QString("Boards (*.brd)"));
        EXPECT_EQ(shown->findChild<QLineEdit*>("fileNameEdit")->text(), QString("start.brd"));
        EXPECT_EQ(shown->labelText(QFileDialog::LookIn), QString("Save in:"));
        for (const auto* button : shown->findChildren<QPushButton*>()) {
            EXPECT_TRUE(button->icon().isNull()) << button->text().toStdString();
        }
        const auto* header = shown->findChild<QTreeView*>("treeView")->header();
        for (int column = 1; column < header->count(); ++column) {
            EXPECT_GE(header->sectionSize(column), header->sectionSizeHint(column)) << column;
        }
        EXPECT_EQ(header->length(), header->viewport()->width()) << "the name takes the rest";
    });
    answer("fresh");
    ASSERT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(dialog.GetPathName(), driveName("fresh.brd"));
}

namespace {

constexpr const char* twoKinds = "Boards (*.brd)|*.brd|Notes|*.nts|All Files (*.*)|*.*||";

/// What the user does in the dialogs of one table, and what comes of it.
struct Typed {
    std::string name;
    DWORD filter;
    std::string result; ///< the name answered; empty when the dialog stayed open
    std::string said;   ///< part of the one message box; empty for none
    QString button = "Yes";
};

} // namespace

/// Dialogs that begin in the test's folder.
class FileNames : public FrameTest {
protected:
    void expect(BOOL opens, DWORD flags, const Typed& typed) {
        SCOPED_TRACE(typed.name + " with filter " + std::to_string(typed.filter));
        const auto before = std::filesystem::current_path();
        CFileDialog dialog(opens, "brd", nullptr, flags | OFN_NOCHANGEDIR, twoKinds);
        const std::string folder = file("").string();
        dialog.m_ofn.lpstrInitialDir = folder.c_str();
        dialog.m_ofn.nFilterIndex = typed.filter;
        BoxAnswer box(typed.button);
        const std::string name = typed.name.starts_with('/') ? file(typed.name.substr(1)).string() : typed.name;
        inDialog([&] {
            auto* edit = shownDialog()->findChild<QLineEdit*>("fileNameEdit");
            edit->setFocus();
            edit->setText(QString::fromStdString(name));
            QTest::keyClick(edit, Qt::Key_Return);
            later([shown = QPointer(shownDialog())] {
                if (shown) { // it has stayed open
                    QTest::keyClick(shown, Qt::Key_Escape);
                }
            });
        });
        EXPECT_EQ(dialog.DoModal(), typed.result.empty() ? IDCANCEL : IDOK);
        if (!typed.result.empty()) {
            EXPECT_EQ(dialog.GetPathName(), driveName(typed.result));
            EXPECT_EQ(dialog.m_ofn.nFilterIndex, typed.filter);
        }
        EXPECT_EQ(box.texts.size(), typed.said.empty() ? 0U : 1U);
        if (!box.texts.empty()) {
            EXPECT_NE(box.texts.front().find(typed.said), std::string::npos) << box.texts.front();
        }
        EXPECT_EQ(std::filesystem::current_path(), before);
    }
};

TEST_F(FileNames, ToSaveAreAskedAboutAsTheyWillBeWritten) {
    for (const char* name : {"there.brd", "bare", "dots.brd.old"}) {
        write(file(name), "x");
    }
    write(file("fixed.brd"), "x");
    std::filesystem::permissions(file("fixed.brd"), std::filesystem::perms::owner_read);
    std::filesystem::create_directories(file("folder.brd"));
    for (const Typed& typed : {
             Typed{"there", 1, "there.brd", "there.brd already exists"},
             {"there", 1, "", "there.brd already exists", "No"},
             {"there.brd", 2, "there.brd", "already exists"},
             {"there", 2, "there.nts", ""},
             {"bare", 1, "bare.brd", ""},
             {"fresh", 3, "fresh.brd", ""},
             {"fresh.nts", 1, "fresh.nts", ""},
             {"100% #1 \xC3\xA4", 1, "100% #1 \xC3\xA4.brd", ""},
             {"/there", 1, "there.brd", "already exists"},
             {"fixed", 1, "", "cannot be written", "OK"},
             {"folder", 1, "", "is a folder", "OK"},
             {"missing/a.brd", 1, "", "missing\nThis folder does not exist", "OK"},
             {"Z:\\a.brd", 1, "", "not valid", "OK"},
             {"*.nts", 1, "", ""},
         }) {
        expect(FALSE, OFN_OVERWRITEPROMPT | OFN_PATHMUSTEXIST, typed);
    }
    expect(FALSE, 0, {"there", 1, "there.brd", ""});
    expect(FALSE, 0, {"missing/a.brd", 1, "missing/a.brd", ""});
}

TEST_F(FileNames, ToOpenAreLookedFor) {
    std::filesystem::create_directories(file("sub"));
    for (const char* name : {"there.brd", "LARGE.BRD", "bare", "sub/a.brd", "one.nts", "one.brd"}) {
        write(file(name), "x");
    }
    for (const Typed& typed : {
             Typed{"there", 1, "there.brd", ""},
             {"THERE.BRD", 1, "there.brd", ""},
             {"large", 1, "LARGE.BRD", ""},
             {"bare", 1, "bare", ""},
             {"one", 2, "one.nts", ""},
             {"one", 3, "one.brd", ""},
             {"sub\\a.brd", 1, "sub/a.brd", ""},
             {"sub/../there", 1, "there.brd", ""},
             {"gone.brd", 1, "", "cannot be found", "OK"},
             {"sub", 1, "", ""},
         }) {
        expect(TRUE, OFN_FILEMUSTEXIST, typed);
    }
    expect(TRUE, 0, {"gone", 1, "gone.brd", ""});
    expect(TRUE, OFN_CREATEPROMPT, {"gone", 2, "gone.nts", "gone.nts does not exist"});
    expect(TRUE, OFN_CREATEPROMPT, {"gone", 2, "", "gone.nts does not exist", "No"});
    expect(TRUE, OFN_CREATEPROMPT, {"missing/gone", 2, "", "This folder does not exist", "OK"});
}

TEST_F(FileDialogs, EqualFiltersAreToldApartByTheirPlaces) {
    CFileDialog dialog(TRUE, nullptr, nullptr, 0, "Same|*.brd|Same|*.brd|Same|*.brd||");
    dialog.m_ofn.nFilterIndex = 2;
    later([] {
        auto* types = shownDialog()->findChild<QComboBox*>("fileTypeCombo");
        EXPECT_EQ(types->currentIndex(), 1);
        types->setCurrentIndex(2);
    });
    answer(file("a.brd").string());
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(dialog.m_ofn.nFilterIndex, 3U);
    std::filesystem::current_path("/");
}

TEST_F(FileDialogs, PatternsAreWithoutRegardToCase) {
    for (const char* name : {"a.brd", "b.Brd", "c.nts", "README"}) {
        write(file(name), "x");
    }
    const std::string folder = file("").string();
    CFileDialog dialog(TRUE, nullptr, nullptr, 0, "Boards|*.BRD||");
    dialog.m_ofn.lpstrInitialDir = folder.c_str();
    later([] {
        auto* list = shownDialog()->findChild<QTreeView*>("treeView");
        const auto shows = [&](int rows) {
            return QTest::qWaitFor([&] { return list->model()->rowCount(list->rootIndex()) == rows; });
        };
        EXPECT_TRUE(shows(2));
        auto* field = shownDialog()->findChild<QLineEdit*>("fileNameEdit");
        for (const auto& [typed, rows] : {std::pair("*.nts; *.brd", 3), {"*.*", 4}, {"?.nts", 1}}) {
            field->setText(typed);
            QTest::keyClick(field, Qt::Key_Return);
            EXPECT_TRUE(shows(rows)) << typed;
        }
        QTest::keyClick(shownDialog(), Qt::Key_Escape);
    });
    dialog.DoModal();
}

TEST_F(FileDialogs, SeveralFilesStandInTheRecordBehindTheirFolder) {
    for (const char* name : {"a.brd", "b b.brd", "c.brd"}) {
        write(file(name), "x");
    }
    const std::string folder = file("").string();
    const auto choose = [&](DWORD room) {
        CFileDialog dialog(TRUE, "brd", nullptr, OFN_ALLOWMULTISELECT | OFN_FILEMUSTEXIST | OFN_NOCHANGEDIR);
        std::string buffer(room, '?');
        buffer[0] = '\0';
        dialog.m_ofn.lpstrInitialDir = folder.c_str();
        dialog.m_ofn.lpstrFile = buffer.data();
        dialog.m_ofn.nMaxFile = room;
        inDialog([] {
            auto* list = shownDialog()->findChild<QTreeView*>("treeView");
            ASSERT_TRUE(QTest::qWaitFor([&] { // until they are sorted
                const QAbstractItemModel& model = *list->model();
                return model.index(1, 0, list->rootIndex()).data() == "b b.brd" &&
                       model.index(2, 0, list->rootIndex()).data() == "c.brd";
            }));
            list->setFocus();
            list->setCurrentIndex(list->model()->index(0, 0, list->rootIndex()));
            QTest::keyClick(list, Qt::Key_Down, Qt::ShiftModifier);
            QTest::keyClick(list, Qt::Key_Return);
        });
        EXPECT_EQ(dialog.DoModal(), IDOK);
        std::vector<CString> paths;
        for (POSITION at = dialog.GetStartPosition(); at;) {
            paths.push_back(dialog.GetNextPathName(at));
        }
        EXPECT_EQ(paths, (std::vector<CString>{driveName("a.brd"), driveName("b b.brd")}));
        return buffer;
    };
    const std::string place = tvx::driveName(folder.substr(0, folder.size() - 1));
    using namespace std::string_literals;
    EXPECT_TRUE(choose(1000).starts_with(place + "\0a.brd\0b b.brd\0\0"s));
    EXPECT_TRUE(choose(static_cast<DWORD>(place.size()) + 8).starts_with('\0')) << "no room: no name at all";
}

TEST_F(FileDialogs, KindsGoByTheEndsOfNamesAndHiddenFilesByAKey) {
    for (const char* name : {"a.brd", "b.png", "c", ".d"}) {
        write(file(name), "x");
    }
    const std::string folder = file("").string();
    CFileDialog dialog(TRUE);
    dialog.m_ofn.lpstrInitialDir = folder.c_str();
    inDialog([] {
        auto* list = shownDialog()->findChild<QTreeView*>("treeView");
        const auto column = [list](int number) {
            QStringList texts;
            for (int row = 0; row < list->model()->rowCount(list->rootIndex()); ++row) {
                texts.append(list->model()->index(row, number, list->rootIndex()).data().toString());
            }
            return texts;
        };
        EXPECT_TRUE(QTest::qWaitFor([&] { return column(0) == QStringList({"a.brd", "b.png", "c"}); }));
        EXPECT_EQ(column(2), QStringList({"BRD File", "PNG image", "File"}));
        key(Qt::Key_H, Qt::ControlModifier);
        EXPECT_TRUE(QTest::qWaitFor([&] { return column(0).contains(".d"); }));
        QTest::keyClick(shownDialog(), Qt::Key_Escape);
    });
    dialog.DoModal();
}

TEST_F(FileDialogs, AFolderThatIsTypedIsGoneInto) {
    std::filesystem::create_directory(file("sub"));
    const std::string folder = file("").string();
    CFileDialog dialog(FALSE);
    dialog.m_ofn.lpstrInitialDir = folder.c_str();
    inDialog([] {
        auto* edit = shownDialog()->findChild<QLineEdit*>("fileNameEdit");
        QTest::keyClicks(edit, "sub");
        EXPECT_TRUE(QTest::qWaitFor([] { return QApplication::activePopupWidget() != nullptr; }));
        QTest::keyClick(edit, Qt::Key_Return);
        EXPECT_TRUE(shownDialog()->directory().path().endsWith("/sub"));
        EXPECT_EQ(edit->text(), "");
        EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
        QTest::keyClick(edit, Qt::Key_Escape);
    });
    dialog.DoModal();
}

TEST_F(FileDialogs, TheCurrentFolderFollowsUnlessThatIsUnwanted) {
    const auto before = std::filesystem::current_path();
    for (const DWORD flag : {OFN_NOCHANGEDIR, 0}) {
        CFileDialog dialog(FALSE, nullptr, nullptr, flag);
        answer(file("a").string());
        EXPECT_EQ(dialog.DoModal(), IDOK);
        EXPECT_EQ(std::filesystem::current_path(), flag != 0 ? before : file("").parent_path());
    }
    std::filesystem::current_path(before);
}

TEST_F(FileDialogs, StandInFrontOfTheirOwnersAndQuestionsInFrontOfThem) {
    NoteFrame& frame = openNote();
    write(file("there.brd"), "x");
    CFileDialog dialog(FALSE, "brd", file("there").c_str(), OFN_OVERWRITEPROMPT | OFN_NOCHANGEDIR);
    inDialog([&] {
        QFileDialog* asking = shownDialog();
        EXPECT_EQ(asking->parentWidget(), widgetOf(frame));
        later([asking] {
            auto* box = dynamic_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            EXPECT_EQ(box->parentWidget(), asking);
            QTest::mouseClick(box->buttons().front(), Qt::LeftButton);
        });
        QTest::keyClick(asking->findChild<QLineEdit*>("fileNameEdit"), Qt::Key_Return);
    });
    EXPECT_EQ(dialog.DoModal(), IDOK);
}

TEST_F(FileDialogs, LetExceptionsOfTheHostsCheckOut) {
    class Failing : public CFileDialog {
    public:
        Failing() : CFileDialog(FALSE) {}

    protected:
        BOOL OnFileNameOK() override {
            throw std::runtime_error("no more names");
        }
    } dialog;
    answer(file("any.brd").string());
    EXPECT_THROW(dialog.DoModal(), std::runtime_error);
    EXPECT_EQ(shownDialog(), nullptr);
}

TEST_F(FileDialogs, SaveAsAsksForTheName) {
    NoteFrame& frame = openNote();
    document().text = "named";
    answer(file("named.note").string());
    frame.SendMessage(WM_COMMAND, ID_FILE_SAVE);
    EXPECT_EQ(contents(file("named.note")), "\x05named");
    EXPECT_EQ(titleOf(frame), "named.note - Frame Test");
}
