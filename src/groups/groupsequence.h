#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "coder/step.h"

namespace kdx {

class Profile;
struct Place;

// A group sequence is the groups in their order, each followed by a comma: "0A,2A,8A,". That is how it is shown after
// its heading, and how it is stored.

inline constexpr int kGroups = 16;
inline constexpr int kTmcGroup = 8;

/// One group as a part of a sequence. @param number 0 to 15.
[[nodiscard]] std::string groupText(int number);

/// The sequence as the coder takes it: without its last character, the comma after the last group.
[[nodiscard]] std::string sequenceToSend(std::string_view groups);

/// The group sequence of a data set. It may have any length, but a file gives the beginning only of a long one: what
/// was read and not composed since must not take the place of what is stored.
struct GroupSequence {
    std::string groups;     ///< each followed by a comma
    bool composed = false;  ///< by the user, since it was read
    bool cut = false;       ///< begins with a reading that goes on in its file

    void load(const Profile& profile);
    /// The same from another place.
    void load(const Profile& profile, const Place& place);
    /// Begins a new one.
    void startAnew();
    /// Whether it is longer than a reading gives; true also for one that was read and goes on in its file.
    [[nodiscard]] bool exceedsReading() const;
    /// Whether the set at work is to get it when it is sent; never what begins with a cut reading.
    [[nodiscard]] bool isToBeStored(const Profile& profile) const;
    /// Adds the sequence; no step without one.
    void appendSteps(Steps& steps) const;
};

/// Counts one more; a full counter stays full.
void countUp(std::int16_t& counter);

}  // namespace kdx
