#include "support/rawrecord.h"

#include <arpa/inet.h>

#include <cstring>

namespace kdx::test {

void appendWord(std::string& bytes, std::uint32_t value) {
    const std::uint32_t big = htonl(value);
    bytes.append(reinterpret_cast<const char*>(&big), sizeof big);
}

std::uint32_t wordAt(const std::string& bytes, std::size_t at) {
    std::uint32_t value = 0;
    std::memcpy(&value, bytes.data() + at, sizeof value);
    return ntohl(value);
}

std::string record(const std::string& message) {
    std::string bytes;
    appendWord(bytes, kLastFragment | static_cast<std::uint32_t>(message.size()));
    return bytes + message;
}

std::string fragments(const std::string& message) {
    constexpr std::size_t kFragment = 5;  // not a multiple of the four bytes that fields have
    std::string bytes;
    for (std::size_t at = 0; at < message.size(); at += kFragment) {
        const std::string part = message.substr(at, kFragment);
        const bool last = at + kFragment >= message.size();
        appendWord(bytes, (last ? kLastFragment : 0) | static_cast<std::uint32_t>(part.size()));
        bytes += part;
    }
    return bytes;
}

std::string claims(std::uint32_t length) {
    std::string mark;
    appendWord(mark, kLastFragment | length);
    return mark;
}

std::string answerTo(std::uint32_t call) {
    std::string message;
    for (const std::uint32_t word : {call, 1U, 0U, 0U, 0U, 0U}) appendWord(message, word);  // 1: a reply
    return record(message);
}

}  // namespace kdx::test
