#pragma once

#include <string>

#include "coder/fieldsizes.h"
#include "coder/step.h"

namespace kdx {

class Profile;

/// The own programme's RDS data in a data set, each value as it is sent.
struct Programme {
    std::string pi;       ///< as typed, also while it has not been sent yet
    std::string ps;       ///< at most kPsLength characters; not padded
    std::string psField;  ///< as typed, also what is too long to be sent
    std::string trafficProgramme = "0";
    std::string announcement = "0";
    std::string musicSpeech;  ///< "M" or "S"; "" where the data set says nothing
    std::string decoderInfo;  ///< "0" to "15", or ""
    std::string radiotext;    ///< as typed, also while it has not been sent yet
    std::string pty;          ///< number of the entry; "-1" for a stored number that no entry has

    /// Reads what the data set holds; the traffic flags are kept in none and stay.
    void load(const Profile& profile);
    /// Adds PI, traffic flags, PS, the return from the test mode, music/speech and radiotext.
    void appendSteps(Steps& steps) const;
    /// Adds the programme type, which follows the AF lists.
    void appendPtySteps(Steps& steps) const;
};

}  // namespace kdx
