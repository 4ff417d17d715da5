#pragma once

#include <string_view>
#include <vector>

#include "scenario/problems.h"
#include "scenario/scenario.h"
#include "settings/corrections.h"

namespace kdx::scenario {

/// What a file was read as. With problems the scenario is not whole and must not be run.
struct Reading {
    Scenario scenario;
    std::vector<Problem> problems;  ///< in the order of their places
};

/// Reads a scenario. @param utf8 the file's bytes; @param force values need not be legal; @param corrections of the
/// data folder that it is read for.
[[nodiscard]] Reading readScenario(std::string_view utf8, bool force = false, const Corrections& corrections = {});

}  // namespace kdx::scenario
