#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "scenario/decimal.h"
#include "scenario/problems.h"
#include "scenario/yamltree.h"
#include "settings/corrections.h"

namespace kdx::scenario {

inline constexpr std::string_view kPointName = "a point";  ///< what a number of a sweep's list is called

/// Reads single values of a document; what is wrong with them is added to the problems.
class Values {
public:
    /// @param force values for the instrument need not be legal.
    Values(Problems& problems, bool force, const Corrections& corrections)
        : m_problems(problems), m_force(force), m_corrections(corrections) {}

    void wrong(const YamlNode& node, Mistake mistake, std::vector<std::string> words = {}) {
        m_problems.add(node.at, mistake, std::move(words));
    }

    /// A text as it is written, one line. @param name what it is the value of.
    [[nodiscard]] std::optional<std::string> text(const YamlNode& node, std::string_view name);
    /// The same in the instrument's characters.
    [[nodiscard]] std::optional<std::string> instrumentText(const YamlNode& node, std::string_view name);
    /// A value that the key's command can carry, in the instrument's characters, as it is to go out.
    [[nodiscard]] std::optional<std::string> keyValue(const YamlNode& node, const std::string& key);
    /// "2 s", "500 ms", "1.5 min", "1 h".
    [[nodiscard]] std::optional<std::chrono::milliseconds> time(const YamlNode& node, std::string_view name);
    [[nodiscard]] std::optional<unsigned> whole(const YamlNode& node, std::string_view name, unsigned lowest,
                                                unsigned highest);
    [[nodiscard]] std::optional<bool> choice(const YamlNode& node, std::string_view name);
    [[nodiscard]] std::optional<Decimal> number(const YamlNode& node, std::string_view name);
    /// Whether the value is legal for the key, which need be no text of the file; told at the node.
    bool isLegal(const YamlNode& node, const std::string& key, const std::string& value);

private:
    Problems& m_problems;
    bool m_force;
    Corrections m_corrections;
};

}  // namespace kdx::scenario
