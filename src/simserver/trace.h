#pragma once

#include <string>
#include <string_view>

namespace kdx::simserver {

/// Says in words what a program message asks of the coder, where its text does not say so by itself: the fields of a
/// traffic message (8A) and of its announcement (3A), radiotext, AF lists, other networks, set-ups. "" when there is
/// nothing to add; several commands are joined by "; ".
[[nodiscard]] std::string describe(std::string_view message);

}  // namespace kdx::simserver
