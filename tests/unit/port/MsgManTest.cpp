#include "platform/port/MsgMan.h"

#include "Collector.h"
#include "platform/port/Exception.h"
#include "platform/port/MsgDispatcher.h"
#include "platform/port/MsgManData.h"
#include "platform/port/detail/MsgFormat.h"

#include <clocale>
#include <functional>
#include <gtest/gtest.h>
#include <memory>

namespace {

using Lines = std::vector<std::string>;

Port_MsgManData origin(int line = 1, const char* source = "Source") {
    return Port_MsgManData::createObject("Module", source, line, "$Revision");
}

Lines format(Port_MsgMan::MsgType type, const std::string& text, int width = 80, bool clean = false) {
    int count = -1;
    wchar_t** lines =
        Port_MsgManDefault::msgFormat(type, clean, width, UT_STR::MbstrToWstr(text.c_str()).c_str(), &count);
    Lines result;
    for (int i = 0; i < count; ++i) {
        result.push_back(UT_STR::WstrToMbstr(lines[i]));
    }
    UT_STR::WDelStrings(lines, count);
    return result;
}

Lines wrap(const std::string& text, int width) {
    return format(Port_MsgMan::MsgTypeStatus, text, width);
}

/// A manager that does something of its own when it gets a message.
class Reacting : public Port_MsgManDefault {
public:
    explicit Reacting(std::function<void()> reaction) : m_reaction(std::move(reaction)) {}

protected:
    void msgWrite(MsgType, const wchar_t*) override {
        m_reaction();
    }

private:
    std::function<void()> m_reaction;
};

TEST(MsgFormat, EachLineEndsWithOneLineFeed) {
    EXPECT_EQ(wrap("one\ntwo\nthree", 80), (Lines{"one\n", "two\n", "three\n"}));
    EXPECT_EQ(wrap("one\n", 80), (Lines{"one\n"}));
    EXPECT_EQ(wrap("one\n\ntwo\r\n", 80), (Lines{"one\n", "\n", "two\n"}));
    EXPECT_EQ(wrap("\n", 80), (Lines{"\n"}));
    EXPECT_EQ(wrap("", 80), Lines{});
    EXPECT_EQ(format(Port_MsgMan::MsgTypeError, ""), Lines{});
}

TEST(MsgFormat, NamesTheTypeUnlessClean) {
    EXPECT_EQ(format(Port_MsgMan::MsgTypeStatus, "x"), Lines{"x\n"});
    EXPECT_EQ(format(Port_MsgMan::MsgTypeWarning, "x"), Lines{"Warning: x\n"});
    EXPECT_EQ(format(Port_MsgMan::MsgTypeError, "x\ny"), (Lines{"Error: x\n", "y\n"}));
    EXPECT_EQ(format(Port_MsgMan::MsgTypeInternal, "x"), Lines{"Internal error: x\n"});
    EXPECT_EQ(format(Port_MsgMan::MsgTypeFatal, "x"), Lines{"Fatal error: x\n"});
    EXPECT_EQ(format(Port_MsgMan::MsgTypeFatal, "x", 80, true), Lines{"x\n"});
    EXPECT_EQ(format(Port_MsgMan::MsgTypeError, "four", 9), (Lines{"Error:\n", "four\n"}));
}

TEST(MsgFormat, WrapsBetweenWordsAndCutsLongOnes) {
    EXPECT_EQ(wrap("aaa bbb ccc", 7), (Lines{"aaa bbb\n", "ccc\n"}));
    EXPECT_EQ(wrap("aaa bbb  ccc", 8), (Lines{"aaa bbb\n", "ccc\n"}));
    EXPECT_EQ(wrap("aaa bbbbbbbbbb cc", 4), (Lines{"aaa\n", "bbbb\n", "bbbb\n", "bb\n", "cc\n"}));
    EXPECT_EQ(wrap("aaa bbb", 0), Lines{"aaa bbb\n"});
    EXPECT_EQ(wrap("aaa bbb", -1), Lines{"aaa bbb\n"});
    EXPECT_EQ(wrap("ab", 1), (Lines{"a\n", "b\n"}));
    EXPECT_EQ(wrap("a\tb", 8), (Lines{"a\n", "b\n"})) << "a tab reaches to column 8";
    EXPECT_EQ(wrap("a\tb", 9), Lines{"a\tb\n"});
}

TEST(MsgFormat, IndentsContinuationsLikeTheirFirstLine) {
    EXPECT_EQ(wrap("  aaa bbb ccc", 9), (Lines{"  aaa bbb\n", "  ccc\n"}));
    EXPECT_EQ(wrap("      aaa bbb", 10), (Lines{"      aaa\n", "bbb\n"})) << "wide indentation is not repeated";
    EXPECT_EQ(wrap("    ", 2), Lines{"    \n"});
}

TEST(MsgFormat, CountsEastAsianCharactersAsTwoColumns) {
    EXPECT_EQ(wrap("図面を開く", 4), (Lines{"図面\n", "を開\n", "く\n"}));
    EXPECT_EQ(wrap("図面を開く", 5), (Lines{"図面\n", "を開\n", "く\n"}));
    EXPECT_EQ(wrap("図面。", 4), (Lines{"図\n", "面。\n"})) << "a full stop does not begin a line";
    EXPECT_EQ(wrap("a図面", 3), (Lines{"a図\n", "面\n"}));
    EXPECT_EQ(wrap("e\u0301e\u0301e\u0301", 2), (Lines{"e\u0301e\u0301\n", "e\u0301\n"})) << "marks take no column";
    EXPECT_EQ(wrap("図か\u3099xx", 5), (Lines{"図\n", "か\u3099xx\n"})) << "a mark stays with its character";
}

TEST(MsgFormat, KeepsBrokenBytes) {
    const std::string broken = "a\xFF\xC3 \xED\xA0\x80 \xF0\x9F\x98";
    EXPECT_EQ(wrap(broken, 80), Lines{broken + "\n"});
}

TEST(MsgFormat, LosesNothingWhateverTheWidth) {
    const std::string text = "Drawing  \"図面 1\" has 3 layers,\tsome-very-long-name.brd and   blanks";
    std::string dense = text;
    std::erase_if(dense, [](char c) { return c == ' ' || c == '\t'; });
    for (int width = 1; width < 70; ++width) {
        std::string joined;
        for (const std::string& line : wrap(text, width)) {
            joined += line;
        }
        std::erase_if(joined, [](char c) { return c == ' ' || c == '\t' || c == '\n'; });
        EXPECT_EQ(joined, dense) << width;
    }
}

TEST(MsgFormat, LongTextsTakeLinearWork) {
    const std::wstring word(1 << 20, L'x');
    EXPECT_EQ(Port::detail::wrapText(word, 64).size(), word.size() / 64);
    EXPECT_EQ(Port::detail::wrapText(word, 1 << 19).size(), 2u);
}

TEST(MsgDispatcher, LastRegisteredManagerGetsTheMessageAlone) {
    Collector outer;
    {
        Collector inner;
        origin().issueStatus("to %s", "inner");
        EXPECT_EQ(inner.texts(), Lines{"to inner"});
    }
    origin().issueStatus("to outer");
    EXPECT_EQ(outer.texts(), Lines{"to outer"}) << "a destroyed manager is registered no more";
}

TEST(MsgDispatcher, RegisteringAgainMovesToTheFront) {
    Collector first;
    Collector second;
    Port_MsgDispatcher::addMsgMan(&first);
    Port_MsgDispatcher::addMsgMan(nullptr);
    origin().issueStatus("1");
    Port_MsgDispatcher::removeMsgMan(&first);
    origin().issueStatus("2");
    EXPECT_EQ(first.texts(), Lines{"1"});
    EXPECT_EQ(second.texts(), Lines{"2"});
    Port_MsgDispatcher::removeMsgMan(nullptr);
}

TEST(MsgDispatcher, PassesOverDisabledAndBusyManagers) {
    Collector outer;
    Reacting reacting([] { origin().issueError("from inside"); });
    Port_MsgDispatcher::addMsgMan(&reacting);
    origin().issueStatus("outside");
    EXPECT_TRUE(reacting.getEnabled());
    reacting.setEnabled(false);
    EXPECT_FALSE(reacting.getEnabled());
    origin().issueStatus("past");
    EXPECT_EQ(outer.texts(), (Lines{"from inside", "past"}));
    EXPECT_EQ(reacting.getMsgCount(Port_MsgMan::MsgTypeStatus), 1);
}

TEST(MsgDispatcher, AManagerThatThrowsStaysUsable) {
    int calls = 0;
    Reacting reacting([&] {
        ++calls;
        throw Port::Exception("no");
    });
    Port_MsgDispatcher::addMsgMan(&reacting);
    EXPECT_THROW(origin().issueStatus("1"), Port::Exception);
    EXPECT_THROW(origin().issueStatus("2"), Port::Exception);
    EXPECT_EQ(calls, 2);
}

TEST(MsgDispatcher, WithoutManagersWritesToTheStandardStreams) {
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    origin().issueStatus("status");
    origin().issueInfo("info\n");
    origin().issueWarning("warning");
    origin().issueError("error");
    origin().issueFatal(3, "fatal");
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "status\nInfo: info\n");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "Warning: warning\nError: error\nFatal error: fatal\n");
}

TEST(MsgMan, KeepsACopyOfItsName) {
    std::string name = "console";
    const Port_MsgManDefault named(name.c_str());
    name.clear();
    EXPECT_STREQ(named.getName(), "console");
    EXPECT_STREQ(Port_MsgManDefault().getName(), "");
}

TEST(MsgMan, ErrorClassIsFourToSix) {
    Collector collector;
    origin().issueError("e");
    origin().issueInternal("i");
    origin().issueFatal(2, "f");
    ASSERT_EQ(collector.messages.size(), 3u);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(collector.messages[i].type, 4 + i);
    }
    EXPECT_EQ(collector.getErrorCount(), 3);
    collector.resetMsgCounts();
    EXPECT_EQ(collector.getErrorCount(), 0);
}

TEST(MsgMan, FatalMessagesAskForTheEnd) {
    Collector collector;
    origin().issueError("e");
    EXPECT_EQ(collector.getAbort(), 0);
    origin().issueFatal(7, "f");
    EXPECT_EQ(collector.getAbort(), 7);
    origin().issueFatal(0, "f");
    EXPECT_EQ(collector.getAbort(), 1);
    collector.setAbort(0);
    EXPECT_EQ(collector.getAbort(), 0);
}

TEST(MsgMan, MessagesAreSwitchedByTheirOrigin) {
    using Switch = Port_MsgMan::MsgSwitch;
    Collector collector;
    collector.setMsgSwitch("Module", "Source", 5, Switch::Off);
    origin(5).issueError("line off");
    origin(6).issueError("other line");
    collector.setMsgSwitch("Module", nullptr, 0, Switch::Off);
    collector.setMsgSwitch("Module", "Other", 0, Switch::On);
    origin(6).issueError("module off");
    origin(6, "Other").issueError("source on");
    origin(5).issueFatal(1, "always");
    collector.setMsgSwitch("Module", nullptr, 0, Switch::On);
    origin(5).issueError("module on");
    EXPECT_EQ(collector.texts(), (Lines{"other line", "source on", "always", "module on"}));
    EXPECT_EQ(collector.getMsgCount(Port_MsgMan::MsgTypeError), 3);
}

TEST(MsgManData, FormatsInTheCLocaleAndKeepsBrokenBytes) {
    Collector collector;
    const std::string before = std::setlocale(LC_ALL, nullptr);
    std::setlocale(LC_ALL, "");
    origin().issueStatus("%.1f %s", 1.5, "\xFFx");
    std::setlocale(LC_ALL, before.c_str());
    EXPECT_EQ(collector.texts(), Lines{"1.5 \xFFx"});
}

TEST(Exception, ReportsItselfAsAnError) {
    Collector collector;
    try {
        throw Port::Exception("100 % broken");
    } catch (const Port::Exception& exception) {
        exception.report();
    }
    ASSERT_EQ(collector.messages.size(), 1u);
    EXPECT_EQ(collector.messages[0].type, Port_MsgMan::MsgTypeError);
    EXPECT_EQ(collector.messages[0].text, "100 % broken");
}

} // namespace
