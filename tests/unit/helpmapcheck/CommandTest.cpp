#include "tools/helpmapcheck/Command.h"

#include "tests/unit/SavedEnvironment.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>
#include <string>
#include <vector>

using helpmap::Outcome;

namespace {

namespace fs = std::filesystem;

/// An installation that has the folders of American English and German, and whose package "p" is checked.
class HelpMapCheck : public testing::Test {
protected:
    HelpMapCheck() {
        make("doc/usenglish/a.htm", "<a name=start>A</a>");
        make("doc/german/a.htm", "<h1 id=start>A</h1><h2 id=mehr>");
        make("doc/usenglish/b.pdf", "");
        ::setenv("TARVEX", m_root.c_str(), 1);
        ::unsetenv("MYTARVEX");
    }
    void make(const std::string& name, const std::string& text) {
        fs::create_directories(fs::path(m_root + "/" + name).parent_path());
        std::ofstream(m_root + "/" + name, std::ios::binary) << text;
    }
    Outcome run(const std::vector<std::string>& words) {
        std::ostringstream out;
        std::ostringstream errors;
        const Outcome outcome = helpmap::run(words, out, errors);
        m_out = out.str();
        m_errors = errors.str();
        return outcome;
    }
    /// What is found in a map, without the folder of maps.
    std::string found(const std::string& map) {
        make("share/helpmap/p.map", map);
        const Outcome outcome = run({"p"});
        EXPECT_EQ(outcome, m_out.empty() ? Outcome::Clean : Outcome::Findings);
        EXPECT_EQ(m_errors, "");
        const std::string folder = m_root + "/share/helpmap/";
        for (std::size_t at = m_out.find(folder); at != std::string::npos; at = m_out.find(folder)) {
            m_out.erase(at, folder.size());
        }
        return m_out;
    }

    const SavedEnvironment m_environment;
    const std::string m_root = testing::TempDir() + testing::UnitTest::GetInstance()->current_test_info()->name();
    std::string m_out;
    std::string m_errors;
};

TEST_F(HelpMapCheck, FindsWhatIsWrongInAMap) {
    make("share/helpmap/q.map", "#include p\n\n[topic 2]\nfile=a.htm\n");
    make("share/helpmap/beside.htm", "");
    const struct {
        const char* map;
        const char* findings;
        const char* why;
    } cases[] = {
        {"; a comment\n[topic 1]\r\nfile=a.htm#start\r\n\r\n[topic contents]\nfile=beside.htm\n[own key]\ntype = "
         "url\nfile="
         "https://x/\n[topic topic_not_found]\nfile=a.htm\n[topic 4294967295]\nfile=a.htm\n[topic 3d view]\nfile=a.htm",
         "", "a clean map"},
        {"file=a.htm\n[k]\nfile=a.htm\nFile=b\n=x\n[l]\nfile=a.htm\ntype=x\ntype=y\n",
         "p.map:1: line: it belongs to no section: \"file=a.htm\"\n"
         "p.map:4: line: it means nothing: \"File=b\"\np.map:5: line: it means nothing: \"=x\"\n"
         "p.map:9: line: the type was \"x\" before\n",
         "lines"},
        {"[topic 007]\nfile=a.htm\n[topic 4294967296]\nfile=a.htm\n[topic 0x10064]\nfile=a.htm\n[topic 0]\nfile=a.htm\n"
         "[]\nfile=a.htm\n[topic 126976]\nfile=a.htm\n[topic 130817]\nfile=a.htm\n",
         "p.map:1: unreachable: \"topic 007\": context numbers are written without zeros before them\n"
         "p.map:3: unreachable: \"topic 4294967296\": the highest context number is 4294967295\n"
         "p.map:5: unreachable: \"topic 0x10064\": context numbers are written in decimal digits\n"
         "p.map:7: unreachable: \"topic 0\": the context 0 is \"topic contents\"\n"
         "p.map:9: unreachable: a header without words\n"
         "p.map:11: unreachable: \"topic 126976\": menus of windows and their lists ask for 126720\n"
         "p.map:13: unreachable: \"topic 130817\": menus of windows and their lists ask for 126751\n",
         "keys that no request asks for"},
        {"#include q\r[topic 1]\rfile=a.htm\r[topic  1]\rnonsense\r[topic 2]\rfile=x\r",
         "p.map:4: duplicate: \"topic 1\" is ignored, the first is at p.map:2\n"
         "p.map:6: duplicate: \"topic 2\" is ignored, the first is at q.map:3\n"
         "q.map:1: cycle: p.map is being read already\n",
         "sections that are there already, in lines that end with CR"},
        {"#\n[k]\n# q\nfile=a.htm\n# a long remark\n#include q\n",
         "p.map:1: include: no file is named\n"
         "p.map:5: include: \"a long remark.map\" is not installed (a comment begins with \";\")\n"
         "q.map:1: cycle: p.map is being read already\n",
         "includes"},
        {"[k]\n[l]\nfile=a.htm\ntitle=A\ntitle=B\n[m]\nfile=a.htm\nfile=a.htm#start\nfile=a.htm\ntitle=A\n",
         "p.map:1: empty: \"k\" has no document\np.map:5: title: there is no document for this title\n"
         "p.map:8: title: \"a.htm#start\" has no title and cannot be chosen\n"
         "p.map:9: title: \"a.htm\" has no title and cannot be chosen\n",
         "documents and titles that do not match"},
        {"[k]\nfile=b.pdf#page=9\nfile=none.htm\ntitle=\ntitle=B\ntitle=N\n[l]\ntype=URL\nfile=none.htm\n",
         "p.map:2: untranslated: b.pdf is not in german\n"
         "p.map:3: missing: none.htm is not installed, it will be looked for on the web\n"
         "p.map:4: line: it means nothing: \"title=\"\n",
         "documents that are not there"},
        {"[prefix helpurl]\nfile=https://x\n",
         "p.map:1: prefix: the type of a web location is \"url\"\np.map:2: prefix: a web location ends in \"/\"\n",
         "a web location"},
    };
    for (const auto& each : cases) {
        EXPECT_EQ(found(each.map), each.findings) << each.why;
    }
    make("doc/german/g.htm", "");
    EXPECT_EQ(found("[k]\nfile=g.htm\n"), "p.map:2: missing: g.htm is not in usenglish\n");
    EXPECT_EQ(found("[k]\nfile=a.htm#mehr\n[l]\nfile=A.HTM#mehr\n[m]\nfile=a.htm#\n"),
              "p.map:2: anchor: " + m_root + "/doc/usenglish/a.htm has no \"mehr\"\n" + //
                  "p.map:4: anchor: " + m_root + "/doc/usenglish/A.HTM has no \"mehr\"\n");
}

TEST_F(HelpMapCheck, TakesPackagesFilesAndRoots) {
    make("share/helpmap/p.map", "[k]\nfile=c.htm\n");
    make("other/doc/usenglish/c.htm", "");
    make("other/mine.map", "[k]\n");
    const std::string other = m_root + "/other";
    EXPECT_EQ(run({"p"}), Outcome::Findings);
    EXPECT_EQ(run({"--root", m_root, "--root", other, "p"}), Outcome::Findings) << m_out;
    EXPECT_EQ(m_out, m_root + "/share/helpmap/p.map:2: untranslated: c.htm is not in german\n");
    EXPECT_EQ(run({"--root", other, m_root + "/share/helpmap/p.map"}), Outcome::Clean) << m_out;
    EXPECT_EQ(run({"--root", other, "p"}), Outcome::Failed);
    EXPECT_EQ(m_errors, "helpmapcheck: p: there is no map of this package\n");
    EXPECT_EQ(run({"--", other + "/none.map", other + "/mine.map"}), Outcome::Failed);
    EXPECT_EQ(m_errors, "helpmapcheck: " + other + "/none.map: it cannot be read\n");
    EXPECT_EQ(m_out, other + "/mine.map:1: empty: \"k\" has no document\n") << "the others are checked all the same";
}

TEST_F(HelpMapCheck, SaysHowItIsUsed) {
    EXPECT_EQ(run({"--help"}), Outcome::Clean);
    EXPECT_TRUE(m_out.starts_with("Usage: helpmapcheck"));
    EXPECT_EQ(run({"--version"}), Outcome::Clean);
    EXPECT_TRUE(m_out.starts_with("helpmapcheck "));
    for (const std::vector<std::string>& words :
         {std::vector<std::string>{}, {"--root"}, {"--root", m_root}, {"-x", "p"}, {"--help", "p"}}) {
        EXPECT_EQ(run(words), Outcome::Failed);
        EXPECT_TRUE(m_errors.ends_with(". See helpmapcheck --help.\n")) << m_errors;
    }
}

} // namespace
