#pragma once

#include "station/readout.h"

namespace kdx {

class Captions;
class DataFolder;
class Profile;

/// What an instrument has against what a data set would make of it.
struct Comparison {
    Differences differing;  ///< wanted is what the data set would make of it
    Readout wanted;         ///< everything, as the data set would make it
};

/// Sends the data set to a virtual instrument that has the values of the present one, and asks it the same questions:
/// what the data set leaves alone differs in nothing.
[[nodiscard]] Comparison compared(DataFolder& data, const Captions& captions, const Profile& source,
                                  const Readout& present);

/// What of a read-out does not come back when a data set is sent.
struct NotKept {
    Readout unsent;       ///< a data set does not send these
    Differences changed;  ///< present is what was read, wanted what comes of it
};
/// Sends the data set to a virtual instrument as after switching on and asks it the same questions.
[[nodiscard]] NotKept notKept(DataFolder& data, const Captions& captions, const Profile& source,
                              const Readout& readout);

}  // namespace kdx
