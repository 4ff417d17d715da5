#include "air/shadow.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/fakeclock.h"

namespace kdx::air {
namespace {

using namespace std::chrono_literals;
using ::testing::HasSubstr;
using ::testing::UnorderedElementsAre;

/// A shadow just begun at noon of the 5th of March 2009.
class ShadowTest : public ::testing::Test {
protected:
    void coder(const std::string& command) { shadow.take(":STEREO:DIRECT \"" + command + "\""); }
    void rdsOn() { shadow.take(":STEREO:RDS:STATE ON"); }
    void look() {
        shadow.setWatched(true);
        shadow.catchUp();
    }
    std::size_t count(GroupType type) const {
        const auto found = shadow.types().find(type);
        return found == shadow.types().end() ? 0 : found->second.count;
    }

    test::FakeClock clock;
    Shadow shadow{clock};
};

TEST_F(ShadowTest, TheRadioShowsWhatTheCommandsMakeOfTheCoder) {
    rdsOn();
    coder("PI=D3C1");
    coder("PS=MESSTURM");
    coder("RT=10,0,Guten Tag");
    look();
    clock.advance(2s);
    shadow.catchUp();
    EXPECT_EQ(shadow.radio().pi, 0xD3C1);
    EXPECT_EQ(shadow.radio().psText(), "MESSTURM");
    EXPECT_EQ(shadow.radio().radiotextText(), "Guten Tag");
}

TEST_F(ShadowTest, NoGroupsAreMadeWhileNobodyLooks) {
    rdsOn();
    clock.advance(1h);
    coder("PS=MESSTURM");
    EXPECT_EQ(shadow.count(), 0U);
    EXPECT_TRUE(shadow.sent().empty());
}

TEST_F(ShadowTest, WhoLooksFindsTheRadioTunedInAtTheLastCommand) {
    rdsOn();
    clock.advance(1h);
    coder("PS=MESSTURM");
    clock.advance(300ms);
    look();
    EXPECT_EQ(shadow.count(), 3U) << "a group takes 87.6 ms";
    EXPECT_EQ(shadow.radio().psText(), "MESSTU  ");
}

TEST_F(ShadowTest, OfALongTimeOnlyTheEndCounts) {
    rdsOn();
    look();
    clock.advance(1h);
    shadow.catchUp();
    EXPECT_LE(shadow.count(), 229U) << "twenty seconds";
    EXPECT_EQ(shadow.sent().size(), Shadow::kMostKept);
    EXPECT_EQ(shadow.radio().psText(), "KDX-X4  ");
    const AirTime noon = airTimeOf(clock);
    EXPECT_LE(shadow.sent().back().end, noon);
    EXPECT_GT(shadow.sent().back().end + kGroupTime, noon);
}

TEST_F(ShadowTest, WhatWentOutBeforeACommandHadTheSettingsBeforeIt) {
    rdsOn();
    look();
    clock.advance(1s);
    coder("PI=D3C1");
    clock.advance(1s);
    shadow.catchUp();
    ASSERT_EQ(shadow.sent().size(), 22U);
    EXPECT_EQ(shadow.sent()[10].what.group.blocks[0], 0x1000);
    EXPECT_EQ(shadow.sent()[11].what.group.blocks[0], 0xD3C1);
    EXPECT_EQ(shadow.sent()[10].settings->pi, "1000");
    EXPECT_EQ(shadow.sent()[11].settings->pi, "D3C1");
}

TEST_F(ShadowTest, GroupsAreCountedByTypeAmongWhatIsKept) {
    rdsOn();
    coder("GS=0A,2A,0A,15B");
    coder("RT=10,0,A");
    look();
    clock.advance(19s);
    shadow.catchUp();
    EXPECT_EQ(count(GroupType::Basic0A), 100U);
    EXPECT_EQ(count(GroupType::Radiotext2A), 50U);
    EXPECT_EQ(count(GroupType::Tuning15B), 50U);
    EXPECT_EQ(shadow.types().at(GroupType::Basic0A).latest.blocks[0], 0x1000);
    coder("GS=0A");
    clock.advance(19s);
    shadow.catchUp();
    EXPECT_EQ(count(GroupType::Basic0A), Shadow::kMostKept);
    EXPECT_EQ(shadow.types().size(), 1U);
}

TEST_F(ShadowTest, TheRadioForgetsAfterAWhileWithoutGroups) {
    rdsOn();
    look();
    clock.advance(2s);
    shadow.take(":STEREO:RDS:STATE OFF");
    clock.advance(2s);
    shadow.catchUp();
    EXPECT_TRUE(shadow.radio().pi.has_value());
    clock.advance(4s);
    shadow.catchUp();
    EXPECT_FALSE(shadow.radio().pi.has_value());
}

TEST_F(ShadowTest, AClockThatIsSetBackBeginsAnew) {
    rdsOn();
    look();
    clock.advance(5s);
    shadow.catchUp();
    clock.set(11 * 3600.0);
    shadow.catchUp();
    EXPECT_TRUE(shadow.sent().empty());
    clock.advance(1s);
    shadow.catchUp();
    EXPECT_EQ(shadow.sent().size(), 11U);
}

TEST_F(ShadowTest, AnAnnouncementNobodySawIsOver) {
    rdsOn();
    coder("EON-PI=D3C2");
    coder("EON-TP=D3C2,1");
    coder("EON-TA=D3C2,1");
    clock.advance(5s);
    look();
    EXPECT_EQ(count(GroupType::Networks14B), 0U);
    coder("EON-TA=D3C2,0");
    clock.advance(2s);
    shadow.catchUp();
    EXPECT_EQ(count(GroupType::Networks14B), 8U);
}

TEST_F(ShadowTest, WarnsOfWhatCannotBeSentWhileItIsSet) {
    coder(
        "PS=A\xA6"
        "C     ");
    EXPECT_THAT(shadow.warnings(), UnorderedElementsAre(HasSubstr("PS: \"\xC2\xA6\"")));
    coder("PS=ABC     ");
    EXPECT_TRUE(shadow.warnings().empty());
}

TEST_F(ShadowTest, ARefusedCommandIsToldUntilOneIsTaken) {
    coder("PI=XYZ ");
    EXPECT_TRUE(shadow.isRefused("PI", "XYZ"));
    EXPECT_FALSE(shadow.isRefused("PI", "D3C1")) << "that was never sent";
    EXPECT_THAT(shadow.warnings(), UnorderedElementsAre(HasSubstr("refused: :STEREO:DIRECT \"PI=XYZ \"")));
    coder("PS=ABC     ");
    EXPECT_TRUE(shadow.isRefused("PI", "XYZ"));
    coder("PI=D3C1");
    EXPECT_FALSE(shadow.isRefused("PI", "XYZ"));
    EXPECT_TRUE(shadow.warnings().empty());
    shadow.take(":STEREO:PILOT:PHASE 999DEG");
    EXPECT_TRUE(shadow.isRefused(":STEREO:PILOT:PHASE", "999DEG"));
}

TEST_F(ShadowTest, ARefusedListIsToldHoweverManyFollowIt) {
    coder("AF=N,98.5,66.0");
    coder("AF=+,98.5,89.3");
    coder("AF=+,98.5,200");
    coder("AF=+,98.5,200");
    EXPECT_THAT(shadow.warnings(), UnorderedElementsAre(HasSubstr("AF=N,98.5,66.0"), HasSubstr("AF=+,98.5,200")));
    coder("AF=N,98.5,89.3");
    EXPECT_TRUE(shadow.warnings().empty()) << "all lists begin anew";
}

TEST_F(ShadowTest, WhatIsRefusedOfOneNetworkIsNoneOfAnothers) {
    coder("EON-PI=D3C2");
    coder("EON-PI=D3C3");
    coder("EON-TP=D3C2,7");
    coder("EON-TP=D3C3,1");
    EXPECT_THAT(shadow.warnings(), UnorderedElementsAre(HasSubstr("EON-TP=D3C2,7")));
    coder("EON-TP=D3C2,1");
    EXPECT_TRUE(shadow.warnings().empty());
}

TEST_F(ShadowTest, AHundredRefusalsAreKept) {
    for (int i = 0; i < 1000; ++i) shadow.take("NO:SUCH:COMMAND" + std::to_string(i) + " 1");
    EXPECT_EQ(shadow.warnings().size(), 100U);
}

}  // namespace
}  // namespace kdx::air
