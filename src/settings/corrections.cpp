#include "settings/corrections.h"

#include "settings/profile.h"
#include "settings/storedvalue.h"

namespace kdx {

Corrections readCorrections(const Profile& profile) {
    Corrections corrections;
    for (const auto& [key, isOn] : kCorrectionKeys) {
        corrections.*isOn = isSwitchedOn(profile.read({KeptIn::General, kCorrectionSection, key}));
    }
    return corrections;
}

}  // namespace kdx
