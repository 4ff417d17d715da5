#pragma once

#include <QString>

#include <string>

#include "settings/corrections.h"

namespace kdx {

class Captions;
struct ProgramState;

/// A warning of the transmission (UTF-8) in the current language; one that has no caption stays as it is.
[[nodiscard]] QString warningText(const Captions& captions, const std::string& warning);

/// Why a value is marked, and which correction would mend that: its name is left out while it is on.
[[nodiscard]] QString withRemedy(const QString& why, bool Corrections::*correction, const Captions& captions,
                                 const ProgramState& state);

}  // namespace kdx
