#include "station/comparison.h"

#include <algorithm>
#include <iterator>

#include "station/rehearsal.h"
#include "station/sentvalues.h"

namespace kdx {

Comparison compared(DataFolder& data, const Captions& captions, const Profile& source, const Readout& present) {
    Rehearsal rehearsal(data, captions);
    rehearsal.become(present);
    rehearsal.apply(source);
    Comparison result;
    result.wanted = rehearsal.readOut();
    result.differing = differences(result.wanted, present);
    // Values that the virtual instrument could not take over are not the data set's doing.
    const SentValues sent(source);
    std::erase_if(result.differing, [&](const Difference& d) { return !sent.hold(d.key, d.network); });
    return result;
}

NotKept notKept(DataFolder& data, const Captions& captions, const Profile& source, const Readout& readout) {
    Rehearsal rehearsal(data, captions);
    rehearsal.apply(source);
    const SentValues sent(source);
    NotKept result;
    std::copy_if(readout.begin(), readout.end(), std::back_inserter(result.unsent), [&](const Reading& reading) {
        return !reading.value.value_or("").empty() && !sent.hold(reading.key, reading.network);
    });
    result.changed = differences(rehearsal.readOut(), readout);
    std::erase_if(result.changed, [&](const Difference& d) { return !sent.hold(d.key, d.network); });
    return result;
}

}  // namespace kdx
