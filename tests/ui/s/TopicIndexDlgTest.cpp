// Help requests as a user meets them: the choice among several topics, and what a request closes.
#include "s/TopicIndexDlg.h"

#include "s/BrowserHelp.h"
#include "s/Profile.h"
#include "tests/ui/afx/InDialog.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"
#include "tests/unit/SavedEnvironment.h"
#include "tests/unit/s/StoreTest.h"

#include <QAbstractScrollArea>

#include <fstream>
#include <optional>

namespace {

namespace fs = std::filesystem;
using Strings = Gui_TopicIndexDlg::Strings;

/// The place of what the user chose, nothing when the dialog was cancelled.
std::optional<int> choose(const Strings& files, const Strings& titles, std::function<void()> act) {
    inDialog(std::move(act));
    Gui_TopicIndexDlg dialog(files, titles, nullptr);
    return dialog.DoModal() == IDOK ? std::optional(dialog.GetSelectedIndex()) : std::nullopt;
}

TEST(TopicIndexDlg, OffersSortedTitlesAndTellsThePlaceOfTheirFile) {
    const Strings files{"z.htm", "a.htm", "m.htm"};
    const Strings titles{"Zoom", "Axes", "Meshes", "A title without a file"};
    EXPECT_EQ(choose(files, titles, [] { key(Qt::Key_Return); }), 1) << "the first line, \"Axes\"";
    EXPECT_EQ(choose(files, titles,
                     [] {
                         key(Qt::Key_Down);
                         key(Qt::Key_Down);
                         key(Qt::Key_Down);
                         key(Qt::Key_Return);
                     }),
              0)
        << "the last line, \"Zoom\"";
    EXPECT_EQ(choose(files, titles,
                     [] {
                         // The widget inside of the list's frame shows the lines.
                         QWidget* lines = qobject_cast<QAbstractScrollArea*>(QApplication::focusWidget())->viewport();
                         const QPoint second(20, lines->fontMetrics().height() * 3 / 2);
                         QTest::mouseClick(lines, Qt::LeftButton, Qt::NoModifier, second);
                         QTest::mouseDClick(lines, Qt::LeftButton, Qt::NoModifier, second);
                     }),
              2)
        << "a double click on the second line";
    EXPECT_EQ(choose(files, titles, [] { key(Qt::Key_Escape); }), std::nullopt);
    EXPECT_EQ(choose(files, {}, [] { key(Qt::Key_Return); }), 0) << "nothing to choose from";
}

/// An installation whose help has two pages for one keyword.
class HelpForUser : public StoreTest {
protected:
    void SetUp() override {
        StoreTest::SetUp();
        setenv("TARVEX", m_folder.c_str(), 1);
        setenv("TVX_GUI_HELP_WEB_LOCATION", "https://web/", 1);
        fs::create_directories(m_folder / "share/helpmap");
        std::ofstream(m_folder / "share/helpmap/test.map")
            << "[index Paste]\nfile = b.htm\ntitle = Pasting texts\nfile = a.htm\ntitle = Pasting shapes\n";
        const fs::path browser = m_folder / "browser";
        std::ofstream(browser) << "#!/bin/sh\necho \"$1\" >" << record().string() << ".new\nmv " << record().string()
                               << ".new " << record().string() << "\n";
        fs::permissions(browser, fs::perms::owner_all);
        Gui_Profile::WriteWebBrowserName(browser.c_str());
        ASSERT_EQ(m_help.SetHelpMapFileName("test.map"), 1);
    }
    [[nodiscard]] fs::path record() const {
        return m_folder / "record";
    }
    int help(const char* keyword) {
        return m_help.BrowserHelp(reinterpret_cast<unsigned long>(keyword), HELP_KEY);
    }
    const SavedEnvironment m_environment;
    Gui_BrowserHelp m_help;
};

TEST_F(HelpForUser, SeveralTopicsAreOfferedAndTheChosenOneOpens) {
    inDialog([] {
        EXPECT_EQ(QApplication::activeModalWidget()->windowTitle(), "Topics Found");
        key(Qt::Key_Down);
        key(Qt::Key_Return);
    });
    EXPECT_EQ(help("Paste"), 1);
    ASSERT_TRUE(QTest::qWaitFor([&] { return fs::exists(record()); }));
    std::string address;
    std::getline(std::ifstream(record()), address);
    EXPECT_EQ(address, "https://web/b.htm") << "\"Pasting texts\" is the second title by its letters";
    fs::remove(record());
    inDialog([] { key(Qt::Key_Escape); });
    EXPECT_EQ(help("Paste"), 1) << "the user wants none";
    EXPECT_FALSE(fs::exists(record()));
}

TEST_F(HelpForUser, ARequestClosesMenusAndEndsHelpModeAndCapture) {
    auto* frame = new CFrameWnd;
    ASSERT_TRUE(frame->Create(nullptr, "Frame"));
    auto* inner = new CFrameWnd;
    ASSERT_TRUE(inner->Create(nullptr, "", WS_CHILD | WS_VISIBLE, CRect(0, 0, 50, 50), frame));
    frame->ShowWindow(SW_SHOW);
    CMenu menu;
    menu.CreatePopupMenu();
    menu.AppendMenu(MF_STRING, 100, "Item");
    for (CFrameWnd* const main : {frame, inner}) {
        testApplication.m_pMainWnd = main;
        frame->SendMessage(WM_COMMAND, ID_CONTEXT_HELP);
        EXPECT_TRUE(frame->m_bHelpMode);
        inner->SetCapture();
        BoxAnswer answer;
        QTimer::singleShot(0, [&] {
            ASSERT_NE(QApplication::activePopupWidget(), nullptr);
            EXPECT_EQ(m_help.OnCommand(1), 1);
            EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
        });
        menu.TrackPopupMenu(TPM_LEFTALIGN, 20, 20, frame);
        EXPECT_EQ(answer.text, "Help not found for topic Help Context ID:  0x10001");
        EXPECT_EQ(::GetCapture(), nullptr);
        EXPECT_FALSE(frame->m_bHelpMode) << "also when the main window stands in another frame";
        EXPECT_FALSE(testApplication.m_bHelpMode);
    }
    testApplication.m_pMainWnd = nullptr;
    frame->SetCapture();
    const BoxAnswer answer;
    EXPECT_EQ(m_help.OnCommand(1), 1);
    EXPECT_EQ(::GetCapture(), nullptr) << "without a main window too";
    frame->DestroyWindow();
}

} // namespace
