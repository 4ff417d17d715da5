#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>
#include <random>
#include <string>
#include <vector>

#include "air/group.h"
#include "air/receiverblocks.h"

namespace kdx::air {

static void PrintTo(const ReceivedGroup& group, std::ostream* out) {
    for (const auto& block : group.blocks) *out << (block ? std::to_string(*block) : "-") << ' ';
}

namespace {

using Bits = std::vector<bool>;
constexpr std::size_t kBlockBits = 26;
constexpr std::size_t kGroupBits = 4 * kBlockBits;

ReceivedGroup whole(const Group& group) {
    return {{group.blocks[0], group.blocks[1], group.blocks[2], group.blocks[3]}};
}

void append(Bits& bits, const Group& group) {
    for (const unsigned byte : bitsOf(group)) {
        for (unsigned bit = 8; bit-- > 0;) bits.push_back((byte >> bit & 1U) != 0);
    }
}

std::vector<ReceivedGroup> received(BlockReceiver& receiver, const Bits& bits) {
    std::vector<ReceivedGroup> groups;
    for (const bool bit : bits) {
        if (const auto group = receiver.take(bit)) groups.push_back(*group);
    }
    return groups;
}

constexpr Group kBasic{{0xD3C2, 0x0408, 0xE0CD, 0x4B44}};
constexpr Group kVersionB{{0xD3C2, 0x0C09, 0xD3C2, 0x582D}};

TEST(ReceivedBlocks, AreFoundInBitsWorkedOutByHand) {
    // IEC 62106, annexes A and B: words of zeros have the offset words alone as their check words.
    Bits bits;
    const std::array offsets = {"0011111100", "0110011000", "0101101000", "0110110100"};
    for (const char* offset : offsets) {
        bits.insert(bits.end(), 16, false);
        for (const char* bit = offset; *bit != '\0'; ++bit) bits.push_back(*bit == '1');
    }
    BlockReceiver receiver;
    EXPECT_EQ(received(receiver, bits), (std::vector<ReceivedGroup>{whole({})}));
    EXPECT_EQ(receiver.blocks(), 4U);
    EXPECT_EQ(receiver.wrongBlocks(), 0U);
}

TEST(ReceivedBlocks, OfVersionBHaveOffsetCPrime) {
    Bits bits;
    append(bits, kVersionB);
    append(bits, kBasic);
    BlockReceiver receiver;
    EXPECT_EQ(received(receiver, bits), (std::vector<ReceivedGroup>{whole(kVersionB), whole(kBasic)}));
    EXPECT_EQ(receiver.wrongBlocks(), 0U);
}

TEST(ReceivedBlocks, OfTheOtherVersionAreWrong) {
    // Group 0A whose third block has C': 350 in place of C, 168, in the check word.
    Bits bits;
    append(bits, kBasic);
    Bits second = bits;
    for (unsigned bit = 0; bit < 10; ++bit) {
        if (((0x350U ^ 0x168U) >> (9 - bit) & 1U) != 0) second[52 + 16 + bit] = !second[52 + 16 + bit];
    }
    BlockReceiver receiver;
    (void)received(receiver, bits);
    EXPECT_EQ(received(receiver, second), (std::vector<ReceivedGroup>{{{0xD3C2, 0x0408, std::nullopt, 0x4B44}}}));
    EXPECT_EQ(receiver.wrongBlocks(), 1U);
}

TEST(ReceivedBlocks, BeginAtAnyBitOfTheFirstGroup) {
    Bits bits;
    for (int i = 0; i < 3; ++i) append(bits, kBasic);
    for (std::ptrdiff_t skipped = 1; skipped < 104; ++skipped) {
        BlockReceiver receiver;
        const auto groups = received(receiver, Bits(bits.begin() + skipped, bits.end()));
        ASSERT_GE(groups.size(), 2U) << skipped;
        EXPECT_EQ(groups.back(), whole(kBasic)) << skipped;
        EXPECT_EQ(groups[groups.size() - 2], whole(kBasic)) << skipped;
        EXPECT_EQ(receiver.wrongBlocks(), 0U) << skipped;
    }
}

TEST(ReceivedBlocks, WithAnErrorAreMissingAndTheOthersStay) {
    Bits bits;
    for (int i = 0; i < 2; ++i) append(bits, kBasic);
    for (std::size_t wrong = kGroupBits; wrong < 2 * kGroupBits; ++wrong) {
        Bits disturbed = bits;
        disturbed[wrong] = !disturbed[wrong];
        BlockReceiver receiver;
        const auto groups = received(receiver, disturbed);
        ASSERT_EQ(groups.size(), 2U) << wrong;
        ReceivedGroup expected = whole(kBasic);
        expected.blocks.at((wrong - kGroupBits) / kBlockBits).reset();
        EXPECT_EQ(groups[1], expected) << wrong;
        EXPECT_EQ(receiver.blocks(), 8U);
        EXPECT_EQ(receiver.wrongBlocks(), 1U);
    }
}

TEST(ReceivedBlocks, KeepTheirStepOverAGapOfNoise) {
    std::mt19937 random(1);
    Bits bits;
    append(bits, kBasic);
    for (int i = 0; i < 800; ++i) bits.push_back(random() % 2 != 0);
    append(bits, kBasic);
    BlockReceiver receiver;
    const auto groups = received(receiver, bits);
    EXPECT_EQ(groups.front(), whole(kBasic));
    EXPECT_EQ(groups.back(), whole(kBasic));
    EXPECT_TRUE(receiver.inStep());
    EXPECT_GE(receiver.wrongBlocks(), 30U);
}

TEST(ReceivedBlocks, LoseTheirStepWhenNoneIsRight) {
    Bits bits;
    append(bits, kBasic);
    bits.insert(bits.end(), 50 * kBlockBits, false);
    BlockReceiver receiver;
    EXPECT_EQ(received(receiver, bits).size(), 1U);
    EXPECT_FALSE(receiver.inStep());
    const auto wrong = receiver.wrongBlocks();
    (void)received(receiver, Bits(100 * kBlockBits, true));
    EXPECT_EQ(receiver.wrongBlocks(), wrong) << "what is not in step is no block";
}

TEST(ReceivedBlocks, FindAnotherStepWhenABitIsLostOrAdded) {
    for (const bool lost : {true, false}) {
        Bits bits;
        for (int i = 0; i < 2; ++i) append(bits, kBasic);
        if (lost) {
            bits.pop_back();
        } else {
            bits.push_back(true);
        }
        for (int i = 0; i < 4; ++i) append(bits, kVersionB);
        BlockReceiver receiver;
        const auto groups = received(receiver, bits);
        EXPECT_EQ(groups.back(), whole(kVersionB));
        EXPECT_EQ(groups[groups.size() - 2], whole(kVersionB));
        EXPECT_LE(receiver.wrongBlocks(), 8U);
    }
}

TEST(ReceivedBlocks, AreNoneInTestPatterns) {
    for (const unsigned pattern : {0b00000000U, 0b11111111U, 0b01010101U, 0b11001100U}) {
        BlockReceiver receiver;
        Bits bits;
        for (unsigned i = 0; i < 8000; ++i) bits.push_back((pattern >> (7 - i % 8) & 1U) != 0);
        EXPECT_TRUE(received(receiver, bits).empty()) << pattern;
    }
}

TEST(ReceivedBlocks, AreThoseThatWereSentWhateverTheyHold) {
    std::mt19937 random(3);
    const auto word = [&random] { return static_cast<std::uint16_t>(random()); };
    std::vector<ReceivedGroup> expected;
    Bits bits;
    for (int i = 0; i < 20000; ++i) {
        const Group group{{word(), word(), word(), word()}};
        append(bits, group);
        expected.push_back(whole(group));
    }
    BlockReceiver receiver;
    EXPECT_EQ(received(receiver, bits), expected);
    EXPECT_EQ(receiver.blocks(), 80000U);
    EXPECT_EQ(receiver.wrongBlocks(), 0U);
}

TEST(ReceivedBlocks, WithErrorsAtRandomAreNeverWrongOnes) {
    // Of every 500 bits one is wrong: about one block in twenty. A single error is always noticed, several in one block
    // are as good as always.
    std::mt19937 random(4);
    const auto word = [&random] { return static_cast<std::uint16_t>(random()); };
    std::vector<Group> sent;
    Bits bits;
    for (int i = 0; i < 5000; ++i) {
        sent.push_back({{word(), word(), word(), word()}});
        append(bits, sent.back());
    }
    std::vector<bool> isWrong(sent.size() * 4);
    for (std::size_t at = 2 * kGroupBits; at < bits.size(); ++at) {
        if (random() % 500 != 0) continue;
        bits[at] = !bits[at];
        isWrong[at / kBlockBits] = true;
    }
    BlockReceiver receiver;
    const auto groups = received(receiver, bits);
    ASSERT_EQ(groups.size(), sent.size());
    for (std::size_t i = 0; i < groups.size(); ++i) {
        for (std::size_t block = 0; block < 4; ++block) {
            const auto expected = isWrong[4 * i + block] ? std::nullopt : std::optional(sent[i].blocks.at(block));
            ASSERT_EQ(groups[i].blocks.at(block), expected) << i;
        }
    }
    EXPECT_EQ(receiver.wrongBlocks(), static_cast<std::uint64_t>(std::count(isWrong.begin(), isWrong.end(), true)));
}

}  // namespace
}  // namespace kdx::air
