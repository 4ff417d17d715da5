#include "settings/corrections.h"

#include "base/numbers.h"
#include "settings/profile.h"

namespace kdx {

Corrections readCorrections(const Profile& profile) {
    Corrections corrections;
    for (const auto& [key, isOn] : kCorrectionKeys) {
        corrections.*isOn = leadingNumber(profile.read({KeptIn::General, kCorrectionSection, key})) == 1;
    }
    return corrections;
}

}  // namespace kdx
