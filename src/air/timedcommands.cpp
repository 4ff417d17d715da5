#include "air/timedcommands.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "base/codepage.h"
#include "base/split.h"
#include "sim/scpi.h"

namespace kdx::air {

namespace {

constexpr std::string_view kUtf8Mark = "\uFEFF";
constexpr double kLatestSeconds = 1e9;

std::optional<TimedCommand> commandOf(std::string_view line) {
    if (!line.starts_with('@')) return TimedCommand{Ticks{0}, std::string(line)};
    line = sim::trimmed(line.substr(1));
    const std::size_t blank = line.find_first_of(" \t");
    if (blank == std::string_view::npos) return std::nullopt;
    const auto seconds = sim::readNumber(line.substr(0, blank));
    if (!seconds || !seconds->suffix.empty() || !(seconds->value >= 0 && seconds->value <= kLatestSeconds))
        return std::nullopt;
    return TimedCommand{Ticks{std::llround(seconds->value * Ticks::period::den)},
                        std::string(sim::trimmed(line.substr(blank)))};
}

}  // namespace

TimedCommands readTimedCommands(std::string_view bytes) {
    const bool marked = bytes.starts_with(kUtf8Mark);
    const std::string text = marked ? fromUtf8(bytes.substr(kUtf8Mark.size())) : std::string(bytes);
    TimedCommands read;
    std::size_t number = 0;
    for (const std::string_view line : split(text, "\n")) {
        ++number;
        const std::string_view content = sim::trimmed(line);
        if (content.empty()) continue;
        if (auto command = commandOf(content)) {
            read.commands.push_back(std::move(*command));
        } else {
            read.unreadableLines.push_back(number);
        }
    }
    std::stable_sort(read.commands.begin(), read.commands.end(),
                     [](const TimedCommand& left, const TimedCommand& right) { return left.after < right.after; });
    return read;
}

}  // namespace kdx::air
