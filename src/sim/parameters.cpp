#include "sim/parameters.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <span>

#include "base/codepage.h"
#include "base/numbers.h"
#include "settings/captions.h"
#include "sim/scpi.h"
#include "sim/setup.h"

namespace kdx::sim {

using Settings = InstrumentSettings;
using Words = std::span<const std::string_view>;

/// On or off.
struct SwitchRow {
    std::string_view header;
    std::string_view coderName;
    bool Settings::*value;
};

/// A number with a unit. The coder counts in steps of `coderStep` units.
struct NumberRow {
    std::string_view header;
    std::string_view coderName;
    double Settings::*value;
    std::string_view unit;
    double lowest;
    double highest;
    double coderStep;
};

/// A whole number, answered with at least `digits` digits.
struct WholeRow {
    std::string_view header;
    std::string_view coderName;
    int Settings::*value;
    int lowest;
    int highest;
    std::size_t digits;
};

/// One of several words, counted from 1. The coder uses the count, or the word itself; where the choice has a switch
/// of its own, the coder's 0 means off.
struct ChoiceRow {
    std::string_view header;
    std::string_view coderName;
    int Settings::*value;
    Words words;
    bool Settings::*onOff;
    bool coderUsesWords;
};

namespace {

constexpr std::array kSwitches = {
    SwitchRow{"STEReo:STATe", "", &Settings::stereoOn},
    SwitchRow{"STEReo:PILot:STATe", "PIL", &Settings::pilotOn},
    SwitchRow{"STEReo:RDS:STATe", "RDS", &Settings::rdsOn},
    SwitchRow{"STEReo:RDS:TRAFfic:PROGram", "TP", &Settings::tp},
    SwitchRow{"", "TA", &Settings::ta},
    SwitchRow{"STEReo:ARI:STATe", "ARI", &Settings::ariOn},
    SwitchRow{"STEReo:ARI:TYPE:STATe", "", &Settings::ariTypeOn},
    SwitchRow{"STEReo:AUDio:PREemphasis:STATe", "", &Settings::preemphasisOn},
    SwitchRow{"OUTPut:STATe", "", &Settings::outputOn},
    SwitchRow{"FM:STATe", "", &Settings::fmOn},
    SwitchRow{"AM:STATe", "", &Settings::amOn},
};

constexpr std::array kNumbers = {
    NumberRow{"STEReo:DEViation", "MPX-DEV", &Settings::mpxHertz, "HZ", 0, 80000, 10},
    NumberRow{"STEReo:PILot:DEViation", "PIL-DEV", &Settings::pilotHertz, "HZ", 0, 15000, 10},
    NumberRow{"STEReo:PILot:PHASe", "PIL-PH", &Settings::pilotDegrees, "DEG", -180, 180, 1},
    NumberRow{"STEReo:RDS:DEViation", "RDS-DEV", &Settings::rdsHertz, "HZ", 0, 4000, 10},
    NumberRow{"STEReo:RDS:PHASe", "RDS-PH", &Settings::rdsDegrees, "DEG", 0, 359, 1},
    NumberRow{"STEReo:ARI:DEViation", "ARI-DEV", &Settings::ariHertz, "HZ", 0, 8000, 10},
    NumberRow{"STEReo:AUDio:FREQuency", "", &Settings::audioKilohertz, "KHZ", 0.02, 80, 1},
    NumberRow{"FREQuency", "", &Settings::rfMegahertz, "MHZ", 0.1, 1040, 1},
    NumberRow{"POWer", "", &Settings::levelDecibelMicrovolt, "DBUV", 0, 120, 1},
};

constexpr std::array kWholes = {
    WholeRow{"", "PTY", &Settings::pty, 0, kProgrammeTypes - 1, 2},
    WholeRow{"", "DI", &Settings::decoderInfo, 0, 15, 1},
    WholeRow{"", "BIN", &Settings::testPattern, 0, 4, 1},
};

constexpr std::array<std::string_view, 3> kSources = {"LREXT", "SPEXT", "LFGEN"};
constexpr std::array<std::string_view, 2> kImpedances = {"600", "100000"};
constexpr std::array<std::string_view, 5> kStereoModes = {"LEFT", "RIGHT", "REL", "REML", "RNEL"};
constexpr std::array<std::string_view, 2> kPreemphases = {"50US", "75US"};
constexpr std::array<std::string_view, 3> kAriTypes = {"DK", "BK", "BKDK"};
constexpr std::array<std::string_view, 6> kAriAreas = {"A", "B", "C", "D", "E", "F"};
constexpr std::array<std::string_view, 2> kMusicSpeech = {"M", "S"};

constexpr std::array kChoices = {
    ChoiceRow{"STEReo:SOURce", "SRC", &Settings::source, kSources, &Settings::stereoOn, false},
    ChoiceRow{"STEReo:EXTernal:IMPedance", "IMP", &Settings::impedance, kImpedances, nullptr, false},
    ChoiceRow{"STEReo:AUDio:MODE", "MODE", &Settings::stereoMode, kStereoModes, nullptr, false},
    ChoiceRow{"STEReo:AUDio:PREemphasis", "PRE", &Settings::preemphasis, kPreemphases, &Settings::preemphasisOn, false},
    ChoiceRow{"STEReo:ARI:TYPE", "ARI-ID", &Settings::ariType, kAriTypes, &Settings::ariTypeOn, false},
    ChoiceRow{"STEReo:ARI:BK", "BK", &Settings::ariArea, kAriAreas, nullptr, true},
    ChoiceRow{"", "MS", &Settings::musicSpeech, kMusicSpeech, nullptr, true},
};

struct Suffix {
    std::string_view text;
    std::string_view base;
    double factor;
};

constexpr std::array kSuffixes = {
    Suffix{"HZ", "HZ", 1},    Suffix{"KHZ", "HZ", 1e3}, Suffix{"MHZ", "HZ", 1e6},
    Suffix{"GHZ", "HZ", 1e9}, Suffix{"DEG", "DEG", 1},  Suffix{"DBUV", "DBUV", 1},
};

const Suffix* suffixOf(std::string_view text) {
    const auto suffix =
        std::find_if(kSuffixes.begin(), kSuffixes.end(), [text](const Suffix& s) { return equalNoCase(s.text, text); });
    return suffix == kSuffixes.end() ? nullptr : &*suffix;
}

template <typename Fits>
std::optional<Parameter> findRow(Fits fits) {
    const auto inTable = [&fits](const auto& table) -> std::optional<Parameter> {
        const auto row = std::find_if(table.begin(), table.end(), fits);
        if (row == table.end()) return std::nullopt;
        return &*row;
    };
    if (auto row = inTable(kSwitches)) return row;
    if (auto row = inTable(kNumbers)) return row;
    if (auto row = inTable(kWholes)) return row;
    return inTable(kChoices);
}

ScpiError storeNumber(const NumberRow& row, double value, Settings& settings) {
    if (!(value >= row.lowest && value <= row.highest)) return ScpiError::OutOfRange;
    settings.*row.value = value;
    return ScpiError::None;
}

std::string bare(std::string_view value) {
    std::string text = upperCase(value);
    std::erase(text, ' ');
    return text;
}

// The number behind the words that SCPI has for the ends of a range and for the value after a reset.
std::optional<double> namedNumber(const NumberRow& row, std::string_view word) {
    if (wordMatches("MINimum", word)) return row.lowest;
    if (wordMatches("MAXimum", word)) return row.highest;
    if (wordMatches("DEFault", word)) return Settings().*row.value;
    return std::nullopt;
}

// The same for a choice between numbers, which stand in rising order; the count of it.
std::optional<int> namedNumber(const ChoiceRow& row, std::string_view word) {
    if (!std::all_of(row.words.begin(), row.words.end(), isDecimal)) return std::nullopt;
    if (wordMatches("MINimum", word)) return 1;
    if (wordMatches("MAXimum", word)) return static_cast<int>(row.words.size());
    if (wordMatches("DEFault", word)) return Settings().*row.value;
    return std::nullopt;
}

std::optional<bool> onOrOff(std::string_view value) {
    if (equalNoCase(value, "ON")) return true;
    if (equalNoCase(value, "OFF")) return false;
    return std::nullopt;
}

// One overload for each kind of row and each of the two ways to write a value.

// By SCPI a number stands for "on" unless it is 0 when rounded.
ScpiError setGenerator(const SwitchRow& row, std::string_view value, Settings& settings) {
    if (const auto word = onOrOff(value)) {
        settings.*row.value = *word;
        return ScpiError::None;
    }
    const auto number = readNumber(value);
    if (!number) return errorOfValue(value);
    if (!number->suffix.empty()) return errorOfSuffix(number->suffix);
    settings.*row.value = std::round(number->value) != 0;
    return ScpiError::None;
}

ScpiError setGenerator(const NumberRow& row, std::string_view value, Settings& settings) {
    if (const auto named = namedNumber(row, value)) return storeNumber(row, *named, settings);
    const auto number = readNumber(value);
    if (!number) return errorOfValue(value);
    const Suffix* unit = suffixOf(row.unit);
    const Suffix* suffix = number->suffix.empty() ? unit : suffixOf(number->suffix);
    if (suffix == nullptr || suffix->base != unit->base) return errorOfSuffix(number->suffix);
    return storeNumber(row, number->value * suffix->factor / unit->factor, settings);
}

ScpiError setGenerator(const WholeRow& row, std::string_view value, Settings& settings) {
    const auto number = readWhole(value);
    if (!number) return ScpiError::IllegalValue;
    if (*number < row.lowest || *number > row.highest) return ScpiError::OutOfRange;
    settings.*row.value = *number;
    return ScpiError::None;
}

ScpiError setGenerator(const ChoiceRow& row, std::string_view value, Settings& settings) {
    if (const auto named = namedNumber(row, value)) {
        settings.*row.value = *named;
        return ScpiError::None;
    }
    const auto word = std::find(row.words.begin(), row.words.end(), bare(value));
    if (word == row.words.end()) return errorOfValue(value);
    settings.*row.value = static_cast<int>(word - row.words.begin()) + 1;
    return ScpiError::None;
}

ScpiError setCoder(const SwitchRow& row, std::string_view value, Settings& settings) {
    if (const auto word = onOrOff(value)) {
        settings.*row.value = *word;
        return ScpiError::None;
    }
    const auto number = readWhole(value);
    if (!number) return ScpiError::IllegalValue;
    if (*number != 0 && *number != 1) return ScpiError::OutOfRange;
    settings.*row.value = *number == 1;
    return ScpiError::None;
}

ScpiError setCoder(const NumberRow& row, std::string_view value, Settings& settings) {
    const auto number = readNumber(value);
    if (!number || !number->suffix.empty()) return ScpiError::IllegalValue;
    return storeNumber(row, number->value * row.coderStep, settings);
}

ScpiError setCoder(const WholeRow& row, std::string_view value, Settings& settings) {
    return setGenerator(row, value, settings);
}

ScpiError setCoder(const ChoiceRow& row, std::string_view value, Settings& settings) {
    if (row.coderUsesWords) return setGenerator(row, value, settings);
    const auto number = readWhole(value);
    if (!number) return ScpiError::IllegalValue;
    const int lowest = row.onOff == nullptr ? 1 : 0;
    if (*number < lowest || *number > static_cast<int>(row.words.size())) return ScpiError::OutOfRange;
    if (row.onOff != nullptr) settings.*row.onOff = *number != 0;
    if (*number != 0) settings.*row.value = *number;
    return ScpiError::None;
}

std::string askGenerator(const SwitchRow& row, const Settings& settings) {
    return settings.*row.value ? "1" : "0";
}

std::string askGenerator(const NumberRow& row, const Settings& settings) {
    return shortestDecimal(settings.*row.value);
}

std::string askGenerator(const WholeRow& row, const Settings& settings) {
    const std::string text = std::to_string(settings.*row.value);
    return text.size() < row.digits ? std::string(row.digits - text.size(), '0') + text : text;
}

std::string wordOf(const ChoiceRow& row, int count) {
    return std::string(row.words[static_cast<std::size_t>(count - 1)]);
}

std::string askGenerator(const ChoiceRow& row, const Settings& settings) {
    return wordOf(row, settings.*row.value);
}

std::string askCoder(const SwitchRow& row, const Settings& settings) {
    return askGenerator(row, settings);
}

std::string askCoder(const NumberRow& row, const Settings& settings) {
    return shortestDecimal(settings.*row.value / row.coderStep);
}

std::string askCoder(const WholeRow& row, const Settings& settings) {
    return askGenerator(row, settings);
}

std::string askCoder(const ChoiceRow& row, const Settings& settings) {
    if (row.coderUsesWords) return askGenerator(row, settings);
    if (row.onOff != nullptr && !(settings.*row.onOff)) return "0";
    return std::to_string(settings.*row.value);
}

}  // namespace

std::optional<Parameter> parameterOfHeader(std::string_view header) {
    return findRow([header](const auto& row) { return !row.header.empty() && headerMatches(row.header, header); });
}

std::optional<Parameter> parameterOfCoder(std::string_view name) {
    return findRow([name](const auto& row) { return !row.coderName.empty() && row.coderName == name; });
}

ScpiError setFromGenerator(const Parameter& parameter, std::string_view value, InstrumentSettings& settings) {
    if (value.empty()) return ScpiError::MissingParameter;
    return std::visit([&](const auto* row) { return setGenerator(*row, value, settings); }, parameter);
}

ScpiError setFromCoder(const Parameter& parameter, std::string_view value, InstrumentSettings& settings) {
    if (trimmed(value).empty()) return ScpiError::MissingParameter;
    return std::visit([&](const auto* row) { return setCoder(*row, trimmed(value), settings); }, parameter);
}

Reply generatorAnswer(const Parameter& parameter, std::string_view argument, const InstrumentSettings& settings) {
    if (argument.empty()) {
        return {ScpiError::None, std::visit([&](const auto* row) { return askGenerator(*row, settings); }, parameter)};
    }
    if (const auto* const choice = std::get_if<const ChoiceRow*>(&parameter)) {
        if (const auto named = namedNumber(**choice, argument)) return {ScpiError::None, wordOf(**choice, *named)};
    }
    const auto* const number = std::get_if<const NumberRow*>(&parameter);
    if (number == nullptr) return {ScpiError::ParameterNotAllowed, std::nullopt};
    const auto named = namedNumber(**number, argument);
    if (!named) return {errorOfValue(argument), std::nullopt};
    return {ScpiError::None, shortestDecimal(*named)};
}

std::string coderAnswer(const Parameter& parameter, const InstrumentSettings& settings) {
    return std::visit([&](const auto* row) { return askCoder(*row, settings); }, parameter);
}

}  // namespace kdx::sim
