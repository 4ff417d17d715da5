#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace kdx {

// A group sequence is the groups in their order, each followed by a comma: "0A,2A,8A,". That is how it is shown after
// its heading, and how it is stored.

inline constexpr int kGroups = 16;
inline constexpr int kTmcGroup = 8;

/// One group as a part of a sequence. @param number 0 to 15.
[[nodiscard]] std::string groupText(int number);

/// The sequence as the coder takes it: without its last character, the comma after the last group.
[[nodiscard]] std::string sequenceToSend(std::string_view groups);

/// Counts one more; a full counter stays full.
void countUp(std::int16_t& counter);

}  // namespace kdx
