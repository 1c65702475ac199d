#include "platform/base/File.h"

#include "platform/base/MemFile.h"
#include "platform/base/StdioFile.h"
#include "tests/unit/base/FileTestFolder.h"

#include <cerrno>
#include <memory>
#include <unistd.h>

using File = FileTestFolder;
using StdioFile = FileTestFolder;

namespace {

/// The cause of the file exception that a function raises; -1 when it raises none.
template <typename Function>
int causeOf(Function function) {
    try {
        function();
        return -1;
    } catch (CFileException* e) {
        const int cause = e->m_cause;
        e->Delete();
        return cause;
    }
}

int openCause(LPCSTR name, UINT flags) {
    CFile file;
    CFileException error;
    return file.Open(name, flags, &error) ? -1 : error.m_cause;
}

} // namespace

TEST_F(File, WritesReadsAndMoves) {
    CFile file("a.bin", CFile::modeCreate | CFile::modeReadWrite);
    file.Write("0123456789", 10);
    EXPECT_EQ(10u, file.GetLength());
    EXPECT_EQ(3u, file.Seek(-7, CFile::end));
    char bytes[20] = {};
    EXPECT_EQ(7u, file.Read(bytes, sizeof bytes));
    EXPECT_STREQ("3456789", bytes);
    EXPECT_EQ(10u, file.GetPosition());
    file.SeekToBegin();
    file.SetLength(2);
    EXPECT_EQ(2u, file.Read(bytes, sizeof bytes));
    file.SeekToBegin();
    EXPECT_EQ(2u, file.SeekToEnd());
    EXPECT_EQ(2u, file.GetPosition());
    file.Seek(3, CFile::begin);
    file.Write("x", 1);
    file.Flush();
    file.Close();
    EXPECT_EQ(std::string("01\0x", 4), get("a.bin"));
    EXPECT_FALSE(file.IsOpen());
    file.Close();
}

TEST_F(File, EmptiesOrKeepsAnExistingFile) {
    put("a.txt", "contents");
    CFile("a.txt", CFile::modeCreate | CFile::modeNoTruncate | CFile::modeWrite).Write("C", 1);
    EXPECT_EQ("Contents", get("a.txt"));
    CFile("a.txt", CFile::modeCreate | CFile::modeWrite | CFile::shareExclusive).Close();
    EXPECT_EQ("", get("a.txt"));
}

TEST_F(File, KnowsItsNamesInTheFormGiven) {
    put("sub/a.b.txt");
    const CFile relative("sub\\a.b.txt", CFile::modeRead);
    EXPECT_EQ(drive("sub\\a.b.txt"), std::string(relative.GetFilePath()));
    EXPECT_EQ("a.b.txt", relative.GetFileName());
    EXPECT_EQ("a.b", relative.GetFileTitle());
    const CFile ordinary("sub/a.b.txt", CFile::modeRead);
    EXPECT_EQ(m_folder + "/sub/a.b.txt", std::string(ordinary.GetFilePath()));
}

TEST_F(File, TellsWhyItCannotBeOpened) {
    put("plain");
    std::filesystem::create_directory("folder");
    EXPECT_EQ(CFileException::fileNotFound, openCause("missing", CFile::modeRead));
    EXPECT_EQ(CFileException::badPath, openCause("plain\\below", CFile::modeRead));
    EXPECT_EQ(CFileException::badPath, openCause("Z:\\a", CFile::modeRead));
    EXPECT_EQ(CFileException::badPath, openCause("", CFile::modeRead));
    EXPECT_EQ(CFileException::badPath, openCause(nullptr, CFile::modeRead));
    EXPECT_EQ(CFileException::badPath, openCause(std::string(5000, 'x').c_str(), CFile::modeRead));
    EXPECT_EQ(CFileException::accessDenied, openCause("folder", CFile::modeRead));
    EXPECT_EQ(CFileException::accessDenied, openCause("folder", CFile::modeCreate | CFile::modeWrite));
    if (::geteuid() != 0) {
        std::filesystem::permissions("plain", std::filesystem::perms::none);
        EXPECT_EQ(CFileException::accessDenied, openCause("plain", CFile::modeRead));
    }
    CFile failed;
    CFileException error;
    EXPECT_FALSE(failed.Open("missing", CFile::modeRead, &error));
    EXPECT_EQ(ENOENT, error.m_lOsError);
    EXPECT_EQ("missing", error.m_strFileName);
    EXPECT_EQ(CFileException::fileNotFound, causeOf([] { CFile("missing", CFile::modeRead); }));
}

TEST_F(File, TellsWhyItCannotBeUsed) {
    put("a.txt", "abc");
    EXPECT_EQ(CFileException::diskFull, causeOf([] { CFile("/dev/full", CFile::modeWrite).Write("x", 1); }));
    CFile file("a.txt", CFile::modeRead);
    EXPECT_EQ(CFileException::badSeek, causeOf([&] { file.Seek(-1, CFile::begin); }));
    EXPECT_EQ(CFileException::invalidFile, causeOf([&] { file.Write("x", 1); }));
    file.Close();
    char byte = 0;
    EXPECT_EQ(CFileException::invalidFile, causeOf([&] { file.Read(&byte, 1); }));
    EXPECT_EQ(CFileException::diskFull, causeOf([] { CFile("a.txt", CFile::modeReadWrite).SetLength(~ULONGLONG{0}); }));
}

TEST_F(File, DuplicatesShareOnePosition) {
    put("a.txt", "abcdef");
    CFile file("a.txt", CFile::modeRead);
    const std::unique_ptr<CFile> duplicate(file.Duplicate());
    duplicate->Seek(4, CFile::begin);
    file.Close();
    char bytes[3] = {};
    EXPECT_EQ(2u, duplicate->Read(bytes, 2));
    EXPECT_STREQ("ef", bytes);
}

TEST_F(File, RenamesRemovesAndTellsStates) {
    put("old", "12345");
    put("other", "kept");
    EXPECT_EQ(CFileException::accessDenied, causeOf([] { CFile::Rename("old", "other"); }));
    EXPECT_EQ("kept", get("other"));
    CFile::Rename("OLD", "new");
    CFileStatus status;
    EXPECT_FALSE(CFile::GetStatus("old", status));
    ASSERT_TRUE(CFile::GetStatus(drive("new").c_str(), status));
    EXPECT_EQ(5u, status.m_size);
    EXPECT_EQ(drive("new"), std::string(status.m_szFullName));
    EXPECT_EQ(0, status.m_attribute & CFile::directory);
    ASSERT_TRUE(CFile::GetStatus(m_folder.c_str(), status));
    EXPECT_NE(0, status.m_attribute & CFile::directory);
    CFile::Remove("new");
    EXPECT_EQ(CFileException::fileNotFound, causeOf([] { CFile::Remove("new"); }));
}

TEST_F(StdioFile, ReadsLinesOfAnyKind) {
    put("a.txt", std::string("one\r\n\ntwo\rthree\n") + std::string("ze\0ro\n", 6) + std::string(100000, 'x'));
    CStdioFile file("a.txt", CFile::modeRead);
    CString line;
    ASSERT_TRUE(file.ReadString(line));
    EXPECT_EQ("one", line);
    ASSERT_TRUE(file.ReadString(line));
    EXPECT_EQ("", line);
    ASSERT_TRUE(file.ReadString(line));
    EXPECT_EQ("two\rthree", line);
    ASSERT_TRUE(file.ReadString(line));
    EXPECT_EQ(5, line.GetLength());
    ASSERT_TRUE(file.ReadString(line));
    EXPECT_EQ(100000, line.GetLength());
    EXPECT_FALSE(file.ReadString(line));
    EXPECT_EQ("", line);

    file.SeekToBegin();
    char buffer[3];
    EXPECT_STREQ("on", file.ReadString(buffer, sizeof buffer));
    EXPECT_STREQ("e\n", file.ReadString(buffer, sizeof buffer));
    EXPECT_STREQ("\n", file.ReadString(buffer, sizeof buffer));
}

TEST_F(StdioFile, KeepsLineEndsInBinary) {
    put("a.txt", "a\r\nb");
    char bytes[8] = {};
    EXPECT_EQ(4u, CStdioFile("a.txt", CFile::modeRead | CFile::typeBinary).Read(bytes, 8));
    EXPECT_EQ(3u, CStdioFile("a.txt", CFile::modeRead | CFile::typeText).Read(bytes, 8));
}

TEST_F(StdioFile, ChangesBetweenReadingAndWriting) {
    CStdioFile file("a.txt", CFile::modeCreate | CFile::modeReadWrite);
    file.WriteString("first\nsecond\n");
    EXPECT_EQ(13u, file.GetLength());
    file.SeekToBegin();
    CString line;
    file.ReadString(line);
    file.WriteString("S");
    file.ReadString(line);
    EXPECT_EQ("econd", line);
    file.Close();
    EXPECT_EQ("first\nSecond\n", get("a.txt"));
}

TEST_F(StdioFile, ReportsWhatCannotBeKept) {
    CStdioFile full("/dev/full", CFile::modeWrite);
    full.WriteString("x");
    EXPECT_EQ(CFileException::diskFull, causeOf([&] { full.Flush(); }));
    CStdioFile closing("/dev/full", CFile::modeWrite);
    closing.WriteString("x");
    EXPECT_EQ(CFileException::diskFull, causeOf([&] { closing.Close(); }));
    EXPECT_FALSE(closing.IsOpen());
    EXPECT_EQ(CFileException::invalidFile, causeOf([&] { closing.WriteString("x"); }));
}

TEST(MemFile, BehavesAsAFile) {
    CMemFile file;
    file.Write("0123456789", 10);
    file.Seek(12, CFile::begin);
    file.Write("x", 1);
    file.Seek(-5, CFile::current);
    char bytes[6] = {};
    EXPECT_EQ(5u, file.Read(bytes, 5));
    EXPECT_EQ(std::string("89\0\0x", 5), std::string(bytes, 5));
    EXPECT_EQ(0u, file.Read(bytes, 5));
    EXPECT_EQ(CFileException::badSeek, causeOf([&] { file.Seek(-14, CFile::end); }));
    file.SetLength(1);
    file.SetLength(2);
    file.SeekToBegin();
    EXPECT_EQ(2u, file.Read(bytes, 5));
    EXPECT_EQ('\0', bytes[1]);
    BYTE* const memory = file.Detach();
    EXPECT_EQ('0', memory[0]);
    std::free(memory);
    EXPECT_EQ(0u, file.GetLength());
}

TEST(MemFile, UsesMemoryOfTheCallers) {
    BYTE memory[4] = {'a', 'b', 'c', 'd'};
    CMemFile file(memory, sizeof memory);
    file.Write("X", 1);
    EXPECT_EQ('X', memory[0]);
    EXPECT_THROW(file.Write("12345", 5), CMemoryException*);
    EXPECT_EQ(4u, file.GetLength());
    EXPECT_EQ(memory, file.Detach());
}
