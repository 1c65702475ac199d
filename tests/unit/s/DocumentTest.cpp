#include "s/Document.h"

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sys/stat.h>

namespace {

class Plan : public Gui_Document {};

std::string contents(const char* name) {
    std::ifstream file(name);
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace

TEST(Document, OpensTheNamedFileItself) {
    const auto folder = std::filesystem::temp_directory_path() / "documents";
    std::filesystem::create_directories(folder);
    std::filesystem::current_path(folder);
    std::ofstream("plan.txt") << "old";
    Plan plan;
    CFileException error;
    CFile* file = plan.GetFile("plan.txt", CFile::modeRead, &error);
    ASSERT_NE(file, nullptr);
    EXPECT_EQ(file->GetRuntimeClass(), RUNTIME_CLASS(CFile));
    EXPECT_EQ(file->GetLength(), 3U);
    plan.ReleaseFile(file, FALSE);

    file = plan.GetFile("plan.txt", CFile::modeCreate | CFile::modeWrite, &error);
    ASSERT_NE(file, nullptr);
    file->Write("new text", 8);
    EXPECT_EQ(contents("plan.txt"), "new text") << "at once, in the file itself";
    plan.ReleaseFile(file, TRUE);
    EXPECT_EQ(contents("plan.txt"), "new text");

    EXPECT_EQ(plan.GetFile("missing.txt", CFile::modeRead, &error), nullptr);
    EXPECT_EQ(error.m_cause, CFileException::fileNotFound);
    EXPECT_EQ(plan.GetFile("missing.txt", CFile::modeRead, nullptr), nullptr);
    EXPECT_EQ(plan.GetFile(nullptr, CFile::modeRead, nullptr), nullptr);

    ASSERT_EQ(::mkfifo("pipe", 0600), 0);
    EXPECT_EQ(plan.GetFile("pipe", CFile::modeRead, &error), nullptr) << "and does not wait";
    EXPECT_EQ(error.m_lOsError, ESPIPE);
}
