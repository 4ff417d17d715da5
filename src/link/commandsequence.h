#pragma once

#include "link/instrument.h"

namespace kdx {

/// While one of these lives, the commands sent and the values asked belong together: a whole data set, or the questions
/// of one button. When the instrument has gone away in the middle, the user can stop the rest at the first box.
class CommandSequence {
public:
    explicit CommandSequence(Instrument& instrument);
    ~CommandSequence();
    CommandSequence(const CommandSequence&) = delete;
    CommandSequence& operator=(const CommandSequence&) = delete;

private:
    Instrument& m_instrument;
};

}  // namespace kdx
