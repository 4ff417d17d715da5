#pragma once

#include <QString>

#include <string>
#include <string_view>

#include "settings/corrections.h"

namespace kdx {

class Captions;
struct ProgramState;

/// A warning of the transmission (UTF-8) in the current language, with the correction that would mend it; one that has
/// no caption stays as it is.
[[nodiscard]] QString warningText(const std::string& warning, const Captions& captions, const ProgramState& state);

/// That the coder refuses an entry, and the correction that would mend that. @param shown how the entry is shown.
[[nodiscard]] QString refusalText(std::string_view entry, const QString& shown, const Captions& captions,
                                  const ProgramState& state);

/// Why a value is marked, and which correction would mend that: its name is left out while it is on.
[[nodiscard]] QString withRemedy(const QString& why, bool Corrections::*correction, const Captions& captions,
                                 const ProgramState& state);

}  // namespace kdx
