#include "platform/afx/dialogs/FileDialog.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QComboBox>
#include <QFileDialog>
#include <QHeaderView>
#include <QLineEdit>
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

TEST_F(FileDialogs, OverwritingIsAskedAbout) {
    write(file("there.brd"), "x");
    CFileDialog dialog(FALSE, "brd", nullptr, OFN_OVERWRITEPROMPT);
    const std::string folder = file("").string();
    dialog.m_ofn.lpstrInitialDir = folder.c_str();
    BoxAnswer box("Yes");
    answer("there.brd");
    EXPECT_EQ(dialog.DoModal(), IDOK);
    EXPECT_EQ(box.texts.size(), 1U);
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
