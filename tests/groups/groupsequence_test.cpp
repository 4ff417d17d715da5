#include "groups/groupsequence.h"

#include <gtest/gtest.h>

#include <limits>

namespace kdx {
namespace {

TEST(GroupSequenceTest, AGroupIsItsNumberAndAnAWithAComma) {
    EXPECT_EQ(groupText(0), "0A,");
    EXPECT_EQ(groupText(8), "8A,");
    EXPECT_EQ(groupText(15), "15A,");
}

TEST(GroupSequenceTest, TheCoderGetsTheSequenceWithoutItsLastComma) {
    EXPECT_EQ(sequenceToSend("0A,2A,8A,"), "0A,2A,8A");
    EXPECT_EQ(sequenceToSend("15A,"), "15A");
    EXPECT_EQ(sequenceToSend(","), "");
    EXPECT_EQ(sequenceToSend(""), "");
}

TEST(GroupSequenceTest, TheLastCharacterGoesEvenWhenItIsNoComma) {
    EXPECT_EQ(sequenceToSend("0A,2A"), "0A,2");
}

TEST(GroupSequenceTest, AFullCounterStaysFull) {
    std::int16_t counter = 0;
    countUp(counter);
    EXPECT_EQ(counter, 1);
    counter = std::numeric_limits<std::int16_t>::max() - 1;
    countUp(counter);
    countUp(counter);
    EXPECT_EQ(counter, 32767);
}

}  // namespace
}  // namespace kdx
