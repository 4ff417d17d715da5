#pragma once

#include <string>

#include "sim/aflists.h"
#include "sim/othernetworks.h"

namespace kdx::sim {

/// What the coder transmits: the part of the instrument's state that its five memories keep. The values here are those
/// after switching on.
struct Setup {
    // Stereo multiplex. Choices count from 1 in the order of their words (see the parameter tables).
    bool stereoOn = false;
    int source = 1;
    int impedance = 1;
    int stereoMode = 3;
    bool preemphasisOn = false;
    int preemphasis = 1;
    double mpxHertz = 40000;
    bool pilotOn = false;
    double pilotHertz = 6750;
    double pilotDegrees = 0;
    bool rdsOn = false;
    double rdsHertz = 2000;
    double rdsDegrees = 0;
    bool ariOn = false;
    double ariHertz = 3500;
    bool ariTypeOn = false;
    int ariType = 1;
    int ariArea = 1;

    // RDS
    std::string ps = "KDX-X4  ";
    std::string pi = "1000";  ///< four hexadecimal digits, in capitals
    int pty = 0;
    bool tp = false;
    bool ta = false;
    int musicSpeech = 1;
    int decoderInfo = 1;
    std::string radiotextNumbers = "0,0";  ///< the two numbers that came before the radiotext
    std::string radiotext;
    std::string groupSequence = "0A,2A";
    int testPattern = 0;  ///< 0: normal operation
    AfLists afLists;
    OtherNetworks otherNetworks;
};

/// Carrier and audio generator.
struct Generator {
    double rfMegahertz = 100;
    double levelDecibelMicrovolt = 60;
    bool outputOn = false;
    bool fmOn = false;
    bool amOn = false;
    double audioKilohertz = 1;
};

/// All settings of the instrument.
struct InstrumentSettings : Setup, Generator {};

}  // namespace kdx::sim
