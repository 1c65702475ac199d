#include "s/Profile.h"

#include "NoProgramsTest.h"
#include "TestApp.h"
#include "platform/port/Version.h"
#include "s/Version.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

namespace {

/// A store and an installation of its own, and an application that has named itself.
class Profile : public StoreTest {
protected:
    void SetUp() override {
        StoreTest::SetUp();
        theApp.SetRegistryKey("Maker");
    }
    void TearDown() override {
        Port::Version::setReader(&Gui_InstallInfo::GetValue);
        StoreTest::TearDown();
    }
    /// Lets the installation have a version.
    static void install(const char* version) {
        installed = version;
        Port::Version::setReader([](const char*) { return installed.c_str(); });
    }
    static std::string applicationKey(const char* section) {
        return std::string("Software\\Maker\\") + theApp.m_pszProfileName + "\\" + section;
    }

    inline static std::string installed;
};

TEST_F(Profile, KeepsTextsBelowRegistryKeyTitleAndSection) {
    Gui_Profile::WriteString("inch", "Unit", nullptr);
    Gui_Profile::WriteString("mm", "Unit", "View");
    EXPECT_EQ(stored(applicationKey("Settings"), "Unit"), "inch");
    EXPECT_EQ(stored(applicationKey("View"), "Unit"), "mm");
    CString value = "cm";
    EXPECT_EQ(Gui_Profile::ReadString(value, "Unit", nullptr), 1);
    EXPECT_EQ(value, "inch");
}

TEST_F(Profile, LeavesTheVariableAloneWhereThereIsNoText) {
    CString value = "cm";
    EXPECT_EQ(Gui_Profile::ReadString(value, "Unit", nullptr), 0);
    Gui_Profile::WriteString("", "Unit", nullptr);
    EXPECT_EQ(stored(applicationKey("Settings"), "Unit"), "");
    EXPECT_EQ(Gui_Profile::ReadString(value, "Unit", nullptr), 0);
    EXPECT_EQ(value, "cm");
}

TEST_F(Profile, RemovesEntriesAndSections) {
    Gui_Profile::WriteString("1", "A", nullptr);
    Gui_Profile::WriteString("2", "B", nullptr);
    Gui_Profile::WriteString(nullptr, "A", nullptr);
    EXPECT_EQ(stored(applicationKey("Settings"), "A"), "<no value>");
    EXPECT_EQ(stored(applicationKey("Settings"), "B"), "2");
    Gui_Profile::WriteString("ignored", nullptr, nullptr);
    EXPECT_EQ(stored(applicationKey("Settings"), "B"), "<no key>");
}

TEST_F(Profile, ReachesAnotherProfileWhileTheApplicationHasItsName) {
    const LPCSTR own = theApp.m_pszProfileName;
    theApp.m_pszProfileName = "Common";
    Gui_Profile::WriteString("1", "AlwayOnWeb", nullptr);
    theApp.m_pszProfileName = own;
    EXPECT_EQ(stored("Software\\Maker\\Common\\Settings", "AlwayOnWeb"), "1");
    CString value;
    EXPECT_EQ(Gui_Profile::ReadString(value, "AlwayOnWeb", nullptr), 0);
}

TEST_F(Profile, KeepsNumbersAndBytesOfHosts) {
    EXPECT_EQ(theApp.GetProfileInt("View", "Zoom", -7), static_cast<UINT>(-7));
    EXPECT_TRUE(theApp.WriteProfileInt("View", "Zoom", -3));
    EXPECT_EQ(static_cast<int>(theApp.GetProfileInt("View", "Zoom", 1)), -3);
    EXPECT_EQ(theApp.GetProfileString("View", "Zoom", "no text"), "no text");
    std::string written(300, '\0');
    written.back() = 'x';
    EXPECT_TRUE(theApp.WriteProfileBinary("View", "Bytes", reinterpret_cast<BYTE*>(written.data()), 300));
    LPBYTE bytes = nullptr;
    UINT size = 0;
    ASSERT_TRUE(theApp.GetProfileBinary("View", "Bytes", &bytes, &size));
    EXPECT_EQ(std::string(reinterpret_cast<char*>(bytes), size), written);
    delete[] bytes;
    EXPECT_FALSE(theApp.GetProfileBinary("View", "Zoom", &bytes, &size));
    const std::string text(5000, 'a');
    EXPECT_TRUE(theApp.WriteProfileString("View", "Long", text.c_str()));
    EXPECT_EQ(theApp.GetProfileString("View", "Long"), text.c_str());
}

TEST_F(Profile, TellsOnceInABoxThatTheFileWasDamaged) {
    std::ofstream(m_folder / "registry.db") << std::string(5000, 'x');
    theApp.boxes.clear();
    CString value = "cm";
    EXPECT_EQ(Gui_Profile::ReadString(value, "Unit", nullptr), 0);
    Gui_Profile::WriteString("mm", "Unit", nullptr);
    EXPECT_EQ(Gui_Profile::ReadString(value, "Unit", nullptr), 1);
    ASSERT_EQ(theApp.boxes.size(), 1u);
    EXPECT_NE(theApp.boxes[0].text.find("registry-damaged-"), std::string::npos) << theApp.boxes[0].text;
}

TEST_F(Profile, ComposesLocationsOfKeys) {
    const auto location = [](bool suite, bool application, bool versioned) {
        return std::string(Gui_Profile::GetKeyLocation("board", suite, application, versioned));
    };
    install("12.34.5");
    EXPECT_EQ(location(false, false, false), "Common");
    EXPECT_EQ(location(false, false, true), "Common\\12.3");
    EXPECT_EQ(location(false, true, false), "Common\\board");
    EXPECT_EQ(location(false, true, true), "Common\\12.3\\board");
    EXPECT_EQ(location(true, false, true), "NEV\\12.3\\Common");
    EXPECT_EQ(location(true, true, true), "NEV\\12.3\\board");
    EXPECT_EQ(location(true, true, false), "");
    EXPECT_EQ(location(true, false, false), "");
    EXPECT_EQ(stored("Common", ""), "<no key>");
}

TEST_F(Profile, TakesTenOneForAVersionThatNobodyKnows) {
    install("");
    EXPECT_EQ(Gui_Profile::GetKeyLocation("board", false, false, true), "Common\\10.1");
    install("9");
    EXPECT_EQ(Gui_Profile::GetKeyLocation("board", false, false, true), "Common\\9");
    install("1.äöü"); // characters are taken, not bytes
    EXPECT_EQ(Gui_Profile::GetKeyLocation("board", false, false, true), "Common\\1.äö");
}

TEST_F(Profile, KeepsARecordOfFirstInstances) {
    unsigned long number = 7;
    EXPECT_EQ(Gui_Profile::ReadFirstInstanceInfo("board", "ProcessID", number), 0);
    EXPECT_EQ(stored("Software\\Tarvex\\board\\FirstInstance", "ProcessID"), "<no value>") << "the key is made";
    Gui_Profile::WriteFirstInstanceInfo("board", "ProcessID", 4294967295);
    EXPECT_EQ(stored("Software\\Tarvex\\board\\FirstInstance", "ProcessID"), "-1");
    EXPECT_EQ(Gui_Profile::ReadFirstInstanceInfo("board", "ProcessID", number), 1);
    EXPECT_EQ(number, 4294967295u);
    number = 7;
    EXPECT_EQ(Gui_Profile::ReadFirstInstanceInfo("notes", "ProcessID", number), 0);
    EXPECT_EQ(number, 7u);
}

TEST_F(Profile, ReadsNumbersOfOthersAsFarAsTheyAreNumbers) {
    const auto read = [](const std::string& text, LONG* number) {
        HKEY key = nullptr;
        RegCreateKeyExA(HKEY_CURRENT_USER, "Software\\Tarvex\\board\\FirstInstance", 0, nullptr, 0, KEY_WRITE, nullptr,
                        &key, nullptr);
        RegSetValueExA(key, "WindowID", 0, REG_SZ, reinterpret_cast<const BYTE*>(text.c_str()),
                       static_cast<DWORD>(text.size() + 1));
        RegCloseKey(key);
        unsigned long value = 7;
        const int result = Gui_Profile::ReadFirstInstanceInfo("board", "WindowID", value);
        *number = static_cast<LONG>(value);
        return result;
    };
    LONG number = 0;
    EXPECT_EQ(read("12abc", &number), 0);
    EXPECT_EQ(number, 7);
    EXPECT_EQ(read("  12", &number), 1);
    EXPECT_EQ(number, 12);
    EXPECT_EQ(read("", &number), 1);
    EXPECT_EQ(number, 0);
    EXPECT_EQ(read("0000000000000000012", &number), 1);
    EXPECT_EQ(number, 12);
    EXPECT_EQ(read("00000000000000000012", &number), 0) << "twenty characters do not fit";
    EXPECT_EQ(number, 7);
}

/// What has been asked for, or "unchanged" where nothing was found.
CString answer(int (*read)(CString&)) {
    CString name = "unchanged";
    const int result = read(name);
    EXPECT_EQ(result, name != "unchanged");
    return name;
}
CString answer(void (*get)(CString&)) {
    CString name = "unchanged";
    get(name);
    return name;
}

class ProfilePrograms : public NoProgramsTest {};

TEST_F(ProfilePrograms, TextEditorIsTheUsersElseTheSystems) {
    EXPECT_EQ(answer(&Gui_Profile::ReadTextEditorName), "wordpad.exe");
    storeForMachine("Software\\Microsoft\\Windows\\CurrentVersion\\App Paths\\WORDPAD.EXE", " %ed% ");
    EXPECT_EQ(answer(&Gui_Profile::ReadTextEditorName), " %ed% ") << "as it is stored";
    Gui_Profile::WriteTextEditorName("kate -b");
    EXPECT_EQ(stored(family, "TextEditor"), "kate -b");
    EXPECT_EQ(answer(&Gui_Profile::ReadTextEditorName), "kate -b");
    EXPECT_EQ(answer(&Gui_Profile::GetDefaultTextEditorName), " %ed% ");
    Gui_Profile::WriteTextEditorName("");
    EXPECT_EQ(answer(&Gui_Profile::ReadTextEditorName), "") << "an empty name is a choice too";
}

TEST_F(ProfilePrograms, WebBrowserIsTheUsersElseTheAssociatedElseTheLast) {
    EXPECT_EQ(answer(&Gui_Profile::ReadWebBrowserName), "unchanged");
    EXPECT_EQ(answer(&Gui_Profile::GetDefaultWebBrowserName), "unchanged");
    EXPECT_EQ(stored(family, "Browser"), "<no key>") << "looking makes no key";
    storeForMachine(lastBrowser, "\tiexplore ");
    EXPECT_EQ(answer(&Gui_Profile::ReadWebBrowserName), "iexplore");
    store("Software\\Classes\\.htm", "", "");
    EXPECT_EQ(answer(&Gui_Profile::ReadWebBrowserName), "iexplore") << "an association with nothing";
    associate(".htm", "  ");
    EXPECT_EQ(answer(&Gui_Profile::GetDefaultWebBrowserName), "iexplore") << "a command of blanks is none";
    associate(".htm", " browse \"%1\" ");
    EXPECT_EQ(answer(&Gui_Profile::ReadWebBrowserName), "browse \"%1\"");
    Gui_Profile::WriteWebBrowserName("  ");
    EXPECT_EQ(answer(&Gui_Profile::ReadWebBrowserName), "  ") << "the user's blanks count";
    EXPECT_EQ(answer(&Gui_Profile::GetDefaultWebBrowserName), "browse \"%1\"");
    Gui_Profile::WriteWebBrowserName("");
    EXPECT_EQ(stored(family, "Browser"), "");
    EXPECT_EQ(answer(&Gui_Profile::ReadWebBrowserName), "browse \"%1\"");
}

} // namespace
