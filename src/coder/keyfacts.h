#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "settings/corrections.h"

namespace kdx {

/// What kind of values a key takes.
enum class ValueKind {
    Ignored,         ///< the value does not matter
    Word,            ///< one of the words
    Whole,           ///< a whole number within the limits
    Number,          ///< a decimal number within the limits
    Text,            ///< at most `highest` characters that RDS has
    Identifier,      ///< a PI: four hexadecimal digits
    Frequencies,     ///< "N," or "+," and a list of MHz
    PlainList,       ///< a list of MHz
    Groups,          ///< "0A,2A"
    Message,         ///< two digits, a comma and ten hexadecimal digits
    TrafficMessage,  ///< the same, the first hexadecimal digit a single bit
    Clock,           ///< "OFF", "AUS" or anything else
};

/// Which values a key takes, for whoever says it in another language.
struct LegalValues {
    ValueKind kind = ValueKind::Ignored;
    double lowest = 0;
    double highest = 0;
    std::string_view unit = {};
    std::string_view words = {};  ///< separated by blanks
};

/// What a key of the key table stands for and which values the instrument takes for it, in words.
struct KeyFacts {
    std::string_view key;
    std::string_view meaning;
    std::string range;      ///< "0 to 31"; "" for a key whose value does not matter
    bool isNumber = false;  ///< whether its values are numbers that can be counted up
    LegalValues legal = {};
};

/// Whether the text is a type of group, from 0A to 15B.
[[nodiscard]] bool isGroupType(std::string_view group);

/// The facts of every key, in the order of the key table.
[[nodiscard]] const std::vector<KeyFacts>& keyFacts();

/// Those of one key; null for an unknown one.
[[nodiscard]] const KeyFacts* factsOf(std::string_view key);

/// Nothing when the instrument takes the value; else what is wrong in words, with the key, the value and what is legal.
/// An unknown key is wrong too. Values are 8-bit Windows-1252; the sentence is UTF-8.
/// @param corrections what they mend on the way to the instrument is not wrong.
[[nodiscard]] std::optional<std::string> wrongValue(std::string_view key, std::string_view value,
                                                    const Corrections& corrections = {});

/// The value as it is to go out: a number's decimal comma is a point where that is corrected.
[[nodiscard]] std::string correctedValue(std::string_view key, const std::string& value,
                                         const Corrections& corrections);

/// The same for a value in UTF-8, as it is typed; one that the code page cannot hold is wrong too.
[[nodiscard]] std::optional<std::string> wrongTypedValue(std::string_view key, std::string_view utf8,
                                                         const Corrections& corrections = {});

}  // namespace kdx
