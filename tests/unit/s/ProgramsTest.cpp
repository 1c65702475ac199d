// Browsers, viewers, editors and tutorials: stand-ins write down how they were started.
#include "RecordedProgramsTest.h"
#include "platform/port/Version.h"
#include "platform/win/Error.h"
#include "s/BrowserChain.h"
#include "s/PDFProcess.h"
#include "s/PDFProfile.h"
#include "s/Profile.h"
#include "s/Tutorial.h"
#include "s/Version.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;

constexpr const char* page = "file:///opt/tarvex/doc/a%20b.html#%1";

class ProgramsTest : public RecordedProgramsTest {
protected:
    void TearDown() override {
        Port::Version::setReader(&Gui_InstallInfo::GetValue);
        RecordedProgramsTest::TearDown();
    }
    /// With "@" for the page.
    static std::string shown(std::string words) {
        for (std::size_t at = words.find(page); at != std::string::npos; at = words.find(page)) {
            words.replace(at, std::string(page).size(), "@");
        }
        return words;
    }
    static int browse(const char* directory = nullptr) {
        return Gui_Process().RunWebBrowser(page, directory, 1, 5000);
    }
};

using WebBrowser = ProgramsTest;

TEST_F(WebBrowser, GetsTheAddressWhereItsCommandLineSays) {
    const std::string quoted = "\"" + (m_folder / "my dir/browser").string() + "\"";
    const struct {
        std::string commandLine;
        std::string started; ///< "@" stands for the address
    } cases[] = {
        {"browser", "browser|@"},
        {"browser -x", "browser|-x|@"},
        {"browser --new \"%1\" -x", "browser|--new|@|-x"},
        {"browser %1 %1 %2", "browser|@|@|???"},
        {"browser --zoom=50%", "browser|--zoom=50%|@"},
        {"browser --zoom=50% %1", "browser|--zoom=50???@"},
        {"browser -remote openURL(%1,new-window)", "browser|@"},
        {"browser  -remote openURL(%1,new-tab) ", "browser|@"},
        {quoted + " -remote openURL(%1)", "browser|@"},
        {"browser -remote openURL(%1) -x", "browser|-remote|openURL(@)|-x"},
        {"browser -remote openurl(%1)", "browser|-remote|openurl(@)"},
        {"browser -Remote openURL(%1)", "browser|-Remote|openURL(@)"},
    };
    for (const auto& [commandLine, expected] : cases) {
        Gui_Profile::WriteWebBrowserName(commandLine.c_str());
        EXPECT_EQ(browse(), 1);
        EXPECT_EQ(shown(started()), expected) << commandLine;
    }
    EXPECT_EQ(boxes(), "");
}

TEST_F(WebBrowser, RunsOnInTheFolderAskedForAndIsNotHeld) {
    Gui_Profile::WriteWebBrowserName("browser");
    Gui_Process busy;
    ASSERT_EQ(busy.Run("/bin/sleep 1000", nullptr, 0, 0), 1);
    EXPECT_EQ(busy.RunWebBrowser("a", "/usr", 0, 0), 1) << "the object has no part in it";
    EXPECT_EQ(busy.IsActive(), 1);
    EXPECT_EQ(started(), "browser|a|/usr\n");
    busy.Release();
    awaitReleased();
    EXPECT_FALSE(hasChildren());
}

TEST_F(WebBrowser, GivesWayToTheNextUntilOneStarts) {
    const std::string userFailed = "none1 " + std::string(page) +
                                   ": failed.\nPlease set environment variable TVX_GUI_HELP_BROWSER_PATH and run the "
                                   "program again. Trying system default browser.\n";
    const std::string systemFailed =
        "none2 " + std::string(page) + " : System default browser failed. Trying Internet Explorer.\n";
    const std::string noSystem = "System default browser not set. Trying Internet Explorer.\n";
    const std::string advice = "\nPlease install Internet Explorer or Netscape as system default browser.";
    const std::string lastFailed = "none3 " + std::string(page) + ": failed." + advice;
    const std::string noLast = "Cannot find Internet Explorer program." + advice;
    const struct {
        const char* user;
        const char* system;
        const char* last;
        std::string started;
        std::string story;
    } cases[] = {
        {"", "", "", "", noSystem + noLast},
        {"none1", "", "", "", userFailed + noSystem + noLast},
        {"", "none2", "", "", systemFailed + noLast},
        {"none1", "none2", "none3 %1", "", userFailed + systemFailed + lastFailed},
        {"none1", " ", " ", "", userFailed + noSystem + noLast},
        {" ", "", "", "", " " + userFailed.substr(5) + noSystem + noLast},
        {"none1", " system %1 ", "last", "system", ""},
        {"none1", "none2", " last\t", "last", ""},
        {"", "", "last", "last", ""},
        {"browser", "system", "last", "browser", ""},
    };
    for (const auto& [user, system, last, program, story] : cases) {
        Gui_Profile::WriteWebBrowserName(user);
        associate(".htm", system);
        storeForMachine(lastBrowser, last);
        EXPECT_EQ(browse(), story.empty());
        EXPECT_EQ(started(), program.empty() ? "" : program + "|" + page);
        EXPECT_EQ(boxes(), story.empty() ? "" : "[" + story + "]");
    }
    Gui_Profile::WriteWebBrowserName("browser");
    EXPECT_EQ(browse("/no/such/folder"), 0);
    EXPECT_NE(boxes().find("browser " + std::string(page) + ": failed."), std::string::npos);
    EXPECT_FALSE(hasChildren());
}

TEST_F(WebBrowser, IsPassedOverWhereItCannotReadThePage) {
    install("snap/bin/fox");
    const std::string fox = (m_folder / "snap/bin/fox").string();
    const std::string why = " runs in a sandbox (snap) and cannot read " + std::string(page) + ".";
    const std::string detour = why + "\nThe page was opened in another way.";
    const std::string noLast =
        "Cannot find Internet Explorer program.\nPlease install Internet Explorer or Netscape as "
        "system default browser.\n";
    const struct {
        std::string user;
        std::string system;
        const char* last;
        const char* web;
        const char* started; ///< "@" stands for the page
        std::string told;
    } cases[] = {
        {fox, "system", "", "http://web", "system|@", "[" + fox + detour + "]"},
        {fox, "system", "", "http://web", "system|@", ""}, // said once
        {fox + " %1", fox, "last", "", "last|@", "[" + fox + " %1" + detour + "]"},
        {"", fox, "", "http://web", "fox|http://web", ""},
        {fox + " -x", fox, "", "http://web", "fox|-x|http://web", "[" + fox + " -x" + detour + "]"},
        {"", fox, "", "", "", "[" + noLast + fox + why + "]"},
        {"", fox + "\t", "none", "", "",
         "[none " + std::string(page) + ": failed." + noLast.substr(38) + fox + why + "]"},
    };
    for (const auto& [user, system, last, web, expected, told] : cases) {
        Gui_Profile::WriteWebBrowserName(user.c_str());
        associate(".htm", system);
        storeForMachine(lastBrowser, last);
        EXPECT_EQ(RunBrowserChain({.url = page, .webUrl = web}), *expected != '\0');
        EXPECT_EQ(shown(started()), expected) << user;
        EXPECT_EQ(boxes(), told) << user;
    }
    EXPECT_EQ(Gui_Process().RunWebBrowser("http://web", nullptr, 0, 0), 1);
    EXPECT_EQ(started(), "fox|http://web");
    EXPECT_EQ(boxes(), "");
}

TEST_F(WebBrowser, SaysWhatFailedWhenTheWebDoesNotHelp) {
    install("snap/bin/fox");
    const std::string fox = (m_folder / "snap/bin/fox").string();
    std::ofstream(fox) << "#!/none\n"; // can be found, but not started
    associate(".htm", fox);
    EXPECT_EQ(RunBrowserChain({.url = page, .webUrl = "http://web"}), 0);
    EXPECT_EQ(boxes(),
              "[Cannot find Internet Explorer program.\nPlease install Internet Explorer or Netscape as system "
              "default browser.\n" +
                  fox + " http://web : System default browser failed. Trying Internet Explorer.\n" + fox +
                  " runs in a sandbox (snap) and cannot read " + page + ".]");
}

using TextEditor = ProgramsTest;

TEST_F(TextEditor, GetsTheFileBehindItsCommandLineAndIsHeld) {
    Gui_Profile::WriteTextEditorName("browser \"%1\"");
    Gui_Process editor;
    EXPECT_EQ(editor.RunTextEditor("\"a b.txt\"", "/usr", 1, 5000), 1);
    EXPECT_EQ(editor.Wait(0xFFFFFFFF), 0u);
    EXPECT_EQ(started(), "browser|%1|a b.txt|/usr\n");
    EXPECT_EQ(editor.RunTextEditor("b.txt", nullptr, 0, 0), 0) << "it holds one already";
    EXPECT_EQ(editor.GetError(), 0u);
    editor.Release();
    Gui_Profile::WriteTextEditorName("none");
    EXPECT_EQ(editor.RunTextEditor("b.txt", nullptr, 0, 0), 0);
    EXPECT_EQ(editor.GetError(), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(boxes(), "");
}

TEST_F(TextEditor, IsEndedWithItsObjectWhenItWasStartedToBe) {
    Gui_Profile::WriteTextEditorName("browser");
    unsigned long child = 0;
    {
        Gui_Process busy;
        ASSERT_EQ(busy.Run("/bin/sleep 1000", nullptr, 0, 0), 1);
        child = busy.GetProcessId();
        EXPECT_EQ(busy.RunTextEditor("b.txt", nullptr, 0, 0), 0);
    }
    awaitReleased();
    EXPECT_EQ(Gui_Process::IsActive(child), 0) << "a call that starts nothing leaves the release policy";
}

class PDFViewer : public ProgramsTest {
protected:
    void SetUp() override {
        ProgramsTest::SetUp();
        nameInstalled("");
    }
    static void nameInstalled(const char* command) {
        installed = command;
        Port::Version::setReader([](const char* key) { return key == std::string("pdfViewer") ? installed : nullptr; });
    }
    static std::string viewer() {
        CString name = "unchanged";
        EXPECT_EQ(Gui_PDFProfile::ReadPDFViewerName(name), 1);
        return name.GetString();
    }

private:
    inline static const char* installed = "";
};

TEST_F(PDFViewer, IsTheUsersTheInstalledTheAssociatedOrTheLast) {
    EXPECT_EQ(viewer(), "AcroRd32.exe");
    setenv("PATH", (m_folder / "none" / ":").c_str(), 1);
    install("more/Acrobat.exe");
    EXPECT_EQ(viewer(), "AcroRd32.exe");
    for (const std::string separator : {":", ";"}) {
        const std::string quoted = "\"/a" + separator + (m_folder / "more").string() + "\"";
        setenv("PATH", (quoted + separator + "/none").c_str(), 1);
        EXPECT_EQ(viewer(), "AcroRd32.exe") << "a quoted stretch is one folder";
        setenv("PATH", (quoted + separator + (m_folder / "more").string()).c_str(), 1);
        EXPECT_EQ(viewer(), "Acrobat.exe") << separator;
    }
    unsetenv("PATH");
    EXPECT_EQ(viewer(), "AcroRd32.exe");
    associate(".pdf", " associated ");
    EXPECT_EQ(viewer(), " associated ") << "as it is registered";
    nameInstalled(" installed ");
    EXPECT_EQ(viewer(), "installed");
    Gui_PDFProfile::WritePDFViewerName("");
    EXPECT_EQ(stored(family, "PDFViewer"), "");
    EXPECT_EQ(viewer(), "installed");
    Gui_PDFProfile::WritePDFViewerName(" mine ");
    EXPECT_EQ(viewer(), " mine ");
    CString name;
    Gui_PDFProfile::GetDefaultPDFViewerName(name);
    EXPECT_EQ(name, "installed");
}

TEST_F(PDFViewer, GetsTheDocumentWithItsAnchorAndIsLeftRunning) {
    Gui_PDFProfile::WritePDFViewerName("\t browser -p \"%1\" ");
    for (const int wait : {0, 1}) {
        Gui_PDFProcess process;
        EXPECT_EQ(process.RunPDFReader("/a b.pdf#page=2", "/usr", wait, 5000), 1);
        EXPECT_EQ(process.RunPDFReader("/c.pdf", nullptr, wait, 5000), 0) << "it holds one already";
        process.Release();
        EXPECT_EQ(started(), "browser|-p|/a b.pdf#page=2|/usr\n");
    }
    Gui_PDFProfile::WritePDFViewerName("browser");
    EXPECT_EQ(Gui_PDFProcess().RunPDFReader("/a b.pdf", nullptr, 0, 0), 1);
    EXPECT_EQ(started(), "browser|/a|b.pdf") << "blanks are the caller's affair";
    Gui_PDFProfile::WritePDFViewerName("none");
    Gui_PDFProcess process;
    EXPECT_EQ(process.RunPDFReader("/a.pdf", nullptr, 1, 5000), 0);
    EXPECT_EQ(process.GetError(), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(boxes(), "");
    EXPECT_FALSE(hasChildren());
}

using Tutorial = ProgramsTest;

TEST_F(Tutorial, IsStartedAndLeftAloneOrSaidToFail) {
    EXPECT_EQ(Gui_Tutorial::Unsupported("layout"), 0);
    Gui_Tutorial::Start("browser --first");
    EXPECT_EQ(started(), "browser|--first");
    EXPECT_EQ(boxes(), "");
    Gui_Tutorial::Start("no tutorial");
    EXPECT_EQ(boxes(), "[The tutorial program no tutorial could not be started.]");
    Gui_Tutorial::Start(nullptr);
    EXPECT_EQ(boxes(), "[The tutorial program  could not be started.]");
    EXPECT_FALSE(hasChildren());
}

TEST_F(Tutorial, CanBeTakenOffMenusAtAnyDepth) {
    CMenu menu;
    CMenu popup;
    CMenu nested;
    menu.CreatePopupMenu();
    popup.CreatePopupMenu();
    nested.CreatePopupMenu();
    nested.AppendMenu(MF_STRING, 7, "Tutorial");
    popup.AppendMenu(MF_STRING, 8, "Other");
    popup.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(nested.Detach()), "Nested");
    menu.AppendMenu(MF_STRING, 7, "Tutorial");
    menu.AppendMenu(MF_POPUP, reinterpret_cast<UINT_PTR>(popup.Detach()), "Popup");
    menu.AppendMenu(MF_STRING, 7, "Tutorial");
    menu.AppendMenu(MF_SEPARATOR);
    Gui_Tutorial::DeleteMenuItem(nullptr, 7);
    Gui_Tutorial::DeleteMenuItem(&menu, 7);
    ASSERT_EQ(menu.GetMenuItemCount(), 2u);
    CMenu* rest = menu.GetSubMenu(0);
    ASSERT_EQ(rest->GetMenuItemCount(), 2u);
    EXPECT_EQ(rest->GetMenuItemID(0), 8u);
    EXPECT_EQ(rest->GetSubMenu(1)->GetMenuItemCount(), 0u);
}

} // namespace
