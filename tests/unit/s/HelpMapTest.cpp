// Help maps and documents on disk, below roots of the test's own.
#include "s/HelpMap.h"

#include "tests/unit/SavedEnvironment.h"
#include "tests/unit/port/Collector.h"

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace {

namespace fs = std::filesystem;
using Texts = std::vector<std::string>;
using namespace std::string_literals;

/// What a look-up gives.
struct Answer {
    Texts files;
    Texts titles;
    std::string type;

    friend bool operator==(const Answer&, const Answer&) = default;
};

void PrintTo(const Answer& answer, std::ostream* out) {
    *out << testing::PrintToString(answer.files) << ", " << testing::PrintToString(answer.titles) << ", "
         << answer.type;
}

/// A shared installation, `m_root`, and a personal one, `m_mine`, for an American user.
class HelpMap : public testing::Test {
protected:
    HelpMap() {
        ::setenv("MYTARVEX", m_mine.c_str(), 1);
        ::setenv("TARVEX", m_root.c_str(), 1);
        ::setenv("LC_ALL", "C", 1);
        ::unsetenv("TVX_GUI_HELP_ALWAYS_TO_WEB");
        ::setenv("TVX_GUI_HELP_WEB_LOCATION", "https://web/", 1);
    }

    static std::string make(const std::string& path, const std::string& text = {}) {
        fs::create_directories(fs::path(path).parent_path());
        std::ofstream(path, std::ios::binary) << text;
        return path;
    }
    std::string makeMap(const std::string& name, const std::string& text) const {
        return make(m_root + "/share/helpmap/" + name, text);
    }
    bool read(const std::string& text) {
        return m_map.Read(makeMap("test.map", text));
    }

    using Strings = Gui_HelpMap::Strings;
    static Answer answer(const Strings& files, const Strings& titles, const Port::StringBase<char>& type) {
        Answer result;
        for (const auto& file : files) {
            result.files.push_back(file.str());
        }
        for (const auto& title : titles) {
            result.titles.push_back(title.str());
        }
        result.type = type.str();
        return result;
    }
    Answer at(Gui_HelpMap::Position position) const {
        Strings files;
        Strings titles;
        Port::StringBase<char> type;
        m_map.Resolve(position, files, titles, type);
        return answer(files, titles, type);
    }
    Answer key(const std::string& key) const {
        Strings files{"old"};
        Strings titles{"old"};
        Port::StringBase<char> type = "old";
        m_map.LookupKey(key, files, titles, type);
        return answer(files, titles, type);
    }
    Answer index(const std::string& keyword) const {
        Strings files{"old"};
        Strings titles{"old"};
        Port::StringBase<char> type = "old";
        m_map.LookupIndex(keyword, files, titles, type);
        return answer(files, titles, type);
    }
    std::string context(unsigned int id) const {
        Port::StringBase<char> type = "old";
        const std::string file = m_map.LookupContext(id, type).str();
        return type.IsEmpty() ? file : file + " " + type.str();
    }
    std::string located(const std::string& name) const {
        return m_map.LocateDocument(name).str();
    }

    const SavedEnvironment m_environment;
    const std::string m_folder = testing::TempDir() + testing::UnitTest::GetInstance()->current_test_info()->name();
    const std::string m_root = m_folder + "/tarvex";
    const std::string m_mine = m_folder + "/mine";
    Collector m_messages;
    Gui_HelpMap m_map;
};

/// What one record is made of, in records of type "url", whose files come out as they are.
TEST_F(HelpMap, TakesLinesApart) {
    const struct {
        std::string text;
        Answer answer;
        const char* why;
    } cases[] = {
        {"[k]\ntype=url\nfile=a\ntitle=A", {{"a"}, {"A"}, "url"}, "the last line needs no end"},
        {"\t[ k ]  \n  type = url more \n\tfile =  a b#c=d \t\n title =\tA = B \n",
         {{"a b#c=d"}, {"A = B"}, "url"},
         "blanks around, equals signs within"},
        {"file=no\n[k]\ntype=url\nfile=a\nfile=b\ntitle=B\n", {{"a", "b"}, {"B"}, "url"}, "what is before a header"},
        {"[k]\ntype=url\nfile=a\n[k]\nfile=b\ntype=x\n", {{"a"}, {}, "url"}, "the first of two sections"},
        {"[k]\ntype=url\nfile=a\n[ k]\nfile=b\n[l]\n[k]\nfile=c\n", {{"a"}, {}, "url"}, "another spelling of the key"},
        {"[k]\nfilename=a\ntitles==A\ntypes=url x\n", {{"a"}, {"=A"}, "url"}, "beginnings of words will do"},
        {"[k]\ntype a=url\nfile=a\n", {{"https://web/a"}, {}, "url"}, "the type is the second word"},
        {"[k]\ntype=url\nfile=\n=x\nfile\nfile =\nFile=b\n file\t= =\ntitle\n;file=c\n",
         {{"="}, {}, "url"},
         "lines that mean nothing"},
        {"[k]\r\ntype=url\r\nfile=a\r\n\r\ntitle=A\r\n", {{"a"}, {"A"}, "url"}, "CR LF"},
        {"[k]\rtype=url\rfile=a\r\rtitle=A", {{"a"}, {"A"}, "url"}, "CR"},
        {"\n[k]\r\ntype=url\rfile=a\n\rtitle=A\n\n", {{"a"}, {"A"}, "url"}, "all kinds of line ends"},
        {"\xEF\xBB\xBF[k]\ntype=url\nfile=\xC3\xA4\n", {{"\xC3\xA4"}, {}, "url"}, "a byte order mark"},
        {"\0\xFF[x]\n[k]\nty\0pe=x\ntype=url\nfile=a\0b\xFF\n\xFE[=\n"s,
         {{std::string("a\0b\xFF", 4)}, {}, "url"},
         "bytes that are no text"},
        {"[k]\ntype=url\nfile=a\ntype=\ntype =\n", {{"a"}, {}, "url"}, "an empty type is no line"},
        {"", {}, "nothing at all"},
    };
    for (const auto& each : cases) {
        Gui_HelpMap map;
        ASSERT_TRUE(map.Read(makeMap("lines.map", each.text)));
        Strings files;
        Strings titles;
        Port::StringBase<char> type;
        map.LookupKey("k", files, titles, type);
        EXPECT_EQ(answer(files, titles, type), each.answer) << each.why;
    }
    EXPECT_EQ(m_messages.texts(), Texts());
}

TEST_F(HelpMap, JoinsTheWordsOfKeys) {
    ASSERT_TRUE(read("[ topic   7 ]\n[index\tCopy[all] Ctrl]\n[a] b [c\n[]\n"));
    const auto end = Gui_HelpMap::End();
    EXPECT_NE(m_map.Find("topic", "7"), end);
    EXPECT_EQ(m_map.Find("", " topic \t 7 "), m_map.Find("topic 7", ""));
    EXPECT_EQ(m_map.Find("topic", "7"), m_map.Find(" topic", "7"));
    EXPECT_NE(m_map.Find("topic", "7"), m_map.Find("index", "Copy all Ctrl"));
    EXPECT_NE(m_map.Find("a", "b c"), end);
    EXPECT_NE(m_map.Find("", ""), end) << "a header without words is the empty key";
    EXPECT_EQ(m_map.Find("topic  7", ""), end) << "the first part is taken as it is";
    EXPECT_EQ(m_map.Find("Topic", "7"), end) << "letter case counts";
    EXPECT_EQ(m_map.Find("topic", "07"), end);
    EXPECT_EQ(m_map.Find("topic", ""), end);
    EXPECT_EQ(Gui_HelpMap().Find("topic", "7"), end);
    Strings files{"old"};
    Strings titles;
    Port::StringBase<char> type;
    m_map.Resolve(end, files, titles, type);
    EXPECT_EQ(files, Strings{"old"});
}

TEST_F(HelpMap, FallsBackFromKeyToKey) {
    const std::string url = "type=url\nfile=";
    ASSERT_TRUE(read("[topic_not_found]\n" + url + "last\n[dialog topic_not_found]\n" + url + "dialog\n[index Cut]\n" +
                     url + "cut\n[Find]\n" + url + "find\n[topic 7]\n" + url + "seven\n" + url +
                     "more\n[topic 4294967295]\n" + url + "highest\n[topic contents]\n" + url + "contents\n[empty]\n"));
    EXPECT_EQ(key("topic 7"), (Answer{{"seven", "more"}, {}, "url"}));
    EXPECT_EQ(key("dialog 12"), (Answer{{"dialog"}, {}, "url"}));
    EXPECT_EQ(key("Dialog 12").files, Texts{"last"});
    EXPECT_EQ(key("").files, Texts{"last"});
    EXPECT_EQ(key("empty"), Answer()) << "a record without files is one";
    EXPECT_EQ(index("Cut").files, Texts{"cut"});
    EXPECT_EQ(index("Find").files, Texts{"find"}) << "the keyword alone";
    EXPECT_EQ(index("Paste").files, Texts{"last"});
    EXPECT_EQ(context(7), "seven url") << "the first document only";
    EXPECT_EQ(context(8), "last url");
    EXPECT_EQ(context(0), "contents url");
    EXPECT_EQ(context(4294967295U), "highest url");
    Port::StringBase<char> type;
    EXPECT_EQ(m_map.GetContents(type).str(), "contents");

    ASSERT_TRUE(m_map.Read(makeMap("more.map", "[index topic_not_found]\n" + url + "index\n[topic topic_not_found]\n" +
                                                   url + "topic\n[topic 7]\n" + url + "other\n")));
    EXPECT_EQ(index("Paste").files, Texts{"index"}) << "a second file adds to the first";
    EXPECT_EQ(context(8), "topic url");
    EXPECT_EQ(context(7), "seven url") << "and replaces nothing";

    const Gui_HelpMap empty;
    Strings files{"old"};
    Strings titles{"old"};
    type = "old";
    empty.LookupKey("topic 7", files, titles, type);
    EXPECT_EQ(answer(files, titles, type), Answer());
    type = "old";
    EXPECT_TRUE(empty.LookupContext(7, type).IsEmpty());
    EXPECT_TRUE(type.IsEmpty());
}

TEST_F(HelpMap, IncludesEachFileOnce) {
    const std::string url = "type=url\nfile=";
    makeMap("a.map", "[a]\n" + url + "a\n#include test\n#include b\nfile=more\n[c]\n" + url + "wrong\n");
    makeMap("b.map", "#\tself b.map\n[b]\n" + url + "b\n# note\n# words that name no file\n");
    makeMap("c.txt", "[c]\n" + url + "c\n");
    make(m_root + "/share/helpmap/folder.map/x");
    ASSERT_TRUE(read("[test]\n" + url + "1\n #include c.txt\n# a\n#include a\n# folder\nfile=2\n[a]\n" + url + "late"));
    EXPECT_EQ(key("test").files, (Texts{"1", "2"})) << "a section goes on behind an include";
    EXPECT_EQ(key("a").files, (Texts{"a", "more"}));
    EXPECT_EQ(key("b").files, Texts{"b"});
    EXPECT_EQ(key("c").files, Texts{"c"});
    EXPECT_EQ(m_messages.texts(), Texts()) << "what is not installed is no mistake";
    EXPECT_TRUE(m_map.IsLoaded(m_root + "/share/helpmap/test.map"));
    EXPECT_FALSE(m_map.IsLoaded(m_root + "/share/helpmap/b.map"));
}

TEST_F(HelpMap, SaysWhatIsWrongWithFilesAndIncludes) {
    const std::string none = m_root + "/none.map";
    EXPECT_FALSE(m_map.Read(none));
    EXPECT_FALSE(m_map.IsLoaded(none));
    EXPECT_TRUE(m_map.IsLoaded(""));
    ASSERT_TRUE(read("#include \t\n[k]\ntype=url\n#\nfile=a\n#" + std::string(5000, 'x')));
    EXPECT_EQ(key("k").files, Texts{"a"});
    EXPECT_EQ(m_messages.texts(),
              (Texts{"Cannot read file " + none + " . Please check the installation\n",
                     "include statement #include does not have space\n", "include statement # does not have space\n",
                     "include statement #" + std::string(2046, 'x') + " does not have space\n"}));
    EXPECT_EQ(m_messages.messages[0].type, Port_MsgMan::MsgTypeError);
    EXPECT_EQ(m_messages.messages[1].type, Port_MsgMan::MsgTypeInternal);
}

TEST_F(HelpMap, TellsOnceOfAFileThatIsNoText) {
    std::string map = "#first\x01\n#text\n[k]\ntype=url\nfile=a\n";
    for (int i = 0; i < 100; ++i) {
        map += "#junk\x02\n";
    }
    ASSERT_TRUE(read(map));
    EXPECT_EQ(key("k").files, Texts{"a"});
    EXPECT_EQ(m_messages.texts(), (Texts{"include statement #first\x01 does not have space\n",
                                         "include statement #text does not have space\n"}));
}

TEST_F(HelpMap, PassesOverNamesThatNoFileCanHave) {
    std::string name;
    for (int i = 0; i < 1000000; ++i) {
        name += "a/";
    }
    ASSERT_TRUE(read("# " + name + "\n[k]\nfile=" + name + "\n"));
    EXPECT_EQ(key("k").files, Texts{"https://web/" + name});
}

TEST_F(HelpMap, LocatesDocuments) {
    const std::string guide = make(m_root + "/doc/usenglish/guide.htm");
    const std::string beside = make(m_root + "/share/helpmap/beside.htm");
    make(m_root + "/doc/usenglish/folder/x");
    ASSERT_TRUE(read(""));
    EXPECT_EQ(located("guide.htm"), guide);
    EXPECT_EQ(located("guide.htm#a#b"), guide + "#b")
        << "the document ends at the first #, the place begins at the last";
    EXPECT_EQ(located("Guide.HTM#A"), guide + "#A") << "in the spelling that the file has";
    EXPECT_EQ(located("beside.htm#a"), beside + "#a");
    for (const char* none : {"none.htm", "folder", "", "#a"}) {
        EXPECT_EQ(located(none), "") << none;
    }
    ::setenv("LC_ALL", "de_DE.UTF-8", 1);
    EXPECT_EQ(located("guide.htm#sec2"), guide + "#sec2") << "American English where there is no German";
    make(m_mine + "/doc/usenglish/guide.htm");
    const std::string german = make(m_root + "/doc/german/guide.htm");
    EXPECT_EQ(located("guide.htm"), german) << "the language counts more than the root";
    const std::string mine = make(m_mine + "/doc/german/guide.htm");
    EXPECT_EQ(located("guide.htm"), mine);
    make(m_mine + "/doc/german/beside.htm");
    EXPECT_EQ(located("beside.htm"), m_mine + "/doc/german/beside.htm");
    ::unsetenv("MYTARVEX");
    ::setenv("TARVEX", (" C:" + m_root).c_str(), 1);
    EXPECT_EQ(located("guide.htm#a"), "C:" + german + "#a") << "a root keeps its form";
    ::setenv("TVX_GUI_HELP_ALWAYS_TO_WEB", "0", 1);
    EXPECT_EQ(located("guide.htm"), "");
}

TEST_F(HelpMap, ResolvesToFilesAndWebAddresses) {
    const std::string installed = make(m_root + "/doc/usenglish/a.htm");
    ASSERT_TRUE(read("[mixed]\ntype=acrobat\nfile=a.htm#x\nfile=none.pdf#page=2\ntitle=A\n[here]\ntype=acrobat\n"
                     "file=a.htm\n[web]\ntype=URL\nfile=a.htm\n[plain]\nfile=a.htm\ntitle=A\ntitle=B\n"));
    EXPECT_EQ(key("mixed"), (Answer{{installed + "#x", "https://web/none.pdf#page=2"}, {"A"}, "url"}));
    EXPECT_EQ(key("here"), (Answer{{installed}, {}, "acrobat"}));
    EXPECT_EQ(key("plain"), (Answer{{installed}, {"A", "B"}, ""}));
    EXPECT_EQ(key("web"), (Answer{{"a.htm"}, {}, "URL"}));
    ::setenv("TVX_GUI_HELP_ALWAYS_TO_WEB", "", 1);
    EXPECT_EQ(key("web"), (Answer{{"a.htm"}, {}, "URL"})) << "an address is an address";
    EXPECT_EQ(key("here"), (Answer{{"https://web/a.htm"}, {}, "url"}));
    EXPECT_EQ(at(m_map.Find("here", "")).type, "url");
}

TEST_F(HelpMap, AsksForTheWebLocationInOrder) {
    const std::string built = m_map.GetWebUrl("a.htm").str();
    EXPECT_EQ(built, "https://web/a.htm") << "the user's own";
    ::setenv("TVX_GUI_HELP_WEB_LOCATION", "", 1);
    EXPECT_TRUE(m_map.GetWebUrl("a.htm").str().ends_with("/docsan/tarvex10/a.htm")) << m_map.GetWebUrl("a.htm").c_str();
    EXPECT_EQ(m_messages.texts(), Texts()) << "an installation need not have its file";
    make(m_root + "/fileset.txt", "::docLocation=https://docs/\n");
    EXPECT_EQ(m_map.GetWebUrl("a.htm").str(), "https://docs/a.htm") << "the installation's";
    ASSERT_TRUE(m_map.Read(makeMap("empty.map", "[prefix topic_not_found]\nfile=no\n[topic_not_found]\nfile=no\n")));
    EXPECT_EQ(m_map.GetWebUrl("a.htm").str(), "https://docs/a.htm") << "no other record will do";
    ASSERT_TRUE(read("[prefix helpurl]\nfile = https://package/\n[topic 1]\nfile=a.htm\n"));
    EXPECT_EQ(m_map.GetWebUrl("a.htm").str(), "https://package/a.htm") << "the package's, whatever the record's type";
    EXPECT_EQ(context(1), "https://package/a.htm url");
}

} // namespace
