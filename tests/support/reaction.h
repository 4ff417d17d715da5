#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace kdx::test {

/// What the scripted device does about one call.
struct Reaction {
    enum class Kind {
        Answer,
        AnswerInPieces,     ///< the reply's bytes one by one
        AnswerInFragments,  ///< the reply as a record of many fragments
        AnswerTwice,        ///< first with the number of an earlier call
        Silence,
        StopReading,  ///< silence, and whatever follows stays in the network
        Close,        ///< hangs up
        Raw,          ///< sends `raw` and nothing else
        RawAndClose,  ///< sends `raw` and hangs up
        RawForEver    ///< sends `raw`, then `again` after each `pause`, until the client hangs up
    };
    Kind kind = Kind::Answer;
    long error = 0;                            ///< device error in the reply
    std::optional<long> reason = {};           ///< of a read, instead of the true one
    std::uint32_t acceptState = 0;             ///< of the remote procedure call
    std::optional<std::string> raw = {};       ///< for Raw; for a read: these bytes, whatever was asked for
    std::optional<std::uint32_t> number = {};  ///< port, or bytes taken over, instead of the true one
    std::string again = {};                    ///< for RawForEver
    std::chrono::milliseconds pause = {};      ///< before the answer, too
};

}  // namespace kdx::test
