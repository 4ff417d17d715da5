#pragma once

#include <string>

#include "coder/step.h"
#include "settings/corrections.h"

namespace kdx {

class Profile;
struct Setting;

/// The impedance that every opening of a session puts in force.
inline constexpr const char* kFirstImpedance = "0";

/// The option chosen of several as it is sent, its index; "" for none (-1).
[[nodiscard]] std::string optionText(int index);

/// What goes out for an option of the setting, given as its index: that, or where it is corrected the number by which
/// the dispatcher knows what the panel names; "" for none.
[[nodiscard]] std::string sentOption(const Setting& setting, const std::string& index, const Corrections& corrections);
/// The index of the option that goes out so.
[[nodiscard]] std::string indexOfSent(const Setting& setting, const std::string& sent, const Corrections& corrections);

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
    void appendOpeningSteps(Steps& steps, const Corrections& corrections = {}) const;
    /// Adds the part of the data set; with the stereo mode, which is left out otherwise, where that is corrected.
    void appendSteps(Steps& steps, const Corrections& corrections = {}) const;
    /// Adds what the whole data set has besides when it goes out without an opening: the impedance where that is
    /// corrected, else nothing.
    void appendImpedanceStep(Steps& steps, const Corrections& corrections) const;
};

}  // namespace kdx
