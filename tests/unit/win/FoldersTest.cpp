#include "platform/win/Background.h"
#include "platform/win/Error.h"
#include "platform/win/FindFile.h"
#include "platform/win/FolderNames.h"
#include "platform/win/Handle.h"
#include "tests/unit/base/FileTestFolder.h"
#include "tests/unit/win/HangingFolder.h"

#include <cstdlib>
#include <set>
#include <stdexcept>
#include <unistd.h>
#include <vector>

namespace {

namespace fs = std::filesystem;
using tvx::HiddenFolders;
using tvx::readFolders;

using Names = std::vector<std::string>;

constexpr DWORD isFolder = FILE_ATTRIBUTE_DIRECTORY;
constexpr DWORD longEnough = 10000;

class Folders : public FileTestFolder {
protected:
    using Found = std::set<std::pair<std::string, DWORD>>;

    static Found found(const std::string& pattern) {
        Found all;
        WIN32_FIND_DATAA entry;
        const HANDLE find = FindFirstFile(pattern.c_str(), &entry);
        if (find == INVALID_HANDLE_VALUE) {
            return all;
        }
        do {
            all.emplace(entry.cFileName, entry.dwFileAttributes);
        } while (FindNextFile(find, &entry));
        EXPECT_EQ(GetLastError(), ERROR_NO_MORE_FILES);
        EXPECT_TRUE(FindClose(find));
        EXPECT_FALSE(FindNextFileA(find, &entry) || FindClose(find));
        EXPECT_EQ(GetLastError(), ERROR_INVALID_HANDLE);
        return all;
    }
    static DWORD notFound(const std::string& pattern) {
        WIN32_FIND_DATAA entry;
        EXPECT_EQ(FindFirstFileA(pattern.c_str(), &entry), INVALID_HANDLE_VALUE);
        return GetLastError();
    }
    std::vector<std::string> names(HiddenFolders hidden = HiddenFolders::LeaveOut) const {
        return readFolders(drive(""), hidden).names;
    }
};

} // namespace

TEST_F(Folders, EntriesAreFoundByPatternWithTheirKind) {
    put("Plan/house.brd");
    put(".hidden/x");
    put("plan.old");
    fs::create_directory_symlink("Plan", "link");
    const std::pair file("plan.old", FILE_ATTRIBUTE_NORMAL);
    EXPECT_EQ(found(drive("*")), (Found{{".", isFolder},
                                        {"..", isFolder},
                                        {"Plan", isFolder},
                                        {"link", isFolder},
                                        {".hidden", isFolder | FILE_ATTRIBUTE_HIDDEN},
                                        file}));
    EXPECT_EQ(found(drive("*.*")), found("*"));
    EXPECT_EQ(found(drive("PL?N*")), (Found{{"Plan", isFolder}, file}));
    EXPECT_EQ(found(drive("plan\\*use.b?d")), (Found{{"house.brd", FILE_ATTRIBUTE_NORMAL}}));
    EXPECT_EQ(found(m_folder + "/*a*l*d"), (Found{file}));
    EXPECT_EQ(notFound(drive("*.dwg")), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(notFound(drive("none\\*")), ERROR_PATH_NOT_FOUND);
    EXPECT_EQ(notFound(drive("plan.old\\*")), ERROR_PATH_NOT_FOUND);
    EXPECT_EQ(notFound("Q:\\*"), ERROR_PATH_NOT_FOUND);
    EXPECT_EQ(notFound(drive("")), ERROR_FILE_NOT_FOUND);
}

TEST_F(Folders, FoldersAreMadeWhereThereIsNone) {
    EXPECT_TRUE(CreateDirectory(drive("new").c_str(), nullptr));
    EXPECT_TRUE(fs::is_directory("new"));
    EXPECT_FALSE(CreateDirectoryA(drive("new").c_str(), nullptr));
    EXPECT_EQ(GetLastError(), ERROR_ALREADY_EXISTS);
    EXPECT_FALSE(CreateDirectoryA(drive("none\\new").c_str(), nullptr));
    EXPECT_EQ(GetLastError(), ERROR_PATH_NOT_FOUND);
    EXPECT_FALSE(CreateDirectoryA("Q:\\new", nullptr));
    EXPECT_EQ(GetLastError(), ERROR_PATH_NOT_FOUND);
}

TEST_F(Folders, NamesKeepTheirBytesAndComeInOrder) {
    for (const char* name : {"beta", "Alpha", "alpha", "\xC3\x84rger", "\xFF\xFE", "line\nend", ".dot", "_"}) {
        fs::create_directory(name);
    }
    put("file");
    EXPECT_EQ(names(), (Names{"_", "Alpha", "alpha", "beta", "line\nend", "\xC3\x84rger", "\xFF\xFE"}));
    EXPECT_EQ(names(HiddenFolders::Include).front(), ".dot");
    EXPECT_EQ(readFolders(drive("none"), HiddenFolders::Include).error, ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(readFolders("Q:\\", HiddenFolders::Include).error, ERROR_PATH_NOT_FOUND);
    if (::geteuid() != 0) {
        fs::permissions("beta", fs::perms::none);
        EXPECT_EQ(readFolders(drive("beta"), HiddenFolders::Include).error, ERROR_ACCESS_DENIED);
        fs::permissions("beta", fs::perms::owner_all);
    }
}

TEST_F(Folders, LinksAreFoldersWhenTheyLeadToOne) {
    put("folder/x");
    put("file");
    fs::create_symlink("folder", "to-folder");
    fs::create_symlink("to-folder", "to-link");
    fs::create_symlink("file", "to-file");
    fs::create_symlink("none", "dangling");
    fs::create_symlink("round", "round");
    fs::create_symlink("..", "folder/up");
    EXPECT_EQ(names(), (Names{"folder", "to-folder", "to-link"}));
    EXPECT_EQ(readFolders(drive("folder\\up\\folder\\up\\folder"), HiddenFolders::LeaveOut).names, (Names{"up"}));
}

/// What lies there is no folder: who asked would have found out.
TEST_F(Folders, LinksToNetworkFoldersAreNotFollowed) {
    put("mounted");
    put("share/file");
    fs::create_symlink(m_folder + "/mounted/plans", "far");
    fs::create_symlink("far", "far-too");
    fs::create_symlink("../mounted/plans", "share/relative");
    fs::create_symlink("file", "share/near");
    EXPECT_EQ(names(), (Names{"share"}));
    const std::string drives = "C=/;X=" + m_folder + "/mounted|\\\\srv\\plans;Y=" + m_folder + "/share|\\\\srv\\share";
    ::setenv("TVX_DRIVES", drives.c_str(), 1);
    EXPECT_EQ(names(), (Names{"far", "far-too", "share"}));
    EXPECT_EQ(readFolders("Y:", HiddenFolders::LeaveOut).names, (Names{"relative"}));
    ::unsetenv("TVX_DRIVES");
}

TEST_F(Folders, QuestionsAreAskedWithoutWaiting) {
    fs::create_directory("dead");
    HangingFolder dead(m_folder + "/dead");
    const auto ask = [name = drive("dead")] { return readFolders(name, HiddenFolders::LeaveOut); };
    tvx::Question<tvx::FolderNames> left(ask); // ends unanswered
    left = {};
    EXPECT_FALSE(left || left.isAnswered());
    const tvx::Question<tvx::FolderNames> question(ask);
    EXPECT_TRUE(question);
    EXPECT_FALSE(question.isAnswered(1));
    EXPECT_EQ(WaitForSingleObject(question.handle(), 0), WAIT_TIMEOUT);
    EXPECT_EQ(names(), (Names{"dead"})); // others are answered meanwhile
    fs::create_directory("dead/late");
    dead.answer();
    EXPECT_EQ(WaitForSingleObject(question.handle(), longEnough), WAIT_OBJECT_0);
    EXPECT_TRUE(question.isAnswered());
    EXPECT_EQ(question.answer().names, (Names{"late"}));
    const tvx::Question<int> failing([]() -> int { throw std::runtime_error("no answer"); });
    EXPECT_TRUE(failing.isAnswered(longEnough));
    EXPECT_EQ(failing.answer(), 0);
}
