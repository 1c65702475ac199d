#include "platform/port/CmdFile.h"

#include "Collector.h"
#include "platform/port/detail/CommandFile.h"

#include <cstring>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;
using Words = std::vector<std::string>;
using Port::detail::splitCommandText;

Words split(std::string_view text) {
    const auto read = splitCommandText(text);
    EXPECT_TRUE(read.unclosedLines.empty());
    return read.words;
}

TEST(CommandText, SplitsAtWhiteSpaceAndAnyLineEnd) {
    EXPECT_EQ(split("-a b\tc\n-d\re\r\nf\v\fg"), (Words{"-a", "b", "c", "-d", "e", "f", "g"}));
    EXPECT_EQ(split(" \r\n\t"), Words{});
    EXPECT_EQ(split("\xEF\xBB\xBF-a"), Words{"-a"});
}

TEST(CommandText, QuotedStretchesKeepWhiteSpace) {
    EXPECT_EQ(split(R"("my drawing.brd" 'a "b" c' x"y z"'w v' "" C:\a\b)"),
              (Words{"my drawing.brd", R"(a "b" c)", "xy zw v", "", R"(C:\a\b)"}));
}

TEST(CommandText, CommentsBeginAWordOnly) {
    EXPECT_EQ(split("# all of it\n-a # rest\nb#c '#d' \"e\"#f\r# \"x\rg"), (Words{"-a", "b#c", "#d", "e#f", "g"}));
}

TEST(CommandText, AnOpenQuoteEndsWithItsLine) {
    const auto read = splitCommandText("-a \"b c\r\n\n'd e\nf 'g");
    EXPECT_EQ(read.words, (Words{"-a", "b c", "d e", "f", "g"}));
    EXPECT_EQ(read.unclosedLines, (std::vector<std::size_t>{1, 3, 4}));
}

class CmdFile : public testing::Test {
protected:
    CmdFile() : m_folder(fs::temp_directory_path() / ("tvx-cmdfile-" + std::to_string(::getpid()))) {
        fs::create_directories(m_folder);
    }
    ~CmdFile() override {
        fs::remove_all(m_folder);
    }

    std::string path(const std::string& name) const {
        return m_folder / name;
    }
    std::string write(const std::string& name, std::string_view text) const {
        std::ofstream(path(name), std::ios::binary) << text;
        return path(name);
    }

    /// Expands a file as the callers do: every "-f name" inside makes another object while the outer one lives.
    static void expandInto(Words& words, const std::string& name) {
        const char* vector[] = {"exe", "-f", name.c_str()};
        const UT_CMDFILE file(3, vector);
        for (int i = 1; i < file.getargc(); ++i) {
            if (std::strcmp(file.getargv()[i], "-f") == 0 && i + 1 < file.getargc()) {
                expandInto(words, file.getargv()[++i]);
            } else {
                words.emplace_back(file.getargv()[i]);
            }
        }
    }
    static Words expand(const std::string& name) {
        Words words;
        expandInto(words, name);
        return words;
    }

    std::string onlyError() const {
        if (m_messages.messages.size() != 1 || m_messages.messages[0].type != Port_MsgMan::MsgTypeError) {
            return std::to_string(m_messages.messages.size()) + " messages";
        }
        return m_messages.messages[0].text;
    }

    Collector m_messages;

private:
    fs::path m_folder;
};

TEST_F(CmdFile, GivesPlaceholderAndWords) {
    const std::string name = write("a", "-scale 2\n");
    const char* vector[] = {"exe", "-f", name.c_str()};
    const UT_CMDFILE file(3, vector);
    ASSERT_EQ(file.getargc(), 3);
    EXPECT_STREQ(file.getargv()[0], "exe");
    EXPECT_STREQ(file.getargv()[1], "-scale");
    EXPECT_STREQ(file.getargv()[2], "2");
    EXPECT_EQ(file.getargv()[3], nullptr);
    EXPECT_FALSE(file.iserror());
}

TEST_F(CmdFile, ReplacesThePairInPlace) {
    const std::string name = write("a", "x y");
    const char* vector[] = {"-f", "first", "/F", name.c_str(), "last", "-f"};
    const UT_CMDFILE file(6, vector);
    EXPECT_EQ(Words(file.getargv(), file.getargv() + file.getargc()), (Words{"-f", "first", "x", "y", "last", "-f"}));

    const UT_CMDFILE none(0, nullptr);
    EXPECT_EQ(none.getargc(), 0);
    EXPECT_EQ(none.getargv()[0], nullptr);
}

TEST_F(CmdFile, NestsAndRepeats) {
    const std::string inner = write("inner", "i");
    const std::string outer = write("outer", "a -f '" + inner + "' b -f '" + inner + "'");
    EXPECT_EQ(expand(outer), (Words{"a", "i", "b", "i"})) << "one file twice in a row is no cycle";
    EXPECT_EQ(expand(outer).size(), 4u) << "nor a second time";
    EXPECT_TRUE(m_messages.messages.empty());
}

TEST_F(CmdFile, RefusesCyclesWhateverTheName) {
    const std::string a = path("a");
    const std::string b = path("b");
    fs::create_symlink("a", path("alias"));
    write("a", "1 -f " + b + " 4");
    write("b", "2 -f " + path("alias") + " 3");
    EXPECT_EQ(expand(a), (Words{"1", "2", "3", "4"}));
    EXPECT_EQ(onlyError(), "Command file \"" + path("alias") + "\" is being expanded already: " + a + " -> " + b +
                               " -> " + path("alias") + ".");
}

TEST_F(CmdFile, RefusesNestingWithoutBound) {
    for (int i = 0; i < 100; ++i) {
        write(std::to_string(i), "x -f " + path(std::to_string(i + 1)));
    }
    EXPECT_EQ(expand(path("0")).size(), 64u);
    EXPECT_NE(onlyError().find("is nested too deep"), std::string::npos);
}

TEST_F(CmdFile, NamesWhatCannotBeRead) {
    EXPECT_EQ(expand(path("missing")), Words{});
    EXPECT_EQ(onlyError(), "Command file \"" + path("missing") + "\" cannot be read: No such file or directory.");

    m_messages.messages.clear();
    const std::string outer = write("outer", "-f " + path("missing") + " x");
    EXPECT_EQ(expand(outer), Words{"x"});
    EXPECT_NE(onlyError().find("(named in " + outer + ")"), std::string::npos);

    m_messages.messages.clear();
    fs::create_directory(path("folder"));
    EXPECT_EQ(expand(path("folder")), Words{});
    EXPECT_NE(onlyError().find("Is a directory"), std::string::npos);

    m_messages.messages.clear();
    EXPECT_EQ(expand(write("wide", {"-\0a\0", 4})), Words{});
    EXPECT_NE(onlyError().find("zero bytes"), std::string::npos);
}

TEST_F(CmdFile, RefusesPipesAndDevicesAtOnce) {
    ASSERT_EQ(::mkfifo(path("pipe").c_str(), 0600), 0); // nobody writes to it
    for (const std::string& name : {path("pipe"), std::string("/dev/zero"), std::string("/dev/null")}) {
        m_messages.messages.clear();
        EXPECT_EQ(expand(name), Words{});
        EXPECT_NE(onlyError().find("it is a pipe or a device"), std::string::npos) << name;
    }
    m_messages.messages.clear();
    const std::string large = write("large", "");
    fs::resize_file(large, (64u << 20) + 1);
    EXPECT_EQ(expand(large), Words{});
    EXPECT_NE(onlyError().find("larger than 64 MB"), std::string::npos);
}

TEST_F(CmdFile, ReportsOpenQuotesAndKeepsTheWord) {
    const std::string name = write("a", "x\n\"y z\n");
    EXPECT_EQ(expand(name), (Words{"x", "y z"}));
    EXPECT_EQ(onlyError(), "Command file \"" + name + "\", line 2: a quote is not closed.");
}

TEST_F(CmdFile, SilentObjectsOnlyAnswer) {
    const char* vector[] = {"exe", "-f", "/nowhere/at/all"};
    const UT_CMDFILE file(3, vector, UT_CMDFILE::Reporting::Silent);
    EXPECT_TRUE(file.iserror());
    ASSERT_EQ(file.geterrors().size(), 1u);
    EXPECT_NE(file.geterrors()[0].find("/nowhere/at/all"), std::string::npos);
    EXPECT_EQ(file.getargc(), 1);
    EXPECT_TRUE(m_messages.messages.empty());
}

TEST_F(CmdFile, TakesManyArgumentsAndLongLines) {
    std::string text;
    for (int i = 0; i < 100'000; ++i) {
        text += "word" + std::to_string(i) + ' ';
    }
    text += '"' + std::string(1 << 20, 'x') + '"';
    const Words words = expand(write("many", text));
    ASSERT_EQ(words.size(), 100'001u);
    EXPECT_EQ(words[99'999], "word99999");
    EXPECT_EQ(words.back().size(), 1u << 20);
}

} // namespace
