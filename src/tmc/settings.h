#pragma once

#include "settings/profile.h"

namespace kdx::setting {

// How traffic messages are sent, and where they are kept: both under the same key, so that the data set keeps the
// message, which goes out last.
inline constexpr Setting kOpenDataAnnouncement{"ODA", {KeptIn::DataSet, "RDS", "TMC"}};
inline constexpr Setting kTrafficMessage{"TMC", {KeptIn::DataSet, "RDS", "TMC"}};

}  // namespace kdx::setting
