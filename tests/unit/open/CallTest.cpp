#include "tools/open/Call.h"

#include <gtest/gtest.h>

#include <array>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <sys/stat.h>
#include <sys/wait.h>

namespace fs = std::filesystem;

namespace {

std::vector<std::string> words(const std::string& text) {
    std::vector<std::string> found;
    std::size_t at = 0;
    for (std::size_t end = 0; end != std::string::npos; at = end + 1) {
        end = text.find(' ', at);
        found.push_back(text.substr(at, end - at));
    }
    return found;
}

/// The words that a call becomes, joined with "|". "@" in a document stands for the folder.
class Opening : public testing::Test {
protected:
    void SetUp() override {
        fs::create_directories(folder);
        setenv("XDG_RUNTIME_DIR", folder.c_str(), 1);
        for (const char* name : {"a.pdf", "a b.pdf", "d#page=2.pdf", "e.pdf#page=7", "50%25.pdf", "Größe.PDF",
                                 "x y.htm", "c#.htm", "C# Docs.htm"}) {
            std::ofstream(folder / name) << "x";
        }
    }
    void TearDown() override {
        fs::remove_all(folder);
    }

    std::string placed(std::string text) const {
        for (std::size_t at = text.find("@/"); at != std::string::npos; at = text.find("@/", at)) {
            text.replace(at, 1, folder.string());
        }
        return text;
    }

    std::string opened(const std::string& command, const std::string& document,
                       opening::Takes takes = opening::Takes::AddressesAndNames) const {
        std::string joined;
        for (const std::string& word : opening::wordsFor({takes, words(command)}, placed(document))) {
            joined += (joined.empty() ? "" : "|") + word;
        }
        return joined;
    }

    const fs::path folder = fs::canonical(fs::temp_directory_path()) / "opening";
};

TEST_F(Opening, TellsViewersThePlaceTheirWay) {
    const struct {
        std::string command;
        std::string document;
        std::string words;
    } rows[] = {
        {"evince", "@/a.pdf", "evince|@/a.pdf"},
        {"evince", "@/a.pdf#page=12", "evince|--page-index=12|@/a.pdf"},
        {"/usr/bin/evince {} -w", "file://@/a%20b.pdf#zoom=50&page=3", "/usr/bin/evince|--page-index=3|@/a b.pdf|-w"},
        {"evince", "@/a.pdf#nameddest=chapter.2", "evince|--named-dest=chapter.2|@/a.pdf"},
        {"evince", "@/a.pdf#chapter", "evince|--named-dest=chapter|@/a.pdf"},
        {"evince", "@/a.pdf#page=x;y", "evince|@/a.pdf"},
        {"atril", "@/a.pdf#chapter", "atril|@/a.pdf"},
        {"xreader", "@/a.pdf#page=1", "xreader|--page-index=1|@/a.pdf"},
        {"okular", "@/a b.pdf#page=2", "okular|--page|2|@/a b.pdf"},
        {"okular", "@/a b.pdf#nameddest=x", "okular|file://@/a%20b.pdf#x"},
        {"zathura", "@/a.pdf#page=2", "zathura|--page=2|@/a.pdf"},
        {"mupdf {} -C", "@/a.pdf#page=2", "mupdf|@/a.pdf|2|-C"},
        {"xpdf", "@/a.pdf#dest", "xpdf|@/a.pdf|+dest"},
        {"qpdfview --unique", "@/a.pdf#page=2", "qpdfview|--unique|@/a.pdf#2"},
        {"firefox -p", "@/a b.pdf#page=2", "firefox|-p|file://@/a%20b.pdf#page=2"},
        {"firefox", "@/a b.pdf", "firefox|@/a b.pdf"},
        {"env A=b evince", "@/a.pdf#page=2", "env|A=b|evince|--page-index=2|@/a.pdf"},
        {"viewer", "@/a.pdf#page=2", "viewer|@/a.pdf"},
        {"viewer --in={}", "@/a.pdf#page=2", "viewer|--in=@/a.pdf"},
        {"flatpak run --branch=x org.gnome.Evince @@u {} @@", "@/a b.pdf#page=2",
         "flatpak|run|--branch=x|org.gnome.Evince|--page-index=2|@@u|file://@/a%20b.pdf|@@"},
        {"flatpak run org.kde.okular @@u {} @@", "@/a.pdf#dest",
         "flatpak|run|org.kde.okular|@@u|file://@/a.pdf#dest|@@"},
        {"flatpak run org.x.qpdfview @@u {} @@", "@/a.pdf#page=2", "flatpak|run|org.x.qpdfview|@@u|file://@/a.pdf|@@"},
        {"flatpak run org.mozilla.firefox @@ {} @@", "@/a.pdf", "flatpak|run|org.mozilla.firefox|@@|@/a.pdf|@@"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(opened(row.command, row.document), placed(row.words)) << row.command << " " << row.document;
    }
}

TEST_F(Opening, KnowsNamesFromPlaces) {
    const struct {
        std::string document;
        std::string words;
    } rows[] = {
        {"@/d#page=2.pdf", "evince|@/d#page=2.pdf"},
        {"@/e.pdf#page=7", "evince|@/e.pdf#page=7"},
        {"file://@/d%23page=2.pdf#page=3", "evince|--page-index=3|@/d#page=2.pdf"},
        {"@/d#page=2.pdf#page=3", "evince|--page-index=3|@/d#page=2.pdf"},
        {"@/50%25.pdf#page=3", "evince|--page-index=3|@/50%25.pdf"},
        {"file://@/50%25.pdf", "evince|@/50%25.pdf"},
        {"file://@/50%2525.pdf", "evince|@/50%25.pdf"},
        {"file://localhost@/Gr%C3%B6%C3%9Fe.PDF#page=1", "evince|--page-index=1|@/Größe.PDF"},
        {"FILE:@/Größe.PDF", "evince|@/Größe.PDF"},
        {"@/missing.pdf#page=4", "evince|--page-index=4|@/missing.pdf"},
        {"file://@/x%20y.htm#s1", "evince|file://@/x%20y.htm#s1"},
        {"@/x y.htm#s 1", "evince|file://@/x%20y.htm#s%201"},
        {"@/c#.htm", "evince|@/c#.htm"},
        {"file://@/C# Docs.htm?q=1#s", "evince|file://@/C%23%20Docs.htm?q=1#s"},
        {"https://www.example.org/a.pdf#page=2", "evince|https://www.example.org/a.pdf#page=2"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(opened("evince", row.document), placed(row.words)) << row.document;
    }
    const fs::path before = fs::current_path();
    fs::current_path(folder);
    EXPECT_EQ(opened("firefox", "a b.pdf#page=2"), placed("firefox|file://@/a%20b.pdf#page=2"));
    fs::current_path(before);
}

TEST_F(Opening, LeadsProgramsThatTakeNamesOnlyToThePlace) {
    const auto names = opening::Takes::Names;
    EXPECT_EQ(opened("viewer -f", "file://@/x%20y.htm", names), placed("viewer|-f|@/x y.htm"));
    EXPECT_THROW((void)opened("viewer", "https://www.example.org", names), opening::Failure);

    const fs::path own = folder / "tvxopen";
    fs::create_directories(own);
    fs::permissions(own, fs::perms::owner_all);
    std::ofstream(own / "old.html") << "x";
    std::ofstream(own / "new.html") << "x";
    fs::last_write_time(own / "old.html", fs::file_time_type::clock::now() - std::chrono::hours(30));
    const std::string call = opened("viewer", R"(file://@/x%20y.htm?a=1&b#se"c<t>)", names);
    const fs::path page = call.substr(call.find('|') + 1);
    EXPECT_EQ(page.parent_path(), own);
    EXPECT_EQ(page.extension(), ".html");
    struct stat status{};
    ASSERT_EQ(stat(page.c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777, 0600u);
    std::ifstream stream(page);
    const std::string text(std::istreambuf_iterator<char>(stream), {});
    EXPECT_NE(text.find(placed("url=file://@/x%20y.htm?a=1&#38;b#se%22c%3Ct%3E\"")), std::string::npos) << text;
    EXPECT_FALSE(fs::exists(own / "old.html"));
    EXPECT_TRUE(fs::exists(own / "new.html"));

    fs::permissions(own, fs::perms::others_read, fs::perm_options::add);
    EXPECT_THROW((void)opened("viewer", "@/x y.htm#s", names), opening::Failure) << "a folder that others see into";
}

struct Ended {
    std::string output;
    int code = 0;
};

Ended run(const std::string& arguments) {
    Ended ended;
    FILE* pipe = popen((TVX_TEST_OPEN " " + arguments + " 2>&1").c_str(), "r");
    std::array<char, 512> buffer{};
    while (pipe && fgets(buffer.data(), buffer.size(), pipe)) {
        ended.output += buffer.data();
    }
    ended.code = WEXITSTATUS(pclose(pipe));
    return ended;
}

TEST_F(Opening, BecomesTheProgram) {
    EXPECT_EQ(run("sh -c 'echo $0 $PPID; exit 7' a.pdf").code, 7);
    EXPECT_EQ(run("printf '[%s]' 'a b' '{}{7B}x' 'c d'").output, "[a b][c d{x]");
    EXPECT_EQ(run("-- printf %s x").output, "x");
    EXPECT_EQ(run("--names printf https://x.example").code, 1);
    EXPECT_EQ(run("--frob printf x").code, 2);
    EXPECT_EQ(run("printf").code, 2);
    EXPECT_EQ(run("/nowhere/program x").code, 127);
    EXPECT_EQ(run("/etc x").code, 126);
    EXPECT_EQ(run("--version").output.substr(0, 8), "tvxopen ");
    EXPECT_EQ(run("--help").code, 0);
}

} // namespace
