#include "coder/keyfacts.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <span>

#include "base/codepage.h"
#include "base/numbers.h"
#include "base/split.h"
#include "coder/fieldsizes.h"
#include "coder/listlead.h"
#include "coder/rdscharacters.h"
#include "settings/captions.h"
#include "settings/storedvalue.h"

namespace kdx {

namespace {

using Kind = ValueKind;

struct Row {
    std::string_view key;
    std::string_view meaning;
    Kind kind;
    double lowest = 0;
    double highest = 0;
    std::string_view unit = {};
    std::string_view words = {};  ///< separated by blanks
};

constexpr std::string_view kFlag = "0 1";
constexpr double kLowestAlternative = 87.5;
constexpr double kLowestTuned = 86;
constexpr double kHighestFrequency = 108;

// The limits are the instrument's; a deviation counts tens of hertz.
constexpr std::array kRows = {
    Row{"PS", "programme service name", Kind::Text, 0, kPsLength},
    Row{"PI", "programme identification", Kind::Identifier},
    Row{"PTY", "programme type", Kind::Whole, 0, kProgrammeTypes - 1},
    Row{"TP", "traffic programme", Kind::Word, 0, 0, {}, kFlag},
    Row{"TA", "traffic announcement", Kind::Word, 0, 0, {}, kFlag},
    Row{"MS", "music or speech", Kind::Word, 0, 0, {}, "M S"},
    Row{"DI", "decoder information", Kind::Whole, 0, 15},
    Row{"RT", "radiotext, ten times", Kind::Text, 0, kRadiotextLength},
    Row{"RTA", "radiotext, five times, other A/B flag", Kind::Text, 0, kRadiotextLength},
    Row{"DEL_RT", "clears the radiotext", Kind::Ignored},
    Row{"UHR", "clock time as the window shows it", Kind::Clock},
    Row{"ZEIT", "clock time of the PC", Kind::Ignored},
    Row{"RDS", "RDS subcarrier", Kind::Word, 0, 0, {}, kFlag},
    Row{"RDS_HUB", "deviation of the RDS subcarrier", Kind::Number, 0, 400, "x 10 Hz"},
    Row{"RDS_PHASE", "phase of the RDS subcarrier", Kind::Number, 0, 359, "degrees"},
    Row{"AF1", "alternative frequencies, list 1", Kind::Frequencies},
    Row{"AF2", "alternative frequencies, list 2", Kind::Frequencies},
    Row{"AF3", "alternative frequencies, list 3", Kind::Frequencies},
    Row{"AF4", "alternative frequencies, list 4", Kind::Frequencies},
    Row{"AF5", "alternative frequencies, list 5", Kind::Frequencies},
    Row{"GROUPSEQ", "group sequence", Kind::Groups},
    Row{"GROUPSEQ_TN", "group sequence", Kind::Groups},
    Row{"STORE", "stores the set-up in a memory of the coder", Kind::Whole, 1, 5},
    Row{"ODA", "group 3A of an open data application", Kind::Message},
    Row{"TMC", "traffic message, group 8A", Kind::TrafficMessage},
    Row{"TEST_M", "test mode: 0 ends it", Kind::Whole, 0, 4},
    Row{"TEST_D", "test pattern", Kind::Whole, 0, 4},
    Row{"EON_PI", "other network: its PI", Kind::Identifier},
    Row{"EON_PS", "other network: programme service name", Kind::Text, 0, kPsLength},
    Row{"EON_PTY", "other network: programme type", Kind::Whole, 0, kProgrammeTypes - 1},
    Row{"EON_TP", "other network: traffic programme", Kind::Word, 0, 0, {}, kFlag},
    Row{"EON_TA", "other network: traffic announcement", Kind::Word, 0, 0, {}, kFlag},
    Row{"EON_AFA", "other network: alternative frequencies, method A", Kind::PlainList},
    Row{"EON_AFB1", "other network: mapped frequencies, list 1", Kind::Frequencies},
    Row{"EON_AFB2", "other network: mapped frequencies, list 2", Kind::Frequencies},
    Row{"EON_AFB3", "other network: mapped frequencies, list 3", Kind::Frequencies},
    Row{"EON_AFB4", "other network: mapped frequencies, list 4", Kind::Frequencies},
    Row{"EON_AFB5", "other network: mapped frequencies, list 5", Kind::Frequencies},
    Row{"EON_DEL", "removes the other network of that PI", Kind::Identifier},
    Row{"MPX_HUB", "total deviation", Kind::Number, 0, 8000, "x 10 Hz"},
    Row{"MPX_SOURCE", "source: off, left and right, SPDIF, audio generator", Kind::Word, 0, 0, {}, "0 1 2 3"},
    Row{"MPX_IMPEDANZ", "input impedance: 600 ohms, 100 kilohms", Kind::Word, 0, 0, {}, "1 2"},
    Row{"STEREO_MODE", "left, right, right = left, right = -left, right and left", Kind::Word, 0, 0, {}, "1 2 3 4 5"},
    Row{"PREEMPHASIS", "preemphasis: off, 50 us, 75 us", Kind::Word, 0, 0, {}, "0 1 2"},
    Row{"PILOT", "pilot tone", Kind::Word, 0, 0, {}, kFlag},
    Row{"PILOT_HUB", "deviation of the pilot tone", Kind::Number, 0, 1500, "x 10 Hz"},
    Row{"PILOT_PHASE", "phase of the pilot tone", Kind::Number, -180, 180, "degrees"},
    Row{"ARI", "ARI signal", Kind::Word, 0, 0, {}, kFlag},
    Row{"ARI-HUB", "deviation of the ARI signal", Kind::Number, 0, 800, "x 10 Hz"},
    Row{"ARI-ID", "ARI identification: off, DK, BK, BK and DK", Kind::Word, 0, 0, {}, "0 1 2 3"},
    Row{"ARI-BK", "ARI area", Kind::Word, 0, 0, {}, "A B C D E F"},
    Row{"STEREO_EIN", "stereo coder on", Kind::Ignored},
    Row{"STEREO_AUS", "stereo coder off", Kind::Ignored},
    Row{"FM_EIN", "frequency modulation on", Kind::Ignored},
    Row{"FM_AUS", "frequency modulation off", Kind::Ignored},
    Row{"AM_AUS", "amplitude modulation off", Kind::Ignored},
    Row{"HF:PEGEL:STATE", "RF output", Kind::Word, 0, 0, {}, "ON OFF"},
    Row{"HF-Frequenz", "RF frequency", Kind::Number, 0.1, 1040, "MHz"},
    Row{"HF-Pegel", "RF level", Kind::Number, 0, 120, "dBuV"},
    Row{"NF-Frequenz", "frequency of the audio generator", Kind::Number, 0.02, 80, "kHz"},
};

/// The number that fills the text, with a decimal point; nothing for anything else.
std::optional<double> wholeText(std::string_view text) {
    double value = 0;
    const char* const end = text.data() + text.size();
    const auto [stop, error] = std::from_chars(text.data(), end, value, std::chars_format::fixed);
    return error == std::errc() && stop == end ? std::optional(value) : std::nullopt;
}

bool isWithin(std::string_view text, double lowest, double highest) {
    const auto number = wholeText(text);
    return number && *number >= lowest && *number <= highest;
}

/// The tuned frequency may lie below the band of the alternatives, also where method B repeats it.
bool isFrequencyList(std::string_view text) {
    const auto frequencies = split(text, ",");
    return std::all_of(frequencies.begin(), frequencies.end(), [&](std::string_view frequency) {
        const bool tuned = wholeText(frequency) == wholeText(frequencies.front());
        return isWithin(frequency, tuned ? kLowestTuned : kLowestAlternative, kHighestFrequency);
    });
}

bool isLedFrequencyList(std::string_view text) {
    const auto list = afterListLead(text);
    return list && isFrequencyList(*list);
}

bool isMessage(std::string_view text) {
    return text.size() == 3 + kGroupDigits && isDecimal(text.substr(0, 2)) && text[2] == ',' && isHex(text.substr(3));
}

std::string joinedWords(std::string_view words) {
    const auto all = split(words, " ");
    std::string text;
    for (std::size_t i = 0; i < all.size(); ++i) {
        if (i > 0) text += i + 1 == all.size() ? " or " : ", ";
        text += all[i];
    }
    return text;
}

std::string range(const Row& row) {
    const std::string unit = row.unit.empty() ? std::string() : " " + std::string(row.unit);
    switch (row.kind) {
        case Kind::Ignored:
            return {};
        case Kind::Word:
            return joinedWords(row.words);
        case Kind::Whole:
            return shortestDecimal(row.lowest) + " to " + shortestDecimal(row.highest);
        case Kind::Number:
            return shortestDecimal(row.lowest) + " to " + shortestDecimal(row.highest) + unit +
                   ", with a decimal point";
        case Kind::Text:
            return "at most " + shortestDecimal(row.highest) + " characters of the RDS character set, no double quote";
        case Kind::Identifier:
            return "four hexadecimal digits";
        case Kind::Frequencies:
            return "\"N,\" or \"+,\", then frequencies in MHz with commas between: N,98.5,87.6,107.9";
        case Kind::PlainList:
            return "frequencies in MHz with commas between: 98.5,87.6,107.9";
        case Kind::Groups:
            return "groups 0A to 15B with commas between, at most " + std::to_string(kMostGroups) + ": 0A,0A,2A";
        case Kind::Message:
            return "two digits, a comma and ten hexadecimal digits: 02,0B90E400CC";
        case Kind::TrafficMessage:
            return "two digits, a comma, 0 or 1 and nine hexadecimal digits: 02,0B90E400CC";
        case Kind::Clock:
            return "OFF, or anything else for the time";
    }
    return {};
}

/// Nothing when the value is legal; else why it is not, as far as that is more than not to be within the range.
std::optional<std::string> problem(const Row& row, std::string_view value, const Corrections& corrections) {
    const auto unless = [](bool legal) { return legal ? std::nullopt : std::optional<std::string>(std::string()); };
    switch (row.kind) {
        case Kind::Ignored:
        case Kind::Clock:
            return std::nullopt;
        case Kind::Word: {
            const auto words = split(row.words, " ");
            return unless(std::find(words.begin(), words.end(), value) != words.end());
        }
        case Kind::Whole:
            return unless(isDecimal(value) && isWithin(value, row.lowest, row.highest));
        case Kind::Number:
            if (value.find(',') != std::string_view::npos) return "it has a decimal comma";
            return unless(isWithin(value, row.lowest, row.highest));
        case Kind::Text: {
            if (!corrections.quotes && value.find('"') != std::string_view::npos)
                return "a double quote ends the text for the coder";
            if (const auto missing = withoutRdsCode(value)) {
                return "RDS has no code for its character " + toUtf8(std::string(1, *missing));
            }
            return unless(value.size() <= static_cast<std::size_t>(row.highest));
        }
        case Kind::Identifier:
            return unless(value.size() == kPiLength && isHex(value));
        case Kind::Frequencies:
            return unless(isLedFrequencyList(value));
        case Kind::PlainList:
            return unless(isFrequencyList(value));
        case Kind::Groups: {
            const auto groups = split(value, ",");
            return unless(groups.size() <= kMostGroups && std::all_of(groups.begin(), groups.end(), isGroupType));
        }
        case Kind::Message:
            return unless(isMessage(value));
        case Kind::TrafficMessage:
            return unless(isMessage(value) && value[3] <= '1');
    }
    return std::nullopt;
}

const Row* rowOf(std::string_view key) {
    const auto* const row = std::find_if(kRows.begin(), kRows.end(), [key](const Row& r) { return r.key == key; });
    return row == kRows.end() ? nullptr : row;
}

std::string noSuchKey(std::string_view key) {
    return "there is no key " + std::string(key);
}

std::string sentence(const Row& row, std::string_view utf8, const std::string& why) {
    std::string text = std::string(row.key).append(" cannot be \"").append(utf8).append("\"");
    if (!why.empty()) text += ": " + why;
    const std::string legal = range(row);
    return text + (legal.empty() ? "." : ". Legal: " + legal + ".");
}

}  // namespace

const std::vector<KeyFacts>& keyFacts() {
    static const std::vector<KeyFacts> all = [] {
        std::vector<KeyFacts> facts;
        facts.reserve(kRows.size());
        for (const Row& row : kRows) {
            facts.push_back({row.key,
                             row.meaning,
                             range(row),
                             row.kind == Kind::Whole || row.kind == Kind::Number,
                             {row.kind, row.lowest, row.highest, row.unit, row.words}});
        }
        return facts;
    }();
    return all;
}

bool isGroupType(std::string_view group) {
    if (group.empty() || (group.back() != 'A' && group.back() != 'B')) return false;
    group.remove_suffix(1);
    return isDecimal(group) && group.size() <= 2 && isWithin(group, 0, kHighestGroup);
}

const KeyFacts* factsOf(std::string_view key) {
    const auto& all = keyFacts();
    const auto found = std::find_if(all.begin(), all.end(), [key](const KeyFacts& facts) { return facts.key == key; });
    return found == all.end() ? nullptr : &*found;
}

std::string correctedValue(std::string_view key, const std::string& value, const Corrections& corrections) {
    const Row* const row = rowOf(key);
    if (!corrections.decimalComma || row == nullptr || row->kind != Kind::Number) return value;
    return decimalNumber(value).value_or(value);
}

std::optional<std::string> wrongValue(std::string_view key, std::string_view value, const Corrections& corrections) {
    const Row* const row = rowOf(key);
    if (row == nullptr) return noSuchKey(key);
    const auto why = problem(*row, correctedValue(key, std::string(value), corrections), corrections);
    return why ? std::optional(sentence(*row, toUtf8(value), *why)) : std::nullopt;
}

std::optional<std::string> wrongTypedValue(std::string_view key, std::string_view utf8,
                                           const Corrections& corrections) {
    const Row* const row = rowOf(key);
    if (row == nullptr) return noSuchKey(key);
    const std::string_view foreign = firstOutsideCodePage(utf8);
    if (foreign.empty()) return wrongValue(key, fromUtf8(utf8), corrections);
    return sentence(*row, utf8, noSuchCharacter(foreign));
}

}  // namespace kdx
