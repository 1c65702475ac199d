#include "s/Version.h"

#include "platform/port/Version.h"
#include "tests/unit/port/Collector.h"

#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <string>
#include <sys/stat.h>

namespace {

using Texts = std::vector<std::string>;

/// The environment names one installation, `m_root`. What one test has read is there for the next, so every file is
/// newer than all before it.
class InstallInfo : public testing::Test {
protected:
    InstallInfo() {
        ::setenv("TZ", "UTC0", 1);
        std::filesystem::create_directories(m_root);
        std::filesystem::create_directories(m_ownRoot);
        ::setenv("TARVEX", m_root.c_str(), 1);
        ::unsetenv("MYTARVEX");
        ::unsetenv("TVX_MSG_DEBUG");
    }

    /// Writes the file of an installation; each one is newer than those before.
    void write(const std::string& contents, const std::string& root = {}) {
        const std::string path = (root.empty() ? m_root : root) + "/fileset.txt";
        std::ofstream(path, std::ios::binary) << contents;
        stamp(path, s_clock += 10);
    }
    static void stamp(const std::string& path, long seconds) {
        const timespec stamps[] = {{seconds, 0}, {seconds, 0}};
        ASSERT_EQ(::utimensat(AT_FDCWD, path.c_str(), stamps, 0), 0);
    }
    static std::string value(const char* key) {
        const char* text = Gui_InstallInfo::GetValue(key);
        return text ? text : "(none)";
    }

    const std::string m_folder =
        testing::TempDir() + "/" + testing::UnitTest::GetInstance()->current_test_info()->name();
    const std::string m_root = m_folder + "/tarvex";
    const std::string m_ownRoot = m_folder + "/mine";
    /// Behind all files that other tests of this process have read: only newer ones are read again.
    static inline long s_clock = 4102444800; // 2100
    Collector m_messages;
};

TEST_F(InstallInfo, TakesLinesApart) {
    write("Mon Jan 12 10:20:30 GMT 2026::version= 10.1 \r\n"
          "no mark at all=1\n"
          "Mon Jan 12 10:20:30 GMT 2026::no value\n"
          "Mon Jan 12 10:20:30 GMT 2026::=no key\n"
          "::pdfViewer=\tokular --find \"a=b::c\" %s\n"
          "Mon Jan 12 10:20:30 GMT 2026::summary=  two blanks \n"
          "Mon Jan 12 10:20:30 GMT 2026:: spaced = x\n"
          "::empty=\n"
          "::last=not ended");
    EXPECT_EQ(value("version"), "10.1");
    EXPECT_EQ(value("Version"), "(none)") << "letter case counts";
    EXPECT_EQ(value("pdfViewer"), "okular --find \"a=b::c\" %s");
    EXPECT_EQ(value("summary"), "  two blanks \n");
    EXPECT_EQ(value(" spaced "), "x") << "keys are exact";
    EXPECT_EQ(value("empty"), "");
    EXPECT_EQ(value("no value"), "(none)");
    EXPECT_EQ(value(""), "(none)");
    EXPECT_EQ(value("last"), "(none)");
    EXPECT_EQ(Gui_InstallInfo::GetValue(nullptr), nullptr);
    EXPECT_EQ(m_messages.texts(), Texts());
}

/// Which of two entries for one key counts, by their time stamps.
TEST_F(InstallInfo, KeepsTheNewestOfAKey) {
    const struct {
        const char* first;
        const char* second;
        const char* winner;
        const char* why;
    } cases[] = {
        {"Mon Jan 12 10:20:30 GMT 2026", "Tue Jan 13 10:20:30 GMT 2026", "second", "a day later"},
        {"Tue Jan 13 10:20:30 GMT 2026", "Mon Jan 12 10:20:30 GMT 2026", "first", "a day earlier"},
        {"Mon Jan 12 10:20:30 GMT 2026", "Fri Jan 12 10:20:30 XYZ 2026", "second", "weekday and zone do not count"},
        {"Mon Jan 12 10:20:30 GMT 2026", "Mon Jan  5 10:20:30 GMT 2026", "first", "the 5th, padded"},
        {"Mon Jan  5 10:20:30 GMT 2026", "Mon Jan 5 10:20:31 GMT 2026", "second", "a second later, not padded"},
        {"Mon Feb 12 10:20:30 GMT 2026", "Mon Hornung 12 10:20:31 GMT 2026", "first", "an unknown month is January"},
        {"Mon Nov 12 10:20:30 GMT 2026", "Mon Dec 1 10:20:30 GMT 2026", "second", "December is the last month"},
        {"Mon Jan 12 10:20:30 GMT 2026", "Mon Jan 12 09.59.59 GMT 2026", "first", "any character separates a clock"},
        {"Mon Jan 12 10:20:30 GMT 2026", "yesterday", "first", "an unknown time never wins over a known one"},
        {"Mon Jan 12 10:20:30 GMT 2026", "Mon Dec 12 10:20 GMT 2027", "first", "a clock without seconds is unknown"},
        {"Mon Jan 12 10:20:30 GMT 2026", "Mon Dec 12 10:20:30 2027", "first", "a zone is missing"},
        {"yesterday", "Thu Jan 1 00:00:01 GMT 1970", "second", "a known time wins over an unknown one"},
        {"yesterday", "Thu Jan 1 00:00:01 GMT 1066", "second", "before 1970 is unknown, and the last such line wins"},
        {"yesterday", "", "second", "the last of several unknown ones wins"},
    };
    for (const auto& each : cases) {
        write(std::string(each.first) + "::key=first\n" + each.second + "::key=second\n");
        EXPECT_EQ(value("key"), each.winner) << each.why;
    }
    write("Mon Jan 10 0:0:0 GMT 2026::key=10\nMon Jan 20 0:0:0 GMT 2026::key=20\nMon Jan 15 0:0:0 GMT 2026::key=15\n");
    EXPECT_EQ(value("key"), "20");
}

TEST_F(InstallInfo, TakesLinesOfAnyLength) {
    // 255 bytes count; what is left is a line of its own, here without a key.
    const std::string longValue = std::string(245, 'v') + "\u00e9" + std::string(1000, 'w');
    write("::before=1\n::key=" + longValue + "\n::after=2\r::broken=\xc3\xff\xe2\x82\n");
    EXPECT_EQ(value("key"), longValue.substr(0, 249));
    EXPECT_EQ(value("before"), "1");
    EXPECT_EQ(value("after"), "2");
    EXPECT_EQ(value("broken"), "\xc3\xff\xe2\x82");
}

TEST_F(InstallInfo, ReadsAgainOnlyWhatHasBecomeNewer) {
    write("::key=old\n");
    EXPECT_EQ(value("key"), "old");
    const std::string path = m_root + "/fileset.txt";
    std::ofstream(path, std::ios::binary) << "::key=new\n";
    stamp(path, s_clock);
    EXPECT_EQ(value("key"), "old") << "as old as the one that was read";
    stamp(path, s_clock - 1000);
    EXPECT_EQ(value("key"), "old") << "the clock went backwards";
    stamp(path, s_clock + 1);
    EXPECT_EQ(value("key"), "new");
    stamp(path, s_clock + 2);
    std::ofstream(path, std::ios::binary) << "::other=x\n";
    stamp(path, s_clock + 3);
    EXPECT_EQ(value("key"), "(none)") << "what is gone from the file is gone";
}

TEST_F(InstallInfo, AlwaysReadsTheFileOnce) {
    write("::key=value\n");
    stamp(m_root + "/fileset.txt", -5);
    const auto readInAFreshProcess = [] { std::exit(value("key") == "value" ? 0 : 1); };
    GTEST_FLAG_SET(death_test_style, "threadsafe");
    EXPECT_EXIT(readInAFreshProcess(), testing::ExitedWithCode(0), "") << "even one from before all time";
}

TEST_F(InstallInfo, PrefersTheUsersOwnInstallation) {
    write("::key=installed\n::other=there\n");
    ::setenv("MYTARVEX", m_ownRoot.c_str(), 1);
    EXPECT_EQ(value("key"), "installed") << "there is no file of the user's own";
    write("::key=mine\n", m_ownRoot);
    EXPECT_EQ(value("key"), "mine");
    EXPECT_EQ(value("other"), "(none)") << "only one of the files is read";
    ::unsetenv("TARVEX");
    EXPECT_EQ(value("key"), "mine");
    EXPECT_EQ(m_messages.texts(), Texts());
}

TEST_F(InstallInfo, SaysEachTimeWhatIsMissing) {
    const char* const unset = "Unable to obtain the value of environment variable TARVEX.\n";
    const char* const unopened = "Unable to open $TARVEX/fileset.txt.\n";
    write("::key=value\n");
    EXPECT_EQ(value("key"), "value");
    ::unsetenv("TARVEX");
    EXPECT_EQ(value("key"), "(none)") << "what was read earlier is not asked";
    ::setenv("TARVEX", "", 1);
    EXPECT_EQ(value("key"), "(none)");
    ::setenv("TARVEX", (m_root + "/nowhere").c_str(), 1);
    EXPECT_EQ(value("key"), "(none)");
    ASSERT_EQ(::mkdir((m_root + "/nowhere").c_str(), 0700), 0);
    ASSERT_EQ(::mkdir((m_root + "/nowhere/fileset.txt").c_str(), 0700), 0);
    EXPECT_EQ(value("key"), "(none)") << "a folder is no file";
    EXPECT_EQ(m_messages.texts(), (Texts{unset, unset, unopened, unopened}));
    EXPECT_EQ(m_messages.messages.front().type, Port_MsgMan::MsgTypeError);
}

TEST_F(InstallInfo, RefusesRootsThatAreTooLong) {
    // The longest root that fits: its path and the zero fill 516 bytes.
    std::string root = m_root;
    while (root.size() + 2 <= 503) {
        root += "/.";
    }
    root.resize(503, '/');
    write("::key=value\n");
    ::setenv("TARVEX", root.c_str(), 1);
    EXPECT_EQ(value("key"), "value");
    EXPECT_EQ(m_messages.texts(), Texts());
    root += '/';
    ::setenv("MYTARVEX", root.c_str(), 1);
    EXPECT_EQ(value("key"), "value") << "the installation is used instead";
    ::setenv("TARVEX", root.c_str(), 1);
    EXPECT_EQ(value("key"), "(none)");
    const std::string mine = "The value of environment variable MYTARVEX is too long.\n";
    EXPECT_EQ(m_messages.texts(), (Texts{mine, mine, "The value of environment variable TARVEX is too long.\n"}));
}

TEST_F(InstallInfo, AnswersThroughThePortabilityLibrary) {
    write("::version=10.1.3\n");
    EXPECT_STREQ(Port::Version::getValue("version").c_str(), "10.1.3");
    EXPECT_TRUE(Port::Version::getValue("browser").IsEmpty());
    ::unsetenv("TARVEX");
    EXPECT_TRUE(Port::Version::getValue("version").IsEmpty());
    EXPECT_EQ(m_messages.messages.size(), 1U);
}

TEST_F(InstallInfo, TracesItsLoadingWhenAsked) {
    write("::key=1\n");
    (void)value("key");
    EXPECT_EQ(m_messages.texts(), Texts());
    ::setenv("TVX_MSG_DEBUG", "1", 1);
    (void)value("key");
    write("::key=2\n");
    (void)value("key");
    EXPECT_EQ(m_messages.texts(), Texts{"Loading information from fileset.txt ...\n\n"});
    EXPECT_EQ(m_messages.messages.front().type, Port_MsgMan::MsgTypeDebug);
}

} // namespace
