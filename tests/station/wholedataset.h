#pragma once

#include "support/linkfixture.h"

namespace kdx::test {

// Settings and a data set in which everything has a value of its own, and the commands they are sent as.

inline constexpr const char* kWholeGeneral =
    "[BUS]\r\nINTERFACE=TCPIP\r\n[ADRESSEN]\r\nKDX_TCPIP=10.0.0.1\r\nLog_Key=1\r\n[Sprache]\r\nSprache=deutsch\r\n"
    "RDS_RBDS=RDS\r\n[FM]\r\nMPX_DEV=06750\r\nMPX_SOURCE=1\r\nMPX_IMPEDANZ=2\r\nStereo_Mode=2\r\nPREEMPHASIS=2\r\n"
    "PILOT=1\r\nPILOT_HUB=0675\r\nPILOT_PHASE=-4\r\nARI=0\r\nARI_HUB=0350\r\nARI_ID=3\r\nARI_BK=1\r\nRDS=1\r\n"
    "RDS_HUB=0205\r\nRDS_PHASE=0\r\n[RDS]\r\nTA_ON=10\r\nTA_REP=60\r\nPS_Dyn=2500\r\n";

inline constexpr const char* kWholeDataSet =
    "[RDS]\r\nPI=d3c\r\nPS=FUNK\r\nPTY=9\r\nMS=S\r\nDI=3\r\nRTA=Hallo\r\nRTB=Welt\r\nGR_FOLGE=0A,2A,8A,\r\nAF_LISTE="
    "2\r\n"
    "AF_LISTE1=87.6,90.1,94.3\r\nAF_LISTE2=88.0,99.9\r\nAF_LISTE3=\r\nAF_LISTE4=101.1\r\nAF_LISTE5=90.0,91.0\r\n"
    "EON_PI=D3C2\r\nEON_PS=RADIO 1\r\nEON_PTY=4\r\nEON_TP=1\r\nEON_TA=0\r\nEON_AFB=1\r\nEON_AFB1=87.6,90.1\r\n"
    "EON_AFB2=99.2,101.5\r\nEON_AFB3=\r\nEON_AFB4=\r\nEON_AFB5=\r\n"
    "[VRN]\r\nHF_Frequenz=98.5\r\nHF_Pegel=60\r\nNF_Frequenz=1\r\nFM_Ulim=65\r\nFM_Olim=110\r\nNF_Ulim=0\r\nNF_Olim="
    "15\r\n";

/// What the coder answers when it is asked for the other networks it holds: two, and a comma at the end.
inline constexpr const char* kTwoNetworks = "\" 1234,5678,\"\n";

inline const Lines kDataSetCommands = {
    ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us",
    ":stereo:pilot:state ON",
    ":STEREO:PILOT:DEVIATION 6750HZ",
    ":STEREO:PILOT:PHASE -4DEG",
    ":stereo:ari:state OFF",
    ":stereo:rds:state ON",
    ":STEREO:RDS:DEVIATION 2050HZ",
    direct("PI=d3c "),
    ":stereo:rds:traffic:program OFF",
    direct("TA=0"),
    direct("PS=FUNK    "),
    direct("BIN=0"),
    direct("MS=S"),
    direct("RT=10,0,Hallo"),
    direct("AF=N,87.6,90.1,94.3"),
    direct("AF=+,88.0,99.9"),
    direct("AF=+,101.1"),
    direct("AF=+,90.0,91.0"),
    direct("PTY=09"),
    coder("EON PI?"),
    direct("EON-DEL=1234"),
    direct("EON-DEL=5678"),
    direct("EON-PI=D3C2"),
    direct("EON-TA=D3C2,0"),
    direct("EON-TP=D3C2,1"),
    direct("EON-PS=D3C2,RADIO 1 "),
    direct("EON-AFB=D3C2,N,87.6,90.1"),
    direct("EON-AFB=D3C2,+,99.2,101.5"),
    direct("GS=0A,2A,8A"),
    "FREQ 98.5MHZ",
    ":POW 60DBUV",
};

/// The commands of an opening.
inline Lines openingCommands() {
    Lines commands = {
        "*IDN?",
        "AM:STAT OFF",
        "FM:STAT OFF",
        "STEREO:STAT ON",
        ":STEREO:DEVIATION 67500HZ",
        "STEREO:STAT ON;:stereo:source LREXT",
        "",  // the first impedance has the index 0, for which there is no command
    };
    commands.insert(commands.end(), kDataSetCommands.begin(), kDataSetCommands.end());
    commands.insert(commands.end(), {":OUTPUT:STAT ON", ":STEREO:AUDIO:FREQ 1KHZ"});
    return commands;
}

}  // namespace kdx::test
