#include "air/receiver.h"

#include <bit>
#include <span>
#include <utility>

#include "air/receivercharacters.h"

namespace kdx::air {

namespace {

// Types of groups (IEC 62106, 6.1), five bits: the number and the version.
constexpr unsigned kType0A = 0;
constexpr unsigned kType0B = 1;
constexpr unsigned kType2A = 4;
constexpr unsigned kType2B = 5;
constexpr unsigned kType3A = 6;
constexpr unsigned kType4A = 8;
constexpr unsigned kType14A = 28;
constexpr unsigned kType14B = 29;
constexpr unsigned kType15B = 31;

constexpr unsigned kLastBits = 0x1F;
constexpr unsigned kSegmentOfPs = 0x03;
constexpr unsigned kSegmentOfRadiotext = 0x0F;
constexpr std::uint8_t kEndOfText = 0x0D;

bool hasBit(unsigned word, unsigned bit) {
    return (word >> bit & 1U) != 0;
}

std::uint8_t upper(std::uint16_t block) {
    return static_cast<std::uint8_t>(block >> 8U);
}

std::uint8_t lower(std::uint16_t block) {
    return static_cast<std::uint8_t>(block & 0xFFU);
}

/// Where block 1 came with errors the third one of version B has the PI too (6.1).
std::optional<std::uint16_t> piOf(const ReceivedGroup& group) {
    const auto& blocks = group.blocks;
    return blocks[0] || !blocks[1] || !hasBit(*blocks[1], 11) ? blocks[0] : blocks[2];
}

/// How many characters there are before the end mark.
std::size_t lengthOf(std::span<const std::uint8_t> codes) {
    std::size_t length = 0;
    while (length < codes.size() && codes[length] != kEndOfText) ++length;
    return length;
}

}  // namespace

std::string RadioState::psText() const {
    return shownText(ps);
}

std::string RadioState::radiotextText() const {
    const auto heard = static_cast<std::size_t>(std::bit_width(radiotextHeard));
    const auto codes = std::span(radiotext).first(heard);
    return shownText(codes.first(lengthOf(codes)));
}

bool RadioState::isRadiotextWhole() const {
    const auto heard = static_cast<std::size_t>(std::countr_one(radiotextHeard));
    return heard == radiotext.size() || lengthOf(std::span(radiotext).first(heard)) < heard;
}

std::optional<int> RadioState::decoderInfoNumber() const {
    int number = 0;
    for (const auto& bit : decoderInfo) {
        if (!bit) return std::nullopt;
        number = 2 * number + (*bit ? 1 : 0);
    }
    return number;
}

void Receiver::take(const ReceivedGroup& group) {
    ++m_state.groups;
    const auto pi = piOf(group);
    const bool isOther = pi && m_state.pi && *pi != *m_state.pi;
    if (!isOther) {
        if (pi) m_ofOtherPi.reset();
        decode(group);
        return;
    }
    const auto before = std::exchange(m_ofOtherPi, group);
    if (!before || piOf(*before) != pi) return;
    Receiver anew;
    anew.m_state.groups = m_state.groups - 1;
    anew.decode(*before);
    ++anew.m_state.groups;
    anew.decode(group);
    *this = std::move(anew);
}

void Receiver::decode(const ReceivedGroup& group) {
    if (const auto pi = piOf(group)) m_state.pi = pi;
    if (!group.blocks[1]) {
        // Of what kind the group was is not known: it may have been the next one of the list.
        m_frequencies.take(std::nullopt);
        return;
    }
    const unsigned word = *group.blocks[1];
    m_state.tp = hasBit(word, 10);
    m_state.pty = static_cast<int>(word >> 5U & kLastBits);
    decodeType(word >> 11U, word & kLastBits, group);
}

void Receiver::decodeType(unsigned type, unsigned bits, const ReceivedGroup& group) {
    switch (type) {
        case kType0A:
        case kType0B:
            takeBasic(type, bits, group);
            break;
        case kType2A:
            takeRadiotext(bits, 4 * std::size_t{bits & kSegmentOfRadiotext}, group.blocks[2]);
            takeRadiotext(bits, 4 * std::size_t{bits & kSegmentOfRadiotext} + 2, group.blocks[3]);
            break;
        case kType2B:
            takeRadiotext(bits, 2 * std::size_t{bits & kSegmentOfRadiotext}, group.blocks[3]);
            break;
        case kType4A:
            takeClock(bits, group);
            break;
        case kType14A:
        case kType14B:
            takeNetworks(type, bits, group);
            break;
        case kType15B:
            takeFlags(bits);
            break;
        default:
            takeOpenData(type, bits, group);
            break;
    }
}

/// TA, M/S, and the bit of the decoder information that the segment's number says (6.1.5.1).
void Receiver::takeFlags(unsigned bits) {
    m_state.ta = hasBit(bits, 4);
    m_state.music = hasBit(bits, 3);
    m_state.decoderInfo.at(bits & kSegmentOfPs) = hasBit(bits, 2);
}

void Receiver::takeBasic(unsigned type, unsigned bits, const ReceivedGroup& group) {
    takeFlags(bits);
    if (type == kType0A) {
        m_frequencies.take(group.blocks[2]);
        m_state.frequencies = m_frequencies.lists();
    }
    const auto characters = group.blocks[3];
    if (!characters) return;
    const std::size_t place = 2 * std::size_t{bits & kSegmentOfPs};
    m_state.ps.at(place) = upper(*characters);
    m_state.ps.at(place + 1) = lower(*characters);
}

/// A flag that changes clears the display (6.1.5.3); a text without a change writes over the one before.
void Receiver::takeRadiotext(unsigned bits, std::size_t place, std::optional<std::uint16_t> characters) {
    const bool flag = hasBit(bits, 4);
    if (m_state.radiotextB != flag) {
        m_state.radiotextB = flag;
        m_state.radiotext = {};
        m_state.radiotextHeard = 0;
    }
    if (!characters) return;
    m_state.radiotext.at(place) = upper(*characters);
    m_state.radiotext.at(place + 1) = lower(*characters);
    m_state.radiotextHeard |= std::uint64_t{3} << place;
}

/// 17 bits of the day, 5 of the hour, 6 of the minute, the offset's sign and 5 bits of half hours (6.1.5.6).
void Receiver::takeClock(unsigned bits, const ReceivedGroup& group) {
    using namespace std::chrono;
    if (!group.blocks[2] || !group.blocks[3]) return;
    const std::uint64_t all =
        std::uint64_t{bits & 3U} << 32U | std::uint64_t{*group.blocks[2]} << 16U | *group.blocks[3];
    const auto day = static_cast<std::uint32_t>(all >> 17U & 0x1FFFFU);
    const hours hour{static_cast<int>(all >> 12U & 0x1FU)};
    const minutes minute{static_cast<int>(all >> 6U & 0x3FU)};
    const minutes offset = minutes{30} * static_cast<int>(all & 0x1FU);
    if (hour >= 24h || minute >= 60min) return;
    constexpr sys_days kDay0{1858y / November / 17};
    m_state.clock =
        RadioState::ClockTime{kDay0 + days{day} + hour + minute, hasBit(all & 0x3FU, 5) ? -offset : offset, day};
}

void Receiver::takeNetworks(unsigned type, unsigned bits, const ReceivedGroup& group) {
    const auto other = group.blocks[3];
    if (!other) return;
    if (type == kType14A) {
        m_networks.take14A(bits, group.blocks[2], *other, m_state.groups);
    } else {
        m_networks.take14B(bits, *other, m_state.groups);
    }
    m_state.networks = m_networks.networks();
}

void Receiver::takeOpenData(unsigned type, unsigned bits, const ReceivedGroup& group) {
    if (!group.blocks[2] || !group.blocks[3]) return;
    const OpenDataGroup data{static_cast<std::uint8_t>(bits), *group.blocks[2], *group.blocks[3]};
    if (type == kType3A) {
        m_traffic.takeAnnouncement(data);
    } else {
        m_traffic.take(type, data, m_state.groups);
    }
    m_state.traffic = m_traffic.received();
}

}  // namespace kdx::air
