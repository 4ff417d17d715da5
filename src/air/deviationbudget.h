#pragma once

#include <string>
#include <vector>

#include "air/deviations.h"

namespace kdx::air {

/// What a transmitter may deviate by at most (ITU-R BS.450), in hertz.
inline constexpr double kHighestDeviation = 75000;

/// What the deviation of the coder's settings is spent on.
struct DeviationBudget {
    struct Row {
        const char* name = "";
        double hertz = 0;
        double ofTotal = 0;    ///< of 1; 0 when there is no total
        double ofHighest = 0;  ///< of 1
    };
    Deviations parts;
    std::vector<Row> rows;  ///< audio, pilot, RDS, ARI and what they peak at together
    std::vector<std::string> warnings;
};

[[nodiscard]] DeviationBudget deviationBudgetOf(const sim::Setup& setup);

}  // namespace kdx::air
