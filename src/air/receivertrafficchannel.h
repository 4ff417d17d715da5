#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

#include "air/receivertraffic.h"

namespace kdx::air {

/// What a radio knows from the traffic message channel.
struct ReceivedTraffic {
    struct Message {
        TrafficMessage message;
        std::uint64_t times = 0;      ///< heard
        std::uint64_t lastGroup = 0;  ///< the count of groups when it was heard last
    };
    std::optional<unsigned> group;  ///< the type of the groups it comes in, five bits; once announced
    std::optional<std::uint16_t> application;
    std::optional<TrafficTable> table;
    std::optional<TrafficTiming> timing;
    std::optional<TrafficCountry> country;
    std::array<std::uint8_t, 8> provider{' ', ' ', ' ', ' ', ' ', ' ', ' ', ' '};  ///< codes of characters
    std::vector<TrafficGroup> tuning;                                              ///< variants 6 to 9, each once
    std::vector<Message> messages;  ///< in the order they were first heard
    /// Groups 8A while no announcement has told that they are traffic messages: a radio passes over them.
    std::uint64_t unannounced = 0;
};

/// Listens to groups 3A and 8A; puts messages of several groups together.
class TrafficChannel {
public:
    void takeAnnouncement(const OpenDataGroup& group);
    /// A group that may carry open data. @param type five bits; @param count of groups.
    void take(unsigned type, const OpenDataGroup& group, std::uint64_t count);
    [[nodiscard]] const ReceivedTraffic& received() const { return m_received; }

private:
    static constexpr unsigned kMostParts = 4;
    /// A message of several groups under way.
    struct UnderWay {
        TrafficMessage message;
        unsigned expected = 0;  ///< parts behind the first group; 0 until the second one has told
        std::array<std::optional<std::uint32_t>, kMostParts> parts;
        std::uint64_t lastGroup = 0;
    };
    void takeFurther(const TrafficGroup& group, std::uint64_t count);
    void takeTuning(const TrafficGroup& group);
    void store(const TrafficMessage& message, std::uint64_t count);

    ReceivedTraffic m_received;
    std::array<std::optional<UnderWay>, 7> m_underWay;  ///< by the continuity index
};

}  // namespace kdx::air
