#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kdx {

/// The pattern with the words in the places of %1 to %9; what they hold themselves stays as it is.
[[nodiscard]] inline std::string filled(std::string_view pattern, const std::vector<std::string>& words) {
    std::string text;
    for (std::size_t at = 0; at < pattern.size(); ++at) {
        const auto word = pattern[at] == '%' && at + 1 < pattern.size()
                              ? static_cast<std::size_t>(pattern[at + 1] - '1')
                              : words.size();
        if (word < words.size()) {
            text += words[word];
            ++at;
        } else {
            text += pattern[at];
        }
    }
    return text;
}

}  // namespace kdx
