#include "sim/statuscommands.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <string>

#include "sim/scpi.h"
#include "sim/status.h"

namespace kdx::sim {

namespace {

/// A header and what it does as a query, as a command without parameter, and as one with a number; null: it is none.
struct Row {
    std::string_view header;
    std::string (*ask)(Status& status);
    void (*act)(Status& status) = nullptr;
    void (*set)(Status& status, int bits) = nullptr;
    int highest = 0;
};

constexpr int kByte = 255;
constexpr int kWord = 65535;
constexpr int kWordBits = 32767;  // the highest bit is not used

std::string zero(Status&) {
    return "0";
}
std::string nextError(Status& status) {
    return status.popError();
}

constexpr std::array kRows = {
    Row{"*CLS", nullptr, [](Status& s) { s.clear(); }},
    Row{"*ESE", [](Status& s) { return std::to_string(s.eventEnable); }, nullptr,
        [](Status& s, int bits) { s.eventEnable = bits; }, kByte},
    Row{"*ESR", [](Status& s) { return std::to_string(s.takeEvents()); }},
    Row{"*OPC", [](Status&) { return std::string("1"); }, [](Status& s) { s.operationComplete(); }},
    Row{"*SRE", [](Status& s) { return std::to_string(s.serviceEnable()); }, nullptr,
        [](Status& s, int bits) { s.setServiceEnable(bits); }, kByte},
    Row{"*STB", [](Status& s) { return std::to_string(s.byte(s.answerBegun)); }},
    Row{"*TST", zero},                     // nothing here can be broken
    Row{"*WAI", nullptr, [](Status&) {}},  // nothing is ever still going on
    Row{"SYSTem:ERRor", nextError},
    Row{"SYSTem:ERRor:NEXT", nextError},
    Row{"SYSTem:VERSion", [](Status&) { return std::string("1999.0"); }},
    Row{"STATus:PRESet", nullptr, [](Status& s) { s.operationEnable = s.questionableEnable = 0; }},
    Row{"STATus:OPERation", zero},
    Row{"STATus:OPERation:EVENt", zero},
    Row{"STATus:OPERation:CONDition", zero},
    Row{"STATus:OPERation:ENABle", [](Status& s) { return std::to_string(s.operationEnable); }, nullptr,
        [](Status& s, int bits) { s.operationEnable = bits & kWordBits; }, kWord},
    Row{"STATus:QUEStionable", zero},
    Row{"STATus:QUEStionable:EVENt", zero},
    Row{"STATus:QUEStionable:CONDition", zero},
    Row{"STATus:QUEStionable:ENABle", [](Status& s) { return std::to_string(s.questionableEnable); }, nullptr,
        [](Status& s, int bits) { s.questionableEnable = bits & kWordBits; }, kWord},
};

ScpiError setBits(const Row& row, std::string_view parameter, Status& status) {
    const auto number = readNumber(parameter);
    if (!number) return errorOfValue(parameter);
    if (!number->suffix.empty()) return errorOfSuffix(number->suffix);
    const double bits = std::round(number->value);
    if (!(bits >= 0 && bits <= row.highest)) return ScpiError::OutOfRange;
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
    if (!unit.parameter.empty()) return Reply{ScpiError::ParameterNotAllowed, std::nullopt};
    if (unit.query) return Reply{ScpiError::None, row->ask(status)};
    row->act(status);
    return Reply{};
}

}  // namespace kdx::sim
