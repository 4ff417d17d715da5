#include "base/numbers.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cmath>
#include <ostream>
#include <string>

namespace kdx {
namespace {

struct NumberCase {
    const char* text;
    double value;
    friend void PrintTo(const NumberCase& number, std::ostream* out) { *out << '"' << number.text << '"'; }
};

class LeadingNumber : public ::testing::TestWithParam<NumberCase> {};

TEST_P(LeadingNumber, IsReadUpToTheFirstCharacterThatDoesNotFit) {
    EXPECT_DOUBLE_EQ(leadingNumber(GetParam().text), GetParam().value);
}

INSTANTIATE_TEST_SUITE_P(Values, LeadingNumber,
                         ::testing::Values(NumberCase{"67.5", 67.5}, NumberCase{"67.5 x", 67.5}, NumberCase{"", 0},
                                           NumberCase{"abc", 0}, NumberCase{"  \t12", 12}, NumberCase{"-3", -3},
                                           NumberCase{"+3", 3}, NumberCase{".5", 0.5}, NumberCase{"5.", 5},
                                           NumberCase{".", 0}, NumberCase{"-", 0}, NumberCase{"87,6", 87},
                                           NumberCase{"1e3", 1000}, NumberCase{"1e", 1}, NumberCase{"1e+", 1},
                                           NumberCase{"00350", 350}, NumberCase{"1.2.3", 1.2}, NumberCase{"nan", 0},
                                           NumberCase{"inf", 0}, NumberCase{"0x10", 0}, NumberCase{"1e-999", 0}));

TEST(LeadingNumberTest, ANumberTooLargeIsInfinite) {
    EXPECT_TRUE(std::isinf(leadingNumber("1e999")));
    EXPECT_LT(leadingNumber("-1e999"), 0);
}

TEST(LeadingNumberTest, ANumberTooSmallIsZeroHoweverItIsWritten) {
    const std::string zeros(400, '0');
    EXPECT_EQ(leadingNumber("0." + zeros + "1"), 0);
    EXPECT_EQ(leadingNumber("-." + zeros + "1e+50"), 0);
    EXPECT_EQ(leadingNumber("100e-99999999999999999999"), 0);
    EXPECT_EQ(leadingNumber("0.0e99999999999999999999"), 0);
}

TEST(LeadingNumberTest, ANumberTooLargeIsInfiniteHoweverItIsWritten) {
    const std::string zeros(400, '0');
    EXPECT_TRUE(std::isinf(leadingNumber("1" + zeros)));
    EXPECT_TRUE(std::isinf(leadingNumber("01" + zeros + "E-50")));
    EXPECT_TRUE(std::isinf(leadingNumber("0.01e99999999999999999999")));
}

TEST(LeadingNumberTest, TheLocaleDoesNotMatter) {
    std::setlocale(LC_ALL, "de_DE.UTF-8");
    EXPECT_DOUBLE_EQ(leadingNumber("67.5"), 67.5);
    EXPECT_EQ(shortestDecimal(67.5), "67.5");
    std::setlocale(LC_ALL, "C");
}

TEST(ShortestDecimalTest, HasNoNoiseNoBlankAndNoExponent) {
    EXPECT_EQ(shortestDecimal(675), "675");
    EXPECT_EQ(shortestDecimal(2.5), "2.5");
    EXPECT_EQ(shortestDecimal(-30), "-30");
    EXPECT_EQ(shortestDecimal(0), "0");
    EXPECT_EQ(shortestDecimal(-0.0), "0");
    EXPECT_EQ(shortestDecimal(67.6 * 10), "676");
    EXPECT_EQ(shortestDecimal(0.1 + 0.2), "0.3");
    EXPECT_EQ(shortestDecimal(0.05), "0.05");
    EXPECT_EQ(shortestDecimal(1234567890), "1234567890");
}

TEST(FixedDecimalTest, HasExactlyTheDecimalsAskedFor) {
    EXPECT_EQ(fixedDecimal(0.05, 2), "0.05");
    EXPECT_EQ(fixedDecimal(80, 1), "80.0");
    EXPECT_EQ(fixedDecimal(-4, 0), "-4");
}

TEST(TwoDigitsTest, AreTheLastTwoOfANumber) {
    EXPECT_EQ(twoDigits(0), "00");
    EXPECT_EQ(twoDigits(7), "07");
    EXPECT_EQ(twoDigits(59), "59");
    EXPECT_EQ(twoDigits(2009), "09");
}

TEST(IsDecimalTest, DigitsAloneAreTaken) {
    for (const char* text : {"0", "007", "123456789012345678901234567890"}) EXPECT_TRUE(isDecimal(text)) << text;
    for (const char* text : {"", " 1", "1 ", "-1", "+1", "1.5", "1a", "\xB2"}) EXPECT_FALSE(isDecimal(text)) << text;
}

TEST(FieldTest, TextsAreCutAndPadded) {
    EXPECT_EQ(rightmost("12345", 4), "2345");
    EXPECT_EQ(rightmost("1", 4), "1");
    EXPECT_EQ(padRight("ab", 4), "ab  ");
    EXPECT_EQ(padRight("abcdef", 4), "abcd");
}

TEST(HexDigits, AreCapitalsWithLeadingZeros) {
    EXPECT_EQ(hexDigits(0xD3C, 4), "0D3C");
    EXPECT_EQ(hexDigits(0, 4), "0000");
    EXPECT_EQ(hexDigits(0x1FFFF, 4), "FFFF");  // only that many
}

}  // namespace
}  // namespace kdx
