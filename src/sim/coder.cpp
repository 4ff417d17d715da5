#include "sim/coder.h"

#include <algorithm>

#include "base/codepage.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"
#include "coder/keyfacts.h"
#include "sim/parameters.h"
#include "sim/scpi.h"

namespace kdx::sim {

namespace {

constexpr int kHighestRadiotextNumber = 255;

// Two digits, a comma and ten characters, which is what 3A and 8A have in common; gives the ten characters.
std::optional<std::string_view> groupContents(std::string_view value) {
    const auto [number, contents] = cutAt(value, ',');
    if (number.size() != 2 || !isDecimal(number) || !contents || contents->size() != kGroupDigits) return std::nullopt;
    return contents;
}

ScpiError checkMemory(std::optional<int> number) {
    if (!number) return ScpiError::IllegalValue;
    const bool exists = *number >= 1 && *number <= static_cast<int>(Coder::kMemories);
    return exists ? ScpiError::None : ScpiError::OutOfRange;
}

// "eon pi" and "EON-PI" are the same name.
std::string coderName(std::string_view text) {
    std::string name = upperCase(trimmed(text));
    std::replace(name.begin(), name.end(), ' ', '-');
    return name;
}

}  // namespace

/// A command or query that is more than one value; a missing half means that there is only the other.
struct Coder::Row {
    std::string_view name;
    ScpiError (*set)(Coder& coder, std::string_view value);
    std::string (*ask)(const Coder& coder);
};

const Coder::Row* Coder::rowOf(std::string_view name) {
    using Value = std::string_view;
    using Text = std::string;
    static constexpr std::array kRows = {
        Row{"PS", [](Coder& c, Value v) { return c.setPs(v); }, [](const Coder& c) -> Text { return c.m_settings.ps; }},
        Row{"PI", [](Coder& c, Value v) { return c.setPi(v); }, [](const Coder& c) -> Text { return c.m_settings.pi; }},
        Row{"RT", [](Coder& c, Value v) { return c.setRadiotext(v); },
            [](const Coder& c) -> Text { return c.m_settings.radiotext; }},
        Row{"RT-N", nullptr, [](const Coder& c) -> Text { return c.m_settings.radiotextNumbers; }},
        Row{"CT", [](Coder& c, Value v) { return c.m_clock.set(v); }, [](const Coder& c) { return c.m_clock.text(); }},
        Row{"AF", [](Coder& c, Value v) { return c.m_settings.afLists.receive(v); }, nullptr},
        Row{"AF1", nullptr, [](const Coder& c) -> Text { return c.m_settings.afLists.list(0); }},
        Row{"AF2", nullptr, [](const Coder& c) -> Text { return c.m_settings.afLists.list(1); }},
        Row{"AF3", nullptr, [](const Coder& c) -> Text { return c.m_settings.afLists.list(2); }},
        Row{"AF4", nullptr, [](const Coder& c) -> Text { return c.m_settings.afLists.list(3); }},
        Row{"AF5", nullptr, [](const Coder& c) -> Text { return c.m_settings.afLists.list(4); }},
        Row{"GS", [](Coder& c, Value v) { return c.setGroupSequence(v); },
            [](const Coder& c) -> Text { return c.m_settings.groupSequence; }},
        Row{"3A", [](Coder& c, Value v) { return c.setOpenData(v); },
            [](const Coder& c) -> Text { return c.m_openData.last; }},
        Row{"3A-N", nullptr, [](const Coder& c) { return std::to_string(c.m_openData.count); }},
        Row{"8A", [](Coder& c, Value v) { return c.setTrafficMessage(v); },
            [](const Coder& c) -> Text { return c.m_traffic.last; }},
        Row{"8A-N", nullptr, [](const Coder& c) { return std::to_string(c.m_traffic.count); }},
        Row{"STORE", [](Coder& c, Value v) { return c.store(v); }, [](const Coder& c) { return c.filledMemories(); }},
        Row{"DS", [](Coder& c, Value v) { return c.recall(v); }, nullptr},
    };
    const auto row = std::find_if(kRows.begin(), kRows.end(), [name](const Row& r) { return r.name == name; });
    return row == kRows.end() ? nullptr : &*row;
}

ScpiError Coder::command(std::string_view text) {
    const auto [head, value] = cutAt(text, '=');
    const std::string name = coderName(head);
    const auto parameter = parameterOfCoder(name);
    const Row* row = rowOf(name);
    const bool special = row != nullptr && row->set != nullptr;
    if (name.empty()) return ScpiError::MissingParameter;
    if (!parameter && !special && !OtherNetworks::knows(name)) return ScpiError::IllegalValue;
    if (!value) return ScpiError::MissingParameter;
    if (parameter) return setFromCoder(*parameter, *value, m_settings);
    if (special) return row->set(*this, *value);
    return m_settings.otherNetworks.command(name, *value);
}

Reply Coder::query(std::string_view text) const {
    text = trimmed(text);
    if (!text.empty() && text.back() == '?') text.remove_suffix(1);
    const auto [head, argument] = cutAt(text, ',');
    const std::string name = coderName(head);
    if (OtherNetworks::knows(name)) return m_settings.otherNetworks.query(name, argument);
    const auto parameter = parameterOfCoder(name);
    const Row* row = rowOf(name);
    const bool special = row != nullptr && row->ask != nullptr;
    if (name.empty()) return {ScpiError::MissingParameter, std::nullopt};
    if (!parameter && !special) return {ScpiError::IllegalValue, std::nullopt};
    const ScpiError error = argument ? ScpiError::ParameterNotAllowed : ScpiError::None;
    return {error, parameter ? coderAnswer(*parameter, m_settings) : row->ask(*this)};
}

void Coder::reset() {
    m_clock.stop();
    m_openData = {};
    m_traffic = {};
}

ScpiError Coder::setPs(std::string_view value) {
    if (value.size() > kPsLength) return ScpiError::TooMuchData;
    if (hasControlCharacter(value)) return ScpiError::IllegalValue;
    m_settings.ps = padRight(value, kPsLength);
    return ScpiError::None;
}

ScpiError Coder::setPi(std::string_view value) {
    if (value.size() != kPiLength || !isHex(value)) return ScpiError::IllegalValue;
    m_settings.pi = upperCase(value);
    return ScpiError::None;
}

// Two numbers and the text: "10,0,text". An empty text clears.
ScpiError Coder::setRadiotext(std::string_view value) {
    const auto [first, rest] = cutAt(value, ',');
    const auto [second, text] = cutAt(rest.value_or(""), ',');
    if (!text) return ScpiError::MissingParameter;
    const auto firstNumber = readWhole(first);
    const auto secondNumber = readWhole(second);
    if (!firstNumber || !secondNumber || hasControlCharacter(*text)) return ScpiError::IllegalValue;
    for (const int number : {*firstNumber, *secondNumber}) {
        if (number < 0 || number > kHighestRadiotextNumber) return ScpiError::OutOfRange;
    }
    if (text->size() > kRadiotextLength) return ScpiError::TooMuchData;
    m_settings.radiotextNumbers = std::to_string(*firstNumber) + "," + std::to_string(*secondNumber);
    m_settings.radiotext = *text;
    return ScpiError::None;
}

ScpiError Coder::setGroupSequence(std::string_view value) {
    const std::string sequence = upperCase(trimmed(value));
    if (sequence.empty()) return ScpiError::MissingParameter;
    const std::vector<std::string_view> groups = splitOutsideQuotes(sequence, ',');
    if (groups.size() > kMostGroups) return ScpiError::TooMuchData;
    for (const std::string_view group : groups) {
        if (!isGroupType(group)) return ScpiError::IllegalValue;
    }
    m_settings.groupSequence = sequence;
    return ScpiError::None;
}

ScpiError Coder::setTrafficMessage(std::string_view value) {
    const auto contents = groupContents(value);
    // The T bit alone, then nine hexadecimal digits.
    if (!contents || !isHex(*contents) || contents->front() > '1') return ScpiError::IllegalValue;
    m_traffic = {upperCase(value), m_traffic.count + 1};
    return ScpiError::None;
}

ScpiError Coder::setOpenData(std::string_view value) {
    const auto contents = groupContents(value);
    if (!contents || !isHex(*contents)) return ScpiError::IllegalValue;
    m_openData = {upperCase(value), m_openData.count + 1};
    return ScpiError::None;
}

ScpiError Coder::store(std::string_view value) {
    const auto number = readWhole(value);
    if (const ScpiError error = checkMemory(number); error != ScpiError::None) return error;
    m_memories[static_cast<std::size_t>(*number - 1)] = m_settings;
    return ScpiError::None;
}

ScpiError Coder::recall(std::string_view value) {
    const auto number = readWhole(value);
    if (const ScpiError error = checkMemory(number); error != ScpiError::None) return error;
    const std::optional<Setup>& memory = m_memories[static_cast<std::size_t>(*number - 1)];
    if (!memory) return ScpiError::SettingsConflict;
    static_cast<Setup&>(m_settings) = *memory;
    return ScpiError::None;
}

// Numbers of the memories that something was stored in: "1,3".
std::string Coder::filledMemories() const {
    std::string numbers;
    for (std::size_t i = 0; i < kMemories; ++i) {
        if (!m_memories[i]) continue;
        if (!numbers.empty()) numbers += ',';
        numbers += std::to_string(i + 1);
    }
    return numbers;
}

}  // namespace kdx::sim
