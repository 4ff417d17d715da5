#pragma once

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

namespace kdx::scenario {

class Problems;

/// A piece of a YAML document with its place. Texts are kept as they are written: 1E10 is no number here.
struct YamlNode {
    enum class Kind { Nothing, Text, List, Map };
    Kind kind = Kind::Nothing;
    std::size_t at = 0;  ///< the byte it begins at; of a text in quotation marks, the one after the mark
    std::string text = {};
    std::vector<YamlNode> items = {};                         ///< of a list
    std::vector<std::pair<YamlNode, YamlNode>> members = {};  ///< of a map, in their order
};

/// Takes the YAML document apart that the problems' text is. Whatever YAML has that a scenario does not need is a
/// mistake: names and references, tags, several documents, names that are no text; and so are names that stand twice,
/// quotes that are never closed, bytes that are not UTF-8, control characters, tabs that indent, and what is nested too
/// deeply.
/// @returns the tree as far as it could be read; mistakes are added to the problems.
[[nodiscard]] YamlNode readYaml(Problems& problems);

}  // namespace kdx::scenario
