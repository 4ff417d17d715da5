#include "app/ctl/scenariofile.h"

#include "app/ctl/laboratory.h"
#include "app/ctl/readablefile.h"
#include "app/ctl/whichdataset.h"
#include "base/split.h"
#include "scenario/reader.h"

namespace kdx::ctl {

namespace {

bool loadDataSet(Laboratory& laboratory, int number) {
    const auto source = WhichDataSet{number, {}}.profile(laboratory);
    if (!source || !laboratory.mayBeSent(*source)) return false;
    if (laboratory.hasSession()) laboratory.session().load(*source);
    return true;
}

}  // namespace

std::optional<scenario::Scenario> readScenarioFile(Laboratory& laboratory, const std::string& file) {
    const auto bytes = bytesOf(laboratory.output(), file);
    if (!bytes) return std::nullopt;
    scenario::Reading reading = scenario::readScenario(*bytes, laboratory.call().force, laboratory.state().corrections);
    for (const scenario::Problem& problem : reading.problems) {
        laboratory.output().problem(
            joined({file, std::to_string(problem.line), std::to_string(problem.column), " " + problem.sentence}, ":"));
    }
    if (!reading.problems.empty()) return std::nullopt;
    if (reading.scenario.dataSet && !loadDataSet(laboratory, *reading.scenario.dataSet)) return std::nullopt;
    return std::move(reading.scenario);
}

}  // namespace kdx::ctl
