#include "s/CommandLineInfo.h"

#include "TestApp.h"
#include "s/CommandLineState.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <string>
#include <vector>

namespace {

using Words = std::vector<std::string>;

class CommandLine : public Gui_CommandLineInfo {
public:
    CString GetCmdOpcodes() const override {
        ++timesAsked;
        return opcodes;
    }
    CString GetUsageText() const override {
        return "More about the arguments.";
    }
    void ParseParam(const char* param, BOOL isSwitch, BOOL isLast) override {
        seen.push_back(std::string(isSwitch ? "-" : "") + param);
        Gui_CommandLineInfo::ParseParam(param, isSwitch, isLast);
    }

    CString opcodes = "smoketest none : Checks and ends.\n"
                      "nosplash none : No splash screen.\n"
                      "scale real : Scale of the drawing.\n"
                      "<drawing> 0..* : Drawings to open.\n";
    Words seen;
    mutable int timesAsked = 0;
};

/// What a start with these words leaves.
struct Outcome {
    CommandLine info;
    Words collected;
    int result = -1;
    int exitCode = -1;
};

class CommandLineInfo : public testing::Test {
protected:
    CommandLineInfo() {
        std::filesystem::create_directories(m_folder);
        std::filesystem::current_path(m_folder);
    }
    ~CommandLineInfo() override {
        std::filesystem::current_path("/");
        std::filesystem::remove_all(m_folder);
    }

    /// Parses and checks as a host does.
    static void start(Outcome& outcome, const Words& words) {
        outcome.exitCode = theApp.start(words, [&] {
            theApp.ParseCommandLine(outcome.info);
            Gui_CmdLineArgsArray arguments;
            if (arguments.GetVector()) {
                outcome.collected.assign(arguments.GetVector(), arguments.GetVector() + arguments.GetCount());
            }
            outcome.result = theApp.ProcessCommandLine(outcome.info);
        });
    }

    std::string file(const std::string& name, const std::string& text) const {
        const std::string path = m_folder / name;
        std::ofstream(path, std::ios::binary) << text;
        return path;
    }
    std::string missing(const std::string& name) const {
        return m_folder / name;
    }

    static std::string lastBox() {
        return theApp.boxes.empty() ? "" : theApp.boxes.back().text;
    }
    static int timesIn(const std::string& text, const std::string& part) {
        int count = 0;
        for (auto at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
            ++count;
        }
        return count;
    }

private:
    std::filesystem::path m_folder = std::filesystem::path(testing::TempDir()) / "tvx command line";
};

} // namespace

TEST_F(CommandLineInfo, NothingGivenLeavesEverythingAsItIs) {
    Outcome outcome;
    outcome.info.opcodes = "a mistake in the specification";
    start(outcome, {});
    EXPECT_EQ(outcome.result, 1) << "the specification is not consulted";
    EXPECT_TRUE(theApp.boxes.empty());
    EXPECT_EQ(outcome.info.IsSmokeTestSwitch(), 0);
    EXPECT_EQ(outcome.info.IsHelpSwitch(), 0);
    EXPECT_EQ(outcome.info.GetStyleSwitch(), Gui_CommandLineInfo::IntStyleNone);
    EXPECT_TRUE(outcome.info.m_bShowSplash);
}

TEST_F(CommandLineInfo, KnowsTheSwitchesOfTheFamily) {
    for (const char* word : {"-help", "/HELP", "-h", "/H"}) {
        Outcome outcome;
        start(outcome, {word});
        EXPECT_EQ(outcome.info.IsHelpSwitch(), 1) << word;
    }
    Outcome longer;
    start(longer, {"-helper"});
    EXPECT_EQ(longer.info.IsHelpSwitch(), 0);

    for (const char* word : {"-sm", "/SMOKE"}) {
        Outcome abbreviated;
        start(abbreviated, {word});
        EXPECT_EQ(abbreviated.info.IsSmokeTestSwitch(), 1) << word;
        EXPECT_EQ(abbreviated.result, 0) << word;
        EXPECT_TRUE(theApp.boxes.empty()) << word;
    }
    Outcome ambiguous;
    start(ambiguous, {"-s"});
    EXPECT_EQ(ambiguous.info.IsSmokeTestSwitch(), 0);
    EXPECT_EQ(ambiguous.result, 0) << "the check refuses it";
    EXPECT_FALSE(theApp.boxes.empty());
    Outcome unlisted;
    start(unlisted, {"-intst", "silent"});
    EXPECT_EQ(unlisted.info.GetStyleSwitch(), Gui_CommandLineInfo::IntStyleNone)
        << "only what the host lists can be abbreviated";

    Outcome splash;
    start(splash, {"-NoSplash", "one.brd"});
    EXPECT_FALSE(splash.info.m_bShowSplash);
    EXPECT_STREQ(splash.info.m_strFileName, "one.brd");
    EXPECT_EQ(splash.result, 1);
}

TEST_F(CommandLineInfo, TakesTheStyleFromTheNextPlainWord) {
    const auto style = [](const Words& words, const char* opened) {
        Outcome outcome;
        start(outcome, words);
        EXPECT_STREQ(outcome.info.m_strFileName, opened);
        return outcome.info.GetStyleSwitch();
    };
    EXPECT_EQ(style({"-intstyle", "silent", "a"}, "a"), Gui_CommandLineInfo::IntStyleSilent);
    EXPECT_EQ(style({"-INTSTYLE", "Nev"}, ""), Gui_CommandLineInfo::IntStyleNev);
    EXPECT_EQ(style({"-intstyle", "kelma", "-intstyle", "loud"}, ""), Gui_CommandLineInfo::IntStyleKelma);
    EXPECT_EQ(style({"-intstyle", "loud"}, ""), Gui_CommandLineInfo::IntStyleNone);
    EXPECT_EQ(style({"-intstyle", "-other", "silent"}, "silent"), Gui_CommandLineInfo::IntStyleNone);
}

TEST_F(CommandLineInfo, CommandFilesStandForTheirWords) {
    const std::string inner = file("inner.cmd", "-smoketest 'with blank.brd'\n");
    const std::string outer = file("outer.cmd", "-scale 2 # a remark\r\n-f '" + inner + "'\r-nosplash\n");
    Outcome outcome;
    start(outcome, {"-f", outer, "-x", "after.brd"});
    EXPECT_EQ(outcome.info.seen, (Words{"-f", outer, "-scale", "2", "-f", inner, "-smoketest", "with blank.brd",
                                        "-nosplash", "-x", "after.brd"}));
    EXPECT_EQ(outcome.collected,
              (Words{"-scale", "2", "-smoketest", "with blank.brd", "-nosplash", "-x", "after.brd"}));
    EXPECT_EQ(outcome.info.IsSmokeTestSwitch(), 1);
    EXPECT_FALSE(outcome.info.m_bShowSplash);
}

TEST_F(CommandLineInfo, EveryPlainWordBehindTheFileSwitchIsACommandFile) {
    const std::string first = file("first.cmd", "one");
    const std::string second = file("second.cmd", "two");
    Outcome together;
    start(together, {"/f", first, second});
    // A plain word of a command file is a command file itself as long as no switch came between.
    EXPECT_EQ(timesIn(lastBox(), "\"one\""), 1);
    EXPECT_EQ(timesIn(lastBox(), "\"two\""), 1);

    Outcome parted;
    start(parted, {"-f", file("switch.cmd", "-scale 2"), second});
    EXPECT_EQ(parted.collected, (Words{"-scale", "2", second}));
}

TEST_F(CommandLineInfo, SwitchesAreCollectedWithADash) {
    Outcome outcome;
    start(outcome, {"/Scale", "2", "plain", file("there.brd", "")});
    EXPECT_EQ(outcome.collected, (Words{"-Scale", "2", "plain", missing("there.brd")}));
    EXPECT_EQ(outcome.result, 1);
}

TEST_F(CommandLineInfo, ASlashWordThatNamesAFileIsThatFile) {
    const std::string drawing = file("drawing.brd", "");
    const std::string commands = file("words.cmd", "-scale 2 \"" + drawing + "\"");
    Outcome outcome;
    start(outcome, {"-f", commands});
    EXPECT_STREQ(outcome.info.m_strFileName, "2");
    EXPECT_EQ(outcome.collected, (Words{"-scale", "2", drawing}));
}

TEST_F(CommandLineInfo, SmokeTestEndsInSilence) {
    Outcome outcome;
    start(outcome, {"-smoketest"});
    EXPECT_EQ(outcome.result, 0);
    EXPECT_TRUE(theApp.boxes.empty());
}

TEST_F(CommandLineInfo, HelpShowsUsageInOnePlainBox) {
    Outcome outcome;
    start(outcome, {"-help"});
    EXPECT_EQ(outcome.result, 0);
    ASSERT_EQ(theApp.boxes.size(), 1u);
    EXPECT_EQ(theApp.boxes[0].type, UINT(MB_OK));
    const std::string text = lastBox();
    EXPECT_EQ(timesIn(text, "Scale of the drawing."), 1);
    EXPECT_EQ(timesIn(text, "More about the arguments.\n"), 1);
    EXPECT_LT(text.find("Scale of"), text.find("More about"));

    Outcome again;
    start(again, {"-help"});
    EXPECT_EQ(lastBox(), text) << "nothing is left from the first time";
}

TEST_F(CommandLineInfo, ErrorsShowAtOnceAndAgainWithTheUsage) {
    Outcome outcome;
    start(outcome, {"-scale", "wide", "-unheard-of"});
    EXPECT_EQ(outcome.result, 0);
    ASSERT_EQ(theApp.boxes.size(), 3u);
    EXPECT_EQ(theApp.boxes[0].type, UINT(MB_ICONERROR));
    EXPECT_EQ(timesIn(theApp.boxes[0].text, "wide"), 1);
    EXPECT_EQ(theApp.boxes[1].type, UINT(MB_ICONERROR));
    EXPECT_EQ(timesIn(theApp.boxes[1].text, "wide"), 1);
    EXPECT_EQ(timesIn(theApp.boxes[1].text, "unheard-of"), 1);
    EXPECT_EQ(theApp.boxes[2].type, UINT(MB_OK));
    EXPECT_EQ(theApp.boxes[2].text.find(theApp.boxes[1].text), 0u);
    EXPECT_EQ(timesIn(lastBox(), "Scale of the drawing."), 1);
    EXPECT_EQ(timesIn(lastBox(), "More about the arguments."), 1);
}

TEST_F(CommandLineInfo, ACommandFileThatCannotBeReadIsReportedOnce) {
    testing::internal::CaptureStderr();
    Outcome alone;
    start(alone, {"-f", "missing.cmd"});
    EXPECT_EQ(alone.result, 0);
    ASSERT_EQ(theApp.boxes.size(), 2u);
    EXPECT_EQ(theApp.boxes[0].type, UINT(MB_ICONERROR));
    EXPECT_EQ(timesIn(theApp.boxes[0].text, "missing.cmd"), 1);
    EXPECT_EQ(theApp.boxes[1].text, theApp.boxes[0].text);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
}

TEST_F(CommandLineInfo, ACycleIsReportedOnceWithItsChain) {
    file("a.cmd", "-scale 2 -f b.cmd");
    file("b.cmd", "-f ./a.cmd");
    Outcome outcome;
    start(outcome, {"-f", "a.cmd"});
    EXPECT_EQ(outcome.result, 0);
    EXPECT_EQ(outcome.collected, (Words{"-scale", "2"}));
    EXPECT_EQ(theApp.boxes.size(), 2u);
    std::string text = lastBox();
    std::replace(text.begin(), text.end(), '\n', ' ');
    EXPECT_EQ(timesIn(text, "is being expanded already: a.cmd -> b.cmd -> ./a.cmd."), 1) << text;
}

TEST_F(CommandLineInfo, ProblemsReachTheUserWithoutTheCheck) {
    testing::internal::CaptureStderr();
    theApp.start({"-f", "no such file", "-f"}, [] {
        CommandLine info;
        theApp.ParseCommandLine(info);
    });
    const std::string said = testing::internal::GetCapturedStderr();
    EXPECT_EQ(timesIn(said, "no such file"), 1);
    EXPECT_EQ(timesIn(said, "needs a command file"), 1);
}

TEST_F(CommandLineInfo, TellsByTheExitCodeThatItIsWrong) {
    const std::string good = file("good.cmd", "-scale 2");
    const struct {
        Words words;
        int exitCode;
    } cases[] = {
        {{}, 0},
        {{"-scale", "2", "a.brd"}, 0},
        {{"-smoketest"}, 0},
        {{"-help"}, 0},
        {{"-help", "-bogus"}, 0},
        {{"-bogus"}, 2},
        {{"-scale", "2kg"}, 2},
        {{"-f", "missing.cmd"}, 2},
        {{"-f", "missing.cmd", "-help"}, 2},
        {{"-f", good}, 0},
        {{"-f", good, "-f"}, 2}, // and no file behind it
        {{"-f", "-smoketest"}, 2},
        {{"-f", file("open.cmd", "-f")}, 2},
    };
    for (const auto& [words, exitCode] : cases) {
        Outcome outcome;
        start(outcome, words);
        EXPECT_EQ(outcome.exitCode, exitCode) << testing::PrintToString(words);
        EXPECT_EQ(exitCode != 0 && theApp.boxes.empty(), false) << "the user is told why";
    }
}

TEST_F(CommandLineInfo, AsksForTheOptionsOnce) {
    Outcome outcome;
    outcome.info.opcodes = "layer none repeatable : Shows a layer.\n";
    start(outcome, Words(1000, "-layer"));
    EXPECT_EQ(outcome.result, 1);
    EXPECT_EQ(outcome.info.timesAsked, 2) << "while it is parsed, and for the check";
}

TEST_F(CommandLineInfo, ManyWordsOfAFileArriveWhole) {
    std::string text;
    for (int i = 0; i < 100000; ++i) {
        text += "drawing" + std::to_string(i) + ".brd ";
    }
    Outcome outcome;
    start(outcome, {"-f", file("many.cmd", "-nosplash " + text)});
    EXPECT_EQ(outcome.result, 1);
    ASSERT_EQ(outcome.collected.size(), 100001u);
    EXPECT_EQ(outcome.collected.back(), "drawing99999.brd");
}
