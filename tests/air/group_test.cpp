#include <gtest/gtest.h>

#include "air/group.h"

namespace kdx::air {
namespace {

TEST(CheckWord, IsTheGeneratorMatrixOfTheStandard) {
    // IEC 62106, annex A: the check bits of each information bit alone, the first bit first.
    constexpr std::array kMatrix = {0x077, 0x2E7, 0x3AF, 0x30B, 0x359, 0x370, 0x1B8, 0x0DC,
                                    0x06E, 0x037, 0x2C7, 0x3BF, 0x303, 0x35D, 0x372, 0x1B9};
    for (unsigned word = 0; word <= 0xFFFF; ++word) {
        int expected = 0x0FC;
        for (unsigned bit = 0; bit < 16; ++bit) {
            if ((word & 0x8000U >> bit) != 0) expected ^= kMatrix.at(bit);
        }
        ASSERT_EQ(checkWord(static_cast<std::uint16_t>(word), Offset::A), expected) << word;
    }
}

TEST(CheckWord, HasTheOffsetWordOfItsBlock) {
    // The offset words of annex A, bit by bit as they are printed; a word of zeros shows them bare.
    EXPECT_EQ(checkWord(0, Offset::A), 0b0011111100);
    EXPECT_EQ(checkWord(0, Offset::B), 0b0110011000);
    EXPECT_EQ(checkWord(0, Offset::C), 0b0101101000);
    EXPECT_EQ(checkWord(0, Offset::CPrime), 0b1101010000);
    EXPECT_EQ(checkWord(0, Offset::D), 0b0110110100);
}

TEST(GroupOffsets, OnlyTheThirdBlockOfVersionBHasItsOwn) {
    const Group versionA{{0x1000, 0x0408, 0xE0CD, 0x4B44}};
    const Group versionB{{0x1000, 0x0C08, 0x1000, 0x4B44}};
    const std::array expected = {Offset::A, Offset::B, Offset::C, Offset::D};
    for (std::size_t block = 0; block < 4; ++block) {
        EXPECT_EQ(offsetOf(versionA, block), expected.at(block));
        EXPECT_EQ(offsetOf(versionB, block), block == 2 ? Offset::CPrime : expected.at(block));
    }
}

TEST(GroupBits, AreFourBlocksOfInformationAndCheckWord) {
    // Worked by hand. Block 1, 0001: 0001 is the last row of the matrix, 1B9, and with A (0FC) 145.
    // Block 2, 8000: 077 with B (198) is 1EF. Block 3, 0000: C is 168. Block 4, 0003: 1B9 and 372 give 2CB, with D
    // (1B4) 37F.
    // 0000000000000001 0101000101 | 1000000000000000 0111101111 | 0000000000000000 0101101000 |
    // 0000000000000011 1101111111
    const std::array<std::uint8_t, 13> expected = {0x00, 0x01, 0x51, 0x60, 0x00, 0x1E, 0xF0,
                                                   0x00, 0x05, 0xA0, 0x00, 0x0F, 0x7F};
    EXPECT_EQ(bitsOf({{0x0001, 0x8000, 0x0000, 0x0003}}), expected);
}

TEST(GroupBits, OfVersionBHaveOffsetCPrime) {
    // Block 2, 0800: the fifth row, 359, with B (198) is 2C1. Block 3, 0000: C' is 350. Block 1, 0000: 0FC; block 4,
    // 0000: 1B4.
    // 0000000000000000 0011111100 | 0000100000000000 1011000001 | 0000000000000000 1101010000 |
    // 0000000000000000 0110110100
    const std::array<std::uint8_t, 13> expected = {0x00, 0x00, 0x3F, 0x02, 0x00, 0x2C, 0x10,
                                                   0x00, 0x0D, 0x40, 0x00, 0x01, 0xB4};
    EXPECT_EQ(bitsOf({{0x0000, 0x0800, 0x0000, 0x0000}}), expected);
}

AirTime at(std::chrono::sys_days day, std::chrono::milliseconds sinceMidnight) {
    return AirTime{day} + sinceMidnight;
}

TEST(LogLine, HasFourBlocksAndTheTimeToTheHundredth) {
    using namespace std::chrono;
    const Group group{{0x1000, 0x040A, 0xE0CD, 0xABCD}};
    const sys_days day = 2026y / January / 1;
    EXPECT_EQ(logLine(group, at(day, 12h + 87ms)), "1000 040A E0CD ABCD @2026/01/01 12:00:00.09");
    EXPECT_EQ(logLine(group, at(day, 9h + 4min + 3s + 14ms)), "1000 040A E0CD ABCD @2026/01/01 09:04:03.01");
    EXPECT_EQ(logLine(group, at(day, 9h + 4min + 3s + 15ms)), "1000 040A E0CD ABCD @2026/01/01 09:04:03.02");
}

TEST(LogLine, IsRoundedOverTheEndOfTheYear) {
    using namespace std::chrono;
    EXPECT_EQ(logLine({}, at(2026y / December / 31, 24h - 5ms)), "0000 0000 0000 0000 @2027/01/01 00:00:00.00");
    EXPECT_EQ(logLine({}, at(2026y / December / 31, 24h - 6ms)), "0000 0000 0000 0000 @2026/12/31 23:59:59.99");
}

}  // namespace
}  // namespace kdx::air
