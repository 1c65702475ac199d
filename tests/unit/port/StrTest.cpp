#include "platform/port/Str.h"

#include "platform/port/Time.h"

#include <cstdlib>
#include <ctime>
#include <gtest/gtest.h>

namespace {

TEST(Str, TakesTokensOffTheFront) {
    std::string source = "a==b;c";
    std::string token;
    EXPECT_EQ(UT_STR::GetToken(source, token, "=;"), '=');
    EXPECT_EQ(token, "a");
    EXPECT_EQ(UT_STR::GetToken(source, token, "=;"), '=');
    EXPECT_EQ(token, "") << "delimiters are not run together";
    EXPECT_EQ(UT_STR::GetToken(source, token, "=;"), ';');
    EXPECT_EQ(token, "b");
    EXPECT_EQ(UT_STR::GetToken(source, token, "=;"), '\0');
    EXPECT_EQ(token, "c");
    EXPECT_EQ(source, "");
    EXPECT_EQ(UT_STR::GetToken(source, token, "=;"), '\0');
    EXPECT_EQ(token, "");
}

TEST(Str, ReadsNumbersAtTheBeginning) {
    EXPECT_EQ(UT_STR::AToI(" -12kg"), -12);
    EXPECT_EQ(UT_STR::AToI("kg"), 0);
    EXPECT_EQ(UT_STR::AToI("99999999999"), 2147483647);
    int hour = 0;
    int minute = 0;
    EXPECT_EQ(UT_STR::SScanf("10:20", "%d %*c %d", &hour, &minute), 2);
    EXPECT_EQ(hour * 100 + minute, 1020);
}

TEST(Str, NeverWritesBeyondABuffer) {
    char buffer[6] = "xxxxx";
    EXPECT_FALSE(UT_STR::Copy(buffer, sizeof buffer, "123456"));
    EXPECT_STREQ(buffer, "xxxxx");
    EXPECT_TRUE(UT_STR::Copy(buffer, sizeof buffer, "123"));
    EXPECT_FALSE(UT_STR::Cat(buffer, sizeof buffer, "456"));
    EXPECT_STREQ(buffer, "123");
    EXPECT_TRUE(UT_STR::Cat(buffer, sizeof buffer, "45"));
    EXPECT_STREQ(buffer, "12345");
}

TEST(Time, TakesLocalTimesThatAreOutOfRange) {
    ::setenv("TZ", "ABC-2", 1);
    std::tm local{};
    local.tm_year = 70;
    local.tm_mday = 32;
    local.tm_hour = 2;
    EXPECT_EQ(UT_TIME::MkTime(local), 31 * 86400);
    local.tm_mday = 0;
    EXPECT_EQ(UT_TIME::MkTime(local), -1);
    EXPECT_EQ(UT_TIME::DiffTime(10, 25), -15);
}

} // namespace
