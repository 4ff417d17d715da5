#include "simserver/trace.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>

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

std::string hexDigits(std::uint64_t value, unsigned count) {
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string digits;
    for (unsigned i = count; i > 0; --i) digits += kDigits[(value >> (4 * (i - 1))) & 0xF];
    return digits;
}

/// Takes bit fields off a group's contents, the most significant first.
class BitReader {
public:
    BitReader(std::uint64_t bits, unsigned length) : m_bits(bits), m_left(length) {}
    std::uint64_t take(unsigned count) {
        m_left -= count;
        return (m_bits >> m_left) & ((std::uint64_t{1} << count) - 1);
    }

private:
    std::uint64_t m_bits;
    unsigned m_left;
};

// "02," and ten characters, all hexadecimal digits.
constexpr std::size_t kGroupPrefix = 3;
bool isGroup(std::string_view value) {
    return value.size() == kGroupPrefix + kGroupDigits && value[2] == ',' && isHex(value.substr(kGroupPrefix));
}

std::string describeTrafficMessage(std::string_view value) {
    if (!isGroup(value)) return "incomplete traffic message";
    const bool t = value[kGroupPrefix] != '0';
    BitReader bits(hexValue(value.substr(kGroupPrefix + 1)), 36);
    const bool single = bits.take(1) == 1;
    const std::uint64_t duration = bits.take(3);
    const bool diversion = bits.take(1) == 1;
    const bool backward = bits.take(1) == 1;
    const std::uint64_t extent = bits.take(3);
    const std::uint64_t event = bits.take(11);
    const std::uint64_t location = bits.take(16);
    return "traffic message: event " + number(event) + ", location " + number(location) + ", extent " + number(extent) +
           ", direction " + (backward ? "backward" : "forward") + ", duration " + number(duration) + ", " +
           (diversion ? "diversion" : "no diversion") + ", F " + (single ? "1" : "0") + ", T " + (t ? "1" : "0");
}

std::string yesNo(std::uint64_t bit) {
    return bit == 0 ? "no" : "yes";
}

// The group that an application's data come in: four bits of type, one of version. Two codes are no group.
std::string groupName(std::uint64_t code) {
    constexpr std::uint64_t kNoGroup = 0;
    constexpr std::uint64_t kFault = 31;
    if (code == kNoGroup) return "no group of its own";
    if (code == kFault) return "no group for now (fault)";
    return "group " + number(code >> 1) + ((code & 1) == 0 ? "A" : "B");
}

// Seconds, in the two bits that enhanced mode has for each of its times.
std::string timeOf(std::uint64_t code) {
    return number(std::uint64_t{1} << code) + " s";
}

// The 16 bits that an announcement of traffic messages carries (ISO 14819-1); what they mean depends on the variant in
// front.
std::string describeSystemInformation(std::uint64_t word) {
    BitReader bits(word, 16);
    const std::uint64_t variant = bits.take(2);
    if (variant == 0) {
        bits.take(2);  // reserved
        const std::uint64_t table = bits.take(6);
        const std::uint64_t alternative = bits.take(1);
        const std::uint64_t enhanced = bits.take(1);
        std::string scope;
        for (const char* area : {"international ", "national ", "regional ", "urban "}) {
            if (bits.take(1) == 1) scope += area;
        }
        return "location table " + number(table) + (table == 0 ? " (encrypted)" : "") + ", alternative frequencies " +
               yesNo(alternative) + ", enhanced mode " + yesNo(enhanced) + ", scope " +
               (scope.empty() ? "none" : scope.substr(0, scope.size() - 1));
    }
    if (variant == 1) {
        constexpr std::array<std::uint64_t, 4> kGaps = {3, 5, 8, 11};
        const std::uint64_t gap = kGaps[bits.take(2)];
        const std::uint64_t service = bits.take(6);
        const std::string activity = timeOf(bits.take(2));
        const std::string window = timeOf(bits.take(2));
        const std::uint64_t delay = bits.take(2);
        return "gap of " + number(gap) + " groups, service " + number(service) + ", activity " + activity +
               ", window " + window + ", delay " + number(delay) + " s";
    }
    if (variant == 2) {
        const std::uint64_t country = bits.take(4);
        bits.take(2);  // reserved
        return "location table country " + hexDigits(country, 1) + ", extended country code " +
               hexDigits(bits.take(8), 2);
    }
    return "variant " + number(variant);
}

std::string describeOpenData(std::string_view value) {
    if (!isGroup(value)) return "incomplete open-data announcement";
    BitReader bits(hexValue(value.substr(kGroupPrefix)), 40);
    bits.take(3);  // the group type has five bits
    const std::uint64_t group = bits.take(5);
    const std::uint64_t word = bits.take(16);
    const std::uint64_t application = bits.take(16);
    std::string text = "open data in " + groupName(group) + ", application ";
    text.append(value.substr(value.size() - 4));
    constexpr std::array<std::uint64_t, 2> kTrafficApplications = {0xCD46, 0xCD47};
    const bool traffic = std::count(kTrafficApplications.begin(), kTrafficApplications.end(), application) > 0;
    if (traffic) text += " (traffic messages), " + describeSystemInformation(word);
    return text;
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
