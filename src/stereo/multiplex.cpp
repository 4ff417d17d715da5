#include "stereo/multiplex.h"

#include <string_view>

#include "base/numbers.h"
#include "settings/storedvalue.h"
#include "stereo/deviation.h"
#include "stereo/settings.h"

namespace kdx {

namespace {

std::string storedDeviation(const Profile& profile, const Deviation& deviation) {
    const std::string stored = profile.read(deviation.setting.place);
    return deviationSetting(deviation, storedPosition(stored, 0, deviation.highest));
}

/// Whether options go out counted from 1, as the dispatcher counts them.
bool countsFromOne(const Setting& setting, const Corrections& corrections) {
    const std::string_view key = setting.sendKey;
    return (corrections.stereoMode && key == setting::kStereoMode.sendKey) ||
           (corrections.impedance && key == setting::kImpedance.sendKey);
}

std::string plus(const std::string& number, int more) {
    return shortestDecimal(leadingNumber(number) + more);
}

}  // namespace

std::string optionText(int index) {
    return index < 0 ? std::string() : std::to_string(index);
}

std::string sentOption(const Setting& setting, const std::string& index, const Corrections& corrections) {
    return index.empty() || !countsFromOne(setting, corrections) ? index : plus(index, 1);
}

std::string indexOfSent(const Setting& setting, const std::string& sent, const Corrections& corrections) {
    return sent.empty() || !countsFromOne(setting, corrections) ? sent : plus(sent, -1);
}

std::string areaCode(int index) {
    return index < 0 ? std::string() : std::string(1, static_cast<char>('A' + index));
}

void Multiplex::load(const Profile& profile) {
    const auto option = [&profile](const Place& place, int first, int last) {
        return optionText(storedOption(profile.read(place), first, last));
    };
    totalDeviation = storedDeviation(profile, kTotalDeviation);
    source = option(setting::kSource.place, 0, 3);
    impedance = option(setting::kImpedance.place, 1, 2);
    stereoMode = option(setting::kStereoMode.place, 0, 4);
    preemphasis = option(setting::kPreemphasis.place, 0, 2);
    pilot = storedFlag(profile.read(setting::kPilot.place));
    pilotDeviation = storedDeviation(profile, kPilotDeviation);
    pilotPhase = pilotPhaseSetting(
        storedPosition(profile.read(setting::kPilotPhase.place), kLowestPilotPhase, kHighestPilotPhase));
    ari = storedFlag(profile.read(setting::kAri.place));
    ariDeviation = storedDeviation(profile, kAriDeviation);
    ariType = option(setting::kAriType.place, 0, 3);
    ariArea = areaCode(storedOption(profile.read(setting::kAriAreaAtStart), 0, 3));  // four of the six areas only
    rds = storedFlag(profile.read(setting::kRds.place));
    rdsDeviation = storedDeviation(profile, kRdsDeviation);
}

void Multiplex::appendOpeningSteps(Steps& steps, const Corrections& corrections) const {
    appendStep(steps, setting::kTotalDeviation.sendKey, totalDeviation);
    appendStep(steps, setting::kSource.sendKey, source);
    // That it is chosen already says nothing of the instrument: corrected, it goes out all the same.
    if (impedance != kFirstImpedance || corrections.impedance) {
        appendStep(steps, setting::kImpedance.sendKey, sentOption(setting::kImpedance, kFirstImpedance, corrections));
    }
}

void Multiplex::appendSteps(Steps& steps, const Corrections& corrections) const {
    appendStep(steps, setting::kPreemphasis.sendKey, preemphasis);
    if (corrections.stereoMode && !stereoMode.empty()) {
        appendStep(steps, setting::kStereoMode.sendKey, sentOption(setting::kStereoMode, stereoMode, corrections));
    }
    appendStep(steps, setting::kPilot.sendKey, pilot);
    appendStep(steps, setting::kPilotDeviation.sendKey, pilotDeviation);
    appendStep(steps, setting::kPilotPhase.sendKey, pilotPhase);
    appendStep(steps, setting::kAri.sendKey, ari);
    // On purpose no keys of the dispatcher (stereo/settings.h).
    appendStep(steps, "ARI_HUB", ariDeviation);
    appendStep(steps, "ARI_ID", ariType);
    appendStep(steps, "AR_BK", ariArea);
    appendStep(steps, setting::kRds.sendKey, rds);
    appendStep(steps, setting::kRdsDeviation.sendKey, rdsDeviation);
}

void Multiplex::appendImpedanceStep(Steps& steps, const Corrections& corrections) const {
    if (!corrections.impedance || impedance.empty()) return;
    appendStep(steps, setting::kImpedance.sendKey, sentOption(setting::kImpedance, impedance, corrections));
}

}  // namespace kdx
