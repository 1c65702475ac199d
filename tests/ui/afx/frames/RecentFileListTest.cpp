#include "platform/afx/frames/RecentFileList.h"

#include "tests/ui/afx/frames/FrameTesting.h"

using namespace frametest;

namespace {

constexpr const char* section = "Recent File List";

class RecentFiles : public FrameTest {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        testApp().WriteProfileString(section, nullptr, nullptr);
        testApp().LoadStdProfileSettings(3);
    }
    void TearDown() override {
        delete testApp().m_pRecentFileList;
        testApp().m_pRecentFileList = nullptr;
        FrameTest::TearDown();
    }
    static CWinApp& testApp() {
        return *AfxGetApp();
    }
    static CRecentFileList& list() {
        return *testApp().m_pRecentFileList;
    }
    /// A frame whose menu has the files between two commands.
    BoardsFrame& openWithMenu() {
        BoardsFrame& frame = openBoards();
        CMenu popup;
        popup.CreatePopupMenu();
        popup.AppendMenu(MF_STRING, ID_TEST_DRAW, "&Draw");
        popup.AppendMenu(MF_STRING, ID_FILE_MRU_FILE1, "No file yet");
        popup.AppendMenu(MF_SEPARATOR);
        popup.AppendMenu(MF_STRING, ID_TEST_GRID, "&Grid");
        frame.GetMenu()->AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(popup.Detach()), "&Recent");
        return frame;
    }
    CString make(const std::string& name) {
        write(file(name), "\x04text");
        return driveName(name);
    }
    static std::vector<CString> stored() {
        std::vector<CString> names;
        for (const char* entry : {"File1", "File2", "File3", "File4"}) {
            const CString name = testApp().GetProfileString(section, entry);
            if (!name.IsEmpty()) {
                names.push_back(name);
            }
        }
        return names;
    }
    /// The texts of the menu with the files; grey ones in brackets.
    static std::vector<std::string> menu(const CFrameWnd& frame) {
        QMenu* open = clickBar(frame, "Recent");
        std::vector<std::string> texts;
        const auto actions = open->actions();
        for (const QAction* action : actions) {
            const std::string text = action->text().toStdString();
            texts.push_back(action->isEnabled() ? text : "[" + text + "]");
        }
        key(Qt::Key_Escape);
        return texts;
    }
    static void choose(const CFrameWnd& frame, int number) {
        QMenu* open = clickBar(frame, "Recent");
        clickItem(*open, QString(open->actions().at(number)->text()).remove(QLatin1Char('&')));
    }
};

using Names = std::vector<CString>;

} // namespace

TEST_F(RecentFiles, StandInTheMenuInPlaceOfItsEntry) {
    BoardsFrame& frame = openWithMenu();
    EXPECT_EQ(menu(frame).at(1), "[No file yet]");
    for (const char* name : {"a.brd", "b & c.brd", "d.brd", "e.brd"}) {
        EXPECT_NE(testApp().OpenDocumentFile(make(name)), nullptr);
    }
    const std::string folder = driveName("").GetString();
    EXPECT_EQ(stored(), (Names{driveName("e.brd"), driveName("d.brd"), driveName("b & c.brd")}));
    testApp().CloseAllDocuments(FALSE);
    const auto texts = menu(frame);
    ASSERT_EQ(texts.size(), 6U);
    EXPECT_EQ(texts[1], "&1 " + folder + "e.brd");
    EXPECT_EQ(texts[3], "&3 " + folder + "b && c.brd");
    EXPECT_EQ(menu(frame), texts) << "once more";
    choose(frame, 3);
    EXPECT_EQ(titleOf(*frame.MDIGetActive()), "b & c.brd");
    EXPECT_EQ(stored().front(), driveName("b & c.brd"));
}

TEST_F(RecentFiles, OfTheCurrentFolderStandThereWithTheirNamesAlone) {
    BoardsFrame& frame = openWithMenu();
    list().Add(make("a.brd"));
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(file(""));
    EXPECT_EQ(menu(frame).at(1), "&1 a.brd");
    std::filesystem::current_path(before);
}

TEST_F(RecentFiles, AreListedOnce) {
    const CString plan = make("Plan.brd");
    std::filesystem::create_symlink("Plan.brd", file("link.brd"));
    const CString other = make("other.brd");
    for (const auto& [added, expected] : std::vector<std::pair<CString, Names>>{
             {plan, {plan}},
             {plan, {plan}},
             {other, {other, plan}},
             {driveName("PLAN.BRD"), {plan, other}},
             {file("Plan.brd").c_str(), {plan, other}},
             {driveName("link.brd"), {driveName("link.brd"), other}},
             {make("plan.brd"), {driveName("plan.brd"), driveName("link.brd"), other}},
             {plan, {plan, driveName("plan.brd"), driveName("link.brd")}}, // two files that differ in case alone
             {"", {plan, driveName("plan.brd"), driveName("link.brd")}},
         }) {
        testApp().AddToRecentFileList(added);
        EXPECT_EQ(stored(), expected) << added.GetString();
    }
}

TEST_F(RecentFiles, AreKeptWhatOtherProgramsAdd) {
    const CString mine = make("mine.brd");
    list().Add(mine);
    testApp().WriteProfileString(section, "File1", "C:\\theirs.brd");
    testApp().WriteProfileString(section, "File2", mine);
    const CString next = make("next.brd");
    list().Add(next);
    EXPECT_EQ(stored(), (Names{next, "C:\\theirs.brd", mine}));
    testApp().WriteProfileString(section, "File2", nullptr);
    testApp().ExitInstance();
    EXPECT_EQ(stored(), (Names{next, mine})) << "the end stores nothing that was not changed";
    EXPECT_STREQ(list()[0], next);
    list()[0] = "C:\\other.brd";
    testApp().ExitInstance();
    EXPECT_EQ(stored().front(), "C:\\other.brd");
}

TEST_F(RecentFiles, ThatAreGoneAreTakenOutWhenTheyCannotBeOpened) {
    BoardsFrame& frame = openWithMenu();
    for (const char* name : {"empty folder", "gone.brd"}) {
        list().Add(make(name));
    }
    std::filesystem::remove(file("gone.brd"));
    BoxAnswer box("OK");
    choose(frame, 1);
    ASSERT_EQ(box.texts.size(), 1U);
    EXPECT_NE(box.texts[0].find("cannot be found"), std::string::npos);
    EXPECT_EQ(stored(), Names{driveName("empty folder")});
    std::filesystem::remove(file("empty folder"));
    std::filesystem::create_directory(file("empty folder"));
    choose(frame, 1);
    EXPECT_EQ(box.texts.size(), 2U);
    EXPECT_EQ(stored().size(), 1U) << "something is there";
    list().Remove(0);
    EXPECT_EQ(menu(frame), (std::vector<std::string>{"[&Draw]", "[No file yet]", "", "[&Grid]"}));
}

TEST_F(RecentFiles, TakeDocumentsThatAreSavedUnderANewName) {
    openNote();
    document().DoSave(driveName("first.note"));
    document().DoSave(driveName("copy.note"), FALSE);
    EXPECT_EQ(stored(), Names{driveName("first.note")});
    document().SetPathName(driveName("quiet.note"), FALSE);
    EXPECT_EQ(stored().size(), 1U);
}
