#include "tmc/groupcode.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdio>
#include <limits>
#include <random>
#include <string>

namespace kdx {
namespace {

/// A message by its numbers.
struct Message {
    unsigned t = 0;
    unsigned f = 0;
    unsigned duration = 0;
    unsigned diversion = 0;
    unsigned direction = 0;
    unsigned extent = 0;
    unsigned event = 0;
    unsigned location = 0;

    /// The code computed another way: the T bit, the low 4 bits of block 2, then blocks 3 and 4, as the standard lays
    /// out a single-group message.
    [[nodiscard]] std::string blocks() const {
        const unsigned block2 = (f << 3U) | duration;
        const unsigned block3 = (diversion << 15U) | (direction << 14U) | (extent << 11U) | event;
        std::array<char, 32> text{};
        std::snprintf(text.data(), text.size(), "%u%01X%04X%04X", t, block2, block3, location);
        return text.data();
    }

    /// The code by way of the bit display.
    [[nodiscard]] std::string code() const {
        return groupCode({lastBits(t, 1), lastBits(f, 1), lastBits(duration, 3), lastBits(diversion, 1),
                          lastBits(direction, 1), lastBits(extent, 3), lastBits(event, 11), lastBits(location, 16)});
    }
};

TEST(GroupCodeTest, MatchesTheWorkedExample) {
    EXPECT_EQ(groupCode({"0", "1", "000", "0", "0", "010", "00000000001", "0011000000111001"}), "0810013039");
}

TEST(GroupCodeTest, MatchesTheBlocksAtTheEdgesOfEveryField) {
    for (unsigned flags = 0; flags < 16; ++flags) {
        for (unsigned duration = 0; duration < 8; ++duration) {
            for (unsigned extent = 0; extent < 8; ++extent) {
                for (const unsigned event : {0U, 1U, 2U, 1023U, 1024U, 1025U, 2046U, 2047U}) {
                    for (const unsigned location : {0U, 1U, 32767U, 32768U, 65534U, 65535U}) {
                        const Message message{flags & 1U,       flags >> 1U & 1U, duration, flags >> 2U & 1U,
                                              flags >> 3U & 1U, extent,           event,    location};
                        ASSERT_EQ(message.code(), message.blocks());
                    }
                }
            }
        }
    }
}

TEST(GroupCodeTest, MatchesTheBlocksOfRandomMessages) {
    std::mt19937 random(20090305);
    const auto below = [&random](unsigned limit) { return static_cast<unsigned>(random() % limit); };
    for (int i = 0; i < 5000; ++i) {
        const Message message{below(2), below(2), below(8), below(2), below(2), below(8), below(2048), below(65536)};
        ASSERT_EQ(message.code(), message.blocks());
    }
}

TEST(GroupCodeTest, MatchesTheBlocksOfEveryEventAndEveryLocation) {
    for (unsigned event = 0; event < 2048; ++event) {
        const Message message{0, 1, 0, 0, 0, 0, event, 0};
        ASSERT_EQ(message.code(), message.blocks());
    }
    for (unsigned location = 0; location < 65536; ++location) {
        const Message message{0, 1, 0, 0, 0, 0, 0, location};
        ASSERT_EQ(message.code(), message.blocks());
    }
}

TEST(GroupCodeTest, CutsNumbersThatAreTooLargeToTheLowBitsOfTheirField) {
    for (unsigned number = 2048; number < 100000; number += 7) {
        const Message cut{1, 1, 7, 1, 1, 7, number & 0x7FFU, number & 0xFFFFU};
        const Message tooLarge{1, 1, 7, 1, 1, 7, number, number};
        ASSERT_EQ(tooLarge.code(), cut.blocks());
    }
}

TEST(GroupCodeTest, CountsFieldsThatHaveNotBeenSetAsZero) {
    EXPECT_EQ(groupCode({"-", "-", "-", "-", "-", "-", "-", "-"}), "-000000000");
}

TEST(GroupCodeTest, IsIncompleteWhileAFieldHasTooFewBits) {
    // With one character in the event's place the bits are 1000 0001 0-00 1100 0000 1110 01.
    EXPECT_EQ(groupCode({"0", "1", "000", "0", "0", "010", "-", "0011000000111001"}), "0810C0E100");
}

TEST(GroupCodeTest, IsTenCharactersLongWhateverTheNumbers) {
    for (const double number : {-1.0, -99999.0, 65536.0, 99999.0, 1e9, 1e99, -1e99}) {
        EXPECT_EQ(groupCode({"1", "1", "111", "1", "1", "111", lastBits(number, 11), lastBits(number, 16)}).size(),
                  kGroupCodeLength);
    }
}

TEST(HexadecimalTest, HasUpperCaseDigitsWithoutLeadingZeros) {
    EXPECT_EQ(hexadecimal(0), "0");
    EXPECT_EQ(hexadecimal(26), "1A");
    EXPECT_EQ(hexadecimal(12345), "3039");
    EXPECT_EQ(hexadecimal(65535), "FFFF");
    EXPECT_EQ(hexadecimal(99999), "1869F");
}

TEST(HexadecimalTest, RoundsToAWholeNumberHalvesToTheEvenOne) {
    EXPECT_EQ(hexadecimal(9.6), "A");
    EXPECT_EQ(hexadecimal(2.5), "2");
    EXPECT_EQ(hexadecimal(3.5), "4");
}

TEST(HexadecimalTest, ShowsNegativeNumbersAsTwosComplement) {
    EXPECT_EQ(hexadecimal(-1), "FFFFFFFF");
}

TEST(HexadecimalTest, TakesTheNearestNumberThatFitsInThirtyTwoBits) {
    EXPECT_EQ(hexadecimal(1e99), "7FFFFFFF");
    EXPECT_EQ(hexadecimal(-1e99), "80000000");
}

TEST(HexadecimalTest, WhatIsNoNumberIsZero) {
    EXPECT_EQ(hexadecimal(std::numeric_limits<double>::quiet_NaN()), "0");
    EXPECT_EQ(hexadecimal(std::numeric_limits<double>::infinity()), "7FFFFFFF");
    EXPECT_EQ(hexadecimal(-std::numeric_limits<double>::infinity()), "80000000");
}

TEST(EntryNumberTest, IsTheNumberOfTheLastFiveCharacters) {
    EXPECT_EQ(entryNumber("Stau                                      00101"), 101);
    EXPECT_EQ(entryNumber("A5                                        12345"), 12345);
    EXPECT_EQ(entryNumber("7"), 7);
}

TEST(EntryNumberTest, IsZeroWhereTheLastFiveCharactersAreNoNumber) {
    EXPECT_EQ(entryNumber("Stau"), 0);
    EXPECT_EQ(entryNumber(""), 0);
    EXPECT_EQ(entryNumber("12345 there"), 0);
}

}  // namespace
}  // namespace kdx
