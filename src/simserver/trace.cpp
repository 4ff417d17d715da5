#include "simserver/trace.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>

#include "air/receivertrafficwords.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "coder/fieldsizes.h"

namespace kdx::simserver {

namespace {

using sim::cutAt;
using sim::splitOutsideQuotes;

std::string number(std::uint64_t value) {
    return std::to_string(value);
}

std::uint64_t hexValue(std::string_view digits) {
    std::uint64_t value = 0;
    std::from_chars(digits.data(), digits.data() + digits.size(), value, 16);
    return value;
}

// "02," and ten characters, all hexadecimal digits.
constexpr std::size_t kGroupPrefix = 3;
bool isGroup(std::string_view value) {
    return value.size() == kGroupPrefix + kGroupDigits && value[2] == ',' && isHex(value.substr(kGroupPrefix));
}

air::OpenDataGroup groupOf(std::string_view value) {
    constexpr std::uint64_t kBits = 0x1F;
    const std::uint64_t content = hexValue(value.substr(kGroupPrefix));
    return {static_cast<std::uint8_t>(content >> 32U & kBits), static_cast<std::uint16_t>(content >> 16U),
            static_cast<std::uint16_t>(content)};
}

std::string describeTrafficMessage(std::string_view value) {
    if (!isGroup(value)) return "incomplete traffic message";
    return fromUtf8(inWords(air::trafficGroupOf(groupOf(value)), {}));
}

std::string describeOpenData(std::string_view value) {
    if (!isGroup(value)) return "incomplete open-data announcement";
    return inWords(air::announcementOf(groupOf(value)));
}

std::string describePs(std::string_view value) {
    return "programme service name \"" + std::string(value) + "\"";
}

std::string describePi(std::string_view value) {
    return "programme identification " + std::string(value);
}

std::string describePty(std::string_view value) {
    return "programme type " + std::string(value);
}

std::string describeRadiotext(std::string_view value) {
    const auto text = cutAt(cutAt(value, ',').tail.value_or(""), ',').tail.value_or("");
    if (text.empty()) return "radiotext cleared";
    return "radiotext of " + number(text.size()) + " characters";
}

// "N,87.6,90.1": what kind of list it is and how many alternatives it has.
std::string describeList(std::string_view mode, const std::vector<std::string_view>& frequencies,
                         std::size_t alternatives, std::string_view method) {
    return std::string(mode == "+" ? "a further AF list" : "first AF list of a new set") + ", tuned to " +
           std::string(frequencies[0]) + " MHz, " + number(alternatives) + " alternatives, " + std::string(method);
}

std::string describeFrequencies(std::string_view value) {
    const auto [mode, rest] = cutAt(value, ',');
    const std::vector<std::string_view> frequencies = splitOutsideQuotes(rest.value_or(""), ',');
    // Method B repeats the tuned frequency in every pair: it stands twice at the beginning.
    const bool methodB = frequencies.size() > 1 && frequencies[0] == frequencies[1];
    const std::size_t alternatives = methodB ? (frequencies.size() - 1) / 2 : frequencies.size() - 1;
    return describeList(mode, frequencies, alternatives, methodB ? "method B" : "method A");
}

// The frequencies of another network have no method: each is mapped to the tuned frequency of this one.
std::string describeNetworkFrequencies(std::string_view value) {
    const auto [pi, rest] = cutAt(value, ',');
    const auto [mode, list] = cutAt(rest.value_or(""), ',');
    const std::vector<std::string_view> frequencies = splitOutsideQuotes(list.value_or(""), ',');
    return "other network " + std::string(pi) + ": " +
           describeList(mode, frequencies, frequencies.size() - 1, "mapped");
}

std::string describeClock(std::string_view value) {
    return equalNoCase(value, "off") ? "clock time no longer sent" : "clock time set";
}

std::string describeGroups(std::string_view value) {
    return "sequence of " + number(splitOutsideQuotes(value, ',').size()) + " groups";
}

std::string describeTest(std::string_view value) {
    return value == "0" ? "normal operation" : "test pattern " + std::string(value);
}

// The program may send a programme type's name under this command.
std::string describeNewNetwork(std::string_view pi) {
    if (pi.size() != 4 || !isHex(pi)) return "no programme identification: " + sim::quoted(pi);
    return "other network " + std::string(pi) + " added";
}

struct TraceRow {
    std::string_view name;
    std::string (*describe)(std::string_view value);
};

constexpr std::array kTraceRows = {
    TraceRow{"PS", describePs},
    TraceRow{"PI", describePi},
    TraceRow{"PTY", describePty},
    TraceRow{"RT", describeRadiotext},
    TraceRow{"CT", describeClock},
    TraceRow{"AF", describeFrequencies},
    TraceRow{"GS", describeGroups},
    TraceRow{"BIN", describeTest},
    TraceRow{"3A", describeOpenData},
    TraceRow{"8A", describeTrafficMessage},
    TraceRow{"EON-PI", describeNewNetwork},
    TraceRow{"EON-DEL", [](std::string_view pi) { return "other network " + std::string(pi) + " removed"; }},
    TraceRow{"EON-AFB", describeNetworkFrequencies},
    TraceRow{"STORE", [](std::string_view memory) { return "set-up stored in memory " + std::string(memory); }},
    TraceRow{"DS", [](std::string_view memory) { return "set-up recalled from memory " + std::string(memory); }},
};

std::string describeCoderCommand(std::string_view command) {
    const auto [head, value] = cutAt(command, '=');
    if (!value) return {};
    const std::string_view name = sim::trimmed(head);
    const auto row = std::find_if(kTraceRows.begin(), kTraceRows.end(),
                                  [name](const TraceRow& r) { return equalNoCase(r.name, name); });
    return row == kTraceRows.end() ? std::string() : row->describe(*value);
}

}  // namespace

std::string describe(const sim::CommandUnit& unit, sim::ScpiError error) {
    if (error != sim::ScpiError::None) return "refused: " + sim::errorAnswer(error);
    if (unit.query || !sim::headerMatches("STEReo:DIRect", unit.header)) return {};
    return describeCoderCommand(sim::unquoted(unit.parameter).value_or(""));
}

}  // namespace kdx::simserver
