#pragma once

#include <string>

#include "station/readout.h"

namespace kdx::ctl {

class Output;

/// "EON_PS of D3C2"; only the key for what is the instrument's own.
[[nodiscard]] std::string nameOf(const std::string& key, const std::string& network);

/// A table of the differences, and a list of that name in the document.
void tellDifferences(Output& output, const char* name, const Differences& differing);

/// What the instrument gave no answer to.
void tellUnanswered(Output& output, const Readout& readout);

}  // namespace kdx::ctl
