#pragma once

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "base/split.h"
#include "scenario/scenario.h"
#include "scenario/values.h"

namespace kdx::scenario {

/// The member of that name; null when there is none.
[[nodiscard]] const YamlNode* memberOf(const YamlNode& map, std::string_view name);

template <typename Words>
[[nodiscard]] bool isOneOf(const Words& words, std::string_view word) {
    return std::find(words.begin(), words.end(), word) != words.end();
}

/// The words with commas between.
template <typename Words>
[[nodiscard]] std::string listed(const Words& words) {
    return joined({words.begin(), words.end()}, ", ");
}

/// Reads lists of steps; what is wrong with them goes to the values' problems.
class StepReader {
public:
    explicit StepReader(Values& values) : m_values(values) {}

    [[nodiscard]] std::vector<Action> steps(const YamlNode& list);

private:
    [[nodiscard]] Action step(const YamlNode& node);
    void send(const YamlNode& map, Action& action);
    void expect(const YamlNode& map, Action& action);
    void expectation(const std::string& name, const YamlNode& at, const YamlNode& value, Action& action);
    void sweep(const YamlNode& node, const YamlNode& key, Action& action);
    void pointsOf(const YamlNode& node, Action& action);
    void range(const YamlNode& node, Action& action);
    /// Counts the points of one more sweep; false when there are too many, which is told.
    bool fits(const YamlNode& node, std::size_t points);
    void repeat(const YamlNode& node, const YamlNode& count, Action& action);
    void message(const YamlNode& code, Action& action);
    void loop(const YamlNode& node, Action& action);
    [[nodiscard]] bool isNames(const YamlNode& node, std::string_view word, std::string_view example);

    Values& m_values;
    std::size_t m_depth = 0;
    std::size_t m_points = 0;  ///< of all sweeps
};

}  // namespace kdx::scenario
