#include "tmc/groupcode.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "tmc/modul2.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <limits>

namespace kdx {

namespace {

constexpr std::size_t kMessageBits = 36;
constexpr std::size_t kBitsOfDigit = 4;
constexpr std::size_t kNumberLength = 5;
// Group type 8A, the two system information words in turn, the identifier of the TMC application.
constexpr const char* kFirstAnnouncement = "01,106100CD46";
constexpr const char* kSecondAnnouncement = "01,100066CD46";
constexpr const char* kMessagePrefix = "02,";

}  // namespace

GroupBits withZeros(const GroupBits& bits) {
    const auto zeros = [](const std::string& field, std::size_t count) {
        return field == "-" ? std::string(count, '0') : field;
    };
    return {zeros(bits.t, 1), zeros(bits.f, 1),      zeros(bits.dp, 3),     zeros(bits.d, 1),
            zeros(bits.u, 1), zeros(bits.extent, 3), zeros(bits.event, 11), zeros(bits.location, 16)};
}

std::string groupCode(const GroupBits& bits) {
    const std::string message = bits.f + bits.dp + bits.d + bits.u + bits.extent + bits.event + bits.location;
    std::string code = bits.t;
    for (std::size_t at = 0; at < kMessageBits; at += kBitsOfDigit) {
        const std::string fourBits = at < message.size() ? message.substr(at, kBitsOfDigit) : std::string();
        // One digit: a location above 65535 leads with a "2" or more in place of a bit and counts above 15 here.
        code += rightmost(hexadecimal(Modul2::BinaryToValue(fourBits)), 1);
    }
    return code;
}

std::string announcement(bool otherVariant) {
    return otherVariant ? kSecondAnnouncement : kFirstAnnouncement;
}

std::string sentMessage(std::string_view code) {
    return std::string(kMessagePrefix).append(code);
}

std::string lastBits(double number, std::size_t count) {
    constexpr double kLargest = std::numeric_limits<float>::max();
    return rightmost(Modul2::ToBinary16(static_cast<float>(std::clamp(number, -kLargest, kLargest))), count);
}

std::string hexadecimal(double number) {
    if (std::isnan(number)) return "0";  // what is no number counts as 0, as everywhere
    constexpr double kLowest = std::numeric_limits<std::int32_t>::min();
    constexpr double kLargest = std::numeric_limits<std::int32_t>::max();
    const auto whole = static_cast<std::int32_t>(std::nearbyint(std::clamp(number, kLowest, kLargest)));
    std::array<char, 8> digits{};
    const auto* end =
        std::to_chars(digits.data(), digits.data() + digits.size(), static_cast<std::uint32_t>(whole), 16).ptr;
    return upperCase({digits.data(), end});
}

double entryNumber(std::string_view entry) {
    return leadingNumber(rightmost(entry, kNumberLength));
}

}  // namespace kdx
