#include "tests/ui/afx/frames/FrameTesting.h"

#include <QDropEvent>
#include <QMimeData>
#include <QUrl>

#include <sys/stat.h>
#include <unistd.h>

using namespace frametest;

using Documents = FrameTest;

namespace {

/// The bytes of a saved note: its text behind its length.
std::string saved(const std::string& text) {
    return std::string(1, static_cast<char>(text.size())) + text;
}

} // namespace

TEST_F(Documents, SaveAndOpen) {
    NoteFrame& frame = openNote();
    document().text = "one";
    document().SetModifiedFlag();
    EXPECT_TRUE(document().DoSave(file("a.note").c_str()));
    EXPECT_EQ(contents(file("a.note")), saved("one"));
    EXPECT_FALSE(document().IsModified());
    EXPECT_EQ(titleOf(frame), "a.note - Frame Test");

    write(file("b.note"), saved("two"));
    const int updates = view().updates;
    EXPECT_EQ(AfxGetApp()->OpenDocumentFile(file("b.note").c_str()), &document());
    EXPECT_EQ(document().text, "two");
    EXPECT_EQ(document().GetPathName(), driveName("b.note"));
    EXPECT_GT(view().updates, updates);
    EXPECT_EQ(AfxGetApp()->GetOpenDocumentCount(), 1);
}

TEST_F(Documents, ChangesReachTheOtherViews) {
    openNote();
    const int before = view().updates;
    document().UpdateAllViews(nullptr, 42);
    EXPECT_EQ(view().updates, before + 1);
    EXPECT_EQ(view().lastHint, 42);
    document().UpdateAllViews(&view(), 43);
    EXPECT_EQ(view().lastHint, 42) << "the sender knows";
    document().SendInitialUpdate();
    EXPECT_EQ(view().lastHint, 0);
    EXPECT_EQ(view().updates, before + 2);
}

TEST_F(Documents, CloseAsksAboutChanges) {
    NoteFrame& frame = openNote();
    document().text = "kept";
    ASSERT_TRUE(document().DoSave(file("c.note").c_str()));
    document().text = "changed";
    document().SetModifiedFlag();
    {
        BoxAnswer box("Cancel");
        frame.SendMessage(WM_CLOSE);
        ASSERT_EQ(box.texts, std::vector<std::string>{"Save changes to c.note?"});
        EXPECT_TRUE(frame.IsWindowVisible());
    }
    {
        BoxAnswer box("Yes");
        frame.SendMessage(WM_CLOSE);
        EXPECT_EQ(box.texts.size(), 1U) << "asked once";
    }
    EXPECT_EQ(AfxGetApp()->m_pMainWnd, nullptr);
    EXPECT_EQ(contents(file("c.note")), saved("changed"));
    EXPECT_TRUE(tvx::afx::isQuitting());
}

TEST_F(Documents, CloseWithoutSaving) {
    NoteFrame& frame = openNote();
    document().text = "lost";
    document().SetModifiedFlag();
    BoxAnswer box("No");
    frame.SendMessage(WM_SYSCOMMAND, SC_CLOSE);
    EXPECT_EQ(box.texts, std::vector<std::string>{"Save changes to Note?"});
    EXPECT_EQ(AfxGetApp()->m_pMainWnd, nullptr);
}

TEST_F(Documents, FailedSaveKeepsTheFile) {
    openNote();
    document().text = "good";
    ASSERT_TRUE(document().DoSave(file("d.note").c_str()));
    document().text = "bad";
    document().SetModifiedFlag();
    document().failsHalfWay = true;
    BoxAnswer box("OK");
    EXPECT_FALSE(document().DoFileSave());
    ASSERT_EQ(box.texts.size(), 1U);
    EXPECT_EQ(box.texts[0], "The disk is full while writing " + file("d.note").string() + ".")
        << "as the file dialogs name it";
    EXPECT_EQ(contents(file("d.note")), saved("good"));
    EXPECT_TRUE(document().IsModified());
    const auto entries = std::filesystem::directory_iterator(file(""));
    EXPECT_EQ(std::distance(begin(entries), end(entries)), 1) << "nothing is left beside it";
}

TEST_F(Documents, CannotBeSavedWhereThereIsNoFolder) {
    openNote();
    BoxAnswer box("OK");
    EXPECT_FALSE(document().DoSave(file("none/e.note").c_str()));
    EXPECT_EQ(box.texts.size(), 1U);
    EXPECT_EQ(document().GetPathName(), "");
}

TEST_F(Documents, FilesThatCannotBeOpened) {
    openNote();
    document().text = "mine";
    BoxAnswer box("OK");
    EXPECT_EQ(AfxGetApp()->OpenDocumentFile(file("missing.note").c_str()), nullptr);
    EXPECT_EQ(document().text, "mine") << "nothing is lost for a file that is not there";
    write(file("damaged.note"), "\x50short");
    EXPECT_EQ(AfxGetApp()->OpenDocumentFile(file("damaged.note").c_str()), nullptr);
    std::filesystem::create_directory(file("folder.note"));
    EXPECT_EQ(AfxGetApp()->OpenDocumentFile(file("folder.note").c_str()), nullptr);
    ASSERT_EQ(mkfifo(file("pipe.note").c_str(), 0600), 0);
    EXPECT_EQ(AfxGetApp()->OpenDocumentFile(file("pipe.note").c_str()), nullptr) << "nor is its other end waited for";
    EXPECT_FALSE(document().DoSave(file("pipe.note").c_str()));
    ASSERT_EQ(box.texts.size(), 5U);
    EXPECT_EQ(box.texts[0].find(file("missing.note").string() + "\nThis file cannot be found."), 0U);
    EXPECT_NE(box.texts[1].find("unexpected file format"), std::string::npos);
    EXPECT_EQ(box.texts[2], file("folder.note").string() + " is a folder, not a file.");
    EXPECT_EQ(box.texts[3], file("pipe.note").string() + " is a pipe, not a file.");
    EXPECT_EQ(box.texts[4], box.texts[3]);
    EXPECT_EQ(document().GetPathName(), "") << "an empty document under no name";
    EXPECT_FALSE(document().IsModified());
}

TEST_F(Documents, CommandsOfTheDocument) {
    NoteFrame& frame = openNote();
    ASSERT_TRUE(document().DoSave(file("f.note").c_str()));
    document().text = "by command";
    document().SetModifiedFlag();
    QMenu* menu = clickBar(frame, "File");
    ASSERT_NE(menu, nullptr);
    clickItem(*menu, "Save");
    EXPECT_EQ(contents(file("f.note")), saved("by command"));
}

TEST_F(Documents, StringsOfTheTemplate) {
    openNote();
    CDocTemplate* docTemplate = document().GetDocTemplate();
    CString text;
    EXPECT_TRUE(docTemplate->GetDocString(text, CDocTemplate::filterName));
    EXPECT_EQ(text, "Notes (*.note)");
    EXPECT_TRUE(docTemplate->GetDocString(text, CDocTemplate::filterExt));
    EXPECT_EQ(text, ".note");
    CDocument* match = nullptr;
    EXPECT_EQ(docTemplate->MatchDocType("/x/y.NOTE", match), CDocTemplate::yesAttemptNative);
    EXPECT_EQ(docTemplate->MatchDocType("/x/y.txt", match), CDocTemplate::yesAttemptForeign);
    ASSERT_TRUE(document().DoSave(file("g.note").c_str()));
    std::filesystem::create_symlink(file("g.note"), file("h.note"));
    EXPECT_EQ(docTemplate->MatchDocType(file("h.note").c_str(), match), CDocTemplate::yesAlreadyOpen);
    EXPECT_EQ(match, &document());
}

TEST_F(Documents, ShellCommands) {
    openNote();
    write(file("i.note"), saved("from the command line"));
    CCommandLineInfo info;
    info.m_nShellCommand = CCommandLineInfo::FileOpen;
    info.m_strFileName = file("i.note").c_str();
    EXPECT_TRUE(AfxGetApp()->ProcessShellCommand(info));
    EXPECT_EQ(document().text, "from the command line");
    info.m_nShellCommand = CCommandLineInfo::FileNew;
    EXPECT_TRUE(AfxGetApp()->ProcessShellCommand(info));
    EXPECT_EQ(document().text, "");
    info.m_nShellCommand = CCommandLineInfo::FilePrint;
    EXPECT_FALSE(AfxGetApp()->ProcessShellCommand(info));
}

TEST_F(Documents, DroppedFilesAreOpened) {
    NoteFrame& frame = openNote();
    write(file("dropped.note"), saved("from the desktop"));
    QMimeData data;
    data.setUrls({QUrl::fromLocalFile(QString::fromStdString(file("dropped.note").string()))});
    const auto drop = [&] {
        QDropEvent event(QPointF(50, 50), Qt::CopyAction, &data, Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(widgetOf(frame), &event);
        settle();
    };
    drop();
    EXPECT_EQ(document().text, "") << "frames that did not ask for files get none";
    frame.DragAcceptFiles(TRUE);
    drop();
    EXPECT_EQ(document().text, "from the desktop");
}

TEST_F(Documents, NewAsksForTheKindWhereThereAreSeveral) {
    BoardsFrame& frame = openBoards();
    AfxGetApp()->AddDocTemplate(
        new CMultiDocTemplate(IDR_TESTMAIN, RUNTIME_CLASS(Note), RUNTIME_CLASS(CMDIChildWnd), RUNTIME_CLASS(NoteView)));
    inDialog([] { key(Qt::Key_Escape); });
    AfxGetApp()->OnFileNew();
    EXPECT_EQ(frame.MDIGetActive(), nullptr);
    inDialog([] {
        key(Qt::Key_Down);
        key(Qt::Key_Return);
    });
    AfxGetApp()->OnFileNew();
    ASSERT_NE(frame.MDIGetActive(), nullptr);
    EXPECT_EQ(titleOf(*frame.MDIGetActive()), "Note1");
}
