#include "platform/win/Error.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <thread>

TEST(Error, LastErrorBelongsToItsThread) {
    SetLastError(ERROR_ACCESS_DENIED);
    DWORD seen = 1;
    std::thread([&] {
        seen = GetLastError();
        SetLastError(ERROR_DISK_FULL);
    }).join();
    EXPECT_EQ(seen, ERROR_SUCCESS);
    EXPECT_EQ(GetLastError(), ERROR_ACCESS_DENIED);
}

TEST(Error, SystemNumbersBecomeThePlatforms) {
    EXPECT_EQ(tvx::errorFromErrno(0), 0u);
    EXPECT_EQ(tvx::errorFromErrno(ENOENT), 2u);
    EXPECT_EQ(tvx::errorFromErrno(ENOTDIR), 3u);
    EXPECT_EQ(tvx::errorFromErrno(EACCES), 5u);
    EXPECT_EQ(tvx::errorFromErrno(ENOMEM), 8u);
    EXPECT_EQ(tvx::errorFromErrno(EINVAL), 87u);
    EXPECT_EQ(tvx::errorFromErrno(EPIPE), 109u);
    EXPECT_EQ(tvx::errorFromErrno(ENOEXEC), 193u);
    EXPECT_EQ(tvx::errorFromErrno(ENAMETOOLONG), 206u);
    EXPECT_EQ(tvx::errorFromErrno(987654), ERROR_GEN_FAILURE);
    errno = EPERM;
    EXPECT_EQ(tvx::setLastErrorFromErrno(), ERROR_ACCESS_DENIED);
    EXPECT_EQ(GetLastError(), ERROR_ACCESS_DENIED);
}

TEST(Error, EveryNumberHasASentence) {
    EXPECT_EQ(tvx::errorText(ERROR_FILE_NOT_FOUND), "The file does not exist.");
    EXPECT_EQ(tvx::errorText(54321), "Error 54321.");
}
