#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "scenario/report.h"
#include "scenario/scenario.h"
#include "station/readout.h"

namespace kdx::scenario {

/// How a run went.
struct Outcome {
    bool complete = false;                  ///< it came to its end: nobody stopped it, nothing failed that ends it
    bool reportLost = false;                ///< a row could not be written, which ends a run
    std::size_t unmet = 0;                  ///< expectations that were not met
    bool restored = true;                   ///< the instrument could be asked and told what stood before
    std::vector<std::string> changed = {};  ///< keys of what does not stand as before all the same, or may not
    std::vector<std::string> untold = {};   ///< keys that were sent and whose values nobody knew before
};

/// Who is with a run: the person before it, and whoever may end it. Asked again and again while it waits.
class Attendant {
public:
    virtual ~Attendant() = default;
    /// False when the run is to end after the running command: it was stopped, or a command failed.
    [[nodiscard]] virtual bool goesOn() = 0;
    enum class Return { NotYet, Pressed, NoLonger };  ///< NoLonger: the input is at its end
    /// What was typed until now is no answer to what is asked next.
    virtual void forgetsTyped() = 0;
    /// Whether Return was pressed since it was last asked.
    [[nodiscard]] virtual Return pressed() = 0;
    /// From here on everything is sent, also when the run was stopped: what stood before is to come back.
    virtual void finishes() = 0;
};

/// Hears of what a run does.
class Watcher {
public:
    virtual ~Watcher() = default;
    virtual void begins(const std::string& step, const Action& action) = 0;
    /// A command went out, an expectation was met or not, a person answered: what the report gets.
    virtual void happened(const Row& row) = 0;
    virtual void waits(std::chrono::nanoseconds length) = 0;
    /// The report cannot be written any more; told once.
    virtual void reportLost() = 0;
    virtual void ended(const Outcome& outcome) = 0;
};

/// Keeps what the instrument is set to over a run.
class Restorer {
public:
    virtual ~Restorer() = default;
    /// Before anything is sent. False when the instrument does not tell: nothing is sent then.
    [[nodiscard]] virtual bool remember() = 0;
    /// What brings it back; nothing when the instrument does not tell what it has now.
    [[nodiscard]] virtual std::optional<SettingCommands> commands() = 0;
    /// Keys of what the instrument did not tell then.
    [[nodiscard]] virtual std::vector<std::string> untold() const = 0;
    /// Keys of what does not stand as before, after the commands; nothing when the instrument does not tell.
    [[nodiscard]] virtual std::optional<std::vector<std::string>> changed() = 0;
};

}  // namespace kdx::scenario
