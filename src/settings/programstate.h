#pragma once

#include <cstdint>
#include <string>

#include "settings/corrections.h"

namespace kdx {

/// What the whole program shares while it runs; one owner, passed by reference. Texts are 8-bit Windows-1252.
struct ProgramState {
    std::string ProgramTitle;
    std::string InterfaceKind;      ///< "IEC" (GPIB) or "TCPIP" (LAN), as read from the general settings
    bool InstrumentOnline = false;  ///< set by the first successful open; closing leaves it set
    bool LogEnabled = false;
    std::string CurrentDataSet = "1";  ///< "1" to "5"
    std::string openedFile;            ///< absolute: the file at work in the place of a data set's; usually none
    bool dataSetChosen = false;        ///< by the user: what is described as read from data set 1 follows the choice

    std::string eonIdentifier;  ///< PI of the other network being edited; leads every EON command
    std::string shownClock;     ///< what `Uhr_Zeit` reads: the time that is sent to the coder

    std::string language;             ///< "deutsch", "english" or "english US"; compared by its exact text
    std::string standard;             ///< "RDS" or "RBDS"
    std::string afEditorKind;         ///< "AF" or "EON AF": the lists the AF editor works on
    std::string storedGroupSequence;  ///< the group sequence of data set 1 as last read

    std::int16_t groupCount = 0;    ///< group buttons pressed since the sequence was started anew
    std::int16_t group8ACount = 0;  ///< how many of those were group 8 (TMC)

    Corrections corrections;

    std::int16_t sendMode = 0;  ///< handed to every send; has no effect on what is sent
};

}  // namespace kdx
