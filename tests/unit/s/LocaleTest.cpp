#include "s/Locale.h"

#include "res/resource.h"
#include "s/FileName.h"
#include "tests/data/resources/resource.h"
#include "tests/unit/SavedEnvironment.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>

namespace {

std::string stringOf(UINT id) {
    CString text;
    text.LoadString(id);
    return text.GetString();
}

/// A session in one language; without a display, so that message boxes go to standard error.
class Locale : public testing::Test {
protected:
    void useLanguage(const char* name) {
        setenv("LC_ALL", name, 1);
    }
    /// What the report says while @p attempt runs.
    template <class Attempt>
    std::string reported(Attempt attempt) {
        setenv("Gui_Locale", "", 1);
        testing::internal::CaptureStderr();
        attempt();
        unsetenv("Gui_Locale");
        return testing::internal::GetCapturedStderr();
    }
    ~Locale() override {
        AfxSetResourceHandle(nullptr);
    }

private:
    SavedEnvironment m_environment;
};

} // namespace

TEST_F(Locale, GivesTheApplicationTheUsersLanguage) {
    EXPECT_EQ(stringOf(IDS_GREETING), "");
    useLanguage("de_DE.UTF-8");
    Gui_Locale::SetAppResourceHandle();
    EXPECT_NE(AfxGetResourceHandle(), AfxGetInstanceHandle());
    EXPECT_EQ(stringOf(IDS_GREETING), "Hallo\tWelt\n");
    // The library's own texts are found behind it.
    EXPECT_EQ(stringOf(GUI_IDS_FAMILY_TITLE), "Tarvex %1");
}

TEST_F(Locale, ChangesNothingWhereThereIsNoTranslation) {
    for (const char* language : {"en_US.UTF-8", "en_GB", "C", "ja_JP.UTF-8", "de_AT"}) {
        useLanguage(language);
        Gui_Locale::SetAppResourceHandle();
        EXPECT_EQ(AfxGetResourceHandle(), AfxGetInstanceHandle()) << language;
        AFX_EXTENSION_MODULE module;
        AfxInitExtensionModule(module, GetModuleHandle("GuiUtilities"));
        Gui_Locale::SetDllResourceHandle(module, module.hModule, "nothing");
        EXPECT_EQ(module.hResource, module.hModule) << language;
    }
}

TEST_F(Locale, NamesTheResourceLibraryAfterTheModuleOrAsTold) {
    useLanguage("de_DE");
    AFX_EXTENSION_MODULE module;
    AfxInitExtensionModule(module, GetModuleHandle("GuiUtilities"));
    Gui_Locale::SetDllResourceHandle(module, module.hModule);
    EXPECT_NE(module.hResource, module.hModule);
    EXPECT_EQ(tvx::resourceString(module.hResource, GUI_IDS_CLOSE), "Schließen");
    for (const char* name : {"s-tests", "s-tests.exe", "C:\\elsewhere\\S-Tests.dll", "/elsewhere/s-tests.old"}) {
        AfxSetResourceHandle(nullptr);
        Gui_Locale::SetAppResourceHandle(name);
        EXPECT_EQ(stringOf(IDS_GREETING), "Hallo\tWelt\n") << name;
    }
    for (const char* name : {"", "/", "C:\\folder\\", ".exe", "other"}) {
        AfxSetResourceHandle(nullptr);
        Gui_Locale::SetAppResourceHandle(name);
        EXPECT_EQ(AfxGetResourceHandle(), AfxGetInstanceHandle()) << name;
    }
}

TEST_F(Locale, ReportsAttemptsWhenTheEnvironmentAsksForIt) {
    const auto attempt = [] { Gui_Locale::SetAppResourceHandle(); };
    useLanguage("en_US");
    EXPECT_EQ(reported(attempt), "");
    useLanguage("ja_JP");
    EXPECT_EQ(reported(attempt), "Gui_Locale Info: hDll=0 ErrCode=7e DllBaseName=s-tests.JPN\n");
    useLanguage("de_DE");
    const std::string success = reported(attempt);
    EXPECT_EQ(success.find("Gui_Locale Info: hDll="), 0u);
    EXPECT_EQ(success.find("hDll=0"), std::string::npos);
    EXPECT_NE(success.find(" ErrCode=0 DllBaseName=s-tests.DEU\n"), std::string::npos) << success;
    EXPECT_EQ(reported([] { Gui_Locale::SetAppResourceHandle("/"); }), "") << "there was nothing to look for";
}

TEST_F(Locale, LeavesNetworkNamesAsTheyWere) {
    useLanguage("de_DE");
    for (const int flag : {0, 1, 7}) {
        Gui_FileName::SetUncFlag(flag);
        Gui_Locale::SetAppResourceHandle();
        Gui_Locale::SetAppResourceHandle("/");
        EXPECT_EQ(Gui_FileName::GetUncFlag(), flag);
    }
    Gui_FileName::SetUncFlag(1);
}

TEST_F(Locale, ChoosesTheFontOfTextWindowsByLanguage) {
    for (const auto& [language, face] : {std::pair("en_GB", "Courier"), std::pair("de_DE", "FixedSys")}) {
        useLanguage(language);
        CFont font;
        ASSERT_NE(Gui_Locale::GetFixedWidthFont(font), 0);
        LOGFONT description;
        ASSERT_NE(font.GetLogFont(&description), 0);
        EXPECT_STREQ(description.lfFaceName, face);
        EXPECT_EQ(description.lfHeight, 15);
        EXPECT_EQ(description.lfQuality, PROOF_QUALITY);
        EXPECT_EQ(description.lfPitchAndFamily, 0x31);
        EXPECT_EQ(description.lfCharSet, DEFAULT_CHARSET);
    }
}
