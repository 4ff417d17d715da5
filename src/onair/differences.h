#pragma once

#include <string>
#include <vector>

namespace kdx {

struct Station;
namespace air {
class Shadow;
}

/// Something that the radio shows otherwise than the entry field or the panel says.
struct AirDifference {
    enum class Row { Pi, Ps, Radiotext, Pty, Tp, Ta, MusicSpeech, DecoderInfo, StereoMode };
    enum class Why {
        Other,    ///< nothing of the following
        Refused,  ///< the coder did not take it
        Cut,      ///< it is longer than what can be sent
        Padded,   ///< blanks follow it
        NoPlace,  ///< RDS has no code for a character
    };
    Row row{};
    Why why{};
    std::string entry;  ///< what the field or panel has; of a character without a place that one (Windows-1252)
};

/// At most one a row, the one that matters most; none of what a radio that hears nothing does not show.
[[nodiscard]] std::vector<AirDifference> differences(const air::Shadow& shadow, const Station& station);

}  // namespace kdx
