#include "platform/port/Stream.h"

#include "platform/port/File.h"

#include <csignal>
#include <cstdio>
#include <fcntl.h>
#include <gtest/gtest.h>
#include <unistd.h>

namespace {

using Port::Stream;

TEST(Stream, WritesInOrderWithTheCLibrary) {
    testing::internal::CaptureStdout();
    std::printf("one ");
    Port::File::getCout() << "two" << ' ' << std::string("three") << static_cast<const char*>(nullptr) << Stream::endl;
    std::printf("four\n");
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "one two three\nfour\n");
}

TEST(Stream, SurvivesAReaderThatHasGone) {
    int ends[2];
    ASSERT_EQ(::pipe(ends), 0);
    ::close(ends[0]);
    Stream stream(ends[1]);
    stream << "nobody reads this" << Stream::endl;
    ::close(ends[1]);

    sigset_t pending;
    ::sigpending(&pending);
    EXPECT_EQ(sigismember(&pending, SIGPIPE), 0) << "nothing is left behind that would end the process later";
}

TEST(Stream, SurvivesAFullDisk) {
    const int full = ::open("/dev/full", O_WRONLY);
    ASSERT_GE(full, 0);
    Stream stream(full);
    stream << "no room" << Stream::endl;
    ::close(full);
    stream << "closed";
}

} // namespace
