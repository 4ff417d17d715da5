#include "station/wrongsettings.h"

#include <array>
#include <optional>

#include "af/aflist.h"
#include "af/settings.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "coder/keyfacts.h"
#include "groups/groupsequence.h"
#include "groups/settings.h"
#include "rds/settings.h"
#include "settings/profile.h"
#include "stereo/deviation.h"
#include "stereo/settings.h"

namespace kdx {

namespace {

/// What of a stored text is to be legal for the key.
enum class Judged {
    AsStored,
    Carrier,     ///< a number of the carrier, whose decimal comma may be corrected
    Required,    ///< the same, and it must not be missing
    Impedance,   ///< counts from 1 where it is read, from 0 where the window has stored a choice
    PilotPhase,  ///< within the limits of the setting, which are narrower than the key's
    List,        ///< a list without what leads it when it is sent
    Sequence,    ///< a group sequence: its last comma is not sent
};

struct SettingToJudge {
    Setting setting;
    Judged judged = Judged::AsStored;
};

// In the order of sending. Not sent with a data set: the type of the other network, decoder information, stereo mode,
// ARI details, RDS phase.
constexpr std::array kSettingsToJudge = {
    SettingToJudge{setting::kTotalDeviation},
    SettingToJudge{setting::kSource},
    SettingToJudge{setting::kImpedance, Judged::Impedance},
    SettingToJudge{setting::kPreemphasis},
    SettingToJudge{setting::kPilot},
    SettingToJudge{setting::kPilotDeviation},
    SettingToJudge{setting::kPilotPhase, Judged::PilotPhase},
    SettingToJudge{setting::kAri},
    SettingToJudge{setting::kRds},
    SettingToJudge{setting::kRdsDeviation},
    SettingToJudge{setting::kPi, Judged::Required},
    SettingToJudge{setting::kPs},
    SettingToJudge{setting::kMusicSpeech},
    SettingToJudge{setting::kRadiotext},
    SettingToJudge{setting::kAfLists[0], Judged::List},
    SettingToJudge{setting::kAfLists[1], Judged::List},
    SettingToJudge{setting::kAfLists[2], Judged::List},
    SettingToJudge{setting::kAfLists[3], Judged::List},
    SettingToJudge{setting::kAfLists[4], Judged::List},
    SettingToJudge{{setting::kPty.sendKey, setting::kPtyOfDataSet}},
    SettingToJudge{setting::kEonPi},
    SettingToJudge{setting::kEonTa},
    SettingToJudge{setting::kEonTp},
    SettingToJudge{setting::kEonPs},
    SettingToJudge{setting::kEonAfLists[0], Judged::List},
    SettingToJudge{setting::kEonAfLists[1], Judged::List},
    SettingToJudge{setting::kEonAfLists[2], Judged::List},
    SettingToJudge{setting::kEonAfLists[3], Judged::List},
    SettingToJudge{setting::kEonAfLists[4], Judged::List},
    SettingToJudge{setting::kGroupSequence, Judged::Sequence},
    SettingToJudge{setting::kRfFrequency, Judged::Carrier},
    SettingToJudge{setting::kRfLevel, Judged::Carrier},
    SettingToJudge{setting::kAudioFrequency, Judged::Carrier},
};

std::optional<std::string> wrongPhase(const std::string& stored) {
    auto wrong = wrongValue(setting::kPilotPhase.sendKey, stored);
    const double degrees = leadingNumber(stored);
    if (!wrong && (degrees < kLowestPilotPhase || degrees > kHighestPilotPhase)) {
        wrong = std::string(setting::kPilotPhase.sendKey) + " of a data set cannot be \"" + toUtf8(stored) +
                "\". Legal: " + std::to_string(kLowestPilotPhase) + " to " + std::to_string(kHighestPilotPhase) +
                " degrees.";
    }
    return wrong;
}

std::optional<std::string> wrong(const SettingToJudge& row, const std::string& stored, const Corrections& corrections) {
    const char* const key = row.setting.sendKey;
    if (stored.empty() && row.judged != Judged::Required) return std::nullopt;
    switch (row.judged) {
        case Judged::AsStored:
        case Judged::Required:
            return wrongValue(key, stored, {.quotes = corrections.quotes});
        case Judged::Carrier:
            return wrongValue(key, stored, corrections);
        case Judged::Impedance:
            return stored == "0" ? std::nullopt : wrongValue(key, stored);
        case Judged::PilotPhase:
            return wrongPhase(stored);
        case Judged::List:
            return wrongValue(key, newOrFurtherList(1) + stored);
        case Judged::Sequence:
            return wrongValue(key, sequenceToSend(stored));
    }
    return std::nullopt;
}

LegalValues legalValues(const SettingToJudge& row) {
    const KeyFacts* const facts = factsOf(row.setting.sendKey);
    LegalValues legal = facts == nullptr ? LegalValues() : facts->legal;
    if (row.judged == Judged::PilotPhase) {
        legal.lowest = kLowestPilotPhase;
        legal.highest = kHighestPilotPhase;
    }
    return legal;
}

}  // namespace

std::vector<WrongSetting> wrongSettings(const Profile& source) {
    const Corrections corrections = readCorrections(source);
    std::vector<WrongSetting> found;
    for (const SettingToJudge& row : kSettingsToJudge) {
        const Place& place = row.setting.place;
        const std::string stored = source.read(place);
        if (const auto sentence = wrong(row, stored, corrections)) {
            found.push_back({row.setting.sendKey, stored, legalValues(row), source.fileOf(place), place,
                             *sentence + " It stands in " + source.fileOf(place) + ", [" + place.section + "] " +
                                 place.key + "=" + toUtf8(stored) + "."});
        }
    }
    return found;
}

}  // namespace kdx
