#include "sim/statuscommands.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <string>

#include "sim/scpi.h"
#include "sim/status.h"

namespace kdx::sim {

namespace {

/// The numbers that a register takes, beginning with 0, and those that SCPI has words for.
struct Range {
    int highest = 0;  ///< of what is taken
    int most = 0;     ///< that can be kept: some bits are not used
    int preset = 0;
};

/// A header and what it does as a query, as a command without parameter, and as one with a number; null: it is none.
struct Row {
    std::string_view header;
    std::string (*ask)(Status& status);
    void (*act)(Status& status) = nullptr;
    void (*set)(Status& status, int bits) = nullptr;
    Range range = {};
};

constexpr int kWordBits = 32767;  // the highest bit is not used
constexpr Range kEventBits{255, 255};
constexpr Range kServiceBits{255, 191};  // the summary bit cannot be its own cause
constexpr Range kWord{65535, kWordBits};
constexpr Range kPositiveWord{65535, kWordBits, kWordBits};

using Group = Status::Group;

template <Group Status::*group, int Group::*bits>
std::string askWord(Status& status) {
    return std::to_string(status.*group.*bits);
}
template <Group Status::*group, int Group::*bits>
void setWord(Status& status, int value) {
    status.*group.*bits = value & kWordBits;
}

std::string zero(Status&) {
    return "0";
}
std::string nextError(Status& status) {
    return status.popError();
}

constexpr std::array kRows = {
    Row{"*CLS", nullptr, [](Status& s) { s.clear(); }},
    Row{"*ESE", [](Status& s) { return std::to_string(s.eventEnable); }, nullptr,
        [](Status& s, int bits) { s.eventEnable = bits; }, kEventBits},
    Row{"*ESR", [](Status& s) { return std::to_string(s.takeEvents()); }},
    Row{"*OPC", [](Status&) { return std::string("1"); }, [](Status& s) { s.operationComplete(); }},
    Row{"*SRE", [](Status& s) { return std::to_string(s.serviceEnable()); }, nullptr,
        [](Status& s, int bits) { s.setServiceEnable(bits); }, kServiceBits},
    Row{"*STB", [](Status& s) { return std::to_string(s.byte(s.answerBegun)); }},
    Row{"*TST", zero},                     // nothing here can be broken
    Row{"*WAI", nullptr, [](Status&) {}},  // nothing is ever still going on
    Row{"SYSTem:ERRor", nextError},
    Row{"SYSTem:ERRor:NEXT", nextError},
    Row{"SYSTem:VERSion", [](Status&) { return std::string("1999.0"); }},
    Row{"STATus:PRESet", nullptr, [](Status& s) { s.operation = s.questionable = Group(); }},
    Row{"STATus:OPERation", zero},
    Row{"STATus:OPERation:EVENt", zero},
    Row{"STATus:OPERation:CONDition", zero},
    Row{"STATus:OPERation:ENABle", askWord<&Status::operation, &Group::enable>, nullptr,
        setWord<&Status::operation, &Group::enable>, kWord},
    Row{"STATus:OPERation:PTRansition", askWord<&Status::operation, &Group::positiveTransition>, nullptr,
        setWord<&Status::operation, &Group::positiveTransition>, kPositiveWord},
    Row{"STATus:OPERation:NTRansition", askWord<&Status::operation, &Group::negativeTransition>, nullptr,
        setWord<&Status::operation, &Group::negativeTransition>, kWord},
    Row{"STATus:QUEStionable", zero},
    Row{"STATus:QUEStionable:EVENt", zero},
    Row{"STATus:QUEStionable:CONDition", zero},
    Row{"STATus:QUEStionable:ENABle", askWord<&Status::questionable, &Group::enable>, nullptr,
        setWord<&Status::questionable, &Group::enable>, kWord},
    Row{"STATus:QUEStionable:PTRansition", askWord<&Status::questionable, &Group::positiveTransition>, nullptr,
        setWord<&Status::questionable, &Group::positiveTransition>, kPositiveWord},
    Row{"STATus:QUEStionable:NTRansition", askWord<&Status::questionable, &Group::negativeTransition>, nullptr,
        setWord<&Status::questionable, &Group::negativeTransition>, kWord},
};

std::optional<int> namedBits(const Range& range, std::string_view word) {
    if (wordMatches("MINimum", word)) return 0;
    if (wordMatches("MAXimum", word)) return range.most;
    if (wordMatches("DEFault", word)) return range.preset;
    return std::nullopt;
}

ScpiError setBits(const Row& row, std::string_view parameter, Status& status) {
    if (const auto named = namedBits(row.range, parameter)) {
        row.set(status, *named);
        return ScpiError::None;
    }
    const auto number = readNumber(parameter);
    if (!number) return errorOfValue(parameter);
    if (!number->suffix.empty()) return errorOfSuffix(number->suffix);
    const double bits = std::round(number->value);
    if (!(bits >= 0 && bits <= row.range.highest)) return ScpiError::OutOfRange;
    row.set(status, static_cast<int>(bits));
    return ScpiError::None;
}

}  // namespace

std::optional<Reply> statusCommand(std::string_view header, const CommandUnit& unit, Status& status) {
    const auto row =
        std::find_if(kRows.begin(), kRows.end(), [header](const Row& r) { return headerMatches(r.header, header); });
    if (row == kRows.end()) return std::nullopt;
    const bool known = unit.query ? row->ask != nullptr : row->act != nullptr || row->set != nullptr;
    if (!known) return std::nullopt;
    if (const ScpiError error = checkOneParameter(unit); error != ScpiError::None) return Reply{error, std::nullopt};
    if (!unit.query && row->set != nullptr) {
        if (unit.parameter.empty()) return Reply{ScpiError::MissingParameter, std::nullopt};
        return Reply{setBits(*row, unit.parameter, status), std::nullopt};
    }
    if (!unit.parameter.empty()) {
        const auto named = row->set == nullptr ? std::nullopt : namedBits(row->range, unit.parameter);
        if (named) return Reply{ScpiError::None, std::to_string(*named)};
        return Reply{ScpiError::ParameterNotAllowed, std::nullopt};
    }
    if (unit.query) return Reply{ScpiError::None, row->ask(status)};
    row->act(status);
    return Reply{};
}

}  // namespace kdx::sim
