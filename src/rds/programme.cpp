#include "rds/programme.h"

#include "rds/settings.h"
#include "settings/captions.h"
#include "settings/storedvalue.h"

namespace kdx {

void Programme::load(const Profile& profile) {
    constexpr int kDecoderInfos = 16;
    pi = profile.read(setting::kPi.place);
    ps = profile.read(setting::kPs.place).substr(0, kPsLength);
    const std::string ms = profile.read(setting::kMusicSpeech.place);
    musicSpeech = ms.empty() ? std::string() : (ms == "M" ? "M" : "S");
    const std::string di = profile.read(setting::kDecoderInfo.place);
    const int info = di.empty() ? -1 : storedEntry(di, kDecoderInfos);
    decoderInfo = info < 0 ? std::string() : std::to_string(info);
    radiotext = profile.read(setting::kRadiotext.place);
    pty = std::to_string(storedEntry(profile.read(setting::kPtyOfDataSet), kProgrammeTypes));
}

void Programme::appendSteps(Steps& steps) const {
    appendStep(steps, setting::kPi.sendKey, pi);
    appendStep(steps, setting::kTrafficProgramme, trafficProgramme);
    appendStep(steps, setting::kAnnouncement, announcement);
    appendStep(steps, setting::kPs.sendKey, ps);
    appendStep(steps, setting::kTestMode, "0");
    appendStep(steps, setting::kMusicSpeech.sendKey, musicSpeech);
    appendStep(steps, setting::kRadiotext.sendKey, radiotext);
}

void Programme::appendPtySteps(Steps& steps) const {
    appendStep(steps, setting::kPty.sendKey, pty);
}

}  // namespace kdx
