#pragma once

#include <filesystem>

namespace kdx::test {

/// The checkout that the tests were built from: where the shipped data and the tests' own are.
[[nodiscard]] std::filesystem::path sourceFolder();

}  // namespace kdx::test
