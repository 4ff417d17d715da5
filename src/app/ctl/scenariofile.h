#pragma once

#include <optional>
#include <string>

#include "scenario/scenario.h"

namespace kdx::ctl {

class Laboratory;

/// Reads the scenario, and its data set into the session; every mistake is told with file, line and column. Nothing
/// when there is one.
[[nodiscard]] std::optional<scenario::Scenario> readScenarioFile(Laboratory& laboratory, const std::string& file);

}  // namespace kdx::ctl
