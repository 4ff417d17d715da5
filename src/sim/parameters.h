#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <variant>

#include "sim/errorqueue.h"

namespace kdx::sim {

struct InstrumentSettings;
struct SwitchRow;
struct NumberRow;
struct WholeRow;
struct ChoiceRow;

/// A setting of one value: a row of one of the parameter tables. Generator and coder have a name for it each, or one
/// of them has, and each its own way to write the value.
using Parameter = std::variant<const SwitchRow*, const NumberRow*, const WholeRow*, const ChoiceRow*>;

/// The setting behind a generator header (see headerMatches), if any.
[[nodiscard]] std::optional<Parameter> parameterOfHeader(std::string_view header);
/// The setting behind a coder name in capitals, if any.
[[nodiscard]] std::optional<Parameter> parameterOfCoder(std::string_view name);

/// Sets the value as the generator's commands write it: ON and OFF, numbers with units or MIN, MAX, DEF, words. A value
/// that is refused changes nothing.
ScpiError setFromGenerator(const Parameter& parameter, std::string_view value, InstrumentSettings& settings);
/// Sets the value as the coder's commands write it: small numbers, deviations in tens of hertz. A value that is refused
/// changes nothing.
ScpiError setFromCoder(const Parameter& parameter, std::string_view value, InstrumentSettings& settings);

/// The value as the generator answers it; numbers are in the unit that a number without a unit is taken for.
/// @param argument of the query: for a number MIN, MAX or DEF ask for these; empty for the value itself.
[[nodiscard]] Reply generatorAnswer(const Parameter& parameter, std::string_view argument,
                                    const InstrumentSettings& settings);
/// The value as the coder answers it, without quotes.
[[nodiscard]] std::string coderAnswer(const Parameter& parameter, const InstrumentSettings& settings);

}  // namespace kdx::sim
