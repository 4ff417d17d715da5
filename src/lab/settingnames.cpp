#include "lab/settingnames.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "ui/caption.h"
#include "ui/text.h"

namespace kdx {

namespace {

struct Name {
    std::string_view key;
    int number;
    const char* design;
    const char* after = "";
};

// By the captions that the pages have for them, where they have.
constexpr std::array kNames = {
    Name{"MPX_SOURCE", 20, ""},
    Name{"MPX_HUB", 348, "Gesamthub"},
    Name{"MPX_IMPEDANZ", 26, ""},
    Name{"STEREO_MODE", 950, "Stereo-Mode"},
    Name{"PREEMPHASIS", 27, ""},
    Name{"PILOT", 344, "Pilotton"},
    Name{"PILOT_HUB", 349, "Pilottonhub"},
    Name{"PILOT_PHASE", 350, "Pilottonphase"},
    Name{"ARI", 343, "A R I"},
    Name{"ARI-HUB", 353, "ARI-Hub"},
    Name{"ARI-ID", 951, "ARI-Kennung"},
    Name{"ARI-BK", 952, "ARI-Bereich"},
    Name{"RDS", 342, "R D S"},
    Name{"RDS_HUB", 351, "RDS-Hub"},
    Name{"RDS_PHASE", 352, "RDS-Phase"},
    Name{"PI", 394, "PI"},
    Name{"PS", 393, "PS"},
    Name{"PTY", 395, "PTY"},
    Name{"TP", 727, "TP"},
    Name{"TA", 728, "TA"},
    Name{"MS", 55, ""},
    Name{"DI", 396, "Decoder Info"},
    Name{"RT", 49, ""},
    Name{"RT_N", 953, "Radiotext: Anzahl, A/B"},
    Name{"TEST_M", 420, "Test Mode"},
    Name{"AF1", 161, "", " 1"},
    Name{"AF2", 161, "", " 2"},
    Name{"AF3", 161, "", " 3"},
    Name{"AF4", 161, "", " 4"},
    Name{"AF5", 161, "", " 5"},
    Name{"GROUPSEQ", 83, ""},
    Name{"HF-Frequenz", 212, ""},
    Name{"HF-Pegel", 218, ""},
    Name{"NF-Frequenz", 215, ""},
    Name{"FM", 954, "FM-Modulation"},
    Name{"AM", 955, "AM-Modulation"},
    Name{"HF:PEGEL:STATE", 630, "HF-Ausgang"},
    Name{"EON_PI", 481, "EON PI"},
    Name{"EON_PS", 482, "EON PS"},
    Name{"EON_PTY", 483, "EON PTY"},
    Name{"EON_TP", 484, "    EON TP"},
    Name{"EON_TA", 486, "EON TA"},
    Name{"EON_AFA", 956, "EON AF Liste", " A"},
    Name{"EON_AFB1", 956, "EON AF Liste", " 1"},
    Name{"EON_AFB2", 956, "EON AF Liste", " 2"},
    Name{"EON_AFB3", 956, "EON AF Liste", " 3"},
    Name{"EON_AFB4", 956, "EON AF Liste", " 4"},
    Name{"EON_AFB5", 956, "EON AF Liste", " 5"},
};

}  // namespace

QString settingName(const std::string& key, const Captions& captions) {
    const auto* name = std::find_if(kNames.begin(), kNames.end(), [&](const Name& row) { return row.key == key; });
    if (name == kNames.end()) return toText(key);
    return captionText(captions, {name->number, name->design, QLatin1String(name->after)}).trimmed();
}

}  // namespace kdx
