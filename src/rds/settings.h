#pragma once

#include "settings/profile.h"

namespace kdx::setting {

// How the programme's own RDS data are sent, and where they are kept.
inline constexpr Setting kPs{"PS", {KeptIn::DataSet, "RDS", "PS"}};
inline constexpr Setting kPi{"PI", {KeptIn::DataSet, "RDS", "PI"}};
// The window writes and reads the type in data set 1 whatever set is at work; a data set that is loaded brings its own.
inline constexpr Setting kPty{"PTY", {KeptIn::DataSet1, "RDS", "PTY"}};
inline constexpr Place kPtyOfDataSet{KeptIn::DataSet, "RDS", "PTY"};
inline constexpr Setting kMusicSpeech{"MS", {KeptIn::DataSet, "RDS", "MS"}};
inline constexpr Setting kDecoderInfo{"DI", {KeptIn::DataSet, "RDS", "DI"}};
// Stored as radiotext A, sent under "RT": data sets are kept that way.
inline constexpr Setting kRadiotext{"RT", {KeptIn::DataSet, "RDS", "RTA"}};
inline constexpr Place kSecondRadiotext{KeptIn::DataSet, "RDS", "RTB"};  // shown only
inline constexpr const char* kTrafficProgramme = "TP";                   // kept nowhere
inline constexpr const char* kAnnouncement = "TA";                       // kept nowhere
inline constexpr const char* kTestMode = "TEST_M";                       // kept nowhere
inline constexpr const char* kTestPattern = "TEST_D";                    // kept nowhere
inline constexpr const char* kClock = "UHR";                             // kept nowhere
inline constexpr const char* kStore = "STORE";                           // number of a memory of the coder's own

// Times of the automations, never sent.
inline constexpr Place kAnnouncementSeconds{KeptIn::General, "RDS", "TA_ON"};
inline constexpr Place kRepetitionSeconds{KeptIn::General, "RDS", "TA_REP"};
inline constexpr Place kDynamicPsInterval{KeptIn::General, "RDS", "PS_Dyn"};  // milliseconds

}  // namespace kdx::setting
