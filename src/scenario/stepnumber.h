#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "scenario/scenario.h"

namespace kdx::scenario {

/// Where in a scenario a step stands: "4.2" is the second step within the fourth, "4#3.2" the same in the third pass
/// of that sweep or repetition. Steps and passes count from 1.
struct StepNumber {
    struct Part {
        std::size_t step = 1;
        std::size_t pass = 0;  ///< 0: none is named

        friend bool operator==(const Part&, const Part&) = default;
    };
    std::vector<Part> parts;

    [[nodiscard]] std::string text() const;
};

/// Nothing for what is no step number.
[[nodiscard]] std::optional<StepNumber> readStepNumber(std::string_view text);

/// Whether the scenario has the step, and the passes that are named.
[[nodiscard]] bool isStepOf(const Scenario& scenario, const StepNumber& number);

/// Whether the first one is done before the second one begins; a pass that is not named is the first.
[[nodiscard]] bool isBefore(const StepNumber& first, const StepNumber& second);

/// Whether the step that has come to its end is the one looked for, in any pass that is not named there.
[[nodiscard]] bool isReached(const StepNumber& ended, const StepNumber& wanted);

}  // namespace kdx::scenario
