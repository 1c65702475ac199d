#include "platform/base/SystemPath.h"

#include "tests/unit/base/FileTestFolder.h"

using tvx::PathUse;
using tvx::systemPath;

using SystemPath = FileTestFolder;

TEST_F(SystemPath, MapsEveryFormOfAName) {
    put("sub/a.txt");
    EXPECT_EQ(m_folder + "/sub/a.txt", systemPath(drive("sub\\a.txt")));
    EXPECT_EQ(m_folder + "/sub/a.txt", systemPath(drive("sub\\a.txt").substr(2)));
    EXPECT_EQ("sub/a.txt", systemPath("sub\\a.txt"));
    EXPECT_EQ(m_folder + "/sub/a.txt", systemPath(m_folder + "/sub/a.txt"));
    EXPECT_EQ("sub/a.txt", systemPath("c:sub/a.txt"));
    EXPECT_EQ("/", systemPath("C:\\"));
    EXPECT_EQ("/", systemPath("C:"));
    EXPECT_EQ("/no/such/file", systemPath("\\no\\such\\file"));
    EXPECT_EQ("//no/such", systemPath("//no/such"));
}

TEST_F(SystemPath, TakesAnExistingNameAsItIsWritten) {
    put("odd\\name");
    put("C:");
    put("odd/name");
    EXPECT_EQ("odd\\name", systemPath("odd\\name"));
    EXPECT_EQ("C:", systemPath("C:"));
}

TEST_F(SystemPath, LooksForMissingPartsWithoutCase) {
    put("Sub Folder/Été/a.TXT");
    EXPECT_EQ("Sub Folder/Été/a.TXT", systemPath("SUB FOLDER\\ÉTÉ\\A.txt"));
    EXPECT_EQ("./Sub Folder//Été/", systemPath("./sub folder//été/"));
    EXPECT_EQ("Sub Folder/Été/missing/x", systemPath("sub folder\\été\\missing\\x"));
    // The exact spelling wins over the others; of those, the first in byte order.
    put("Sub Folder/Été/A.txt");
    EXPECT_EQ("Sub Folder/Été/a.TXT", systemPath("Sub Folder/Été/a.TXT"));
    EXPECT_EQ("Sub Folder/Été/A.txt", systemPath("Sub Folder/Été/a.txt"));
}

TEST_F(SystemPath, NewFilesDoNotFallOnOtherSpellings) {
    put("Sub/README");
    EXPECT_EQ("Sub/README", systemPath("sub\\readme"));
    EXPECT_EQ("Sub/readme", systemPath("sub\\readme", PathUse::creating));
    EXPECT_EQ("Sub/README", systemPath("sub\\README", PathUse::creating));
}

TEST_F(SystemPath, AsksTheDriveTableForRoots) {
    EXPECT_EQ(std::nullopt, systemPath("D:\\a"));
    EXPECT_EQ(std::nullopt, systemPath("\\\\server\\share\\a"));
    static std::string asked;
    tvx::setRootResolver([](std::string_view root) -> std::optional<std::string> {
        asked = root;
        return "/mnt";
    });
    EXPECT_EQ("/mnt/a", systemPath("D:\\a"));
    EXPECT_EQ("D:", asked);
    EXPECT_EQ("/mnt/a", systemPath("D:a"));
    EXPECT_EQ("/mnt", systemPath("D:"));
    EXPECT_EQ("/mnt/a/b", systemPath("\\\\server\\share\\a\\b"));
    EXPECT_EQ("\\\\server\\share", asked);
    EXPECT_EQ("/mnt", systemPath("\\\\server"));
    tvx::setRootResolver(nullptr);
}

TEST_F(SystemPath, RefusesNamesThatCannotBe) {
    EXPECT_EQ(std::nullopt, systemPath(""));
    EXPECT_EQ(std::nullopt, systemPath(std::string_view("a\0b", 3)));
}
