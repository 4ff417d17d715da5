#include "station/datasetfile.h"

#include <limits>

#include "af/settings.h"
#include "base/codepage.h"
#include "groups/settings.h"
#include "rds/settings.h"
#include "settings/folderlock.h"
#include "settings/profilefile.h"
#include "settings/storedvalue.h"
#include "station/station.h"

namespace kdx {

namespace {

constexpr const char* kSection = "RDS";

}  // namespace

DataSetContent storedDataSet(const ProfileText& file) {
    DataSetContent content;
    (void)file.anyKey(kSection, [&](std::string_view key) {
        constexpr std::size_t kWhole = std::numeric_limits<std::size_t>::max();
        content.emplace(upperCase(std::string(key)), quotedWhereNeeded(file.value(kSection, key, kWhole)));
        return false;
    });
    return content;
}

DataSetContent dataSetAtWork(const ProfileText& file, const Station& station, bool blanksCount) {
    DataSetContent content = storedDataSet(file);
    const auto keep = [&](const Place& place, const std::string& value) { content[upperCase(place.key)] = value; };
    const auto keepText = [&](const Setting& setting, const std::string& text) {
        if (file.value(kSection, setting.place.key) == text) return;  // as it stands there, in quotes or not
        keep(setting.place, blanksCount ? quotedWhereNeeded(text) : text);
    };
    const Programme& programme = station.programme;
    keepText(setting::kPs, programme.psField.substr(0, kPsLength));
    keepText(setting::kRadiotext, programme.radiotext);
    keep(setting::kPi.place, programme.pi);
    keep(setting::kMusicSpeech.place, programme.musicSpeech);
    keep(setting::kDecoderInfo.place, programme.decoderInfo);
    if (programme.pty != "-1") keep(setting::kPtyOfDataSet, programme.pty);
    const OtherNetwork& network = station.otherNetwork;
    keepText(setting::kEonPs, network.ps);
    keep(setting::kEonPi.place, network.pi);
    keep(setting::kEonPty.place, network.pty);
    keep(setting::kEonTp.place, network.tp);
    keep(setting::kEonTa.place, network.ta);
    // What begins with a cut reading never takes the place of what is stored.
    if (!station.groups.cut) keep(setting::kGroupSequence.place, station.groups.groups);
    return content;
}

void putDataSet(const DataSetContent& content, ProfileText& file) {
    for (const auto& [key, value] : storedDataSet(file)) {
        if (!value.empty() && !content.contains(key)) file.setValue(kSection, key, "");
    }
    for (const auto& [key, value] : content) {
        if (!file.holds(kSection, key, value)) file.setValue(kSection, key, value);
    }
}

bool writeDataSet(const DataSetContent& content, const std::filesystem::path& file) {
    bool written = false;
    return underFolderLock(file.parent_path(),
                           [&] {
                               const auto before = readToChange(file);
                               if (!before || isUtf16(*before)) return;
                               ProfileText text(*before);
                               putDataSet(content, text);
                               written = replaceFile(file, text.bytes());
                           }) &&
           written;
}

}  // namespace kdx
