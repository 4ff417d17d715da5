#include "air/receivertraffic.h"

#include <algorithm>
#include <cstddef>

namespace kdx::air {

namespace {

/// Takes fields off a word, the most significant first.
class Fields {
public:
    Fields(std::uint64_t word, unsigned length) : m_word(word), m_left(length) {}
    unsigned take(unsigned count) {
        m_left -= count;
        return static_cast<unsigned>(m_word >> m_left & ((std::uint64_t{1} << count) - 1));
    }
    bool takeFlag() { return take(1) == 1; }

private:
    std::uint64_t m_word;
    unsigned m_left;
};

constexpr unsigned kBlockBits = 16;
constexpr unsigned kContentBits = 28;
constexpr unsigned kLabelBits = 4;
// How long the data of each label are (ISO 14819-1, optional content).
constexpr std::array<std::uint8_t, 16> kDataBits = {3, 3, 5, 5, 5, 8, 8, 8, 8, 11, 16, 16, 16, 16, 0, 0};

/// What a single group and the first one of several share: direction, extent and event, and the location.
void readMessage(Fields& fields, const OpenDataGroup& group, TrafficMessage& message) {
    message.backward = fields.takeFlag();
    message.extent = fields.take(3);
    message.event = fields.take(11);
    message.location = group.block4;
}

void readGroupOfSeveral(Fields& fields, const OpenDataGroup& group, TrafficGroup& read) {
    const bool first = fields.takeFlag();
    if (first) {
        read.kind = TrafficGroup::Kind::First;
        read.message.multiGroup = true;
        readMessage(fields, group, read.message);
        return;
    }
    read.kind = TrafficGroup::Kind::Further;
    read.second = fields.takeFlag();
    read.toFollow = fields.take(2);
    read.content = fields.take(12) << kBlockBits | group.block4;
}

}  // namespace

bool OpenDataAnnouncement::comesInNoGroup() const {
    // No group of its own; none for now, for a fault.
    return group == 0b00000 || group == 0b11111;
}

bool OpenDataAnnouncement::isTraffic() const {
    return application == 0xCD46 || application == 0xCD47;
}

std::optional<TrafficTable> OpenDataAnnouncement::table() const {
    Fields fields(word, kBlockBits);
    if (fields.take(2) != 0) return std::nullopt;
    fields.take(2);  // reserved
    TrafficTable table;
    table.number = fields.take(6);
    table.alternativeFrequencies = fields.takeFlag();
    table.enhanced = fields.takeFlag();
    table.international = fields.takeFlag();
    table.national = fields.takeFlag();
    table.regional = fields.takeFlag();
    table.urban = fields.takeFlag();
    return table;
}

std::optional<TrafficTiming> OpenDataAnnouncement::timing() const {
    constexpr std::array<unsigned, 4> kGaps = {3, 5, 8, 11};
    Fields fields(word, kBlockBits);
    if (fields.take(2) != 1) return std::nullopt;
    TrafficTiming timing;
    timing.gap = kGaps.at(fields.take(2));
    timing.service = fields.take(6);
    timing.activity = 1U << fields.take(2);
    timing.window = 1U << fields.take(2);
    timing.delay = fields.take(2);
    return timing;
}

std::optional<TrafficCountry> OpenDataAnnouncement::country() const {
    Fields fields(word, kBlockBits);
    if (fields.take(2) != 2) return std::nullopt;
    TrafficCountry country;
    country.country = fields.take(4);
    fields.take(2);  // reserved
    country.extended = fields.take(8);
    return country;
}

OpenDataAnnouncement announcementOf(const OpenDataGroup& group) {
    return {group.bits, group.block3, group.block4};
}

TrafficGroup trafficGroupOf(const OpenDataGroup& group) {
    constexpr unsigned kTuning = 0x10;
    constexpr unsigned kSingle = 0x08;
    constexpr unsigned kNumber = 0x07;
    constexpr unsigned kVariant = 0x0F;
    constexpr unsigned kHighestContinuity = 6;
    TrafficGroup read;
    read.block3 = group.block3;
    read.block4 = group.block4;
    Fields fields(group.block3, kBlockBits);
    const unsigned number = group.bits & kNumber;
    if ((group.bits & kTuning) != 0) {
        read.kind = TrafficGroup::Kind::Tuning;
        read.variant = group.bits & kVariant;
    } else if ((group.bits & kSingle) != 0) {
        read.kind = TrafficGroup::Kind::Single;
        read.message.duration = number;
        read.message.diversion = fields.takeFlag();
        readMessage(fields, group, read.message);
    } else if (number == 0) {
        read.kind = TrafficGroup::Kind::Administration;
    } else if (number <= kHighestContinuity) {
        read.continuity = number;
        readGroupOfSeveral(fields, group, read);
    }
    return read;
}

std::vector<TrafficMessage::Detail> detailsOf(std::span<const std::uint32_t> parts) {
    std::vector<bool> bits;
    for (const std::uint32_t part : parts) {
        for (unsigned bit = kContentBits; bit-- > 0;) bits.push_back((part >> bit & 1U) != 0);
    }
    std::size_t at = 0;
    const auto take = [&bits, &at](unsigned count) {
        unsigned value = 0;
        for (; count > 0; --count) value = value << 1U | (bits[at++] ? 1U : 0U);
        return value;
    };
    std::vector<TrafficMessage::Detail> details;
    while (bits.size() - at >= kLabelBits) {
        // The rest is filled with zeros, which look like labels themselves.
        const auto rest = bits.begin() + static_cast<std::ptrdiff_t>(at);
        if (std::find(rest, bits.end(), true) == bits.end()) break;
        const unsigned label = take(kLabelBits);
        if (bits.size() - at < kDataBits.at(label)) break;
        details.push_back({label, take(kDataBits.at(label))});
    }
    return details;
}

}  // namespace kdx::air
