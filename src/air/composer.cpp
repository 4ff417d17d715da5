#include "air/composer.h"

#include <utility>

#include "air/characters.h"
#include "air/groupring.h"
#include "air/hexword.h"

namespace kdx::air {

namespace {

// Places in block 2 (IEC 62106, 6.1) and in groups 0A, 0B and 15B.
constexpr unsigned kTypePlace = 11;
constexpr unsigned kTpPlace = 10;
constexpr unsigned kPtyPlace = 5;
constexpr unsigned kTa = 0x10;
constexpr unsigned kMusic = 0x08;
constexpr unsigned kDecoderInfoBit = 0x04;
constexpr std::size_t kSegments = 4;

// The test patterns of "BIN=1" to "BIN=4".
constexpr std::array<std::uint8_t, 4> kPatterns = {0b00000000, 0b11111111, 0b01010101, 0b11001100};

constexpr Group groupOf(std::uint16_t block1, std::uint16_t block2, unsigned block3, unsigned block4) {
    return {{block1, block2, static_cast<std::uint16_t>(block3), static_cast<std::uint16_t>(block4)}};
}

}  // namespace

void Composer::take(const sim::Transmission& transmission) {
    const sim::Setup& setup = transmission.settings;
    m_kind = !setup.rdsOn ? OnAir::Kind::Nothing : setup.testPattern != 0 ? OnAir::Kind::Pattern : OnAir::Kind::Group;
    if (setup.testPattern != 0) m_pattern = kPatterns.at(static_cast<std::size_t>(setup.testPattern) - 1);
    m_clockLead = transmission.clockLead;
    takeProgramme(setup);
    m_frequencies.take(setup.afLists, m_warnings);
    m_radiotext.take(setup.radiotext, setup.radiotextNumbers, m_warnings);
    // What changed before the first group is how things are; while no groups go out a change has nobody to hear it.
    m_networks.take(setup.otherNetworks.networks(), m_begun && m_kind == OnAir::Kind::Group, m_warnings);
    m_openData = given(transmission.openData);
    m_traffic = given(transmission.trafficMessage);
    auto ring = groupRing(setup.groupSequence);
    if (ring != m_ring) {
        m_ring = std::move(ring);
        m_slot = 0;
    }
    m_begun = true;
}

void Composer::takeProgramme(const sim::Setup& setup) {
    m_pi = hexWord(setup.pi);
    m_common =
        static_cast<std::uint16_t>((setup.tp ? 1U : 0U) << kTpPlace | static_cast<unsigned>(setup.pty) << kPtyPlace);
    m_announcementAndMusic = (setup.ta ? kTa : 0) | (setup.musicSpeech == 1 ? kMusic : 0);
    m_decoderInfo = static_cast<unsigned>(setup.decoderInfo);
    std::array<std::uint8_t, kPsLength> ps{};
    writeCodes(setup.ps, ps, "PS", m_warnings);
    if (ps != m_ps) {
        m_ps = ps;
        m_psSegment = 0;
    }
}

/// Ten digits behind a number that has no meaning on the air.
std::optional<Composer::Given> Composer::given(std::string_view message) {
    constexpr unsigned kBits = 0x1F;
    if (message.size() < kGroupDigits) return std::nullopt;
    const std::string_view digits = message.substr(message.size() - kGroupDigits);
    return Given{static_cast<std::uint8_t>(hexWord(digits.substr(0, 2)) & kBits), hexWord(digits.substr(2, 4)),
                 hexWord(digits.substr(6, 4))};
}

OnAir Composer::next(AirTime start) {
    if (m_kind != OnAir::Kind::Group) return {m_kind, {}, m_pattern};
    if (const auto clock = clockGroup(start)) return {m_kind, *clock, 0};
    if (m_networks.announces()) return {m_kind, networks14B(m_networks.nextOfBurst()), 0};
    const GroupType type = m_ring[m_slot];
    m_slot = (m_slot + 1) % m_ring.size();
    return {m_kind, groupOfSlot(type), 0};
}

/// 4A when this is the group whose end is the nearest to a full minute of the coder's clock (IEC 62106, 6.1.5.6).
std::optional<Group> Composer::clockGroup(AirTime start) const {
    using namespace std::chrono;
    if (!m_clockLead) return std::nullopt;
    const AirTime end = start + kGroupTime + *m_clockLead;
    const auto minute = floor<minutes>(end + kGroupTime / 2);
    if (end + kGroupTime / 2 - minute >= kGroupTime) return std::nullopt;
    const auto midnight = floor<days>(minute);
    const hh_mm_ss time{minute - midnight};
    constexpr std::int64_t kModifiedJulianDayOf1970 = 40587;
    const auto day = static_cast<unsigned>(midnight.time_since_epoch().count() + kModifiedJulianDayOf1970);
    const auto hour = static_cast<unsigned>(time.hours().count());
    const auto minuteOfHour = static_cast<unsigned>(time.minutes().count());
    // Two bits of the day, fifteen more; one bit of the hour, four more; the offset from UTC is 0.
    return groupOf(m_pi, block2(GroupType::Clock4A, day >> 15U & 3U), (day & 0x7FFFU) << 1U | hour >> 4U,
                   (hour & 0xFU) << 12U | minuteOfHour << 6U);
}

Group Composer::groupOfSlot(GroupType type) {
    switch (type) {
        case GroupType::Basic0B:
            return basic(type);
        case GroupType::Radiotext2A:
        case GroupType::Radiotext2B:
            if (!m_radiotext.empty()) return radiotext(type);
            break;
        case GroupType::OpenData3A:
            if (m_openData) return ofGiven(type, *m_openData);
            break;
        case GroupType::Traffic8A:
            if (m_traffic) return ofGiven(type, *m_traffic);
            break;
        case GroupType::Networks14A:
            if (!m_networks.empty()) return networks14A(m_networks.nextOf14A());
            break;
        case GroupType::Networks14B:
            if (!m_networks.empty()) return networks14B(m_networks.nextOf14B());
            break;
        case GroupType::Tuning15B:
            return fastTuning();
        case GroupType::Basic0A:
        case GroupType::Clock4A:  // its time is the full minute, not a slot
            break;
    }
    return basic(GroupType::Basic0A);
}

/// TA, M/S, the bit of the decoder information that belongs to the segment (d3 in the first one), and the segment.
unsigned Composer::flagsOf(std::size_t segment) const {
    const bool info = (m_decoderInfo >> (kSegments - 1 - segment) & 1U) != 0;
    return m_announcementAndMusic | (info ? kDecoderInfoBit : 0) | static_cast<unsigned>(segment);
}

Group Composer::basic(GroupType type) {
    const std::size_t segment = std::exchange(m_psSegment, (m_psSegment + 1) % kSegments);
    const unsigned block3 = type == GroupType::Basic0A ? m_frequencies.next() : m_pi;
    return groupOf(m_pi, block2(type, flagsOf(segment)), block3,
                   pairOf(m_ps.at(2 * segment), m_ps.at(2 * segment + 1)));
}

Group Composer::radiotext(GroupType type) {
    if (type == GroupType::Radiotext2B) {
        const auto [bits, text] = m_radiotext.next(2);
        return groupOf(m_pi, block2(type, bits), m_pi, pairOf(text[0], text[1]));
    }
    const auto [bits, text] = m_radiotext.next(4);
    return groupOf(m_pi, block2(type, bits), pairOf(text[0], text[1]), pairOf(text[2], text[3]));
}

/// Block 4 repeats block 2.
Group Composer::fastTuning() {
    const std::size_t segment = std::exchange(m_tuningSegment, (m_tuningSegment + 1) % kSegments);
    const std::uint16_t word = block2(GroupType::Tuning15B, flagsOf(segment));
    return groupOf(m_pi, word, m_pi, word);
}

Group Composer::networks14A(const Networks::Part& part) const {
    return groupOf(m_pi, block2(GroupType::Networks14A, part.bits), part.block3, part.network);
}

Group Composer::networks14B(const Networks::Part& part) const {
    return groupOf(m_pi, block2(GroupType::Networks14B, part.bits), m_pi, part.network);
}

Group Composer::ofGiven(GroupType type, const Given& message) const {
    return groupOf(m_pi, block2(type, message.bits), message.block3, message.block4);
}

std::uint16_t Composer::block2(GroupType type, unsigned bits) const {
    return static_cast<std::uint16_t>(static_cast<unsigned>(type) << kTypePlace | m_common | bits);
}

}  // namespace kdx::air
