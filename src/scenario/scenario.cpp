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

std::string describe(const Action& action) {
    switch (action.kind) {
        case Action::Kind::Send: {
            std::string text = "send";
            for (const auto& [key, value] : action.settings) text.append(" ").append(key).append("=" + toUtf8(value));
            return text;
        }
        case Action::Kind::Wait:
            return "wait " + timeWords(action.time);
        case Action::Kind::Expect: {
            std::string text = "expect";
            for (const auto& [name, values] : action.expected)
                text.append(" ").append(name).append("=" + toUtf8(joined(values, ",")));
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
