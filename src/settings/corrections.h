#pragma once

#include <array>

namespace kdx {

class Profile;

/// Which of the described ways of the program are corrected. All of them stay as they are unless the user wants it:
/// test set-ups live with them.
struct Corrections {
    bool stereoMode = false;     ///< the stereo mode goes out as the panel names it
    bool impedance = false;      ///< the input impedance likewise
    bool eonType = false;        ///< the other network's programme type goes out and is kept as a number
    bool levelUnit = false;      ///< the level that is read back bears the unit it was set in
    bool rfOutput = false;       ///< only the first opening of a session turns the RF output over
    bool trafficFields = false;  ///< fields of a traffic message that nobody chose count as 0
    bool decimalComma = false;   ///< a decimal comma is taken for a point, and numbers are checked
    bool rfValues = false;       ///< entered RF and audio values are kept
    bool quotes = false;         ///< a double quote inside a text goes out doubled
    bool edgeBlanks = false;     ///< blanks at the edges of stored texts come back
    bool midnight = false;       ///< a pause that reaches over midnight ends
};

/// A correction by the key of its switch.
struct CorrectionKey {
    const char* key;
    bool Corrections::*isOn;
};

/// Section of the general settings that holds the switches; the number 1 is on.
inline constexpr const char* kCorrectionSection = "Berichtigungen";

inline constexpr std::array kCorrectionKeys{
    CorrectionKey{"Stereo_Mode", &Corrections::stereoMode}, CorrectionKey{"Impedanz", &Corrections::impedance},
    CorrectionKey{"EON_PTY", &Corrections::eonType},        CorrectionKey{"Pegel", &Corrections::levelUnit},
    CorrectionKey{"HF_Ausgang", &Corrections::rfOutput},    CorrectionKey{"TMC_Felder", &Corrections::trafficFields},
    CorrectionKey{"Komma", &Corrections::decimalComma},     CorrectionKey{"HF_Werte", &Corrections::rfValues},
    CorrectionKey{"Anfuehrung", &Corrections::quotes},      CorrectionKey{"PS_Rand", &Corrections::edgeBlanks},
    CorrectionKey{"Mitternacht", &Corrections::midnight}};

/// What the general settings correct as they are now.
[[nodiscard]] Corrections readCorrections(const Profile& profile);

}  // namespace kdx
