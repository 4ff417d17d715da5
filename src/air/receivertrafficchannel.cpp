#include "air/receivertrafficchannel.h"

#include <algorithm>
#include <cstddef>
#include <utility>

namespace kdx::air {

namespace {

constexpr unsigned kGroup8A = 16;
// A receiver holds 300 messages at least; the oldest gives way.
constexpr std::size_t kMostMessages = 300;
constexpr std::size_t kMostTunings = 256;
// Groups of one message do not lie further apart than 15 s: what comes later belongs to another one.
constexpr std::uint64_t kLongestPause = 171;

std::uint8_t byteOf(std::uint16_t block, unsigned shift) {
    return static_cast<std::uint8_t>(block >> shift);
}

}  // namespace

void TrafficChannel::takeAnnouncement(const OpenDataGroup& group) {
    const OpenDataAnnouncement announcement = announcementOf(group);
    if (!announcement.isTraffic()) {
        // Another application took the groups over.
        if (m_received.group == announcement.group) m_received.group.reset();
        return;
    }
    m_received.application = announcement.application;
    m_received.group = announcement.comesInNoGroup() ? std::nullopt : std::optional(announcement.group);
    if (const auto table = announcement.table()) m_received.table = table;
    if (const auto timing = announcement.timing()) m_received.timing = timing;
    if (const auto country = announcement.country()) m_received.country = country;
}

void TrafficChannel::take(unsigned type, const OpenDataGroup& group, std::uint64_t count) {
    if (m_received.group != type) {
        if (type == kGroup8A) ++m_received.unannounced;
        return;
    }
    const TrafficGroup traffic = trafficGroupOf(group);
    switch (traffic.kind) {
        case TrafficGroup::Kind::Single:
            store(traffic.message, count);
            break;
        case TrafficGroup::Kind::First: {
            auto& underWay = m_underWay.at(traffic.continuity);
            // Each group is sent again: the same first one does not begin anew.
            const bool again = underWay && underWay->message == traffic.message;
            if (!again || count - underWay->lastGroup > kLongestPause) underWay = UnderWay{traffic.message, 0, {}, 0};
            underWay->lastGroup = count;
            break;
        }
        case TrafficGroup::Kind::Further:
            takeFurther(traffic, count);
            break;
        case TrafficGroup::Kind::Tuning:
            takeTuning(traffic);
            break;
        case TrafficGroup::Kind::Administration:
        case TrafficGroup::Kind::Unknown:
            break;
    }
}

/// The second group tells how many come behind it, each further one how many are left.
void TrafficChannel::takeFurther(const TrafficGroup& group, std::uint64_t count) {
    auto& underWay = m_underWay.at(group.continuity);
    if (!underWay) return;
    if (count - underWay->lastGroup > kLongestPause) {
        underWay.reset();
        return;
    }
    underWay->lastGroup = count;
    if (group.second) {
        const bool again = underWay->expected == group.toFollow + 1 && underWay->parts[0] == group.content;
        if (!again) underWay->parts = {};
        underWay->expected = group.toFollow + 1;
    }
    if (underWay->expected <= group.toFollow) return;
    const std::size_t place = underWay->expected - 1 - group.toFollow;
    if ((place == 0) != group.second) return;
    underWay->parts.at(place) = group.content;
    if (group.toFollow != 0) return;

    std::vector<std::uint32_t> parts;
    for (const auto& part : underWay->parts) {
        if (part) parts.push_back(*part);
    }
    if (parts.size() < underWay->expected) return;
    TrafficMessage message = underWay->message;
    message.details = detailsOf(parts);
    store(message, count);
}

void TrafficChannel::takeTuning(const TrafficGroup& group) {
    constexpr unsigned kFirstHalf = 4;
    constexpr unsigned kSecondHalf = 5;
    constexpr unsigned kLast = 9;
    if (group.variant == kFirstHalf || group.variant == kSecondHalf) {
        const std::size_t at = group.variant == kFirstHalf ? 0 : 4;
        const std::array<std::uint8_t, 4> codes = {byteOf(group.block3, 8), byteOf(group.block3, 0),
                                                   byteOf(group.block4, 8), byteOf(group.block4, 0)};
        std::copy(codes.begin(), codes.end(), m_received.provider.begin() + static_cast<std::ptrdiff_t>(at));
        return;
    }
    if (group.variant < kFirstHalf || group.variant > kLast) return;
    auto& known = m_received.tuning;
    const auto isSame = [&group](const TrafficGroup& other) {
        return other.variant == group.variant && other.block3 == group.block3 && other.block4 == group.block4;
    };
    if (std::any_of(known.begin(), known.end(), isSame)) return;
    if (known.size() == kMostTunings) known.erase(known.begin());
    known.push_back(group);
}

/// A message about the same event there takes the place of the one before.
void TrafficChannel::store(const TrafficMessage& message, std::uint64_t count) {
    auto& messages = m_received.messages;
    const auto isSame = [&message](const ReceivedTraffic::Message& other) {
        return other.message.event == message.event && other.message.location == message.location &&
               other.message.backward == message.backward;
    };
    auto known = std::find_if(messages.begin(), messages.end(), isSame);
    if (known == messages.end()) {
        if (messages.size() == kMostMessages) messages.erase(messages.begin());
        known = messages.insert(messages.end(), {message, 0, 0});
    } else if (known->message != message) {
        *known = {message, 0, 0};
    }
    ++known->times;
    known->lastGroup = count;
}

}  // namespace kdx::air
