#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace kdx {

inline constexpr std::size_t kGroupCodeLength = 10;

/// The fields of a single-group traffic message (group 8A) as the bit display holds them: "0" and "1", or "-" where
/// nothing has been chosen yet. In brackets the count of bits.
struct GroupBits {
    std::string t;         ///< (1) message kind flag, sent beside the other 36 bits
    std::string f;         ///< (1) single-group message
    std::string dp;        ///< (3) duration and persistence
    std::string d;         ///< (1) diversion advice
    std::string u;         ///< (1) direction
    std::string extent;    ///< (3)
    std::string event;     ///< (11)
    std::string location;  ///< (16)
};

/// The message with the fields that nobody has chosen yet at 0.
[[nodiscard]] GroupBits withZeros(const GroupBits& bits);

/// The group code: the T bit, then nine upper-case hexadecimal digits. Fields not chosen yet make the bits too few;
/// the code is then incomplete, but ten characters all the same.
[[nodiscard]] std::string groupCode(const GroupBits& bits);

/// The open-data announcement that goes out before each message: receivers look for messages when they see it.
/// @param otherVariant the two system information words go out in turn.
[[nodiscard]] std::string announcement(bool otherVariant);

/// The message of that group code as it goes out.
[[nodiscard]] std::string sentMessage(std::string_view code);

/// The number's last `count` binary digits: larger numbers lose their upper bits.
[[nodiscard]] std::string lastBits(double number, std::size_t count);

/// The number, rounded to a whole one, in upper-case hexadecimal digits without leading zeros or blanks; negative
/// ones as 32-bit two's complement. Beyond 32 bits the nearest number that fits is taken; what is no number gives 0.
[[nodiscard]] std::string hexadecimal(double number);

/// The number that an entry of the event or location list ends in: its last 5 characters, 0 when they are none.
[[nodiscard]] double entryNumber(std::string_view entry);

}  // namespace kdx
