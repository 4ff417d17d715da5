#pragma once

#include "sim/errorqueue.h"
#include "sim/scpi.h"

#include <string>

namespace kdx::simserver {

/// Says in words what became of a command: that it was refused and why, or what it asks of the coder where its text
/// does not say so by itself: the fields of a traffic message (8A) and of its announcement (3A), radiotext, AF lists,
/// other networks, set-ups. "" when there is nothing to add.
/// @param unit its header in full.
[[nodiscard]] std::string describe(const sim::CommandUnit& unit, sim::ScpiError error);

}  // namespace kdx::simserver
