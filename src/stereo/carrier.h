#pragma once

#include <string>

#include "coder/step.h"
#include "settings/corrections.h"

namespace kdx {

class Profile;

/// The generator's own values, each as it is sent. They are kept in data set 1 and read anew whenever they go out.
struct Carrier {
    std::string rfFrequency;     ///< MHz
    std::string rfLevel;         ///< dBµV
    std::string audioFrequency;  ///< kHz
    bool outputOn = false;       ///< off at first; every opening of a session turns it over
    bool everOpened = false;     ///< an opening has begun; those after it leave the output where that is corrected

    void load(const Profile& profile);
    /// Adds the part of the data set: frequency and level. What is no number is left out where numbers are checked.
    void appendSteps(Steps& steps, const Corrections& corrections = {}) const;
    /// Adds what the opening of a session sends after the data set: the output turned over (or as it stands), the
    /// audio generator.
    void appendOpeningSteps(Steps& steps, const Corrections& corrections = {}) const;
};

/// The RF output's state as it is sent.
[[nodiscard]] inline const char* outputText(bool on) {
    return on ? "ON" : "OFF";
}

}  // namespace kdx
