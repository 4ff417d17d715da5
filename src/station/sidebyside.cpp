#include "station/sidebyside.h"

#include <algorithm>
#include <array>
#include <utility>

#include "coder/keyfacts.h"
#include "settings/profile.h"
#include "settings/profilefile.h"
#include "settings/storedvalue.h"
#include "station/rehearsal.h"
#include "station/sentvalues.h"
#include "station/setupfile.h"

namespace kdx {

namespace {

using Column = std::optional<std::string> SettingSideBySide::*;

/// Where what a set-up file keeps is kept by the window.
constexpr std::array<std::pair<const char*, KeptIn>, 3> kSections{
    {{"RDS", KeptIn::DataSet}, {"FM", KeptIn::General}, {"VRN", KeptIn::DataSet1}}};

std::vector<SettingSideBySide>::iterator rowOf(std::vector<SettingSideBySide>& rows, const Reading& reading) {
    return std::find_if(rows.begin(), rows.end(), [&](const SettingSideBySide& row) { return row.isAt(reading); });
}

/// What is only here stands at the end: networks that the others do not have.
void fill(std::vector<SettingSideBySide>& rows, Column column, const Readout& readout) {
    for (const Reading& reading : readout) {
        auto row = rowOf(rows, reading);
        if (row == rows.end()) row = rows.insert(rows.end(), {reading.key, reading.network, {}, {}, {}});
        (*row).*column = reading.value;
    }
}

/// What a data set leaves alone is not the data set's doing.
Readout sentOf(Readout readout, const SentValues& sent) {
    std::erase_if(readout, [&](const Reading& reading) { return !sent.hold(reading.key, reading.network); });
    return readout;
}

bool knowsNetworks(const Readout& readout) {
    return std::none_of(readout.begin(), readout.end(),
                        [](const Reading& r) { return r.key == kNetworkKey && r.network.empty(); });
}

bool differ(const SettingSideBySide& row, bool present) {
    // A network counts as one: that its values are not there says nothing more than that it is not.
    const bool wholeNetwork = row.key == kNetworkKey && !row.network.empty();
    if (wholeNetwork && row.window != row.file) return true;
    if (wholeNetwork && present && row.window != row.instrument) return true;
    const std::array columns{row.window, row.file, row.instrument};
    return std::any_of(columns.begin(), columns.end(), [&](const auto& one) {
        return std::any_of(columns.begin(), columns.end(),
                           [&](const auto& other) { return one && other && *one != *other; });
    });
}

/// What the coder does not take is shown as it was entered, and goes nowhere.
void showRefused(std::vector<SettingSideBySide>& rows, const Station& entered, const Corrections& corrections) {
    for (const Step& step : openingSteps(entered, corrections)) {
        if (step.kind != Step::Kind::Parameter || !wrongValue(step.key, step.value, corrections)) continue;
        const auto row = rowOf(rows, {step.key, {}, {}});
        if (row == rows.end()) continue;
        row->window = step.value;
        row->refused = true;
    }
}

/// Without it no networks would mean that there are none.
const Reading kOtherNetworksUnknown{std::string(kNetworkKey), {}, std::nullopt};

/// @returns whether a file keeps anything of it.
bool write(Profile& into, const Readout& taken) {
    ProfileText text;
    keep(taken, text);
    bool kept = false;
    for (const auto& [section, file] : kSections) {
        for (const auto& [key, value] : text.section(section)) {
            into.write({file, section, key.c_str()}, quotedWhereNeeded(value));
            kept = true;
        }
    }
    return kept;
}

}  // namespace

SideBySide sideBySide(DataFolder& data, const Captions& captions, const Profile& source, const Station& entered,
                      const Readout& present) {
    SideBySide result;
    Rehearsal window(data, captions);
    window.become(present);
    window.apply(entered);
    result.window = window.readOut();
    Rehearsal file(data, captions);
    file.become(present);
    file.apply(source);
    fill(result.settings, &SettingSideBySide::window,
         sentOf(result.window, SentValues(entered, readCorrections(source))));
    const Corrections corrections = readCorrections(source);
    showRefused(result.settings, entered, corrections);
    fill(result.settings, &SettingSideBySide::file, sentOf(file.readOut(), SentValues(source)));
    fill(result.settings, &SettingSideBySide::instrument, present);
    const bool asked = !present.empty() && knowsNetworks(present);
    for (SettingSideBySide& row : result.settings) row.differs = row.refused || differ(row, asked);
    return result;
}

SettingCommands commandsForWindow(const std::vector<SettingSideBySide>& settings, const Readout& window,
                                  const Corrections& corrections) {
    Differences differing;
    for (const SettingSideBySide& row : settings) {
        const bool wholeNetwork = row.key == kNetworkKey && !row.network.empty();
        const bool known = !row.refused && (wholeNetwork || (row.window && row.instrument));
        if (known && row.window != row.instrument)
            differing.push_back({row.key, row.network, row.window, row.instrument});
    }
    return commandsFor(differing, window, corrections);
}

std::size_t takeOver(const std::vector<SettingSideBySide>& settings, Profile& into) {
    // A data set holds one other network: one of another PI comes with that.
    std::string network;
    bool goes = false;
    for (const SettingSideBySide& row : settings) {
        if (row.key != kNetworkKey) continue;
        if (row.instrument && network.empty()) network = row.network;
        if (!row.instrument && row.window) goes = true;
    }
    if (goes && network.empty()) write(into, {});
    std::size_t left = 0;
    for (const SettingSideBySide& row : settings) {
        if (!row.instrument) continue;
        const bool fits = row.network.empty() || row.network == network || (network.empty() && row.window);
        const Reading taken{row.key, row.network, row.instrument};
        if (!fits || !write(into, {taken, kOtherNetworksUnknown})) ++left;
    }
    return left;
}

}  // namespace kdx
