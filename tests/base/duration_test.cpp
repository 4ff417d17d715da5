#include "base/duration.h"

#include <gtest/gtest.h>

#include <string>

namespace kdx {
namespace {

using namespace std::chrono_literals;

TEST(Duration, IsANumberWithItsUnit) {
    EXPECT_EQ(parseDuration("2 s"), 2s);
    EXPECT_EQ(parseDuration("2s"), 2s);
    EXPECT_EQ(parseDuration("  500  ms "), 500ms);
    EXPECT_EQ(parseDuration("0.0005 s"), 1ms);
    EXPECT_EQ(parseDuration(".5s"), 500ms);
    EXPECT_EQ(parseDuration("1.s"), 1s);
    EXPECT_EQ(parseDuration("0 s"), 0s);
    EXPECT_EQ(parseDuration("86400 s"), 24h);
    EXPECT_EQ(parseDuration("1.5 min"), 90s);
    EXPECT_EQ(parseDuration("168h"), 168h);
}

TEST(Duration, NoneIsLongerThanTheLongest) {
    EXPECT_EQ(parseDuration("1000000001 s"), kLongestDuration);
    EXPECT_EQ(parseDuration(std::string(100000, '9') + "s"), kLongestDuration);
}

TEST(Duration, OtherTextsAreNone) {
    for (const char* text : {"", " ", "s", "2", "2 hours", "2 m", "2,5 s", "-1 s", "+1 s", "1e3 s", ".s", "1.2.3 s",
                             "nan s", "inf s", "0x10 s", "2 s s", "2 S", "2 s\n"}) {
        EXPECT_EQ(parseDuration(text), std::nullopt) << text;
    }
    EXPECT_EQ(parseDuration(std::string_view("2\0s", 3)), std::nullopt);
}

}  // namespace
}  // namespace kdx
