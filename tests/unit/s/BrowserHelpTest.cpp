// Help requests from the application's entry to the program that shows the page.
#include "s/BrowserHelp.h"

#include "RecordedProgramsTest.h"
#include "res/resource.h"
#include "s/Help.h"
#include "s/PDFProfile.h"
#include "s/Profile.h"

#include <utility>
#include <vector>

namespace {

namespace fs = std::filesystem;

/// An installation with a map of the package "test", and a browser that writes down what it gets.
class BrowserHelpTest : public RecordedProgramsTest {
protected:
    void SetUp() override {
        RecordedProgramsTest::SetUp();
        unsetenv("MYTARVEX");
        setenv("TARVEX", root().c_str(), 1);
        setenv("LC_ALL", "C", 1);
        setenv("TVX_GUI_HELP_WEB_LOCATION", "https://web/", 1);
        Gui_Profile::WriteWebBrowserName("browser");
        Gui_PDFProfile::WritePDFViewerName("system -view \"%1\"");
        for (const char* name : {"a.htm", "b.htm", "c.htm", "contents.htm", "manual.pdf", "two words.htm",
                                 "50%\xc3\xa4\"1.htm", "two words.pdf"}) {
            make(fs::path("doc/usenglish") / name, "");
        }
        make("share/helpmap/test.map", "[topic 1001]\nfile = a.htm\nfile = b.htm\nfile = c.htm\n"
                                       "[topic 65636]\nfile = b.htm#part\n"
                                       "[topic 151074]\nfile = two words.htm#x y\n"
                                       "[topic 196648]\nfile = 50%\xc3\xa4\"1.htm\n"
                                       "[topic 327681]\nfile = missing.htm\n"
                                       "[topic contents]\nfile = contents.htm\n"
                                       "[topic 2]\ntype = Acrobat\nfile = manual.pdf#page=12\n"
                                       "[topic 3]\ntype = acrobat\nfile = two words.pdf\n"
                                       "[topic 4]\ntype = url\nfile = https://x/y?z\n"
                                       "[topic 5]\ntype = acrobat\nfile = missing.pdf\n"
                                       "[index Paste]\nfile = a.htm\n"
                                       "[dialog 12]\nfile = c.htm\n");
    }
    void make(const fs::path& name, const std::string& text) const {
        fs::create_directories((root() / name).parent_path());
        std::ofstream(root() / name) << text;
    }
    [[nodiscard]] fs::path root() const {
        return m_folder / "in#1";
    }
    /// The started program, with "@" for the folder of documents.
    [[nodiscard]] std::string opened() const {
        std::string text = started();
        const bool isAddress = text.find("file://") != std::string::npos;
        const std::string documents = (m_folder / (isAddress ? "in%231" : "in#1") / "doc/usenglish/").string();
        const std::size_t at = text.find(documents);
        text = at == std::string::npos ? text : text.replace(at, documents.size(), "@");
        return text;
    }
    Gui_BrowserHelp m_help;
};

TEST_F(BrowserHelpTest, OpensTheDocumentOfEachKindOfRequest) {
    ASSERT_EQ(m_help.SetHelpMapFileName("test.map"), 1);
    const auto keyword = reinterpret_cast<unsigned long>("Paste");
    const struct {
        unsigned long data;
        unsigned int command;
        const char* opened; ///< "@" stands for the folder of documents
    } cases[] = {
        {1001, HELP_CONTEXT, "browser|file://@a.htm"},
        {0, HELP_CONTEXT, "browser|file://@contents.htm"},
        {0x20080, HELP_CONTEXT, "browser|file://@contents.htm"},
        {7, HELP_CONTENTS, "browser|file://@contents.htm"},
        {7, HELP_FINDER, "browser|file://@contents.htm"},
        {keyword, HELP_KEY, "browser|file://@a.htm"},
        {2, HELP_CONTEXT, "system|-view|@manual.pdf#page=12"},
        {3, HELP_CONTEXT, "system|-view|@two words.pdf"},
        {4, HELP_CONTEXT, "browser|https://x/y?z"},
        {5, HELP_CONTEXT, "browser|https://web/missing.pdf"},
    };
    for (const auto& [data, command, expected] : cases) {
        EXPECT_EQ(m_help.BrowserHelp(data, command), 1);
        EXPECT_EQ(opened(), expected) << data << ", " << command;
    }
    EXPECT_EQ(m_help.OnCommand(100), 1);
    EXPECT_EQ(opened(), "browser|file://@b.htm#part");
    EXPECT_EQ(m_help.OnDialog(20002), 1);
    EXPECT_EQ(opened(), "browser|file://@two%20words.htm#x%20y");
    EXPECT_EQ(m_help.OnPrompt(40), 1);
    EXPECT_EQ(opened(), "browser|file://@50%25%C3%A4%221.htm");
    EXPECT_EQ(m_help.OnFrameControl(-1U), 1);
    EXPECT_EQ(boxes(), "[Help not found for topic Help Context ID:  0x4ffff]");
    EXPECT_EQ(m_help.OnFrameControl(1), 1);
    EXPECT_EQ(opened(), "browser|https://web/missing.htm");
    EXPECT_EQ(m_help.OnContents(), 1);
    EXPECT_EQ(opened(), "browser|file://@contents.htm");
    EXPECT_EQ(m_help.HelpForMapRecordKey("dialog  12"), 1);
    EXPECT_EQ(opened(), "browser|file://@c.htm");
    setenv("TARVEX", ("C:" + root().string()).c_str(), 1);
    EXPECT_EQ(m_help.BrowserHelp(1001, HELP_CONTEXT), 1);
    EXPECT_EQ(opened(), "browser|file://@a.htm") << "the drive is left out on the way to the program";
    m_help.DisplayFailureOnHelp();
    EXPECT_EQ(boxes(), "");
}

TEST_F(BrowserHelpTest, AViewerWithoutAPlaceForTheNameGetsNamesWithBlanksInQuotes) {
    Gui_PDFProfile::WritePDFViewerName("system");
    ASSERT_EQ(m_help.SetHelpMapFileName("test"), 1);
    EXPECT_EQ(m_help.BrowserHelp(3, HELP_CONTEXT), 1);
    EXPECT_EQ(opened(), "system|@two words.pdf");
}

TEST_F(BrowserHelpTest, TellsOnceWhatIsMissing) {
    EXPECT_EQ(m_help.OnCommand(1), 0);
    EXPECT_EQ(boxes(), "[Internal error: Help Package name was not set.]");
    const std::string missing = " : Help file for this package was not installed or does not have read "
                                "permission.\nContext sensitive help would be unavailable.\nPlease check if help "
                                "files are installed.]";
    EXPECT_EQ(m_help.SetHelpMapFileName("nobody.map"), 0);
    EXPECT_EQ(boxes(), "[nobody.map" + missing);
    EXPECT_EQ(m_help.OnCommand(1), 0);
    EXPECT_EQ(boxes(), "") << "told already";
    ASSERT_EQ(m_help.SetHelpMapFileName("test.map"), 1);
    fs::rename(root() / "share", root() / "elsewhere");
    EXPECT_EQ(m_help.OnCommand(1), 0);
    EXPECT_EQ(boxes(), "[" + (root() / "share/helpmap/test.map").string() + missing);
    EXPECT_EQ(m_help.SetHelpMapFileName("test.map"), 1) << "chosen, so it is not looked for again";
    fs::rename(root() / "elsewhere", root() / "share");
    Gui_PDFProfile::WritePDFViewerName("no-viewer");
    EXPECT_EQ(m_help.BrowserHelp(2, HELP_CONTEXT), 1);
    EXPECT_EQ(boxes(), "[Could not find the PDF viewer]");
    Gui_Profile::WriteWebBrowserName("no-browser %1");
    EXPECT_EQ(m_help.BrowserHelp(1001, HELP_CONTEXT), 0);
    EXPECT_EQ(theApp.boxes.size(), 1U) << boxes();
    theApp.boxes.clear();
    const auto keyword = reinterpret_cast<unsigned long>("Cut");
    const struct {
        unsigned long data;
        unsigned int command;
        const char* box;
    } cases[] = {
        {1002, HELP_CONTEXT, "[Help not found for topic Help Context ID:  0x3ea]"},
        {keyword, HELP_KEY, "[Help not found for topic index  Cut]"},
        {0, HELP_KEY, "[Help not found for topic index  none]"},
        {0, 258, "[Help not found for topic unknown 258]"},
    };
    for (const auto& [data, command, box] : cases) {
        EXPECT_EQ(m_help.BrowserHelp(data, command), 1);
        EXPECT_EQ(boxes(), box);
    }
    EXPECT_EQ(m_help.HelpForMapRecordKey("dialog 13"), 1);
    EXPECT_EQ(boxes(), "[Help not found for topic dialog 13  ]");
    EXPECT_EQ(opened(), "");
    make("share/helpmap/empty.map", "");
    Gui_BrowserHelp empty;
    ASSERT_EQ(empty.SetHelpMapFileName("empty"), 1);
    EXPECT_EQ(empty.OnContents(), 1);
    EXPECT_EQ(boxes(), "[Help not found for topic Contents  ]");
}

TEST_F(BrowserHelpTest, ASecondPackageAddsItsRecords) {
    make("share/helpmap/more.map", "[topic 1001]\nfile = c.htm\n[topic 9]\nfile = b.htm\n");
    ASSERT_EQ(m_help.SetHelpMapFileName("test.map"), 1);
    EXPECT_EQ(m_help.BrowserHelp(1001, HELP_CONTEXT), 1);
    EXPECT_EQ(opened(), "browser|file://@a.htm");
    ASSERT_EQ(m_help.SetHelpMapFileName("more.map"), 1);
    EXPECT_EQ(m_help.BrowserHelp(9, HELP_CONTEXT), 1);
    EXPECT_EQ(opened(), "browser|file://@b.htm");
    EXPECT_EQ(m_help.BrowserHelp(1001, HELP_CONTEXT), 1);
    EXPECT_EQ(opened(), "browser|file://@a.htm") << "the first record of a key counts";
}

TEST_F(BrowserHelpTest, ShowsRequestsToThoseWhoWriteHelp) {
    setenv("TVX_GUI_HELP_DEBUG", "", 1);
    Gui_BrowserHelp help;
    unsetenv("TVX_GUI_HELP_DEBUG");
    ASSERT_EQ(help.SetHelpMapFileName("test.map"), 1);
    const std::string map = (root() / "share/helpmap/test.map").string() + "]";
    const auto keyword = reinterpret_cast<unsigned long>("Paste");
    const std::pair<std::pair<unsigned long, unsigned int>, std::string> cases[] = {
        {{1001, HELP_CONTEXT},
         "[HELP_CONTEXT nCmd: 1 Help Id requested : 1001\nCheck .hm file for 0x3e9 Map File: " + map},
        {{5, HELP_CONTENTS}, "[HELP_CONTENTS nCmd: 3 dwData: 5 Map File: " + map},
        {{0, HELP_FINDER}, "[HELP_FINDER nCmd: 11 dwData: 0 Map File: " + map},
        {{keyword, HELP_KEY}, "[HELP_KEY nCmd: 257 dwData LPCTSTR value : Paste Map File: " + map},
        {{0, HELP_KEY}, "[HELP_KEY nCmd: 257 dwData LPCTSTR value : NULL Map File: " + map},
        {{6, 258}, "[Unsupported nCmd: 258 dwData value : 6 Map File: " + map},
    };
    for (const auto& [request, trace] : cases) {
        EXPECT_EQ(help.BrowserHelp(request.first, request.second), 1);
        EXPECT_EQ(boxes().substr(0, trace.size()), trace) << "the first box";
    }
    help.HelpForMapRecordKey("dialog 12");
    EXPECT_EQ(boxes(), "[Lookup .map file for key: dialog 12]");
}

TEST_F(BrowserHelpTest, ABrowserInASandboxGetsThePageOnTheWeb) {
    install("PATH/flatpak");
    // What is told once for each browser and process is to be told when the test is repeated, too.
    static int repetition = 0;
    const std::string browser = "run org.example.Browser" + std::to_string(++repetition);
    Gui_Profile::WriteWebBrowserName(("flatpak " + browser).c_str());
    const std::string expected = "flatpak|run|" + browser.substr(4) + "|";
    ASSERT_EQ(m_help.SetHelpMapFileName("test.map"), 1);
    EXPECT_EQ(m_help.OnCommand(100), 1);
    EXPECT_EQ(opened(), expected + "https://web/b.htm#part");
    EXPECT_EQ(theApp.boxes.size(), 1U) << "and the user is told why";
    EXPECT_EQ(m_help.OnCommand(100), 1);
    EXPECT_EQ(theApp.boxes.size(), 1U) << "once";
    EXPECT_EQ(opened(), expected + "https://web/b.htm#part");
    EXPECT_EQ(m_help.BrowserHelp(4, HELP_CONTEXT), 1);
    EXPECT_EQ(opened(), expected + "https://x/y?z");
}

// --- the application's entry and the Help menu ---

class ApplicationHelp : public BrowserHelpTest {
protected:
    void TearDown() override {
        Gui_Help::SetHelpFileName("none.hlp");
        BrowserHelpTest::TearDown();
    }
};

TEST_F(ApplicationHelp, TheHelpFileIsTheMapElseAnInstalledHelpFileElseTheMapsName) {
    make("share/help/old.hlp", "");
    const std::tuple<const char*, int, std::string> cases[] = {
        {"test.hlp", 1, "test.map"}, {"test.map", 1, "test.map"},
        {"test", 1, "test"},         {"old.hlp", 1, (root() / "share/help/old.hlp").string()},
        {"none.hlp", 0, "none.map"},
    };
    for (const auto& [name, result, path] : cases) {
        EXPECT_EQ(Gui_Help::SetHelpFileName(name), result) << name;
        EXPECT_EQ(theApp.m_pszHelpFilePath, path) << name;
    }
    EXPECT_EQ(Gui_Help::SetHelpFileName(nullptr), 0);
}

TEST_F(ApplicationHelp, RequestsReachTheMapByTheApplicationsEntry) {
    Gui_Help::SetHelpFileName("test.hlp");
    const struct {
        void (*ask)(unsigned int);
        unsigned int id;
        const char* opened;
    } entries[] = {
        {&Gui_Help::OnCommand, 100, "browser|file://@b.htm#part"},
        {&Gui_Help::OnDialog, 20002, "browser|file://@two%20words.htm#x%20y"},
        {&Gui_Help::OnPrompt, 40, "browser|file://@50%25%C3%A4%221.htm"},
        {&Gui_Help::OnFrameControl, 1, "browser|https://web/missing.htm"},
        {&Gui_Help::OnContents, 99, "browser|file://@contents.htm"},
    };
    for (const auto& [ask, id, expected] : entries) {
        ask(id);
        EXPECT_EQ(opened(), expected);
    }
    theApp.WinHelpInternal(1001);
    EXPECT_EQ(opened(), "browser|file://@a.htm");
    free(const_cast<char*>(std::exchange(theApp.m_pszHelpFilePath, strdup("x/capital.MAP"))));
    theApp.WinHelp(1001);
    EXPECT_NE(boxes().find("x/capital.MAP : Help file for this package was not installed"), std::string::npos)
        << "the dispatcher is asked, whatever the letters of the extension";
}

TEST_F(ApplicationHelp, AnotherHelpFileHasNoViewer) {
    Gui_Help::SetHelpFileName("test.hlp");
    free(const_cast<char*>(std::exchange(theApp.m_pszHelpFilePath, strdup("test.hlp"))));
    theApp.WinHelp(0x20080);
    theApp.WinHelp(0, HELP_QUIT);
    ASSERT_EQ(theApp.boxes.size(), 1U);
    EXPECT_EQ(theApp.boxes[0].text, "Help could not be started.");
    theApp.boxes.clear();
}

TEST_F(ApplicationHelp, TheHelpMenuOpensManualsAndSupportPage) {
    const auto choose = [](UINT id) { return theApp.OnCmdMsg(id, CN_COMMAND, nullptr, nullptr); };
    EXPECT_TRUE(choose(GUI_ID_HELP_MANUALS));
    EXPECT_EQ(boxes(), "[Help not found for topic manuals  ]");
    make("doc/usenglish/manuals.pdf", "");
    EXPECT_TRUE(choose(GUI_ID_HELP_MANUALS));
    EXPECT_EQ(opened(), "system|-view|@manuals.pdf");
    Gui_PDFProfile::WritePDFViewerName("no-viewer");
    EXPECT_TRUE(choose(GUI_ID_HELP_MANUALS));
    EXPECT_EQ(boxes(), "[Could not find the PDF viewer]");
    const std::pair<const char*, const char*> languages[] = {{"ja_JP", "jp"}, {"ko_KR", "kr"}, {"zh_TW", "tw"},
                                                             {"zh_CN", "cn"}, {"zh_HK", "en"}, {"de_DE", "en"}};
    for (const auto& [locale, code] : languages) {
        setenv("LC_ALL", (std::string(locale) + ".UTF-8").c_str(), 1);
        EXPECT_TRUE(choose(GUI_ID_HELP_SUPPORT));
        const std::string page = started();
        EXPECT_EQ(page.substr(0, 16), "browser|https://") << page;
        EXPECT_EQ(page.substr(page.find("/cgi-bin")),
                  std::string("/cgi-bin/SW_Docs_Redirect/sw_docs_redirect?locale=") + code + "&topic=support");
    }
    EXPECT_EQ(boxes(), "");
}

} // namespace
