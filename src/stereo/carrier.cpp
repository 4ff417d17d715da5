#include "stereo/carrier.h"

#include "settings/storedvalue.h"
#include "stereo/settings.h"

namespace kdx {

namespace {

/// A number may have been written into the file with a decimal comma.
void appendNumber(Steps& steps, const Setting& setting, const std::string& text, const Corrections& corrections) {
    const auto number = corrections.decimalComma ? decimalNumber(text) : text;
    if (number) appendStep(steps, setting.sendKey, *number);
}

}  // namespace

void Carrier::load(const Profile& profile) {
    rfFrequency = profile.read(setting::kRfFrequency.place);
    rfLevel = profile.read(setting::kRfLevel.place);
    audioFrequency = profile.read(setting::kAudioFrequency.place);
}

void Carrier::appendSteps(Steps& steps, const Corrections& corrections) const {
    appendNumber(steps, setting::kRfFrequency, rfFrequency, corrections);
    appendNumber(steps, setting::kRfLevel, rfLevel, corrections);
}

void Carrier::appendOpeningSteps(Steps& steps, const Corrections& corrections) const {
    const bool stays = corrections.rfOutput && everOpened;
    appendStep(steps, setting::kRfOutput, outputText(stays ? outputOn : !outputOn));
    appendStep(steps, "NFShape Sinus", "");  // the generator knows no command for it, so it becomes no step
    appendNumber(steps, setting::kAudioFrequency, audioFrequency, corrections);
}

}  // namespace kdx
