#pragma once

#include "settings/profile.h"

namespace kdx::setting {

// Where the settings of the program itself are kept; none of them is sent.
// Spelled so when it is written anew; reading is blind to letter case.
inline constexpr Place kInterface{KeptIn::General, "BUS", "Interface"};  // "IEC" or "TCPIP"
inline constexpr Place kOpenAtStart{KeptIn::General, "BUS", "IECBUS"};   // "AUTO" in any letter case
inline constexpr Place kGpibAddress{KeptIn::General, "ADRESSEN", "KDX_IEEE"};
inline constexpr Place kLanAddress{KeptIn::General, "ADRESSEN", "KDX_TCPIP"};
inline constexpr Place kCommandLogOn{KeptIn::General, "ADRESSEN", "Log_Key"};  // the number 1
inline constexpr Place kLanguage{KeptIn::General, "Sprache", "Sprache"};
inline constexpr Place kStandard{KeptIn::General, "Sprache", "RDS_RBDS"};

}  // namespace kdx::setting
