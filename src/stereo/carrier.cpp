#include "stereo/carrier.h"

#include "stereo/settings.h"

namespace kdx {

void Carrier::load(const Profile& profile) {
    rfFrequency = profile.read(setting::kRfFrequency.place);
    rfLevel = profile.read(setting::kRfLevel.place);
    audioFrequency = profile.read(setting::kAudioFrequency.place);
}

void Carrier::appendSteps(Steps& steps) const {
    appendStep(steps, setting::kRfFrequency.sendKey, rfFrequency);
    appendStep(steps, setting::kRfLevel.sendKey, rfLevel);
}

void Carrier::appendOpeningSteps(Steps& steps, const Corrections& corrections) const {
    const bool stays = corrections.rfOutput && everOpened;
    appendStep(steps, setting::kRfOutput, outputText(stays ? outputOn : !outputOn));
    appendStep(steps, "NFShape Sinus", "");  // the generator knows no command for it, so it becomes no step
    appendStep(steps, setting::kAudioFrequency.sendKey, audioFrequency);
}

}  // namespace kdx
