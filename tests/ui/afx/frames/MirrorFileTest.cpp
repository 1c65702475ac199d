#include "platform/afx/frames/detail/MirrorFile.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <sys/stat.h>
#include <unistd.h>

using frametest::contents;
using tvx::afx::MirrorFile;

namespace fs = std::filesystem;

namespace {

class Mirror : public testing::Test {
protected:
    void SetUp() override {
        std::string pattern = (fs::temp_directory_path() / "mirror.XXXXXX").string();
        ASSERT_NE(mkdtemp(pattern.data()), nullptr);
        folder = pattern;
        frametest::write(path(), "old");
    }
    void TearDown() override {
        fs::permissions(folder, fs::perms::owner_all);
        fs::remove_all(folder);
    }
    fs::path path(const char* name = "file") const {
        return folder / name;
    }
    static void store(MirrorFile& file, const fs::path& path, const char* text) {
        ASSERT_TRUE(file.Open(path.c_str(), CFile::modeCreate | CFile::modeReadWrite));
        file.Write(text, static_cast<UINT>(std::strlen(text)));
    }
    std::ptrdiff_t entries() const {
        return std::distance(fs::directory_iterator(folder), fs::directory_iterator());
    }
    fs::path folder;
};

} // namespace

TEST_F(Mirror, ReplacesTheFileWhenClosed) {
    MirrorFile file;
    store(file, path(), "new");
    EXPECT_EQ(contents(path()), "old");
    EXPECT_EQ(file.GetFilePath(), path().c_str());
    file.Close();
    EXPECT_EQ(contents(path()), "new");
    EXPECT_EQ(entries(), 1);
}

TEST_F(Mirror, LeavesTheFileWhenGivenUp) {
    {
        MirrorFile file;
        store(file, path(), "half");
        file.Abort();
        EXPECT_EQ(contents(path()), "old");
    }
    {
        MirrorFile file;
        store(file, path("fresh"), "half");
    }
    EXPECT_EQ(entries(), 1) << "no half file, no temporary one";
}

TEST_F(Mirror, KeepsPermissionsAndLinks) {
    ::chmod(path().c_str(), 0640);
    fs::create_symlink("file", path("symbolic"));
    MirrorFile file;
    store(file, path("symbolic"), "new");
    file.Close();
    EXPECT_TRUE(fs::is_symlink(path("symbolic")));
    EXPECT_EQ(contents(path()), "new");
    EXPECT_EQ(static_cast<unsigned>(fs::status(path()).permissions()), 0640U);

    fs::create_hard_link(path(), path("second"));
    MirrorFile linked;
    store(linked, path(), "both");
    linked.Close();
    EXPECT_EQ(contents(path("second")), "both");
    EXPECT_EQ(fs::hard_link_count(path()), 2U);
}

TEST_F(Mirror, NewFilesHaveTheUsersPermissions) {
    const mode_t mask = ::umask(027);
    MirrorFile file;
    store(file, path("fresh"), "x");
    file.Close();
    ::umask(mask);
    EXPECT_EQ(static_cast<unsigned>(fs::status(path("fresh")).permissions()), 0640U);
}

TEST_F(Mirror, RefusesWhatCannotBeWritten) {
    MirrorFile file;
    CFileException error;
    EXPECT_FALSE(file.Open(path("none/file").c_str(), CFile::modeCreate | CFile::modeWrite, &error));
    EXPECT_EQ(error.m_cause, CFileException::fileNotFound);
    EXPECT_FALSE(file.Open("", CFile::modeCreate | CFile::modeWrite, &error));
    if (::geteuid() != 0) { // nothing is read-only for the superuser
        ::chmod(path().c_str(), 0444);
        EXPECT_FALSE(file.Open(path().c_str(), CFile::modeCreate | CFile::modeWrite, &error));
        EXPECT_EQ(error.m_cause, CFileException::accessDenied);
    }
}

TEST_F(Mirror, ReadsInPlace) {
    MirrorFile file;
    ASSERT_TRUE(file.Open(path().c_str(), CFile::modeRead));
    char text[4] = {};
    EXPECT_EQ(file.Read(text, 3), 3U);
    EXPECT_STREQ(text, "old");
    file.Close();
    EXPECT_EQ(entries(), 1);
}
