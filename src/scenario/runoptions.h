#pragma once

#include <functional>
#include <optional>

#include "scenario/attendance.h"
#include "scenario/stepnumber.h"

namespace kdx {
class Clock;
struct ProgramState;
struct Session;
}  // namespace kdx

namespace kdx::scenario {

/// What a run works with; everything is lent.
struct Surroundings {
    Session& session;  ///< open; the scenario's data set loaded unless another sends it
    ProgramState& state;
    Clock& clock;
    Attendant& attendant;
    Watcher& watcher;
    Restorer* restorer = nullptr;
    const Report* report = nullptr;          ///< begun
    std::function<void()> sendDataSet = {};  ///< sends the scenario's data set; the session's opening unless said
};

/// Which part of a scenario is run, and how.
struct RunOptions {
    std::optional<StepNumber> from;   ///< begins with it; steps of the scenario
    std::optional<StepNumber> until;  ///< ends after it, the first time
    bool nobodyThere = false;         ///< pauses go on by themselves, nothing waits for Return
};

}  // namespace kdx::scenario
