#include "station/sentvalues.h"

#include <algorithm>

#include "coder/sendparam.h"
#include "station/readout.h"
#include "station/station.h"

namespace kdx {

namespace {

Station loaded(const Profile& source) {
    Station station;
    station.load(source);
    return station;
}

}  // namespace

SentValues::SentValues(const Profile& source) : SentValues(loaded(source), readCorrections(source)) {}

SentValues::SentValues(const Station& station, const Corrections& corrections) {
    for (const Step& step : openingSteps(station, corrections)) {
        std::string value = step.value;
        if (!composeCommand(step.key, value, {}).value_or("").empty()) m_keys.insert(step.key);
    }
}

bool SentValues::hold(const std::string& key, const std::string& network) const {
    // All other networks are removed, and what is added begins anew. The first AF list makes all others go.
    if (!network.empty()) return true;
    if (key.starts_with("AF")) return m_keys.count("AF1") != 0;
    return std::any_of(m_keys.begin(), m_keys.end(), [&](const std::string& sent) { return setsReading(sent, key); });
}

}  // namespace kdx
