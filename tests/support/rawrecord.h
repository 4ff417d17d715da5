#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace kdx::test {

/// In a record mark beside the fragment's length: the record ends with this fragment.
inline constexpr std::uint32_t kLastFragment = 0x80000000U;

/// A number as it stands in a message of the remote procedure call.
void appendWord(std::string& bytes, std::uint32_t value);
std::uint32_t wordAt(const std::string& bytes, std::size_t at);

/// The message as a record of one fragment.
std::string record(const std::string& message);

/// The message as a record of many.
std::string fragments(const std::string& message);

/// Record mark of one fragment, the last one of its record, that claims to have so many bytes.
std::string claims(std::uint32_t length);

/// A whole answer that bears another call's number.
std::string answerTo(std::uint32_t call);

}  // namespace kdx::test
