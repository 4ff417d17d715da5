#include "air/group.h"

#include <cstdio>

namespace kdx::air {

namespace {

constexpr unsigned kGenerator = 0x5B9;  // x^10 + x^8 + x^7 + x^5 + x^4 + x^3 + 1
constexpr unsigned kCheckBits = 10;
constexpr unsigned kCheckMask = (1U << kCheckBits) - 1;
constexpr unsigned kInformationBits = 16;
constexpr unsigned kByteBits = 8;
constexpr std::uint16_t kVersionB = 0x0800;

/// The remainder of each byte, shifted up by the check bits, when divided by the generator.
constexpr std::array<std::uint16_t, 256> remainders() {
    std::array<std::uint16_t, 256> table{};
    for (unsigned byte = 0; byte < table.size(); ++byte) {
        unsigned rest = byte << kCheckBits;
        for (unsigned bit = kByteBits; bit-- > 0;) {
            if ((rest >> (kCheckBits + bit) & 1U) != 0) rest ^= kGenerator << bit;
        }
        table.at(byte) = static_cast<std::uint16_t>(rest);
    }
    return table;
}
constexpr auto kRemainders = remainders();

}  // namespace

std::uint16_t checkWord(std::uint16_t information, Offset offset) {
    const unsigned first = kRemainders.at(information >> kByteBits);
    const unsigned next = (first >> (kCheckBits - kByteBits)) ^ (information & 0xFFU);
    const unsigned rest = (first << kByteBits & kCheckMask) ^ kRemainders.at(next);
    return static_cast<std::uint16_t>(rest ^ static_cast<unsigned>(offset));
}

Offset offsetOf(const Group& group, std::size_t block) {
    constexpr std::array kOffsets = {Offset::A, Offset::B, Offset::C, Offset::D};
    if (block == 2 && (group.blocks[1] & kVersionB) != 0) return Offset::CPrime;
    return kOffsets.at(block);
}

std::array<std::uint8_t, kBytesOfGroup> bitsOf(const Group& group) {
    std::array<std::uint8_t, kBytesOfGroup> bytes{};
    std::size_t at = 0;
    std::uint64_t waiting = 0;  // bits of the blocks so far that fill no byte yet
    unsigned waitingBits = 0;
    for (std::size_t block = 0; block < group.blocks.size(); ++block) {
        const unsigned information = group.blocks.at(block);
        const unsigned check = checkWord(group.blocks.at(block), offsetOf(group, block));
        waiting = waiting << (kInformationBits + kCheckBits) | information << kCheckBits | check;
        waitingBits += kInformationBits + kCheckBits;
        for (; waitingBits >= kByteBits; waitingBits -= kByteBits)
            bytes.at(at++) = static_cast<std::uint8_t>(waiting >> (waitingBits - kByteBits));
    }
    return bytes;
}

std::string logLine(const Group& group, AirTime end) {
    using namespace std::chrono;
    using Hundredths = duration<std::int64_t, std::centi>;
    const auto stamp = floor<Hundredths>(end + Ticks{95});  // half of one
    const auto midnight = floor<days>(stamp);
    const year_month_day date{midnight};
    const hh_mm_ss clock{stamp - midnight};
    std::array<char, 64> line{};
    const auto& blocks = group.blocks;
    const int length = std::snprintf(
        line.data(), line.size(), "%04X %04X %04X %04X @%04d/%02u/%02u %02d:%02d:%02d.%02d", unsigned{blocks[0]},
        unsigned{blocks[1]}, unsigned{blocks[2]}, unsigned{blocks[3]}, static_cast<int>(date.year()),
        static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()), static_cast<int>(clock.hours().count()),
        static_cast<int>(clock.minutes().count()), static_cast<int>(clock.seconds().count()),
        static_cast<int>(clock.subseconds().count()));
    return {line.data(), static_cast<std::size_t>(length)};
}

}  // namespace kdx::air
