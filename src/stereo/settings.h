#pragma once

#include "settings/profile.h"

namespace kdx::setting {

// How the stereo multiplex, the carrier and the audio generator are sent, and where they are kept. Where the two names
// of a setting differ they do so on purpose: settings files and the dispatcher have names of their own.
inline constexpr Setting kTotalDeviation{"MPX_HUB", {KeptIn::General, "FM", "MPX_DEV"}};
inline constexpr Setting kSource{"MPX_SOURCE", {KeptIn::General, "FM", "MPX_SOURCE"}};
// Read as 1 and 2, sent and stored as the option's index from 0, for which the dispatcher has no command at 0.
// This and the next go out as the panel names them where the user wants it (settings/corrections.h).
inline constexpr Setting kImpedance{"MPX_IMPEDANZ", {KeptIn::General, "FM", "MPX_IMPEDANZ"}};
// Sent as the option's index from 0, where the dispatcher counts from 1.
inline constexpr Setting kStereoMode{"STEREO_MODE", {KeptIn::General, "FM", "Stereo_Mode"}};
inline constexpr Setting kPreemphasis{"PREEMPHASIS", {KeptIn::General, "FM", "PREEMPHASIS"}};
inline constexpr Setting kPilot{"PILOT", {KeptIn::General, "FM", "PILOT"}};
inline constexpr Setting kPilotDeviation{"PILOT_HUB", {KeptIn::General, "FM", "PILOT_HUB"}};
inline constexpr Setting kPilotPhase{"PILOT_PHASE", {KeptIn::General, "FM", "PILOT_PHASE"}};
inline constexpr Setting kAri{"ARI", {KeptIn::General, "FM", "ARI"}};
// A whole data set names these three "ARI_HUB", "ARI_ID" and "AR_BK", which the dispatcher does not know: it leaves the
// ARI details of the instrument as they are.
inline constexpr Setting kAriDeviation{"ARI-HUB", {KeptIn::General, "FM", "ARI_HUB"}};
inline constexpr Setting kAriType{"ARI-ID", {KeptIn::General, "FM", "ARI_ID"}};
// Stored with a hyphen as a letter, read with an underscore as a number: a choice does not come back at the next start.
inline constexpr Setting kAriArea{"ARI-BK", {KeptIn::General, "FM", "ARI-BK"}};
inline constexpr Place kAriAreaAtStart{KeptIn::General, "FM", "ARI_BK"};
inline constexpr Setting kRds{"RDS", {KeptIn::General, "FM", "RDS"}};
inline constexpr Setting kRdsDeviation{"RDS_HUB", {KeptIn::General, "FM", "RDS_HUB"}};
inline constexpr Place kRdsPhase{KeptIn::General, "FM", "RDS_PHASE"};  // shown only; no handler sends it

// The generator's own values are kept once, in data set 1.
inline constexpr Setting kRfFrequency{"HF-Frequenz", {KeptIn::DataSet1, "VRN", "HF_Frequenz"}};
inline constexpr Setting kRfLevel{"HF-Pegel", {KeptIn::DataSet1, "VRN", "HF_Pegel"}};
inline constexpr Setting kAudioFrequency{"NF-Frequenz", {KeptIn::DataSet1, "VRN", "NF_Frequenz"}};
inline constexpr Place kRfLowest{KeptIn::DataSet1, "VRN", "FM_Ulim"};
inline constexpr Place kRfHighest{KeptIn::DataSet1, "VRN", "FM_Olim"};
inline constexpr Place kAudioLowest{KeptIn::DataSet1, "VRN", "NF_Ulim"};
inline constexpr Place kAudioHighest{KeptIn::DataSet1, "VRN", "NF_Olim"};
inline constexpr const char* kRfOutput = "HF:PEGEL:STATE";  // "ON" or "OFF"; kept nowhere

}  // namespace kdx::setting
