#include "station/setupfile.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "af/settings.h"
#include "base/numbers.h"
#include "coder/keyfacts.h"
#include "coder/listlead.h"
#include "groups/settings.h"
#include "rds/settings.h"
#include "settings/profilefile.h"
#include "settings/storedvalue.h"
#include "settings/withoutcontrols.h"
#include "stereo/deviation.h"
#include "stereo/settings.h"

namespace kdx {

namespace {

// Where a key of what was read is another one than that of the setting, it stands beside its place.
constexpr std::array kAsRead = {
    setting::kSource,
    setting::kImpedance,
    setting::kPreemphasis,
    setting::kPilot,
    setting::kAri,
    setting::kAriType,
    setting::kAriArea,
    setting::kRds,
    Setting{"RDS_PHASE", setting::kRdsPhase},
    setting::kPi,
    Setting{setting::kPty.sendKey, setting::kPtyOfDataSet},
    setting::kMusicSpeech,
    setting::kDecoderInfo,
    setting::kRfFrequency,
    setting::kRfLevel,
    setting::kAudioFrequency,
    setting::kEonPi,
    Setting{setting::kEonType, setting::kEonPty.place},
    setting::kEonTp,
    setting::kEonTa,
    setting::kEonAfLists[0],
    setting::kEonAfLists[1],
    setting::kEonAfLists[2],
    setting::kEonAfLists[3],
    setting::kEonAfLists[4],
    setting::kAfLists[0],
    setting::kAfLists[1],
    setting::kAfLists[2],
    setting::kAfLists[3],
    setting::kAfLists[4],
};

/// The texts, whose blanks count.
constexpr std::array kTexts = {setting::kPs, setting::kRadiotext, setting::kEonPs};

constexpr std::array kDeviations = {kTotalDeviation, kPilotDeviation, kRdsDeviation, kAriDeviation};

const Setting* settingOf(const auto& settings, std::string_view key) {
    const auto found =
        std::find_if(settings.begin(), settings.end(), [key](const Setting& s) { return s.sendKey == key; });
    return found == settings.end() ? nullptr : &*found;
}

/// Whether the instrument can have the value: what a broken one says otherwise is not kept. Texts are free, and there
/// may be no lists.
bool isPossible(const std::string& key, const std::string& value) {
    if (settingOf(kTexts, key) != nullptr) return true;
    if (value.empty()) return key.starts_with("AF") || key.starts_with("EON_AF");
    return !wrongValue(key, value);
}

class Keeper {
public:
    explicit Keeper(ProfileText& text) : m_text(text) {}

    void keep(const std::string& key, const std::string& value) {
        if (const Setting* setting = settingOf(kAsRead, key)) {
            // What leads a list tells the coder which one it is; the file tells it by the key.
            write(setting->place, std::string(afterListLead(value).value_or(value)));
        } else if (const Setting* text = settingOf(kTexts, key)) {
            write(text->place, quotedWhereNeeded(value));
        } else if (key == setting::kGroupSequence.sendKey) {
            write(setting::kGroupSequence.place, value.empty() ? value : value + ",");
        } else if (key == setting::kStereoMode.sendKey) {
            write(setting::kStereoMode.place, shortestDecimal(leadingNumber(value) - 1));
        } else if (key == setting::kPilotPhase.sendKey) {
            write(setting::kPilotPhase.place,
                  pilotPhaseSetting(storedPosition(value, kLowestPilotPhase, kHighestPilotPhase)));
        }
        for (const Deviation& deviation : kDeviations) {
            if (key != deviation.setting.sendKey) continue;
            write(deviation.setting.place, deviationSetting(deviation, storedPosition(value, 0, deviation.highest)));
        }
    }

private:
    void write(const Place& place, const std::string& value) { m_text.setValue(place.section, place.key, value); }

    ProfileText& m_text;
};

}  // namespace

void keep(const Readout& readout, ProfileText& text) {
    Keeper keeper(text);
    // A data set holds one other network: the one that the coder names first.
    std::string network;
    bool networksKnown = true;
    for (const Reading& reading : readout) {
        if (network.empty()) network = reading.network;
        if (reading.key == setting::kEonPi.sendKey && !reading.value) networksKnown = false;
        const std::string value = withoutControls(reading.value.value_or(""));
        if (!reading.value || !isPossible(reading.key, value)) continue;
        if (reading.network.empty() || reading.network == network) keeper.keep(reading.key, value);
    }
    if (!network.empty() || !networksKnown) return;
    for (const Setting& setting : kAsRead) {
        if (std::string_view(setting.sendKey).starts_with("EON_")) keeper.keep(setting.sendKey, "");
    }
    keeper.keep("EON_PS", "");
}

}  // namespace kdx
