#include "scenario/stepnumber.h"

#include <algorithm>

#include "base/numbers.h"

namespace kdx::scenario {

namespace {

constexpr std::size_t kMostCountDigits = 7;

/// Takes a count off the text's beginning; 0 when there is none.
std::size_t takeCount(std::string_view& text) {
    const std::size_t digits = std::min(text.find_first_not_of("0123456789"), text.size());
    if (digits > kMostCountDigits) return 0;
    std::size_t count = 0;
    for (const char digit : text.substr(0, digits)) count = count * 10 + static_cast<std::size_t>(digit - '0');
    text.remove_prefix(digits);
    return count;
}

}  // namespace

std::string StepNumber::text() const {
    std::string text;
    for (const Part& part : parts) {
        if (!text.empty()) text += '.';
        text += std::to_string(part.step);
        if (part.pass > 0) text += '#' + std::to_string(part.pass);
    }
    return text;
}

std::optional<StepNumber> readStepNumber(std::string_view text) {
    StepNumber number;
    for (;;) {
        StepNumber::Part part{takeCount(text)};
        if (part.step == 0) return std::nullopt;
        if (text.starts_with('#')) {
            text.remove_prefix(1);
            part.pass = takeCount(text);
            if (part.pass == 0) return std::nullopt;
        }
        number.parts.push_back(part);
        if (text.empty()) return number;
        if (!text.starts_with('.')) return std::nullopt;
        text.remove_prefix(1);
    }
}

bool isStepOf(const Scenario& scenario, const StepNumber& number) {
    const std::vector<Action>* actions = &scenario.actions;
    for (const StepNumber::Part& part : number.parts) {
        if (part.step > actions->size()) return false;
        const Action& action = (*actions)[part.step - 1];
        if (part.pass > passesOf(action)) return false;
        actions = &action.actions;
    }
    return !number.parts.empty();
}

bool isBefore(const StepNumber& first, const StepNumber& second) {
    for (std::size_t i = 0; i < std::min(first.parts.size(), second.parts.size()); ++i) {
        const auto [step, pass] = first.parts[i];
        const auto [otherStep, otherPass] = second.parts[i];
        if (step != otherStep) return step < otherStep;
        const std::size_t one = std::max<std::size_t>(pass, 1);
        const std::size_t other = std::max<std::size_t>(otherPass, 1);
        // A step whose last part names no pass is done with all of its passes only.
        const bool whole = i + 1 == first.parts.size() && pass == 0;
        if (one != other) return one < other && !whole;
    }
    return false;
}

bool isReached(const StepNumber& ended, const StepNumber& wanted) {
    if (ended.parts.size() != wanted.parts.size()) return false;
    for (std::size_t i = 0; i < ended.parts.size(); ++i) {
        const StepNumber::Part& part = wanted.parts[i];
        const bool last = i + 1 == ended.parts.size();
        if (part.step != ended.parts[i].step) return false;
        if (part.pass != ended.parts[i].pass && (last || part.pass != 0)) return false;
    }
    return true;
}

}  // namespace kdx::scenario
