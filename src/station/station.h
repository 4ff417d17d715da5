#pragma once

#include <string>

#include "af/aflistset.h"
#include "af/othernetwork.h"
#include "coder/step.h"
#include "groups/groupsequence.h"
#include "rds/programme.h"
#include "settings/corrections.h"
#include "stereo/carrier.h"
#include "stereo/multiplex.h"

namespace kdx {

class DataFolder;

/// A data set: everything that the program can put into the instrument in one go.
struct Station {
    Multiplex multiplex;
    Programme programme;
    AfListSet af;
    OtherNetwork otherNetwork;
    GroupSequence groups;
    Carrier carrier;

    /// Reads the data set of the profile, the multiplex of the general settings and the carrier of data set 1.
    void load(const Profile& profile);
    /// Reads what the data set alone holds; multiplex and carrier stay as they are.
    void loadDataSet(const Profile& profile);
    /// Reads anew what lives in its files and is looked up whenever it goes out: AF lists and the carrier's values.
    void reload(const Profile& profile);
};

/// The data set of that number ("1" to "5") as its files have it.
[[nodiscard]] Station loadStation(DataFolder& data, const std::string& number);

/// What is sent when a session has been opened: identification, base state, the whole data set, RF output, audio.
[[nodiscard]] Steps openingSteps(const Station& station, const Corrections& corrections = {});
/// What is sent when the whole data set is.
[[nodiscard]] Steps dataSetSteps(const Station& station, const Corrections& corrections = {});
/// How a session ends.
[[nodiscard]] Steps closingSteps();

}  // namespace kdx
