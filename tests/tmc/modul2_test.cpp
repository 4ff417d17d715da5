#include "tmc/modul2.h"

#include <gtest/gtest.h>

#include <bitset>
#include <cmath>
#include <limits>
#include <string>

namespace kdx {
namespace {

using Modul2::BinaryToValue;
using Modul2::ToBinary16;

TEST(ToBinary16Test, GivesTheSixteenBitsOfEveryNumberUpTo65535) {
    for (unsigned number = 0; number < 65536; ++number) {
        ASSERT_EQ(ToBinary16(static_cast<float>(number)), std::bitset<16>(number).to_string());
    }
}

TEST(ToBinary16Test, LeavesOutAFraction) {
    EXPECT_EQ(ToBinary16(5.75F), "0000000000000101");
}

TEST(ToBinary16Test, WritesTheFirstDigitOfALargerNumberAsDecimalText) {
    EXPECT_EQ(ToBinary16(65536.0F), "2000000000000000");
    EXPECT_EQ(ToBinary16(99999.0F), "3000011010011111");
    EXPECT_EQ(ToBinary16(10.0F * 32768 + 1), "10000000000000001");  // a 17th character
}

TEST(ToBinary16Test, CutToItsLastCharactersALargerNumberKeepsItsLowBits) {
    for (const unsigned number : {65536U, 65541U, 99999U, 131071U, 1000001U}) {
        const std::string digits = ToBinary16(static_cast<float>(number));
        EXPECT_EQ(digits.substr(digits.size() - 11), std::bitset<11>(number & 0x7FFU).to_string());
    }
}

TEST(ToBinary16Test, GivesNegativeDigitsForANegativeNumber) {
    EXPECT_EQ(ToBinary16(-1.0F), "000000000000000-1");
    EXPECT_EQ(ToBinary16(-3.0F), "00000000000000-1-1");
    EXPECT_EQ(ToBinary16(-0.5F), "0000000000000000");
}

TEST(ToBinary16Test, SurvivesTheLargestNumbers) {
    EXPECT_TRUE(ToBinary16(std::numeric_limits<float>::max()).ends_with("000000000000000"));
    EXPECT_TRUE(ToBinary16(std::numeric_limits<float>::lowest()).ends_with("000000000000000"));
}

TEST(ToBinary16Test, FindsNoDigitsInInfinityAndNan) {
    const std::string zeros(16, '0');
    EXPECT_EQ(ToBinary16(std::numeric_limits<float>::infinity()), zeros);
    EXPECT_EQ(ToBinary16(-std::numeric_limits<float>::infinity()), zeros);
    EXPECT_EQ(ToBinary16(std::numeric_limits<float>::quiet_NaN()), zeros);
}

TEST(BinaryToValueTest, ReadsBackEverySixteenBitNumber) {
    for (unsigned number = 0; number < 65536; ++number) {
        ASSERT_EQ(BinaryToValue(std::bitset<16>(number).to_string()), number);
    }
}

TEST(BinaryToValueTest, ReadsTextsOfAnyLength) {
    EXPECT_EQ(BinaryToValue(""), 0);
    EXPECT_EQ(BinaryToValue("1"), 1);
    EXPECT_EQ(BinaryToValue("10"), 2);
    EXPECT_EQ(BinaryToValue("1" + std::string(40, '0')), std::ldexp(1.0, 40));
}

TEST(BinaryToValueTest, CountsEachCharacterWithItsNumericValue) {
    EXPECT_EQ(BinaryToValue("2"), 2);
    EXPECT_EQ(BinaryToValue("3001"), 25);
    EXPECT_EQ(BinaryToValue("9999"), 135);
}

TEST(BinaryToValueTest, CountsWhatIsNoDigitAsNothing) {
    EXPECT_EQ(BinaryToValue("-"), 0);
    EXPECT_EQ(BinaryToValue("1-x1"), 9);
    EXPECT_EQ(BinaryToValue("1 1"), 5);
}

}  // namespace
}  // namespace kdx
