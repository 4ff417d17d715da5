#include "station/comparison.h"

#include <algorithm>
#include <iterator>
#include <set>
#include <string>

#include "coder/sendparam.h"
#include "station/rehearsal.h"
#include "station/station.h"

namespace kdx {

namespace {

/// Which values sending a data set sets, whatever it sets them to.
class SentValues {
public:
    explicit SentValues(const Profile& source) {
        Station station;
        station.load(source);
        for (const Step& step : openingSteps(station, readCorrections(source))) {
            std::string value = step.value;
            if (!composeCommand(step.key, value, {}).value_or("").empty()) m_keys.insert(step.key);
        }
    }

    [[nodiscard]] bool hold(const std::string& key, const std::string& network) const {
        // All other networks are removed, and what is added begins anew. The first AF list makes all others go.
        if (!network.empty()) return true;
        if (key.starts_with("AF")) return m_keys.count("AF1") != 0;
        return std::any_of(m_keys.begin(), m_keys.end(),
                           [&](const std::string& sent) { return setsReading(sent, key); });
    }

private:
    std::set<std::string> m_keys;
};

}  // namespace

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
