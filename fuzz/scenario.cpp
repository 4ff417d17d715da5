// Scenario files: what is read without a mistake can be described, has its steps found by their numbers, and every
// value of it is legal for its key; mistakes stand within the file.
#include "harness.h"

#include "coder/keyfacts.h"
#include "scenario/reader.h"
#include "scenario/stepnumber.h"

#include <algorithm>

namespace {

using kdx::fuzz::demand;
using kdx::scenario::Action;

void look(const std::vector<Action>& actions, const kdx::scenario::Scenario& scenario, const std::string& before) {
    std::size_t step = 0;
    for (const Action& action : actions) {
        const std::string number = before + std::to_string(++step);
        const auto read = kdx::scenario::readStepNumber(number);
        demand(read && read->text() == number && isStepOf(scenario, *read), "every step has a number");
        demand(!describe(action).empty(), "every step can be described");
        for (const auto& [key, value] : action.settings) demand(!kdx::wrongValue(key, value), "what is sent is legal");
        for (const std::string& point : action.points)
            demand(!kdx::wrongValue(action.key, point), "what is swept is legal");
        demand(action.points.size() <= kdx::scenario::kMostPoints, "the points are bounded");
        demand(action.time.count() >= 0 && action.time <= kdx::scenario::kLongestTime, "times are bounded");
        const bool loops = action.kind == Action::Kind::Sweep || action.kind == Action::Kind::Repeat;
        demand(!loops || passesOf(action) > 0, "a loop goes through once at least");
        demand(loops || action.actions.empty(), "only loops have steps");
        look(action.actions, scenario, number + ".");
    }
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    const auto reading = kdx::scenario::readScenario(text);
    const auto lines = static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n')) + 1;
    for (const kdx::scenario::Problem& problem : reading.problems) {
        demand(problem.line >= 1 && problem.line <= lines, "a mistake stands in a line of the file");
        demand(problem.column >= 1 && problem.column <= text.size() + 1, "and in a column of it");
        demand(!problem.sentence.empty(), "and is told");
    }
    if (!reading.problems.empty()) return 0;
    demand(!reading.scenario.actions.empty(), "a scenario has steps");
    look(reading.scenario.actions, reading.scenario, {});
    return 0;
}
