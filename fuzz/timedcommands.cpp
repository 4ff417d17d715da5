// Command files: every line is a command, empty or told as unreadable; the commands come in the order of their times
// and the instrument answers on behind them.
#include "harness.h"

#include "air/broadcast.h"
#include "air/timedcommands.h"

#include <algorithm>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    using namespace kdx::air;
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const TimedCommands read = readTimedCommands(bytes);
    const auto lines = static_cast<std::size_t>(std::count(bytes.begin(), bytes.end(), '\n')) + 1;
    demand(read.commands.size() + read.unreadableLines.size() <= lines, "a line is one command at most");
    demand(std::is_sorted(read.unreadableLines.begin(), read.unreadableLines.end()), "lines are told in their order");
    for (const std::size_t line : read.unreadableLines) demand(line >= 1 && line <= lines, "a line is one of the file");

    constexpr Ticks kLatest{std::chrono::seconds{1'000'000'000}};
    Ticks last{0};
    Broadcast broadcast(AirTime{std::chrono::sys_days{std::chrono::year{2026} / 1 / 1}}, {});
    for (const auto& [after, command] : read.commands) {
        demand(after >= last && after <= kLatest, "commands come in the order of their times");
        demand(!command.empty() && command.find('\n') == std::string::npos, "a command is a line's");
        last = after;
        broadcast.execute(command, broadcast.time());
        (void)broadcast.next();
    }
    broadcast.execute("*RST", broadcast.time());
    broadcast.execute(":STEREO:RDS:STATE ON", broadcast.time());
    demand(broadcast.next().kind == OnAir::Kind::Group, "the instrument transmits on");
    return 0;
}
