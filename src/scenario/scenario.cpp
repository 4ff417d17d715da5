#include "scenario/scenario.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "base/split.h"

namespace kdx::scenario {

namespace {

std::string timeWords(std::chrono::milliseconds time) {
    if (time.count() % 1000 != 0 && time < std::chrono::seconds(1)) return std::to_string(time.count()) + " ms";
    return shortestDecimal(static_cast<double>(time.count()) / 1000) + " s";
}

}  // namespace

std::size_t passesOf(const Action& action) {
    return action.kind == Action::Kind::Sweep ? action.points.size() : action.passes;
}

std::string listed(const Action& action) {
    std::vector<std::string> all;
    for (const auto& [key, value] : action.settings) all.push_back(key + "=" + toUtf8(value));
    for (const auto& [name, values] : action.expected) all.push_back(name + "=" + toUtf8(joined(values, ",")));
    return joined(all, " ");
}

std::string describe(const Action& action) {
    switch (action.kind) {
        case Action::Kind::Send:
            return "send " + listed(action);
        case Action::Kind::Wait:
            return "wait " + timeWords(action.time);
        case Action::Kind::Expect: {
            const std::string text = "expect " + listed(action);
            return action.time.count() == 0 ? text : text + " within " + timeWords(action.time);
        }
        case Action::Kind::Sweep:
            return "sweep " + action.key + " from " + action.points.front() + " to " + action.points.back() + ", " +
                   std::to_string(action.points.size()) + " points";
        case Action::Kind::Repeat:
            return "repeat " + std::to_string(action.passes) + " times";
        case Action::Kind::TrafficMessage:
            return "tmc " + action.text;
        case Action::Kind::Pause:
            return "pause: " + action.text;
        case Action::Kind::Note:
            return "note: " + action.text;
    }
    return {};
}

}  // namespace kdx::scenario
