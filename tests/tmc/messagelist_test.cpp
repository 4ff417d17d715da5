#include "tmc/messagelist.h"

#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

namespace kdx {
namespace {

std::vector<int> positions(int messageCount, int ticks) {
    std::vector<int> sent;
    sent.reserve(static_cast<std::size_t>(ticks));
    int position = 0;
    for (int tick = 0; tick < ticks; ++tick) sent.push_back(position = nextPosition(position, messageCount));
    return sent;
}

TEST(MessageEntryTest, HoldsLocationEventAndCodeInFixedColumns) {
    EXPECT_EQ(messageEntry("Musterstadt", "Stau", "0810013039"),
              "Musterstadt" + std::string(24, ' ') + "  :" + "Stau" + std::string(31, ' ') + "   :" + "0810013039");
}

TEST(MessageEntryTest, CutsLongTextsAndKeepsTheCode) {
    const std::string entry = messageEntry(std::string(47, 'L'), std::string(47, 'E'), "0810013039");
    EXPECT_EQ(entry, std::string(35, 'L') + "  :" + std::string(35, 'E') + "   :0810013039");
    EXPECT_EQ(codeOfMessage(entry), "0810013039");
}

TEST(NextPositionTest, RunsThroughTheListStartingWithTheSecondMessage) {
    EXPECT_EQ(positions(2, 4), (std::vector{1, 0, 1, 0}));
    EXPECT_EQ(positions(3, 6), (std::vector{1, 2, 0, 1, 2, 0}));
}

TEST(NextPositionTest, StaysAtTheOnlyMessage) {
    EXPECT_EQ(positions(1, 3), (std::vector{0, 0, 0}));
}

TEST(NextPositionTest, ReachesAllOfTwentyMessages) {
    const std::vector<int> sent = positions(20, 21);
    EXPECT_EQ(sent.at(0), 1);
    EXPECT_EQ(sent.at(18), 19);
    EXPECT_EQ(sent.at(19), 0);
    EXPECT_EQ(sent.at(20), 1);
}

TEST(NextPositionTest, OfMoreThanTwentyMessagesSendsPositionsOneToTwentyOnly) {
    for (const int count : {21, 22, 50}) {
        const std::vector<int> sent = positions(count, 41);
        for (std::size_t tick = 0; tick < sent.size(); ++tick) {
            EXPECT_EQ(sent[tick], static_cast<int>(tick % 20) + 1) << count << " messages, tick " << tick;
        }
    }
}

TEST(CycleTimeTest, IsRoundedToTheNearestMillisecond) {
    EXPECT_EQ(cycleTimeMs("1"), 1000);
    EXPECT_EQ(cycleTimeMs("0.0504"), 50);
    EXPECT_EQ(cycleTimeMs("0.0506"), 51);
    EXPECT_EQ(cycleTimeMs("65.535"), 65535);
    EXPECT_EQ(cycleTimeMs("65.536"), 65536);
    EXPECT_EQ(cycleTimeMs(" 2.5 s"), 2500);
    EXPECT_EQ(cycleTimeMs("-1"), -1000);
}

TEST(CycleTimeTest, IsZeroWithoutANumber) {
    EXPECT_EQ(cycleTimeMs(""), 0);
    EXPECT_EQ(cycleTimeMs("abc"), 0);
}

TEST(CycleTimeTest, IsInfiniteForANumberBeyondAllBounds) {
    EXPECT_TRUE(std::isinf(cycleTimeMs("1e999")));
}

}  // namespace
}  // namespace kdx
