#pragma once

#include "settings/profile.h"

namespace kdx::setting {

// How the group sequence is sent, and where it is kept.
inline constexpr Setting kGroupSequence{"GROUPSEQ", {KeptIn::DataSet, "RDS", "GR_Folge"}};
// The page shows the sequence of data set 1 whatever set is at work, although sending stores in the one at work.
inline constexpr Place kShownGroupSequence{KeptIn::DataSet1, "RDS", "GR_FOLGE"};

}  // namespace kdx::setting
