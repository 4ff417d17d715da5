#pragma once

#include <functional>
#include <optional>
#include <string>

#include "app/options.h"

namespace CLI {
class App;
}

namespace kdx::ctl {

class Laboratory;

// How kdx-ctl ends.
inline constexpr int kDone = 0;
inline constexpr int kFailed = 1;        ///< a command failed, or the run was stopped
inline constexpr int kWrongCall = 2;     ///< the call cannot be understood, or a file cannot be read
inline constexpr int kDifferent = 3;     ///< done, and what was compared differs, or there are warnings
inline constexpr int kNoConnection = 4;  ///< the instrument cannot be reached

/// What holds for every subcommand.
struct Call {
    Options program;                 ///< of these the data folder, the VISA library and the virtual instrument
    std::optional<std::string> lan;  ///< host, or host and device with a comma between
    std::optional<int> gpib;
    bool json = false;
    bool quiet = false;
    bool verbose = false;
    bool force = false;      ///< sends also what is not legal
    bool continues = false;  ///< goes on after a failure
};

/// What was called: runs with the laboratory, gives the exit code.
using Task = std::function<int(Laboratory&)>;

/// A subcommand adds itself to the command line and sets the task when it was called.
using AddSubcommand = void (*)(CLI::App& app, Task& task);

void addAir(CLI::App& app, Task& task);
void addApply(CLI::App& app, Task& task);
void addBudget(CLI::App& app, Task& task);
void addCheck(CLI::App& app, Task& task);
void addDiff(CLI::App& app, Task& task);
void addFind(CLI::App& app, Task& task);
void addList(CLI::App& app, Task& task);
void addPlay(CLI::App& app, Task& task);
void addQuery(CLI::App& app, Task& task);
void addRead(CLI::App& app, Task& task);
void addReplay(CLI::App& app, Task& task);
void addSend(CLI::App& app, Task& task);
void addShell(CLI::App& app, Task& task);

}  // namespace kdx::ctl
