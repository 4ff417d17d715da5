#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <vector>

namespace kdx::air {

/// The three parts that a group of open data has beside what all groups have: the five last bits of block 2, and two
/// blocks.
struct OpenDataGroup {
    std::uint8_t bits = 0;
    std::uint16_t block3 = 0;
    std::uint16_t block4 = 0;
    friend bool operator==(const OpenDataGroup&, const OpenDataGroup&) = default;
};

// What 3A says of the traffic message channel (ISO 14819-1, system information), in turn.
struct TrafficTable {
    unsigned number = 0;  ///< of the table that locations are looked up in; 0 when they are encrypted
    bool alternativeFrequencies = false;
    bool enhanced = false;
    bool international = false, national = false, regional = false, urban = false;
};
struct TrafficTiming {
    unsigned gap = 0;  ///< so many groups at least between two of the channel
    unsigned service = 0;
    unsigned activity = 0, window = 0, delay = 0;  ///< seconds, in enhanced mode
};
struct TrafficCountry {
    unsigned country = 0;   ///< of the location table
    unsigned extended = 0;  ///< its extended country code
};

/// What group 3A says (IEC 62106, 6.1.5.4).
struct OpenDataAnnouncement {
    unsigned group = 0;  ///< the type of the groups that the data come in, five bits
    std::uint16_t word = 0;
    std::uint16_t application = 0;

    [[nodiscard]] bool comesInNoGroup() const;
    [[nodiscard]] bool isTraffic() const;  ///< only then the following has a meaning, one of them at a time
    [[nodiscard]] unsigned variant() const { return word >> 14U; }
    [[nodiscard]] std::optional<TrafficTable> table() const;
    [[nodiscard]] std::optional<TrafficTiming> timing() const;
    [[nodiscard]] std::optional<TrafficCountry> country() const;
};
[[nodiscard]] OpenDataAnnouncement announcementOf(const OpenDataGroup& group);

/// A traffic message as far as one group, or the groups that it took, tell it.
struct TrafficMessage {
    /// A field of the optional content of a message of several groups.
    struct Detail {
        unsigned label = 0;
        unsigned value = 0;
        friend bool operator==(const Detail&, const Detail&) = default;
    };
    bool multiGroup = false;
    unsigned event = 0;
    unsigned location = 0;
    unsigned extent = 0;
    bool backward = false;
    bool diversion = false;       ///< of a message of one group
    unsigned duration = 0;        ///< likewise
    std::vector<Detail> details;  ///< of a message of several groups
    friend bool operator==(const TrafficMessage&, const TrafficMessage&) = default;
};

/// A group 8A (ISO 14819-1): the flags T and F tell what it is.
struct TrafficGroup {
    enum class Kind { Single, First, Further, Tuning, Administration, Unknown };
    Kind kind = Kind::Unknown;
    TrafficMessage message;     ///< of a single and of a first group
    unsigned continuity = 0;    ///< of the groups of one message
    bool second = false;        ///< the group behind the first one
    unsigned toFollow = 0;      ///< so many groups come behind this one
    std::uint32_t content = 0;  ///< 28 bits of it
    unsigned variant = 0;       ///< of tuning information
    std::uint16_t block3 = 0, block4 = 0;
};
[[nodiscard]] TrafficGroup trafficGroupOf(const OpenDataGroup& group);

/// The fields of the optional content. @param parts 28 bits each, the first one first.
[[nodiscard]] std::vector<TrafficMessage::Detail> detailsOf(std::span<const std::uint32_t> parts);

}  // namespace kdx::air
