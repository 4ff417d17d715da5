#pragma once

#include <cstddef>
#include <string>

namespace kdx::test {

/// A tuned frequency with the given count of AFs: "98.5,90.0,90.1,...".
inline std::string listOf(std::size_t count) {
    std::string list = "98.5";
    for (std::size_t i = 0; i < count; ++i) list += ",90." + std::to_string(i % 10);
    return list;
}

}  // namespace kdx::test
