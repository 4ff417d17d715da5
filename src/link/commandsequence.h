#pragma once

#include "link/instrument.h"

namespace kdx {

/// While one of these lives, the commands sent and the values asked belong together: a whole data set, or the questions
/// of one button. When the instrument has gone away in the middle, the user can stop the rest at the first box.
class CommandSequence {
public:
    enum class Kind {
        Run,   ///< what the user started and may stop
        Tick,  ///< what a timer sends by itself
    };

    explicit CommandSequence(Instrument& instrument, Kind kind = Kind::Run);
    ~CommandSequence();
    CommandSequence(const CommandSequence&) = delete;
    CommandSequence& operator=(const CommandSequence&) = delete;

private:
    Instrument& m_instrument;
    Kind m_kind;
};

}  // namespace kdx
