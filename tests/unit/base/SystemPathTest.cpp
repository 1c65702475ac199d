#include "platform/base/SystemPath.h"

#include "tests/unit/base/FileTestFolder.h"

using tvx::PathUse;
using tvx::systemPath;

namespace {

/// With the one drive that there always is, whatever is mounted on this machine.
class SystemPath : public FileTestFolder {
protected:
    SystemPath() : m_previous(tvx::setRootResolver(nullptr)) {}
    ~SystemPath() override {
        tvx::setRootResolver(m_previous);
    }

private:
    const tvx::RootResolver* m_previous;
};

} // namespace

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
    EXPECT_EQ("Sub/readme", systemPath("sub\\readme", PathUse::Creating));
    EXPECT_EQ("Sub/README", systemPath("sub\\README", PathUse::Creating));
}

namespace {

/// D: and \\server\share are one folder, everything else is C:.
class TwoDrives : public SystemPath {
protected:
    TwoDrives() {
        std::filesystem::create_directory("mount");
        folder = m_folder + "/mount";
        static constexpr tvx::RootResolver resolver{&folderOf, &driveOf};
        tvx::setRootResolver(&resolver);
    }

    static inline std::string folder;

private:
    static std::optional<std::string> folderOf(std::string_view root) {
        if (root == "C:") {
            return "/";
        }
        return root == "D:" || root == "\\\\server\\share" ? std::optional(folder) : std::nullopt;
    }
    static std::optional<tvx::DriveRoot> driveOf(std::string_view path) {
        if (path == folder || path.starts_with(folder + "/")) {
            return tvx::DriveRoot{"D:", folder};
        }
        return tvx::DriveRoot{"C:", "/"};
    }
};

} // namespace

TEST_F(TwoDrives, RootsAreFolders) {
    EXPECT_EQ(folder + "/a", systemPath("D:\\a"));
    EXPECT_EQ(folder, systemPath("D:"));
    EXPECT_EQ(folder + "/a/b", systemPath("\\\\server\\share\\a\\b"));
    EXPECT_EQ(folder, systemPath("\\\\server\\share"));
    EXPECT_EQ(std::nullopt, systemPath("E:\\a"));
    EXPECT_EQ(std::nullopt, systemPath("\\\\server\\other\\a"));
    EXPECT_EQ(std::nullopt, systemPath("\\\\server"));
}

TEST_F(TwoDrives, TheCurrentFolderIsOnOneOfThem) {
    put("mount/sub/a");
    EXPECT_EQ(folder + "/a", systemPath("D:a"));
    EXPECT_EQ("a", systemPath("C:a"));
    std::filesystem::current_path("mount/sub");
    EXPECT_EQ("a", systemPath("D:a"));
    EXPECT_EQ("/a", systemPath("C:a"));
    EXPECT_EQ(folder + "/sub/a", systemPath("\\sub\\a"));
    EXPECT_EQ("D:\\sub", tvx::currentFolderName());
}

TEST_F(TwoDrives, SystemNamesCompletedByTheWrongDriveAreFound) {
    put("mount/sub/a");
    put("other/a");
    const std::string rest = drive("other\\a").substr(2);
    EXPECT_EQ(folder + m_folder + "/other/a", systemPath("D:" + rest)) << "the current drive is C:";
    std::filesystem::current_path("mount");
    EXPECT_EQ(m_folder + "/other/a", systemPath("D:" + rest));
    EXPECT_EQ(m_folder + "/other/a", systemPath(rest));
    EXPECT_EQ(m_folder + "/other/new", systemPath(drive("other\\new").replace(0, 1, "D"), PathUse::Creating));
    EXPECT_EQ(folder + "/sub/new", systemPath("D:\\sub\\new", PathUse::Creating));
    EXPECT_EQ(folder + "/tmp", systemPath("D:\\tmp", PathUse::Creating)) << "the drive has that folder itself";
}

TEST_F(TwoDrives, RootedNamesAreNeverTakenAsTheyAreWritten) {
    put("D:\\a");
    put("\\a");
    EXPECT_EQ(folder + "/a", systemPath("D:\\a"));
    EXPECT_EQ("/a", systemPath("\\a"));
}

TEST_F(TwoDrives, NamesOfTheSystemGetTheirDrive) {
    EXPECT_EQ("D:\\a\\b", tvx::driveName(folder + "/a/b"));
    EXPECT_EQ("D:\\", tvx::driveName(folder));
    EXPECT_EQ("C:\\", tvx::driveName("/"));
    EXPECT_EQ("C:\\usr\\lib", tvx::driveName("/usr/lib"));
    EXPECT_EQ("a\\b", tvx::driveName("a/b"));
    EXPECT_EQ("/odd\\name", tvx::driveName("/odd\\name"));
    EXPECT_EQ("", tvx::driveName(""));
    EXPECT_EQ(folder + "/a/b", tvx::shownName("D:\\a\\b")) << "what the user sees has no drives";
    EXPECT_EQ("X:\\a", tvx::shownName("X:\\a")) << "nobody knows where that is";
}

TEST_F(SystemPath, RefusesNamesThatCannotBe) {
    EXPECT_EQ(std::nullopt, systemPath(""));
    EXPECT_EQ(std::nullopt, systemPath(std::string_view("a\0b", 3)));
}
