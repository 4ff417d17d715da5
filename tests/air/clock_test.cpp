#include "air/airtest.h"

#include "sim/transmission.h"

namespace kdx::air {
namespace {

using namespace std::chrono_literals;

struct SentGroup {
    int number = 0;  ///< of the group, from 1
    std::string group;
    bool operator==(const SentGroup&) const = default;
};
void PrintTo(const SentGroup& sent, std::ostream* out) {
    *out << sent.number << ": " << sent.group;
}

class ClockGroups : public AirTest {
protected:
    /// The clock groups among the next ones.
    std::vector<SentGroup> clocks(int groups) {
        std::vector<SentGroup> found;
        for (int number = 1; number <= groups; ++number) {
            const std::string group = next();
            if (group.substr(5, 3) == "400") found.push_back({number, group});
        }
        return found;
    }
};

TEST_F(ClockGroups, ComeAtEachFullMinuteAndNotAtTheStart) {
    // A group takes 104 / 1187.5 s = 0.0875789 s: the 685th ends at 59.992 s, the 1370th at 119.983 s, the 2055th at
    // 179.975 s, the 2740th at 239.966 s; the 3426th at 300.045 s is further from it than the 3425th, at 299.958 s.
    // 1 January 2026 is MJD 61041, 01 and 110 1110 0111 0001; 12:01 is 0 1100 and 000001.
    coder("CT=12:00:00,01.01.26");
    EXPECT_EQ(clocks(3500), (std::vector<SentGroup>{{685, "1000 4001 DCE2 C040"},
                                                    {1370, "1000 4001 DCE2 C080"},
                                                    {2055, "1000 4001 DCE2 C0C0"},
                                                    {2740, "1000 4001 DCE2 C100"},
                                                    {3425, "1000 4001 DCE2 C140"}}));
}

TEST_F(ClockGroups, GoByTheCodersClock) {
    // Half a minute ahead: the 343rd group ends at 30.040 s, the 1028th at 90.031 s. 08:31 is 0 1000 and 011111.
    coder("CT=08:30:30,01.01.26");
    EXPECT_EQ(clocks(1100), (std::vector<SentGroup>{{343, "1000 4001 DCE2 87C0"}, {1028, "1000 4001 DCE2 8800"}}));
}

TEST_F(ClockGroups, AreNotSentWhileTheClockIsOff) {
    EXPECT_EQ(clocks(700), std::vector<SentGroup>{});
    coder("CT=12:00:59,01.01.26");
    EXPECT_EQ(clocks(20).size(), 1U);
    coder("CT=off");
    EXPECT_EQ(clocks(1400), std::vector<SentGroup>{});
}

TEST_F(ClockGroups, ArePutInWhileTheSequenceWaits) {
    coder("GS=0A,15B");
    coder("CT=12:00:59,01.01.26");  // the eleventh group ends 0.963 s later, the twelfth 1.051 s
    EXPECT_EQ(block(2, 13), (Groups{"0008", "F808", "0009", "F809", "000A", "F80A", "000F", "F80F", "0008", "F808",
                                    "4001", "0009", "F809"}));
}

TEST_F(ClockGroups, GoBeforeABurst) {
    coder("EON-PI=D3C2");
    coder("CT=12:00:59,01.01.26");
    (void)next(5);
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(block(2, 10), (Groups{"E808", "E808", "E808", "E808", "E808", "4001", "E808", "E808", "E808", "0009"}));
}

struct Date {
    const char* clock;
    const char* group;
    friend void PrintTo(const Date& date, std::ostream* out) { *out << date.clock; }
};

class ClockDates : public ClockGroups, public ::testing::WithParamInterface<Date> {};

TEST_P(ClockDates, HaveTheModifiedJulianDayOfTheMinuteThatBegins) {
    coder(std::string("CT=") + GetParam().clock);
    EXPECT_EQ(clocks(20), (std::vector<SentGroup>{{11, GetParam().group}}));
}

// Days counted from 1 January 2000, MJD 51544. Block 2 ends in the upper two of its 17 bits, block 3 holds the others
// and the first bit of the hour.
INSTANTIATE_TEST_SUITE_P(
    Days, ClockDates,
    ::testing::Values(Date{"23:58:59,31.12.25", "1000 4001 DCE1 7EC0"},    // 61040, 1 0111 and 111011
                      Date{"23:59:59,31.12.25", "1000 4001 DCE2 0000"},    // 61041
                      Date{"15:59:59,05.03.09", "1000 4001 ACDF 0000"},    // 54895, 16:00 is 1 0000
                      Date{"23:59:59,28.02.24", "1000 4001 D7A2 0000"},    // 60369: a leap year
                      Date{"23:59:59,29.02.24", "1000 4001 D7A4 0000"},    // 60370
                      Date{"23:59:59,28.02.23", "1000 4001 D4C8 0000"},    // 60004: none
                      Date{"23:59:59,30.04.26", "1000 4001 DDD2 0000"},    // 61161
                      Date{"00:00:59,01.01.00", "1000 4001 92B0 0040"},    // 51544
                      Date{"23:59:59,31.12.99", "1000 4002 B00A 0000"}));  // 88069, which has the highest bit

TEST(ClockGroup, HasTheStandardsExampleOfADay) {
    // IEC 62106, annex G: 6 September 1982 is MJD 45218, 01 and 011 0000 1010 0010. 10:05 is 0 1010 and 000101.
    sim::InstrumentSettings settings;
    settings.rdsOn = true;
    Composer composer{nullptr};
    composer.take({settings, "", "", 0ms});
    const AirTime minute = AirTime{std::chrono::sys_days{std::chrono::year{1982} / 9 / 6}} + 10h + 5min;
    const Group expected{{0x1000, 0x4001, 0x6144, 0xA140}};
    EXPECT_EQ(composer.next(minute - kGroupTime).group, expected);
}

TEST(ClockGroup, IsTheOneWhoseEndIsNearest) {
    // Half a group is 52 bits.
    sim::InstrumentSettings settings;
    settings.rdsOn = true;
    Composer composer{nullptr};
    composer.take({settings, "", "", 0ms});
    const AirTime begin = AirTime{std::chrono::sys_days{std::chrono::year{2026} / 1 / 1}} + 1min - kGroupTime;
    const auto isClock = [&](int bits) {
        return (composer.next(begin + bits * kBitTime).group.blocks[1] & 0xF800) == 0x4000;
    };
    EXPECT_FALSE(isClock(-53));
    EXPECT_TRUE(isClock(-52));
    EXPECT_TRUE(isClock(0));
    EXPECT_TRUE(isClock(51));
    EXPECT_FALSE(isClock(52));  // as near as the one before, which was it
}

}  // namespace
}  // namespace kdx::air
