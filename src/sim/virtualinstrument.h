#pragma once

#include <string>
#include <string_view>

namespace kdx {

/// The virtual generator with its stereo/RDS coder: reads program messages as the instrument does, keeps its state,
/// answers its queries. Used inside the program and, over VXI-11, by the kdx-sim program.
class VirtualInstrument {
public:
    VirtualInstrument();
    /// @param identification the answer to "*IDN?", without its line end.
    explicit VirtualInstrument(std::string identification);

    /// Carries out one program message (several commands may be joined by ";"), its line end left off or not.
    /// @returns the answer with its line feed, or "" when the message asked nothing. Errors go to the error queue.
    std::string execute(std::string_view message);
};

}  // namespace kdx
