#include "platform/afx/core/CommandLineInfo.h"

#include <cstring>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace {

/// As the application object does it.
void parse(CCommandLineInfo& info, const std::vector<std::string>& words) {
    for (const std::string& word : words) {
        const auto [text, isSwitch] = tvx::afx::takeApart(word.c_str());
        info.ParseParam(text, isSwitch, &word == &words.back());
    }
}

class SwallowsLastWord : public CCommandLineInfo {
public:
    void ParseParam(const char* param, BOOL isSwitch, BOOL isLast) override {
        if (isSwitch && std::strcmp(param, "own") == 0) {
            return;
        }
        CCommandLineInfo::ParseParam(param, isSwitch, isLast);
    }
};

} // namespace

TEST(CommandLineInfo, NothingGivenMeansANewDocument) {
    CCommandLineInfo info;
    EXPECT_EQ(info.m_nShellCommand, CCommandLineInfo::FileNew);
    EXPECT_TRUE(info.m_bShowSplash);
}

TEST(CommandLineInfo, TheFirstPlainWordIsOpened) {
    CCommandLineInfo info;
    parse(info, {"one.brd", "-unheard-of", "two.brd"});
    EXPECT_EQ(info.m_nShellCommand, CCommandLineInfo::FileOpen);
    EXPECT_STREQ(info.m_strFileName, "one.brd");
}

TEST(CommandLineInfo, OpensTheFileWhenADerivedClassKeepsTheLastWord) {
    SwallowsLastWord info;
    parse(info, {"one.brd", "-own"});
    EXPECT_EQ(info.m_nShellCommand, CCommandLineInfo::FileOpen);
}

TEST(CommandLineInfo, PrintSwitchesHoldBeforeAndAfterTheFile) {
    CCommandLineInfo before;
    parse(before, {"-p", "one.brd"});
    EXPECT_EQ(before.m_nShellCommand, CCommandLineInfo::FilePrint);

    CCommandLineInfo after;
    parse(after, {"one.brd", "/p"});
    EXPECT_EQ(after.m_nShellCommand, CCommandLineInfo::FilePrint);

    CCommandLineInfo printer;
    parse(printer, {"-pt", "one.brd", "laser", "driver", "port", "more"});
    EXPECT_EQ(printer.m_nShellCommand, CCommandLineInfo::FilePrintTo);
    EXPECT_STREQ(printer.m_strFileName, "one.brd");
    EXPECT_STREQ(printer.m_strPrinterName, "laser");
    EXPECT_STREQ(printer.m_strDriverName, "driver");
    EXPECT_STREQ(printer.m_strPortName, "port");
}

TEST(CommandLineInfo, SwitchesOfOtherProgramsHideTheSplashScreen) {
    for (const char* word : {"-Embedding", "/AUTOMATION"}) {
        CCommandLineInfo info;
        parse(info, {word});
        EXPECT_FALSE(info.m_bShowSplash) << word;
    }
}

TEST(CommandLineInfo, ASlashBeginsASwitchUnlessTheFileExists) {
    const auto folder = std::filesystem::temp_directory_path() / "tvx-command-line-info";
    std::filesystem::create_directories(folder);
    const std::string file = folder / "ünï code.brd";
    std::ofstream(file) << "x";

    const auto given = [](const std::string& word) {
        const auto parts = tvx::afx::takeApart(word.c_str());
        return std::string(parts.isSwitch ? "switch:" : "word:") + parts.text;
    };
    EXPECT_EQ(given(file), "word:" + file);
    EXPECT_EQ(given(folder), "word:" + folder.string());
    EXPECT_EQ(given(file + ".missing"), "switch:" + (file + ".missing").substr(1));
    EXPECT_EQ(given("/help"), "switch:help");
    EXPECT_EQ(given("--help"), "switch:-help");
    EXPECT_EQ(given("-"), "switch:");
    EXPECT_EQ(given(""), "word:");
    EXPECT_EQ(given("a-b"), "word:a-b");
    std::filesystem::remove_all(folder);
}
