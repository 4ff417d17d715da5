#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace kdx {

/// The pieces of the text between the separators, empty ones too; one at least.
[[nodiscard]] std::vector<std::string_view> split(std::string_view text, std::string_view separator);

/// The texts with the separator between them.
[[nodiscard]] std::string joined(const std::vector<std::string>& texts, std::string_view separator);

}  // namespace kdx
