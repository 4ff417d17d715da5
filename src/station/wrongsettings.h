#pragma once

#include <string>
#include <vector>

#include "coder/keyfacts.h"
#include "settings/profile.h"

namespace kdx {

/// A stored value that cannot be sent.
struct WrongSetting {
    std::string key;
    std::string stored;  ///< 8-bit Windows-1252
    LegalValues legal;
    std::string file;
    Place place;
    std::string sentence;  ///< all of it in words of kdx-ctl, in UTF-8
};

/// What stands in a data set, the multiplex and the carrier that go with it, and cannot be sent as it stands; in the
/// order of sending. Sending makes something else of some of these without a word: no command, the nearest limit, off.
/// A value that is missing is legal, but for the PI; what sending a data set leaves out may be anything.
[[nodiscard]] std::vector<WrongSetting> wrongSettings(const Profile& source);

}  // namespace kdx
