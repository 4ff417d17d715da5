#pragma once

#include <string>
#include <string_view>

namespace kdx {

/// What the coder is asked for one of its values with.
[[nodiscard]] inline std::string coderQuestion(std::string_view key) {
    return std::string(":STEREO:DIRECT? \"").append(key).append("\"");
}

}  // namespace kdx
