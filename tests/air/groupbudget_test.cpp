#include "air/groupbudget.h"

#include "airtest.h"

namespace kdx::air {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using What = GroupBudget::What;

constexpr double kGroup = 104 / 1187.5;  // seconds
constexpr const char* kMessage = "8A=01,0812345678";
constexpr const char* kAnnouncement = "3A=01,106100CD46";

class GroupBudgetTest : public AirTest {
protected:
    GroupBudget budget() { return groupBudgetOf(broadcast.transmission()); }
    GroupBudget::Item item(What what) { return budget().items.at(static_cast<std::size_t>(what)); }
    void expectWait(What what, double meanGroups, double worstGroups) {
        const auto wait = item(what).wait;
        ASSERT_TRUE(wait) << nameOf(what);
        EXPECT_NEAR(wait->mean, meanGroups * kGroup, 1e-9) << nameOf(what);
        EXPECT_NEAR(wait->worst, worstGroups * kGroup, 1e-9) << nameOf(what);
    }
    std::vector<std::string> shares() {
        std::vector<std::string> texts;
        for (const auto& [type, share] : budget().shares) {
            std::string text = nameOf(type);
            texts.push_back(text.append(" ").append(std::to_string(share)));
        }
        return texts;
    }
    void setNetwork() {
        coder("EON-PI=D7A1");
        coder("EON-PS=D7A1,MESSTURM");
    }
};

// A radio that tunes in loses the group under way: half a group on the average, a whole one at worst. To that comes
// what it needs from the beginning of the next group, the mean and the greatest of all slots.

TEST_F(GroupBudgetTest, OfNothingBut0AHoldsItsFourSegments) {
    EXPECT_THAT(shares(), ElementsAre("0A 1.000000"));  // 2A has no text to send
    expectWait(What::Ps, 4.5, 5);
    expectWait(What::Ta, 1.5, 2);
    for (const What what : {What::AfLists, What::Radiotext, What::Networks, What::TrafficMessage}) {
        EXPECT_FALSE(item(what).isSet) << nameOf(what);
        EXPECT_FALSE(item(what).wait) << nameOf(what);
    }
}

/// Slots 0A, 2A. PS in 0, 2, 4, 6: 7 groups from the first slot on, 8 from the other. The text "HELLO" with its end
/// mark takes two segments: 4 groups from 0A on, 3 from 2A on. TA: 1 and 2.
TEST_F(GroupBudgetTest, OfTurnsWithTheRadiotext) {
    coder("RT=10,0,HELLO");
    EXPECT_THAT(shares(), ElementsAre("0A 0.500000", "2A 0.500000"));
    expectWait(What::Ps, 8, 9);
    expectWait(What::Radiotext, 4, 5);
    expectWait(What::Ta, 2, 3);
    EXPECT_THAT(budget().warnings, IsEmpty());
}

/// 64 characters are 16 segments of 2A. In 0A, 2A, 2A they take from 0A on: 8 rounds, 24 groups; from the first 2A on:
/// 23; from the second: that one, 0A, seven rounds but for their last 0A, and 2A once more: 1 + 7 * 3 + 2 = 24.
TEST_F(GroupBudgetTest, OfALongRadiotext) {
    coder("GS=0A,2A,2A");
    coder("RT=10,0," + std::string(64, 'x'));
    expectWait(What::Radiotext, (24 + 23 + 24) / 3.0 + 0.5, 25);
}

/// 2B has the first 32 characters in 16 segments: 31 groups from 2B on, 32 from 0A on.
TEST_F(GroupBudgetTest, Of2BWithALongRadiotextWarns) {
    coder("GS=0A,2B");
    coder("RT=10,0," + std::string(32, 'x'));
    expectWait(What::Radiotext, 32, 33);
    EXPECT_THAT(budget().warnings, IsEmpty());
    coder("RT=10,0," + std::string(33, 'x'));
    expectWait(What::Radiotext, 32, 33);
    EXPECT_THAT(budget().warnings, ElementsAre("2B in the sequence with a radiotext above 32 characters"));
}

/// 32 characters and the end mark are 9 segments of 2A, 16 of 2B. They count on from 0 in 2A and 1 in 2B to 8 and 9,
/// then 2A begins anew: the odd ones of 2A never come, nor the even ones of 2B. Of three characters and the end mark 2A
/// has the one segment that there is, each time.
TEST_F(GroupBudgetTest, OfMixedRadiotextTellsWhetherItIsEverWhole) {
    coder("GS=2A,2B,0A,0A");
    coder("RT=10,0," + std::string(32, 'x'));
    EXPECT_TRUE(item(What::Radiotext).isSet);
    EXPECT_FALSE(item(What::Radiotext).wait);
    EXPECT_THAT(budget().warnings, ElementsAre("2A and 2B in one sequence: neither ever sends the whole radiotext"));
    coder("RT=10,0,ABC");
    expectWait(What::Radiotext, (1 + 4 + 3 + 2) / 4.0 + 0.5, 5);
    EXPECT_THAT(budget().warnings, ElementsAre("2A and 2B in one sequence: their segments have different lengths"));
}

/// Four frequencies and their count take the pairs 228 + one, two, one + filler: three groups 0A from the count on,
/// five from the second pair on, four from the third. With every other group 0A it is 5, 9 or 7 groups from 0A on, and
/// 10, 8 or 6 from 2A on.
TEST_F(GroupBudgetTest, OfAfLists) {
    coder("AF=N,91.7,104.2,88.1,93.6");
    expectWait(What::AfLists, (3 + 5 + 4) / 3.0 + 0.5, 6);
    coder("RT=10,0,HELLO");
    expectWait(What::AfLists, (5 + 9 + 7 + 10 + 8 + 6) / 6.0 + 0.5, 11);
    coder("GS=0B,2A");
    EXPECT_TRUE(item(What::AfLists).isSet);
    EXPECT_FALSE(item(What::AfLists).wait);
    EXPECT_THAT(budget().warnings, ElementsAre("AF lists are set but 0A has no slot"));
}

/// Four variants of PS, one of type and TA: 9 groups from 14A on, 10 from 0A on. A second network doubles them: 19, 20.
TEST_F(GroupBudgetTest, OfNetworks) {
    setNetwork();
    EXPECT_TRUE(item(What::Networks).isSet);
    EXPECT_FALSE(item(What::Networks).wait);
    EXPECT_THAT(budget().warnings, testing::Contains("EON is set but 14A has no slot"));
    coder("GS=0A,14A");
    EXPECT_THAT(shares(), ElementsAre("0A 0.500000", "14A 0.500000"));
    expectWait(What::Networks, 10, 11);
    EXPECT_THAT(budget().warnings, IsEmpty());
    coder("EON-PI=D7A3");
    expectWait(What::Networks, 20, 21);
}

/// Slots 0A, 3A, 8A: from 0A on 3 groups, from 3A on 2, from 8A on (which means nothing yet) 4.
TEST_F(GroupBudgetTest, OfTrafficMessagesAwaitsTheirAnnouncementFirst) {
    coder("GS=0A,3A,8A");
    EXPECT_THAT(budget().warnings, testing::Not(testing::Contains("8A without 3A")));
    coder(kMessage);
    EXPECT_FALSE(item(What::TrafficMessage).wait);
    EXPECT_THAT(budget().warnings,
                ElementsAre("8A without 3A", "3A in the sequence has nothing to send: the slot sends 0A"));
    coder(kAnnouncement);
    expectWait(What::TrafficMessage, 3.5, 5);
    EXPECT_THAT(budget().warnings, ElementsAre("PS takes 1.2 s: more than 1 s is noticed"));  // 13 groups: 1.139 s
    coder("GS=0A,8A");
    EXPECT_THAT(budget().warnings, ElementsAre("8A without 3A"));
    coder("GS=0A");
    EXPECT_THAT(budget().warnings, ElementsAre("a traffic message is set but 8A has no slot"));
}

/// One slot of eight: 4 * 8 groups from the slot behind it on, and the one that was lost: 33, 2.890 s.
TEST_F(GroupBudgetTest, WarnsOfAPsThatTakesLongerThanASecond) {
    coder("GS=0A,2A,2A,2A,2A,2A,2A,2A");
    coder("RT=10,0,HELLO");
    expectWait(What::Ps, (25 + 26 + 27 + 28 + 29 + 30 + 31 + 32) / 8.0 + 0.5, 33);
    EXPECT_THAT(budget().warnings, ElementsAre("PS takes 2.9 s: more than 1 s is noticed"));
    coder("GS=0A,2A,0A,2A,2A");  // 10 groups at most, 11 with the lost one: 0.963 s
    EXPECT_THAT(budget().warnings, IsEmpty());
    coder("GS=2A");
    EXPECT_FALSE(item(What::Ps).wait);
    EXPECT_FALSE(item(What::Ta).wait);
    EXPECT_THAT(budget().warnings, ElementsAre("PS is never sent: neither 0A nor 0B has a slot"));
    coder("GS=15B,2A");
    expectWait(What::Ta, 2, 3);
}

TEST_F(GroupBudgetTest, WarnsOfSlotsThatAlwaysPassTo0A) {
    coder("GS=0A,1A,4A,1A,8A,14A,14B");
    coder(kAnnouncement);
    EXPECT_THAT(shares(), ElementsAre("0A 1.000000"));
    EXPECT_THAT(budget().warnings,
                ElementsAre("8A without 3A", "1A in the sequence has nothing to send: the slot sends 0A",
                            "4A in the sequence: the clock comes at the full minute, the slot sends 0A",
                            "8A in the sequence has nothing to send: the slot sends 0A",
                            "14A in the sequence has nothing to send: the slot sends 0A",
                            "14B in the sequence has nothing to send: the slot sends 0A"));
}

TEST_F(GroupBudgetTest, WarnsOfARadiotextWithoutASlot) {
    coder("GS=0A");
    coder("RT=10,0,HELLO");
    EXPECT_THAT(budget().warnings, ElementsAre("radiotext is set but neither 2A nor 2B has a slot"));
}

/// Eleven networks of 5 groups, one slot of 32: 54 * 32 + 1 groups from the 14A on, up to 55 * 32 from the slot behind
/// it on, and the lost one: 1761 groups, 154.23 s.
TEST_F(GroupBudgetTest, WarnsOfNetworksThatTakeLongerThanTwoMinutes) {
    for (int i = 10; i < 21; ++i) coder("EON-PI=D7" + std::to_string(i));
    std::string sequence = "14A";
    for (int i = 1; i < 32; ++i) sequence += ",0A";
    coder("GS=" + sequence);
    expectWait(What::Networks, 55 * 32 - 31 / 2.0 + 0.5, 1761);
    EXPECT_THAT(budget().warnings, ElementsAre("EON takes 154.3 s: all networks should come within 2 minutes"));
}

/// One group of 104 bits in the 71250 bits of a minute.
TEST_F(GroupBudgetTest, CountsTheClock) {
    coder("CT=12:00:00,01.01.26");
    const auto shares = budget().shares;
    ASSERT_EQ(shares.size(), 2U);
    EXPECT_EQ(nameOf(shares[1].type), "4A");
    EXPECT_DOUBLE_EQ(shares[1].share, 104.0 / 71250);
    EXPECT_DOUBLE_EQ(shares[0].share, 1 - 104.0 / 71250);
}

TEST_F(GroupBudgetTest, OfNoGroupsIsEmpty) {
    coder("BIN=2");
    EXPECT_THAT(shares(), IsEmpty());
    EXPECT_FALSE(item(What::Ps).wait);
    EXPECT_THAT(budget().warnings, ElementsAre("a test pattern goes out instead of groups"));
    tell(":STEREO:RDS:STATE OFF");
    EXPECT_THAT(budget().warnings, ElementsAre("RDS is off: no groups go out"));
}

}  // namespace
}  // namespace kdx::air
