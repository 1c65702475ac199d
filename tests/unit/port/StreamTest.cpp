#include "platform/port/Stream.h"

#include "platform/port/File.h"

#include <csignal>
#include <cstdint>
#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

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

/// A file with the given contents, read back line by line.
class Reading : public testing::Test {
protected:
    struct Line {
        std::string text;
        bool atEnd;
        friend bool operator==(const Line&, const Line&) = default;
        friend std::ostream& operator<<(std::ostream& out, const Line& line) {
            return out << line.text.size() << " bytes: " << line.text << (line.atEnd ? " (end)" : "");
        }
    };

    std::string write(const std::string& contents) {
        const std::string path = m_folder + "/text";
        std::ofstream(path, std::ios::binary) << contents;
        return path;
    }

    /// All lines up to the one that met the end of the file.
    std::vector<Line> lines(const std::string& contents, int limit) {
        std::vector<Line> result;
        Stream* stream = Port::File::open(write(contents).c_str(), Port::File::AccessRead, Port::File::FlagText);
        std::vector<char> buffer(static_cast<std::size_t>(limit) + 1);
        do {
            const int length = stream->readline(buffer.data(), limit);
            EXPECT_EQ(buffer[static_cast<std::size_t>(length)], '\0');
            result.push_back({std::string(buffer.data(), static_cast<std::size_t>(length)), stream->geteof()});
        } while (!stream->geteof() && result.size() < 1000);
        Port::File::close(stream);
        return result;
    }

    const std::string m_folder = testing::TempDir();
};

TEST_F(Reading, TakesLineEndsOfEveryKind) {
    EXPECT_EQ(
        lines("one\r\ntwo\n\n\rthree\r", 80),
        (std::vector<Line>{{"one", false}, {"two", false}, {"", false}, {"", false}, {"three", false}, {"", true}}));
    EXPECT_EQ(lines("one\ntwo", 80), (std::vector<Line>{{"one", false}, {"two", true}}));
    EXPECT_EQ(lines("", 80), (std::vector<Line>{{"", true}}));
    EXPECT_EQ(lines(std::string("a\0b\n", 4), 80), (std::vector<Line>{{std::string("a\0b", 3), false}, {"", true}}));
}

TEST_F(Reading, ReadsLongLinesInPieces) {
    EXPECT_EQ(lines("abcdef\r\nxyz\r\nuv\n", 3),
              (std::vector<Line>{{"abc", false}, {"def", false}, {"xyz", false}, {"uv", false}, {"", true}}));
    EXPECT_EQ(lines("abcd", 3), (std::vector<Line>{{"abc", false}, {"d", true}}));
    EXPECT_EQ(lines("abc", 3), (std::vector<Line>{{"abc", true}}));
}

TEST_F(Reading, CutsNoCharacterAndKeepsBrokenOnes) {
    EXPECT_EQ(lines("a\u00e9\u20ac\n", 2),
              (std::vector<Line>{{"a", false}, {"\u00e9", false}, {"\xe2\x82", false}, {"\xac", false}, {"", true}}))
        << "a character that no piece has room for is cut";
    EXPECT_EQ(lines("\xff\xc3\xe2\x82\n\xc3", 2),
              (std::vector<Line>{{"\xff\xc3", false}, {"\xe2\x82", false}, {"\xc3", true}}));
}

TEST_F(Reading, PassesOverTheBoundsOfItsBuffer) {
    std::string text;
    for (int i = 0; i < 40000; ++i) {
        text += std::to_string(i) + "\r\n";
    }
    Stream* stream = Port::File::open(write(text).c_str(), Port::File::AccessRead, Port::File::FlagText);
    char line[256];
    for (int i = 0; i < 40000; ++i) {
        stream->readline(line, 255);
        ASSERT_EQ(line, std::to_string(i));
        ASSERT_FALSE(stream->geteof());
    }
    stream->readline(line, 255);
    EXPECT_TRUE(stream->geteof());
    Port::File::close(stream);
}

TEST_F(Reading, OpensNothingButFiles) {
    const auto open = [](const std::string& path) {
        return std::unique_ptr<Stream, void (*)(Stream*)>(
            Port::File::open(path.c_str(), Port::File::AccessRead, Port::File::FlagText), &Port::File::close);
    };
    const std::string pipe = m_folder + "/pipe";
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
    EXPECT_FALSE(open(m_folder));
    EXPECT_FALSE(open(pipe));
    EXPECT_FALSE(open(m_folder + "/missing"));
    EXPECT_FALSE(open(""));
    EXPECT_TRUE(open(write("x")));
    EXPECT_TRUE(open(m_folder + "/TEXT")) << "letter case does not matter";
    std::int64_t time = 5;
    EXPECT_FALSE(Port::File::getdatetime((m_folder + "/missing").c_str(), time));
    EXPECT_EQ(time, 5);
    const timespec stamps[] = {{0, 0}, {1234567890, 999999999}};
    ASSERT_EQ(::utimensat(AT_FDCWD, write("x").c_str(), stamps, 0), 0);
    ASSERT_TRUE(Port::File::getdatetime((m_folder + "/text").c_str(), time));
    EXPECT_EQ(time, 1234567890);
}

} // namespace
