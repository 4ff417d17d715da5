#pragma once

#include <optional>
#include <string_view>

#include "sim/errorqueue.h"

namespace kdx::sim {

struct CommandUnit;
class Status;

/// Carries out the commands and queries about the status: the common ones of IEEE 488.2 but for *IDN? and *RST, and
/// SYSTem and STATus of SCPI.
/// @param header the unit's header in full. Gives nothing when it is none of these.
std::optional<Reply> statusCommand(std::string_view header, const CommandUnit& unit, Status& status);

}  // namespace kdx::sim
