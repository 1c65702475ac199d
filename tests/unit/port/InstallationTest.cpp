// Files of an installation: where its roots are, what is found below them, and in which language.
#include "platform/port/Env.h"
#include "platform/port/File.h"
#include "platform/port/FileName.h"
#include "platform/port/TarvexPath.h"
#include "platform/port/detail/DocumentFolder.h"
#include "platform/win/detail/LanguageTable.h"
#include "tests/unit/SavedEnvironment.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <set>
#include <string>
#include <vector>

namespace {

namespace fs = std::filesystem;

/// A personal installation, `m_mine`, and a shared one, `m_shared`, for an American user.
class Installation : public testing::Test {
protected:
    Installation() {
        ::setenv("MYTARVEX", m_mine.c_str(), 1);
        ::setenv("TARVEX", m_shared.c_str(), 1);
        setLanguage("C");
    }
    static void setLanguage(const char* name) {
        ::setenv("LC_ALL", name, 1);
    }
    static std::string make(const std::string& path) {
        fs::create_directories(fs::path(path).parent_path());
        std::ofstream(path) << "text";
        return path;
    }
    static std::string textOf(const char* name) {
        return name ? name : "(none)";
    }

    const SavedEnvironment m_environment;
    const std::string m_folder = testing::TempDir() + testing::UnitTest::GetInstance()->current_test_info()->name();
    const std::string m_mine = m_folder + "/mine";
    const std::string m_shared = m_folder + "/shared";
};

TEST_F(Installation, HasRootsInTheOrderOfSearch) {
    const auto roots = [] {
        std::vector<std::string> names;
        for (const Port::StringBase<char>& root : Port::TarvexPath::GetInstance()) {
            names.push_back(root.str());
        }
        return names;
    };
    EXPECT_EQ(roots(), (std::vector<std::string>{m_mine, m_shared}));
    ::setenv("MYTARVEX", "", 1);
    ::setenv("TARVEX", " C:\\opt\\tarvex\t", 1);
    EXPECT_EQ(roots(), std::vector<std::string>{"C:/opt/tarvex"});
    ::setenv("MYTARVEX", " ", 1);
    ::setenv("TARVEX", "\\\\files\\programs\\tarvex", 1);
    EXPECT_EQ(roots(), std::vector<std::string>{"\\\\files/programs/tarvex"}) << "two slashes would be no share";
    ::unsetenv("TARVEX");
    EXPECT_EQ(roots(), std::vector<std::string>());
    EXPECT_EQ(Port_Env::GetEnv(nullptr), nullptr);
    EXPECT_EQ(Port_Env::GetEnv("TARVEX"), nullptr);
}

TEST_F(Installation, FindsDataAndHelpFiles) {
    const auto dataFile = [](const char* name) { return textOf(Port_Env::GetDataFileName(name, 1)); };
    EXPECT_EQ(dataFile("helpmap/a.map"), "(none)");
    const std::string shared = make(m_shared + "/share/helpmap/a.map");
    EXPECT_EQ(dataFile("helpmap/a.map"), shared);
    fs::create_directories(m_mine + "/share/helpmap/a.map");
    EXPECT_EQ(dataFile("helpmap/a.map"), shared) << "a folder is no file";
    fs::remove(m_mine + "/share/helpmap/a.map");
    EXPECT_EQ(dataFile("helpmap/a.map"), shared);
    const std::string mine = make(m_mine + "/share/helpmap/a.map");
    EXPECT_EQ(dataFile("helpmap/a.map"), mine);
    EXPECT_EQ(dataFile(nullptr), "(none)");

    EXPECT_EQ(textOf(Port_Env::GetHelpFileName("a.hlp", 1)), "(none)");
    const std::string help = make(m_shared + "/share/help/a.hlp");
    EXPECT_EQ(textOf(Port_Env::GetHelpFileName("a.hlp", 1)), help);
    EXPECT_EQ(Port_Env::GetHelpFileName(nullptr, 1), nullptr);
}

TEST_F(Installation, FindsDocumentsInTheUsersLanguageFirst) {
    const auto document = [](const char* name) { return textOf(Port_Env::GetDocFileName(name, 0)); };
    EXPECT_EQ(document("manuals"), "(none)");
    const std::string american = make(m_mine + "/doc/usenglish/manuals.pdf");
    const std::string german = make(m_shared + "/doc/german/manuals.pdf");
    EXPECT_EQ(document("manuals"), american);
    EXPECT_EQ(document("manuals.pdf"), american);
    EXPECT_EQ(document("manuals.htm"), "(none)");
    EXPECT_EQ(document("v1.0/manuals"), "(none)") << "the dot of a folder is no extension";
    setLanguage("de_AT.UTF-8");
    EXPECT_EQ(document("manuals"), german) << "the language counts more than the root";
    setLanguage("ja_JP.UTF-8");
    EXPECT_EQ(document("manuals"), american);
    EXPECT_EQ(document(nullptr), "(none)");
}

TEST_F(Installation, NamesTheFolderOfEachLanguage) {
    for (const auto& [locale, folder] :
         std::vector<std::pair<const char*, std::string>>{{"C", "usenglish"},
                                                          {"en_GB.UTF-8", "usenglish"},
                                                          {"de_CH.UTF-8", "german"},
                                                          {"ja_JP", "japanese"},
                                                          {"zh_TW", "traditionalchinese"},
                                                          {"zh_SG", "chinese"},
                                                          {"hr_HR", "croatian"},
                                                          {"sr_RS@latin", "serbian"},
                                                          {"tlh", "usenglish"}}) {
        setLanguage(locale);
        EXPECT_EQ(Port_Env::GetLang(), folder) << locale;
    }
    // Every language of the table but English has a folder of its own.
    for (const tvx::detail::Language& language : tvx::detail::languages()) {
        EXPECT_EQ(Port::detail::documentFolder(language.id) == std::string("usenglish"),
                  std::string_view(language.name).starts_with("en_"))
            << language.name;
    }
}

TEST_F(Installation, TellsWhetherFilesAreThere) {
    const std::string file = make(m_mine + "/Notes.txt");
    EXPECT_TRUE(Port::File::exist(file.c_str()));
    EXPECT_TRUE(Port::File::canread((m_mine + "\\notes.TXT").c_str()));
    for (const char* none : {m_mine.c_str(), "", "Q:\\notes.txt", static_cast<const char*>(nullptr)}) {
        EXPECT_FALSE(Port::File::exist(none));
        EXPECT_FALSE(Port::File::canread(none));
    }
}

TEST_F(Installation, NamesOfOneFileHaveOneForm) {
    const auto normalized = [](const std::string& name) { return Port::FileName(name).Normalize(true).str(); };
    const std::string file = make(m_mine + "/a/notes.txt");
    fs::create_directory_symlink(m_mine + "/a", m_mine + "/link");
    const std::string form = fs::canonical(file).string();
    for (const char* name : {"/a/notes.txt", "/a//./notes.txt", "/a/../a/NOTES.txt", "/link/notes.txt"}) {
        EXPECT_EQ(normalized(m_mine + name), form);
    }
    fs::current_path(m_mine);
    EXPECT_EQ(normalized("a\\notes.txt"), form);
    EXPECT_EQ(normalized("C:" + m_mine + "/a/notes.txt"), form);
    EXPECT_EQ(Port::FileName(m_mine + "/link/./notes.txt").Normalize(false).str(), m_mine + "/link/notes.txt");
    EXPECT_EQ(normalized(""), "");
}

TEST_F(Installation, ReadsFilesWhole) {
    const std::string text = std::string(10000, 'x') + '\0' + "\r\nlast";
    std::ofstream(make(m_mine + "/whole"), std::ios::binary) << "first\n" << text;
    Port::Stream* file = Port::File::open((m_mine + "/whole").c_str(), Port::File::AccessRead, Port::File::FlagText);
    ASSERT_NE(file, nullptr);
    char line[10];
    file->readline(line, 9);
    EXPECT_EQ(file->readall(), text) << "what is left of it";
    EXPECT_TRUE(file->geteof());
    EXPECT_EQ(file->readall(), "");
    EXPECT_EQ(file->readline(line, 9), 0);
    Port::File::close(file);
    // A file of which the system cannot tell the size.
    file = Port::File::open("/proc/self/status", Port::File::AccessRead, Port::File::FlagText);
    ASSERT_NE(file, nullptr);
    EXPECT_TRUE(file->readall().starts_with("Name:"));
    Port::File::close(file);
}

} // namespace
