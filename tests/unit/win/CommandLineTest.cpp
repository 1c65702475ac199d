#include "platform/win/detail/CommandLine.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

using namespace tvx::win;
namespace fs = std::filesystem;
using Words = std::vector<std::string>;

TEST(CommandLine, SplitsByThePlatformsRules) {
    const struct {
        const char* line;
        Words words;
    } cases[] = {
        {"", {}},
        {" \t ", {}},
        {"a  b\tc ", {"a", "b", "c"}},
        {R"("a b" c)", {"a b", "c"}},
        {R"(a" b "c)", {"a b c"}},
        {R"("" x)", {"", "x"}},
        {R"(C:\a\b \\s\t)", {R"(C:\a\b)", R"(\\s\t)"}},
        {R"(a\"b)", {R"(a"b)"}},
        {R"(a\\"b c" d)", {R"(a\b c)", "d"}},
        {R"(a\\\"b c)", {R"(a\"b)", "c"}},
        {R"("C:\my files\\" x)", {R"(C:\my files\)", "x"}},
        {R"("a""b" c)", {R"(a"b)", "c"}},
        {R"("open end)", {"open end"}},
        {R"(tail\)", {R"(tail\)"}},
    };
    for (const auto& [line, words] : cases) {
        EXPECT_EQ(splitArguments(line), words) << line;
    }
}

TEST(CommandLine, FindsTheProgramsName) {
    const auto programs = [](std::string_view line) {
        Words names;
        for (const CommandLine& reading : readings(line)) {
            names.emplace_back(reading.program);
        }
        return names;
    };
    EXPECT_EQ(programs("  "), Words());
    EXPECT_EQ(programs("tool -a b"), Words{"tool"});
    EXPECT_EQ(programs(R"("my tool" -a)"), Words{"my tool"});
    EXPECT_EQ(programs(R"("my tool)"), Words{"my tool"});
    EXPECT_EQ(programs("\""), Words{""});
    EXPECT_EQ(programs("/opt/my tool -a"), (Words{"/opt/my", "/opt/my tool", "/opt/my tool -a"}));
    EXPECT_EQ(readings(R"(  "my tool"  -a b)").front().arguments, "  -a b");
    // Names that no file can have are not even thought of.
    EXPECT_LT(readings("/a" + std::string(100000, ' ') + "b c d").size(), 3u);
}

TEST(CommandLine, NamesReachTheChildInTheSystemsForm) {
    const fs::path folder = fs::temp_directory_path() / "Words";
    fs::create_directories(folder / "a b");
    std::ofstream(folder / "a b" / "x%20#1.htm") << "page";
    std::ofstream(folder / "a b" / "y.htm") << "page";
    const std::string name = folder.string();

    EXPECT_EQ(wordForChild("C:" + name + "\\a b\\y.htm"), name + "/a b/y.htm");
    EXPECT_EQ(wordForChild("c:" + name + "/A B/Y.HTM"), name + "/a b/y.htm");
    EXPECT_EQ(wordForChild("file:///C|" + name + "\\a b\\y.htm"), "file://" + name + "/a%20b/y.htm");
    EXPECT_EQ(wordForChild("file:///C:" + name + "/a%20b/y.htm#part 2"), "file://" + name + "/a%20b/y.htm#part 2");
    EXPECT_EQ(wordForChild("file:///C|" + name + "\\a b\\x%20#1.htm"), "file://" + name + "/a%20b/x%2520%231.htm");
    for (const char* kept : {"C:", "C:y.htm", "-o", "/opt/x", "a\\b", "\\\\d+\\w", "Q:\\x", "file:///opt/a b.htm",
                             "file:", "http://C|/x", "50%", ""}) {
        EXPECT_EQ(wordForChild(kept), kept);
    }
}
