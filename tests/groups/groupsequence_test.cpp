#include "groups/groupsequence.h"

#include <gtest/gtest.h>

#include <limits>

#include "support/linkfixture.h"

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

/// The sequence as a part of a data set.
class GroupSequencePart : public ::testing::Test, protected test::Bench {
protected:
    [[nodiscard]] Steps steps() const {
        Steps steps;
        sequence.appendSteps(steps);
        return steps;
    }
    GroupSequence sequence;
};

TEST_F(GroupSequencePart, ComesFromTheDataSetAtWorkAndGoesOutWithoutItsLastComma) {
    setProfile("Datenset1.INI", "RDS", "GR_Folge", "0A,2A,");
    setProfile("Datenset3.INI", "RDS", "GR_FOLGE", "0A,8A,");
    state.CurrentDataSet = "3";
    sequence.load(settings);
    EXPECT_EQ(sequence.groups, "0A,8A,");
    EXPECT_EQ(steps(), (Steps{{Step::Kind::Parameter, "GROUPSEQ", "0A,8A"}}));
}

TEST_F(GroupSequencePart, IsNoStepWithoutAGroup) {
    sequence.groups = "0A,";
    sequence.load(settings);
    EXPECT_EQ(sequence.groups, "");
    EXPECT_EQ(steps(), Steps{});
}

TEST_F(GroupSequencePart, CountsAsCutOnlyWhenItsFileHoldsMoreThanAReadingGives) {
    for (const std::size_t length : {253U, 254U, 255U}) {
        const std::string stored(length, 'x');
        setProfile("Datenset1.INI", "RDS", "GR_Folge", stored);
        setProfile("Datenset2.INI", "RDS", "GR_Folge", "0A,");
        sequence.load(settings);
        EXPECT_EQ(sequence.groups, stored.substr(0, 254));
        EXPECT_EQ(sequence.cut, length == 255) << length;
        EXPECT_EQ(sequence.exceedsReading(), length == 255) << length;
        state.CurrentDataSet = "2";  // it has another one, and is to get this
        EXPECT_EQ(sequence.isToBeStored(settings), length != 255) << length;
        state.CurrentDataSet = "1";
    }
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
