#pragma once

#include <string>

#include "coder/step.h"

namespace kdx {

class Profile;

/// The impedance that every opening of a session puts in force.
inline constexpr const char* kFirstImpedance = "0";

/// The option chosen of several as it is sent, its index; "" for none (-1).
[[nodiscard]] std::string optionText(int index);

/// The ARI area code of an option as it is sent: a letter, "A" for index 0; "" for none (-1).
[[nodiscard]] std::string areaCode(int index);

/// The stereo multiplex of a data set, each value as it is sent; "" where no option is chosen.
struct Multiplex {
    std::string totalDeviation = "00000";  ///< deviations are digits in units of 10 Hz
    std::string source;                    ///< "0" to "3"
    std::string impedance;                 ///< index of the option, "0" or "1"
    std::string stereoMode;                ///< index of the option, "0" to "4"
    std::string preemphasis;               ///< "0" to "2"
    std::string pilot = "0";               ///< flags are "1" or "0"
    std::string pilotDeviation = "0000";
    std::string pilotPhase = "02";  ///< degrees, two characters
    std::string ari = "0";
    std::string ariDeviation = "0000";
    std::string ariType;  ///< "0" to "3"
    std::string ariArea;  ///< letter, "A" to "F"
    std::string rds = "0";
    std::string rdsDeviation = "0000";

    /// Reads what the general settings hold; what cannot be read becomes 0 or no choice.
    void load(const Profile& profile);
    /// Adds what the opening of a session puts in force before the data set.
    void appendOpeningSteps(Steps& steps) const;
    /// Adds the part of the data set.
    void appendSteps(Steps& steps) const;
};

}  // namespace kdx
