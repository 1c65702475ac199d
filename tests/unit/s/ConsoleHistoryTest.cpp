// What a console remembers: numbers, recall expressions, walking and searching.
#include "s/ConsoleHistory.h"
#include "res/resource.h"
#include "s/ConsoleRecall.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

// The counter is the process's, so numbers in here count from the history's first one.
class ConsoleHistory : public testing::Test {
protected:
    void add(std::initializer_list<const char*> commands) {
        for (const char* command : commands) {
            m_history.AddCommand(command);
        }
    }
    /// The input with "@" for the number before the first one.
    std::string numbered(const std::string& input) const {
        const std::size_t mark = input.find('@');
        if (mark == std::string::npos) {
            return input;
        }
        const std::size_t end = input.find_first_not_of("0123456789", mark + 1);
        const unsigned long number = std::stoul(input.substr(mark + 1)) + m_before;
        return input.substr(0, mark) + std::to_string(number) + (end == std::string::npos ? "" : input.substr(end));
    }
    std::string resolved(const std::string& input) const {
        const auto result = m_history.Resolve(input.c_str());
        return result.runs ? "run " + std::string(result.command.GetString()) : std::to_string(result.message);
    }

    const unsigned long m_before = NextCommandNumber() - 1;
    Gui_ConsoleHistory m_history;
};

TEST_F(ConsoleHistory, NumbersCommandsAndKeepsStatusLinesApart) {
    m_history.AddStatusLine("ready");
    add({"open a"});
    m_history.AddStatusLine("");
    add({"run b"});
    EXPECT_EQ(m_before + 3, NextCommandNumber());
    ASSERT_EQ(2, m_history.GetCommands().GetSize());
    ASSERT_EQ(4, m_history.GetLines().GetSize());
    EXPECT_EQ(m_history.GetCommands().LineAt(1), m_history.GetLines().LineAt(3));
    EXPECT_EQ(m_before + 2, m_history.GetCommands().LineAt(1)->m_number);
    EXPECT_FALSE(m_history.GetLines().LineAt(2)->IsCommand());
}

TEST_F(ConsoleHistory, SaysWhatIsWrongWithARecallBeforeAnyCommand) {
    EXPECT_EQ("0", resolved("!!"));
    EXPECT_EQ(std::to_string(GUI_IDS_RECALL_NUMBER_RANGE), resolved("!1"));
    EXPECT_EQ(std::to_string(GUI_IDS_RECALL_NO_MATCH), resolved("!x"));
    m_history.AddStatusLine("x");
    EXPECT_EQ(std::to_string(GUI_IDS_RECALL_NO_MATCH), resolved("!x"));
}

TEST_F(ConsoleHistory, ResolvesRecallExpressions) {
    add({"open a", "run b"});
    const std::string oneNumber = std::to_string(GUI_IDS_RECALL_ONE_NUMBER);
    const std::string range = std::to_string(GUI_IDS_RECALL_NUMBER_RANGE);
    const std::string place = std::to_string(GUI_IDS_RECALL_PATTERN_PLACE);
    const std::string noMatch = std::to_string(GUI_IDS_RECALL_NO_MATCH);
    const struct {
        const char* input;
        std::string result;
    } cases[] = {
        {"save !1", "run save !1"},
        {"", "run "},
        {"!!", "run run b"},
        {"!@1", "run open a"},
        {"!@2", "run run b"},
        {"!@2 ", "run run b"},
        {"!0", range},
        {"!@3", range},
        {"!99999999999999999999999", range},
        {"!@1x", oneNumber},
        {"!@1 x", oneNumber},
        {"!@1 2", oneNumber},
        {"!@1-", oneNumber},
        {"!", place},
        {"! run", place},
        {"!#x", place},
        {"!!x", place},
        {"!\xC3", place},
        {"!RUN", "run run b"},
        {"!ru", "run run b"},
        {"!o", "run open a"},
        {"!run bee", noMatch},
        {"!r*", noMatch},
        {"!open  a", noMatch},
    };
    for (const auto& test : cases) {
        EXPECT_EQ(test.result, resolved(numbered(test.input))) << test.input;
    }
}

TEST_F(ConsoleHistory, FindsTheNewestCommandWithABeginning) {
    add({"run a", "ÄNDERN 1", "rundown", "Run c", "run a*", "äpfel", "abcdefgh long one", "ABCDEFGH long two"});
    EXPECT_EQ("run run a*", resolved("!run"));
    EXPECT_EQ("run run a*", resolved("!r"));
    EXPECT_EQ("run Run c", resolved("!run c"));
    EXPECT_EQ("run rundown", resolved("!rund"));
    EXPECT_EQ("run ÄNDERN 1", resolved("!änd"));
    EXPECT_EQ("run äpfel", resolved("!Ä"));
    EXPECT_EQ("run abcdefgh long one", resolved("!abcdefgh long o"));
    EXPECT_EQ("run ABCDEFGH long two", resolved("!abcdefgh long"));
}

TEST_F(ConsoleHistory, GoesOnBeyondSixteenBits) {
    for (int i = 0; i < 65600; ++i) {
        m_history.AddCommand(i == 65540 ? "needle" : "command");
    }
    EXPECT_EQ(m_before + 65601, NextCommandNumber());
    EXPECT_TRUE(m_history.GetCommands().LineAt(65599)->IsCommand());
    EXPECT_EQ("run needle", resolved(numbered("!@65541")));
    EXPECT_EQ("run needle", resolved("!need"));
}

class ConsoleRecall : public ConsoleHistory {
protected:
    /// What Up (u), Down (d) or leaving (l) leave in the field; "-" where nothing moves.
    std::string walk(const std::string& keys) {
        std::string seen;
        for (const char key : keys) {
            if (key == 'l') {
                m_recall.Leave();
                continue;
            }
            const bool moved = key == 'u' ? m_recall.Older(m_field) : m_recall.Newer(m_field);
            seen += (moved ? std::string(m_field.GetString()) : "-") + "|";
        }
        return seen;
    }

    CString m_field;
    Gui_ConsoleRecall m_recall{m_history};
};

TEST_F(ConsoleRecall, WalksBackAndForthAndComesBackToTheUnfinishedText) {
    EXPECT_EQ("-|-|", walk("ud"));
    add({"a", "b", "b", "c"});
    m_field = "half";
    EXPECT_EQ("c|b|a|-|b|c|half|-|", walk("uuuudddd"));
    // A text that was changed in between is gone from the walk only, not from the history.
    EXPECT_EQ("c|b|", walk("uu"));
    m_field = "b2";
    EXPECT_EQ("a|b|", walk("ud"));
    m_field = "c";
    EXPECT_EQ("b|", walk("lu"));
    EXPECT_EQ("c|c|", walk("dd"));
}

TEST_F(ConsoleRecall, BeginsWithTheTextsOfEarlierStarts) {
    add({"now"});
    m_recall.SetEarlier({"old", "older way"});
    EXPECT_EQ("now|older way|old|-|", walk("uuuu"));
}

TEST_F(ConsoleRecall, SearchesInBothDirections) {
    add({"draw line", "list", "Draw Ellipse", "save"});
    m_recall.SetEarlier({"redraw"});
    int place = m_recall.GetNewest();
    CString text = "kept";
    EXPECT_FALSE(m_recall.Search("", place, -1, text));
    EXPECT_FALSE(m_recall.Search("nothing", place, -1, text));
    EXPECT_STREQ("kept", text);
    EXPECT_TRUE(m_recall.Search("DRAW", place, -1, text));
    EXPECT_STREQ("Draw Ellipse", text);
    std::string found;
    while (m_recall.Search("draw", --place, -1, text)) {
        found += std::string(text.GetString()) + "|";
    }
    EXPECT_EQ("draw line|redraw|", found);
    place = 1;
    EXPECT_TRUE(m_recall.Search("li", ++place, 1, text));
    EXPECT_STREQ("list", text);
}

} // namespace
