#include "settings/storedvalue.h"

#include <gtest/gtest.h>

#include <ostream>

namespace kdx {
namespace {

TEST(StoredOptionTest, IsFoundByItsExactText) {
    EXPECT_EQ(storedOption("0", 0, 3), 0);
    EXPECT_EQ(storedOption("3", 0, 3), 3);
    EXPECT_EQ(storedOption("1", 1, 2), 0);
    EXPECT_EQ(storedOption("2", 1, 2), 1);
}

TEST(StoredOptionTest, EveryOtherTextChoosesNone) {
    for (const char* text : {"", "4", "-1", "00", "1.0", "1 x", "A", "10"}) EXPECT_EQ(storedOption(text, 0, 3), -1);
    for (const char* text : {"", "0", "3"}) EXPECT_EQ(storedOption(text, 1, 2), -1);
}

struct PositionCase {
    const char* text;
    int position;
    friend void PrintTo(const PositionCase& value, std::ostream* out) { *out << '"' << value.text << '"'; }
};

class StoredPosition : public ::testing::TestWithParam<PositionCase> {};

TEST_P(StoredPosition, IsTheLeadingNumberWithinTheRange) {
    EXPECT_EQ(storedPosition(GetParam().text, -4, 500), GetParam().position);
}

INSTANTIATE_TEST_SUITE_P(Values, StoredPosition,
                         ::testing::Values(PositionCase{"0350", 350}, PositionCase{"", 0}, PositionCase{"abc", 0},
                                           PositionCase{"-4", -4}, PositionCase{"-5", -4}, PositionCase{"500", 500},
                                           PositionCase{"501", 500}, PositionCase{"67.6", 68},
                                           PositionCase{"350 kHz", 350}, PositionCase{"99999999999999999999", 500},
                                           PositionCase{"-1e999", -4}, PositionCase{"1e999", 500}));

TEST(StoredNumber, NamesTheOptionOfThatNumberWhateverFollowsIt) {
    EXPECT_EQ(storedNumber("1", 1, 5), 0);
    EXPECT_EQ(storedNumber("5 x", 1, 5), 4);
    EXPECT_EQ(storedNumber("2.0", 1, 5), 1);
    for (const char* none : {"", "0", "6", "1.5", "-1", "x"}) EXPECT_EQ(storedNumber(none, 1, 5), -1) << none;
}

TEST(StoredEntry, CountsFromZeroAndTakesNoNumberForTheFirst) {
    EXPECT_EQ(storedEntry("0", 32), 0);
    EXPECT_EQ(storedEntry("31", 32), 31);
    EXPECT_EQ(storedEntry("", 32), 0);
    EXPECT_EQ(storedEntry("Nachrichten", 32), 0);
    for (const char* none : {"32", "-1", "1e300"}) EXPECT_EQ(storedEntry(none, 32), -1) << none;
}

TEST(QuotedWhereNeeded, KeepsWhatReadingWouldTakeOff) {
    for (const char* plain : {"", "A B", "A", "\"A", "A\"", "'A\""}) EXPECT_EQ(quotedWhereNeeded(plain), plain);
    for (const std::string_view edged : {" A", "A ", " ", "\"A\"", "'A'", "\""}) {
        const std::string text(edged);
        EXPECT_EQ(quotedWhereNeeded(text), '"' + text + '"');
    }
}

TEST(DecimalNumber, TakesACommaForAPointAndNothingElse) {
    for (const auto& [text, number] : {std::pair("98,7", "98.7"), std::pair("98.7", "98.7"), std::pair(" 60 ", "60"),
                                       std::pair("-0,5", "-0.5"), std::pair("+1", "+1")}) {
        EXPECT_EQ(decimalNumber(text), number);
    }
    for (const char* none :
         {"", " ", "abc", "98.7x", "1.000,5", "1,2,3", "1e3", ",5", "5,", "--1", "0x10", "1 000", "inf"}) {
        EXPECT_EQ(decimalNumber(none), std::nullopt) << none;
    }
}

TEST(StoredFlag, IsOnForAPlainOneOnly) {
    EXPECT_EQ(storedFlag("1"), "1");
    for (const char* off : {"", "0", "1.0", " 1", "x"}) EXPECT_EQ(storedFlag(off), "0") << off;
}

TEST(IsSwitchedOn, ForTheNumberOneWhateverFollowsIt) {
    for (const char* on : {"1", " 1", "1.0", "01", "1 x"}) EXPECT_TRUE(isSwitchedOn(on)) << on;
    for (const char* off : {"", "0", "2", "-1", "1.5", "10", "x", "ON"}) EXPECT_FALSE(isSwitchedOn(off)) << off;
}

TEST(OpensAtStart, ForItsWordInAnyLetterCase) {
    for (const char* yes : {"AUTO", "auto", "Auto"}) EXPECT_TRUE(opensAtStart(yes)) << yes;
    for (const char* no : {"", "MANUAL", "AUTO ", "AUT", "AUTOS", "1"}) EXPECT_FALSE(opensAtStart(no)) << no;
}

struct LimitCase {
    const char* entered;
    const char* lower;
    const char* upper;
    bool accepted;
    friend void PrintTo(const LimitCase& value, std::ostream* out) {
        *out << value.lower << " < " << value.entered << " < " << value.upper;
    }
};

class Limits : public ::testing::TestWithParam<LimitCase> {};

TEST_P(Limits, AreBothRefusedThemselves) {
    EXPECT_EQ(liesBetween(GetParam().entered, GetParam().lower, GetParam().upper), GetParam().accepted);
}

INSTANTIATE_TEST_SUITE_P(
    Values, Limits,
    ::testing::Values(LimitCase{"0", "0", "120", false}, LimitCase{"120", "0", "120", false},
                      LimitCase{"0.1", "0", "120", true}, LimitCase{"119.9", "0", "120", true},
                      LimitCase{"-1", "0", "120", false}, LimitCase{"abc", "0", "120", false},
                      LimitCase{"", "0", "120", false}, LimitCase{"60 dB", "0", "120", true},
                      LimitCase{"87,6", "0", "87.5", true},               // a comma ends the number
                      LimitCase{"119.9999999", "0", "120", false},        // 120 in single precision
                      LimitCase{"119.9999", "0", "120", true},            // a number of its own there
                      LimitCase{"98.10000000001", "98.1", "110", false},  // no different from 98.1 there
                      LimitCase{"1", "", "", false},                      // no limits stored: nothing fits
                      LimitCase{"1e300", "0", "120", false},              // beyond single precision
                      LimitCase{"1e300", "0", "1e301", false},            // both infinite there
                      LimitCase{"5", "-1e300", "1e300", true},            //
                      LimitCase{"1e999", "0", "120", false}, LimitCase{"-1e999", "0", "120", false}));

}  // namespace
}  // namespace kdx
