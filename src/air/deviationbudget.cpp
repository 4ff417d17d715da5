#include "air/deviationbudget.h"

#include "base/numbers.h"
#include "sim/setup.h"

namespace kdx::air {

namespace {

constexpr double kLowestRds = 1000;    // IEC 62106, 4.3
constexpr double kLowestPilot = 6000;  // 8 to 10 % of the highest deviation (ITU-R BS.450)
constexpr double kHighestPilot = 7500;

std::string kilohertz(double hertz) {
    return fixedDecimal(hertz / 1000, 2) + " kHz";
}

std::vector<std::string> warningsOf(const sim::Setup& setup, const Deviations& parts) {
    if (!setup.stereoOn) return {"the stereo coder is off: no multiplex goes out"};
    std::vector<std::string> warnings;
    if (parts.audio <= 0) {
        warnings.push_back("pilot, RDS and ARI take " + kilohertz(parts.subcarriers()) + " of " +
                           kilohertz(parts.total) + ": nothing is left for the audio");
    }
    if (parts.peak() > kHighestDeviation)
        warnings.push_back("the multiplex peaks at " + kilohertz(parts.peak()) + ": 75 kHz is the most");
    if (setup.pilotOn && (parts.pilot < kLowestPilot || parts.pilot > kHighestPilot))
        warnings.push_back("the pilot has " + kilohertz(parts.pilot) + ": radios await 6.00 to 7.50 kHz");
    if (setup.rdsOn && parts.rds < kLowestRds)
        warnings.push_back("RDS has " + kilohertz(parts.rds) + ": radios await 1.00 kHz at least");
    return warnings;
}

}  // namespace

DeviationBudget deviationBudgetOf(const sim::Setup& setup) {
    const Deviations parts = deviationsOf(setup);
    DeviationBudget budget{parts, {}, warningsOf(setup, parts)};
    const auto add = [&](const char* name, double hertz) {
        budget.rows.push_back({name, hertz, parts.total > 0 ? hertz / parts.total : 0, hertz / kHighestDeviation});
    };
    add("audio", parts.audio);
    add("pilot", parts.pilot);
    add("RDS", parts.rds);
    add("ARI", parts.ari);
    add("all", parts.peak());
    return budget;
}

}  // namespace kdx::air
