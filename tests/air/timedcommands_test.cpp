#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "air/timedcommands.h"
#include "support/fakeclock.h"

namespace kdx::air {

static bool operator==(const TimedCommand& left, const TimedCommand& right) {
    return left.after == right.after && left.command == right.command;
}

namespace {

using namespace std::chrono_literals;
using Lines = std::vector<std::size_t>;

TEST(TimedCommandsTest, AreOneALineWithTheirTimeBeforeThem) {
    const auto read = readTimedCommands("*RST\r\n\r\n@ 2.5 :STEREO:DIRECT \"TA=1\"\n@0 FM:STAT ON\n@ 86400 *RST");
    EXPECT_EQ(read.unreadableLines, Lines{});
    EXPECT_EQ(read.commands,
              (std::vector<TimedCommand>{
                  {0s, "*RST"}, {0s, "FM:STAT ON"}, {2500ms, ":STEREO:DIRECT \"TA=1\""}, {24h, "*RST"}}));
}

TEST(TimedCommandsTest, AreInTheOrderOfTheirTimes) {
    const auto read = readTimedCommands("@ 3 c\n@ 1 a\nfirst\n@ 1 b\n");
    EXPECT_EQ(read.commands, (std::vector<TimedCommand>{{0s, "first"}, {1s, "a"}, {1s, "b"}, {3s, "c"}}));
}

TEST(TimedCommandsTest, AreOfTheCodePageOrOfUtf8WithAMark) {
    EXPECT_EQ(readTimedCommands("PS=\xE4").commands, (std::vector<TimedCommand>{{0s, "PS=\xE4"}}));
    EXPECT_EQ(readTimedCommands("\xEF\xBB\xBFPS=\xC3\xA4\xE2\x82\xAC").commands,
              (std::vector<TimedCommand>{{0s, "PS=\xE4\x80"}}));
}

TEST(TimedCommandsTest, ATimeThatIsNoneIsNoted) {
    const auto read = readTimedCommands("@ soon *RST\n*RST\n@ -1 *RST\n@ 2\n@ 1s *RST\n@\n@ 1e99 *RST");
    EXPECT_EQ(read.unreadableLines, (Lines{1, 3, 4, 5, 6, 7}));
    EXPECT_EQ(read.commands.size(), 1U);
}

TEST(AirTimeTest, IsReadFromDateAndTime) {
    using namespace std::chrono;
    EXPECT_EQ(parseAirTime("2026-01-31 23:59:58"), AirTime{sys_days{2026y / 1 / 31}} + 23h + 59min + 58s);
    EXPECT_EQ(parseAirTime("2024-02-29 00:00:00"), AirTime{sys_days{2024y / 2 / 29}});
    for (const char* wrong : {"", "2026-01-01", "2026-01-01T12:00:00", "2026-02-29 12:00:00", "2026-01-01 24:00:00",
                              "2026-01-01 12:60:00", "2026-01-01 12:00:60", "1999-12-31 23:59:59",
                              "2100-01-01 00:00:00", "2026-01-01 12:00:00 ", "+026-01-01 12:00:00"}) {
        EXPECT_EQ(parseAirTime(wrong), std::nullopt) << wrong;
    }
}

TEST(AirTimeTest, IsWhatAClockShows) {
    using namespace std::chrono;
    const test::FakeClock clock(3661.25, {2009, 3, 5});
    EXPECT_EQ(airTimeOf(clock), AirTime{sys_days{2009y / 3 / 5}} + 1h + 1min + 1s + 250ms);
}

}  // namespace
}  // namespace kdx::air
