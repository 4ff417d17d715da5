#include "rds/dynamicpsrule.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace kdx {
namespace {

TEST(DynamicPsRule, TheTextScrollsFromItsFirstCharacterToBlanksAndAgain) {
    DynamicPsRecord record;
    for (const char* shown : {"ABCDEFGH", "BCDEFGHI", "CDEFGHI ", "DEFGHI  ", "EFGHI   ", "FGHI    ", "GHI     ",
                              "HI      ", "I       ", "        ", "ABCDEFGH"}) {
        EXPECT_EQ(nextScrollPs(record, "ABCDEFGHI"), shown);
    }
}

TEST(DynamicPsRule, AnEmptyTextScrollsAsBlanks) {
    DynamicPsRecord record;
    for (int step = 0; step < 3; ++step) EXPECT_EQ(nextScrollPs(record, ""), "        ");
}

TEST(DynamicPsRule, TheMarkerComesFirstAndInTurnWithTheName) {
    DynamicPsRecord record;
    EXPECT_EQ(nextTogglePs(record, "RADIO"), kPsMarker);
    EXPECT_EQ(nextTogglePs(record, "RADIO"), "RADIO");
    EXPECT_EQ(nextTogglePs(record, "OTHER"), kPsMarker);
    EXPECT_EQ(nextTogglePs(record, "OTHER"), "OTHER");
}

TEST(DynamicPsRule, PagesTakeUpTo71Characters) {
    DynamicPsRecord record;
    EXPECT_EQ(nextPagePs(record, std::string(71, 'x')), "");
    EXPECT_EQ(record.length, 8);
    EXPECT_THROW((void)nextPagePs(record, std::string(72, 'x')), std::out_of_range);
    EXPECT_THROW((void)nextPagePs(record, std::string(200, 'x')), std::out_of_range);
}

}  // namespace
}  // namespace kdx
