#include "platform/win/Files.h"

#include "platform/base/File.h"
#include "platform/win/Drives.h"
#include "platform/win/Error.h"
#include "platform/win/Network.h"
#include "tests/unit/base/FileTestFolder.h"

#include <cerrno>
#include <cstdlib>
#include <memory>
#include <sys/stat.h>
#include <vector>

namespace {

/// C: is "/", D: a folder, E: a removable medium, F: a disc, X: a share.
class Files : public FileTestFolder {
protected:
    Files() {
        for (const char* folder : {"work", "stick", "disc", "data"}) {
            std::filesystem::create_directory(folder);
        }
        const std::string table = "C=/;D=" + m_folder + "/work;E=" + m_folder + "/stick|removable;F=" + m_folder +
                                  "/disc|cdrom;X=" + m_folder + "/data|\\\\Srv\\Data";
        ::setenv("TVX_DRIVES", table.c_str(), 1);
    }
    ~Files() override {
        ::unsetenv("TVX_DRIVES");
    }

    static std::string currentFolder(DWORD size = 1024) {
        std::vector<char> buffer(size);
        return GetCurrentDirectoryA(size, buffer.data()) < size ? buffer.data() : "";
    }
    static DWORD failing(DWORD attributes) {
        EXPECT_EQ(attributes, INVALID_FILE_ATTRIBUTES);
        return GetLastError();
    }
};

} // namespace

TEST_F(Files, DrivesAreOfTheirKind) {
    EXPECT_EQ(GetLogicalDrives(), 1u << 2 | 1u << 3 | 1u << 4 | 1u << 5 | 1u << 23);
    EXPECT_EQ(GetDriveTypeA("c:\\"), DRIVE_FIXED);
    EXPECT_EQ(GetDriveTypeA("E:\\"), DRIVE_REMOVABLE);
    EXPECT_EQ(GetDriveTypeA("F:"), DRIVE_CDROM);
    EXPECT_EQ(GetDriveTypeA("X:\\"), DRIVE_REMOTE);
    EXPECT_EQ(GetDriveTypeA("\\\\SRV\\data\\"), DRIVE_REMOTE);
    EXPECT_EQ(GetDriveTypeA("\\\\srv/data"), DRIVE_REMOTE);
    EXPECT_EQ(GetDriveTypeA(nullptr), DRIVE_FIXED);
    for (const char* name : {"G:\\", "\\\\srv\\other", "\\\\", "", "stick", "\\"}) {
        EXPECT_EQ(GetDriveTypeA(name), DRIVE_NO_ROOT_DIR) << name;
    }
}

TEST_F(Files, WithoutATableThereIsTheSystemsRoot) {
    ::unsetenv("TVX_DRIVES");
    EXPECT_EQ(GetDriveTypeA("C:\\"), DRIVE_FIXED);
    EXPECT_EQ(GetFileAttributesA("C:\\.") & FILE_ATTRIBUTE_DIRECTORY, FILE_ATTRIBUTE_DIRECTORY);
    EXPECT_EQ(_getdrive(), 3);
}

TEST_F(Files, TheCurrentFolderIsSeenThroughTheTable) {
    EXPECT_EQ(_getdrive(), 3);
    std::filesystem::create_directories("work/sub");
    std::filesystem::current_path("work/sub");
    EXPECT_EQ(_getdrive(), 4);
    EXPECT_EQ(currentFolder(), "D:\\sub");
    EXPECT_EQ(GetCurrentDirectoryA(0, nullptr), 7u);
    EXPECT_EQ(currentFolder(6), "");
    char buffer[7];
    EXPECT_STREQ(_getdcwd(4, buffer, 7), "D:\\sub");
    EXPECT_EQ(_getdcwd(4, buffer, 6), nullptr);
    EXPECT_EQ(errno, ERANGE);
    EXPECT_STREQ(_getdcwd(5, buffer, 7), "E:\\");
    for (const int none : {1, 27, -1}) {
        EXPECT_EQ(_getdcwd(none, buffer, 7), nullptr) << none;
    }
    const std::unique_ptr<char, void (*)(void*)> made(_getdcwd(0, nullptr, 0), &std::free);
    EXPECT_STREQ(made.get(), "D:\\sub");
    std::filesystem::current_path("..");
    EXPECT_EQ(currentFolder(), "D:\\");
}

TEST_F(Files, AFolderOnNoDriveKeepsTheSystemsName) {
    ::setenv("TVX_DRIVES", ("D=" + m_folder + "/work").c_str(), 1);
    EXPECT_EQ(_getdrive(), 0);
    EXPECT_EQ(currentFolder(), m_folder);
    EXPECT_EQ(_getdcwd(0, nullptr, 0), nullptr);
    EXPECT_EQ(tvx::fullName("a"), m_folder + "/a");
    std::filesystem::remove("work");
    std::filesystem::create_directory("gone");
    std::filesystem::current_path("gone");
    std::filesystem::remove("../gone");
    EXPECT_EQ(GetCurrentDirectoryA(0, nullptr), 0u);
    EXPECT_EQ(GetLastError(), ERROR_FILE_NOT_FOUND);
}

TEST_F(Files, AttributesTellWhatIsThere) {
    put("work/a.txt");
    put("work/.hidden");
    put("work/fixed");
    ::chmod("work/fixed", 0444);
    std::filesystem::create_symlink("work", "link");
    std::filesystem::create_symlink("nowhere", "dangling");
    EXPECT_EQ(GetFileAttributesA("D:\\A.TXT"), FILE_ATTRIBUTE_NORMAL);
    EXPECT_EQ(GetFileAttributesA("d:/.hidden"), FILE_ATTRIBUTE_HIDDEN);
    EXPECT_EQ(GetFileAttributesA("work\\fixed"), FILE_ATTRIBUTE_READONLY);
    EXPECT_EQ(GetFileAttributesA("\\\\srv\\data"), FILE_ATTRIBUTE_DIRECTORY);
    EXPECT_EQ(GetFileAttributesA("link"), FILE_ATTRIBUTE_DIRECTORY);
    EXPECT_EQ(failing(GetFileAttributesA("dangling")), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(failing(GetFileAttributesA("D:\\missing")), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(failing(GetFileAttributesA("D:\\a.txt\\below")), ERROR_PATH_NOT_FOUND);
    for (const char* name : {"Q:\\a", "\\\\none\\here", "", static_cast<const char*>(nullptr)}) {
        EXPECT_EQ(failing(GetFileAttributesA(name)), ERROR_PATH_NOT_FOUND);
    }
}

TEST_F(Files, AreCreatedAndKeptFromOthers) {
    put("work/old", "contents");
    const HANDLE first = CreateFileA("D:\\old", GENERIC_WRITE, 0, nullptr, OPEN_ALWAYS, 0, nullptr);
    ASSERT_NE(first, INVALID_HANDLE_VALUE);
    EXPECT_EQ(CreateFileA("D:\\old", GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS, 0, nullptr), INVALID_HANDLE_VALUE);
    EXPECT_EQ(GetLastError(), ERROR_SHARING_VIOLATION);
    EXPECT_EQ(get("work/old"), "contents") << "a file that is kept from others is not emptied by them";
    EXPECT_TRUE(CloseHandle(first));
    const HANDLE second = CreateFileA("D:\\old", GENERIC_WRITE, FILE_SHARE_READ, nullptr, CREATE_ALWAYS, 0, nullptr);
    EXPECT_TRUE(CloseHandle(second));
    EXPECT_EQ(get("work/old"), "");
    EXPECT_EQ(CreateFileA("D:\\old", GENERIC_WRITE, 0, nullptr, CREATE_NEW, 0, nullptr), INVALID_HANDLE_VALUE);
    EXPECT_EQ(GetLastError(), ERROR_FILE_EXISTS);
    EXPECT_EQ(CreateFileA("D:\\new", GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr), INVALID_HANDLE_VALUE);
    EXPECT_EQ(GetLastError(), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(CreateFileA("D:\\", GENERIC_READ, 0, nullptr, OPEN_EXISTING, 0, nullptr), INVALID_HANDLE_VALUE);
    EXPECT_EQ(GetLastError(), ERROR_ACCESS_DENIED);
    EXPECT_TRUE(DeleteFileA("D:\\OLD"));
    EXPECT_FALSE(DeleteFileA("D:\\"));
    EXPECT_EQ(GetLastError(), ERROR_ACCESS_DENIED);
    EXPECT_FALSE(DeleteFileA("Q:\\a"));
}

TEST_F(Files, CallsGoByTheirNamesWithoutALetterToo) {
    std::filesystem::current_path("work");
    const HANDLE file = CreateFile("D:\\new", GENERIC_WRITE, 0, nullptr, CREATE_NEW, 0, nullptr);
    ASSERT_NE(file, INVALID_HANDLE_VALUE);
    EXPECT_TRUE(CloseHandle(file));
    EXPECT_EQ(GetFileAttributes("new"), FILE_ATTRIBUTE_NORMAL);
    EXPECT_EQ(GetDriveType("E:"), GetDriveTypeA("E:"));
    char buffer[20];
    char* last = nullptr;
    EXPECT_EQ(GetCurrentDirectory(sizeof buffer, buffer), 3u);
    EXPECT_STREQ(buffer, "D:\\");
    EXPECT_EQ(GetFullPathName("new", sizeof buffer, buffer, &last), 6u);
    EXPECT_STREQ(buffer, "D:\\new");
    EXPECT_STREQ(last, "new");
    EXPECT_TRUE(DeleteFile("D:\\new"));
    EXPECT_FALSE(std::filesystem::exists("new"));
}

TEST_F(Files, FullNamesAreCompletedAndResolved) {
    std::filesystem::create_directory("work/sub");
    std::filesystem::current_path("work/sub");
    EXPECT_EQ(tvx::fullName("a"), "D:\\sub\\a");
    EXPECT_EQ(tvx::fullName("..\\a/./b\\\\c\\"), "D:\\a\\b\\c\\");
    EXPECT_EQ(tvx::fullName("..\\..\\..\\a"), "D:\\a");
    EXPECT_EQ(tvx::fullName("\\a"), "D:\\a");
    EXPECT_EQ(tvx::fullName("D:a"), "D:\\sub\\a");
    EXPECT_EQ(tvx::fullName("E:a"), "E:\\a");
    EXPECT_EQ(tvx::fullName("q:a"), "q:\\a");
    EXPECT_EQ(tvx::fullName("/usr/../a"), "C:\\a");
    EXPECT_EQ(tvx::fullName(m_folder + "/stick"), "E:\\");
    EXPECT_EQ(tvx::fullName("\\\\srv\\data\\..\\x"), "\\\\srv\\data\\x");
    EXPECT_EQ(tvx::fullName("\\\\srv\\data"), "\\\\srv\\data\\");
    EXPECT_EQ(tvx::fullName("C:\\"), "C:\\");
    put("odd\\name");
    EXPECT_EQ(tvx::fullName("odd\\name"), m_folder + "/work/sub/odd\\name");
    char buffer[20];
    char* last = nullptr;
    EXPECT_EQ(GetFullPathNameA("x.txt", sizeof(buffer), buffer, &last), 12u);
    EXPECT_STREQ(last, "x.txt");
    EXPECT_EQ(GetFullPathNameA("x\\", sizeof(buffer), buffer, &last), 9u);
    EXPECT_EQ(last, nullptr);
    EXPECT_EQ(GetFullPathNameA("x.txt", 12, buffer, nullptr), 13u);
    EXPECT_EQ(GetFullPathNameA("", sizeof(buffer), buffer, nullptr), 0u);
}

TEST_F(Files, ConnectionsAreEnumerated) {
    ::setenv("TVX_DRIVES", "C=/;X=/x|\\\\srv\\data;Y=/y|\\\\srv\\other", 1);
    HANDLE connections = nullptr;
    ASSERT_EQ(WNetOpenEnumA(RESOURCE_CONNECTED, RESOURCETYPE_DISK, 0, nullptr, &connections), ERROR_SUCCESS);
    alignas(NETRESOURCEA) char buffer[256];
    auto* const records = reinterpret_cast<NETRESOURCEA*>(buffer);
    DWORD count = 0xFFFFFFFF;
    DWORD size = 10;
    EXPECT_EQ(WNetEnumResourceA(connections, &count, buffer, &size), ERROR_MORE_DATA);
    EXPECT_EQ(count, 0u);
    const DWORD needed = size;
    count = 0xFFFFFFFF;
    EXPECT_EQ(WNetEnumResourceA(connections, &count, buffer, &size), ERROR_SUCCESS) << "so much was asked for";
    ASSERT_EQ(count, 1u);
    EXPECT_STREQ(records->lpLocalName, "X:");
    EXPECT_STREQ(records->lpRemoteName, "\\\\srv\\data");
    EXPECT_LT(records->lpRemoteName + 10, buffer + needed);
    size = sizeof(buffer);
    count = 0xFFFFFFFF;
    EXPECT_EQ(WNetEnumResourceA(connections, &count, buffer, &size), ERROR_SUCCESS);
    ASSERT_EQ(count, 1u);
    EXPECT_STREQ(records->lpLocalName, "Y:");
    EXPECT_EQ(WNetEnumResourceA(connections, &count, buffer, &size), ERROR_NO_MORE_ITEMS);
    EXPECT_EQ(WNetCloseEnum(connections), ERROR_SUCCESS);
    EXPECT_EQ(WNetCloseEnum(connections), ERROR_INVALID_HANDLE);
    EXPECT_EQ(WNetEnumResourceA(connections, &count, buffer, &size), ERROR_INVALID_HANDLE);
    EXPECT_EQ(WNetOpenEnumA(2, RESOURCETYPE_DISK, 0, nullptr, &connections), ERROR_NOT_SUPPORTED);
}

TEST_F(Files, EverythingThatOpensAFileKnowsTheDrives) {
    put("data/plan.txt", "x");
    CFile file;
    EXPECT_TRUE(file.Open("\\\\srv\\data\\Plan.txt", CFile::modeRead));
    EXPECT_TRUE(file.Open("\\\\srv/data/plan.txt", CFile::modeRead));
    EXPECT_TRUE(file.Open("X:\\plan.txt", CFile::modeRead));
    EXPECT_FALSE(file.Open("Y:\\plan.txt", CFile::modeRead));
    CFileStatus status;
    EXPECT_TRUE(CFile::GetStatus("X:\\PLAN.TXT", status));
}
