#include "air/airtest.h"

#include <set>

namespace kdx::air {
namespace {

class Frequencies : public AirTest {
protected:
    Frequencies() { coder("GS=0A"); }
    Groups pairs(int count) { return block(3, count); }
};

TEST_F(Frequencies, HaveCodesFrom87Point6To107Point9) {
    // IEC 62106, 6.2.1.6.1: 1 is 87.6 MHz, 204 is 107.9 MHz, each step 0.1 MHz.
    EXPECT_EQ(frequencyCode(87.6), 1);
    EXPECT_EQ(frequencyCode(87.7), 2);
    EXPECT_EQ(frequencyCode(100.0), 125);
    EXPECT_EQ(frequencyCode(107.9), 204);
    std::set<int> codes;
    for (int tenths = 876; tenths <= 1079; ++tenths) codes.insert(frequencyCode(tenths / 10.0).value_or(0));
    EXPECT_EQ(codes.size(), 204U);
    EXPECT_EQ(*codes.begin(), 1);
    for (const double none : {86.0, 87.5, 87.55, 87.65, 108.0, 0.0})
        EXPECT_EQ(frequencyCode(none), std::nullopt) << none;
}

TEST_F(Frequencies, WithoutAListItIsSaidThatThereAreNone) {
    EXPECT_EQ(pairs(3), (Groups{"E0CD", "E0CD", "E0CD"}));
}

TEST_F(Frequencies, MethodACountsTheTunedFrequencyWhichIsFirst) {
    // 87.6, 90.1, 94.3: 1, 26, 68 behind 224 + 3.
    coder("AF=N,87.6,90.1,94.3");
    EXPECT_EQ(pairs(3), (Groups{"E301", "1A44", "E301"}));
}

TEST_F(Frequencies, MethodAIsFilledUpAfterAnEvenCount) {
    coder("AF=N,87.6,90.1,94.3,107.9");
    EXPECT_EQ(pairs(4), (Groups{"E401", "1A44", "CCCD", "E401"}));
    coder("AF=N,87.60, 90.1");
    EXPECT_EQ(pairs(3), (Groups{"E201", "1ACD", "E201"}));
}

TEST_F(Frequencies, ATunedFrequencyAloneCountsOne) {
    coder("AF=N,87.6");
    EXPECT_EQ(pairs(2), (Groups{"E101", "E101"}));
}

TEST_F(Frequencies, ATunedFrequencyThatFindsNoRoomIsLeftOut) {
    std::string alternatives;
    for (int i = 0; i < 24; ++i) alternatives += "," + std::to_string(89 + i / 10) + "." + std::to_string(i % 10);
    coder("AF=N,87.6" + alternatives);  // codes 15 to 38, 25 with the tuned one: 224 + 25
    EXPECT_EQ(pairs(14), (Groups{"F901", "0F10", "1112", "1314", "1516", "1718", "191A", "1B1C", "1D1E", "1F20", "2122",
                                 "2324", "2526", "F901"}));
    coder("AF=N,87.6" + alternatives + ",91.4");
    EXPECT_EQ(pairs(14), (Groups{"F90F", "1011", "1213", "1415", "1617", "1819", "1A1B", "1C1D", "1E1F", "2021", "2223",
                                 "2425", "2627", "F90F"}));
    EXPECT_TRUE(warnings.empty());
}

TEST_F(Frequencies, MethodBSendsThePairsAsGiven) {
    // The standard's example of method B: eleven frequencies around 89.3 MHz, two of the pairs rising, three falling.
    coder("AF=N,89.3,89.3,99.5,89.3,101.7,88.8,89.3,102.6,89.3,89.3,89.0");
    EXPECT_EQ(pairs(7), (Groups{"EB12", "1278", "128E", "0D12", "9712", "120F", "EB12"}));
}

TEST_F(Frequencies, MethodBHoldsTwelveAlternatives) {
    std::string list = "100.0";
    for (int i = 0; i < 12; ++i) list += ",100.0,10" + std::to_string(1 + i / 10) + "." + std::to_string(i % 10);
    coder("AF=N," + list);  // 100.0 is 125, 101.0 to 102.1 are 135 to 146; 224 + 25
    EXPECT_EQ(pairs(14), (Groups{"F97D", "7D87", "7D88", "7D89", "7D8A", "7D8B", "7D8C", "7D8D", "7D8E", "7D8F", "7D90",
                                 "7D91", "7D92", "F97D"}));
}

TEST_F(Frequencies, OnlyAListThatRepeatsTheTunedOneInEveryPairIsMethodB) {
    coder("AF=N,87.6,87.6,90.1,90.2,90.3");
    EXPECT_EQ(pairs(4), (Groups{"E501", "011A", "1B1C", "E501"}));
    coder("AF=N,87.6,87.6,90.1,87.6");
    EXPECT_EQ(pairs(3), (Groups{"E401", "011A", "01CD"}));
}

TEST_F(Frequencies, SeveralListsGoOneAfterTheOther) {
    coder("AF=N,87.6,90.1");
    coder("AF=+,94.3,94.3,107.9");
    coder("AF=+,100.0");
    EXPECT_EQ(pairs(6), (Groups{"E201", "1ACD", "E344", "44CC", "E17D", "E201"}));
}

TEST_F(Frequencies, NewListsBeginAtTheirFirstPairTheSameOnesGoOn) {
    coder("AF=N,87.6,90.1,94.3");
    EXPECT_EQ(pairs(1), (Groups{"E301"}));
    coder("PS=OTHER");
    coder("AF=N,87.6,90.1,94.3");
    EXPECT_EQ(pairs(1), (Groups{"1A44"}));
    EXPECT_EQ(pairs(1), (Groups{"E301"}));
    coder("AF=N,87.7");
    EXPECT_EQ(pairs(1), (Groups{"E102"}));
}

TEST_F(Frequencies, OneWithoutACodeIsLeftOutOfMethodAAndTold) {
    coder("AF=N,86.0,90.1,108.0,94.3,87.65");
    EXPECT_EQ(pairs(3), (Groups{"E21A", "44CD", "E21A"}));
    EXPECT_EQ(warnings, (Groups{"AF list 1: 86.0 MHz has no code and is left out",
                                "AF list 1: 108.0 MHz has no code and is left out",
                                "AF list 1: 87.65 MHz has no code and is left out"}));
}

TEST_F(Frequencies, AListWithoutAnyCodeIsNone) {
    coder("AF=N,86.0,108.0");
    EXPECT_EQ(pairs(2), (Groups{"E0CD", "E0CD"}));
    coder("AF=+,87.6");
    EXPECT_EQ(pairs(2), (Groups{"E101", "E101"}));
}

TEST_F(Frequencies, OfMethodBThePairOfOneWithoutACodeIsLeftOut) {
    coder("AF=N,87.6,87.6,108.0,87.6,94.3");
    EXPECT_EQ(pairs(3), (Groups{"E301", "0144", "E301"}));
    EXPECT_EQ(warnings, (Groups{"AF list 1: 108.0 MHz has no code and is left out"}));
}

TEST_F(Frequencies, ATunedOneWithoutACodeLeavesOutItsListOfMethodB) {
    coder("AF=N,87.6,90.1");
    coder("AF=+,86.0,86.0,90.1,86.0,94.3");
    EXPECT_EQ(pairs(3), (Groups{"E201", "1ACD", "E201"}));
    EXPECT_EQ(warnings, (Groups{"AF list 2: the tuned frequency 86.0 MHz has no code, so the list is left out"}));
}

TEST(Warnings, WhatIsSentOnAndOnIsToldAThousandTimesAtMost) {
    std::vector<std::string> told;
    Warnings warnings([&told](const std::string& text) { told.push_back(text); });
    for (int twice = 0; twice < 2; ++twice) {
        for (int number = 0; number < 3000; ++number) warnings.add(std::to_string(number));
    }
    EXPECT_EQ(told.size(), 1001U);
    EXPECT_EQ(told.back(), "further warnings are left out");
}

}  // namespace
}  // namespace kdx::air
