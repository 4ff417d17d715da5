#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace kdx {

/// Characters of the location and of the event in a message list entry.
inline constexpr std::size_t kMessageTextLength = 35;
/// Characters between the location and the event.
inline constexpr std::string_view kAfterLocation = "  :";
/// Characters between the event and the group code.
inline constexpr std::string_view kAfterEvent = "   :";

/// An entry of the message list: location and event, padded or cut to 35 characters each, and the group code.
[[nodiscard]] std::string messageEntry(std::string_view location, std::string_view event, std::string_view code);

/// The group code of an entry: its last 10 characters.
[[nodiscard]] std::string codeOfMessage(std::string_view entry);

/// The list position sent after `position`. The program counts modulo 20 before it looks at the number of
/// messages, so with more than 20 of them the first and those from the 21st position on are never sent; that is how
/// it has always cycled and is kept.
[[nodiscard]] int nextPosition(int position, int messageCount);

/// The timer interval in whole milliseconds of a change time in seconds; 0 for a text without a number.
[[nodiscard]] double cycleTimeMs(std::string_view seconds);

}  // namespace kdx
