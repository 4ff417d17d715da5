#include <gtest/gtest.h>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

/// A data folder in which everything has a value, none of them the shipped one or a default.
class OpeningTest : public WindowTest {
protected:
    OpeningTest() {
        folder.copyShipped();
        folder.write(kGeneralSettings,
                     "[BUS]\r\nINTERFACE=TCPIP\r\nIECBUS=AUTO\r\n"
                     "[ADRESSEN]\r\nKDX_IEEE=17\r\nKDX_TCPIP=10.1.2.3\r\nLog_Key=0\r\n"
                     "[Sprache]\r\nSprache=english\r\nRDS_RBDS=RBDS\r\n"
                     "[FM]\r\nMPX_DEV=06780\r\nMPX_SOURCE=2\r\nMPX_IMPEDANZ=2\r\nStereo_Mode=4\r\nPREEMPHASIS=2\r\n"
                     "PILOT=1\r\nPILOT_HUB=0705\r\nPILOT_PHASE=-4\r\nARI=1\r\nARI_HUB=0345\r\nARI_ID=3\r\nARI_BK=2\r\n"
                     "RDS=1\r\nRDS_HUB=0210\r\nRDS_PHASE=7\r\n"
                     "[RDS]\r\nTA_ON=7\r\nTA_REP=70\r\nPS_Dyn=3000\r\n");
        folder.write("Datenset1.INI",
                     "[RDS]\r\nPI=d3c2\r\nPS=Funk\r\nPTY=7\r\nMS=S\r\nDI=5\r\nRTA=Hallo, Welt\r\nRTB=zwei\r\n"
                     "GR_FOLGE=0A,2A,15A,\r\nAF_LISTE=2\r\nAF_LISTE1=87.6,90.1,94.3\r\nAF_LISTE2=99.2,101.5\r\n"
                     "AF_LISTE3=88\r\nAF_LISTE4=89.1,90.123\r\nAF_LISTE5=90,91,92\r\n"
                     "EON_PI=D3C4\r\nEON_PS=Andere\r\nEON_PTY=9\r\nEON_TP=1\r\nEON_TA=1\r\nEON_AFB=3\r\n"
                     "EON_AFB1=91.7,104.2\r\nEON_AFB2=93.6\r\nEON_AFB3=96.3,97\r\nEON_AFB4=100.4,88.8\r\n"
                     "EON_AFB5=106.5,87.7\r\nEON_DEL=1111\r\nTMC=01,106100CD46\r\n"
                     "[VRN]\r\nHF_Frequenz=97.25\r\nHF_Pegel=66.5\r\nNF_Frequenz=0.4\r\n"
                     "FM_Ulim=65\r\nFM_Olim=110\r\nNF_Ulim=0.01\r\nNF_Olim=15.1\r\n");
        visa.answersTo[":STEREO:DIRECT? \"EON PI?\""] = "\"1234,5678\"\n";
        clock.set(100);  // early enough in the day that single precision holds a pause of 50 ms exactly
    }
    static std::string direct(const std::string& command) { return ":STEREO:DIRECT \"" + command + "\""; }
};

TEST_F(OpeningTest, SendsTheWholeDataSetInItsOrderToTheLastByte) {
    start();
    EXPECT_EQ(visa.calls.back(), "viOpen TCPIP::10.1.2.3::INSTR 0 0");
    const Lines all = sent();
    EXPECT_EQ(all, (Lines{"*IDN?",
                          "AM:STAT OFF",
                          "FM:STAT OFF",
                          "STEREO:STAT ON",
                          ":STEREO:DEVIATION 67800HZ",
                          "STEREO:STAT ON;:stereo:source SPEXT",
                          "",  // the first impedance, which has no command
                          ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us",
                          ":stereo:pilot:state ON",
                          ":STEREO:PILOT:DEVIATION 7050HZ",
                          ":STEREO:PILOT:PHASE -4DEG",
                          ":stereo:ari:state ON",
                          ":stereo:rds:state ON",
                          ":STEREO:RDS:DEVIATION 2100HZ",
                          direct("PI=d3c2"),
                          ":stereo:rds:traffic:program OFF",
                          direct("TA=0"),
                          direct("PS=Funk    "),
                          direct("BIN=0"),
                          direct("MS=S"),
                          direct("RT=10,0,Hallo, Welt"),
                          direct("AF=N,87.6,90.1,94.3"),
                          direct("AF=+,99.2,101.5"),
                          direct("AF=+,88"),
                          direct("AF=+,89.1,90.123"),
                          direct("AF=+,90,91,92"),
                          direct("PTY=07"),
                          ":STEREO:DIRECT? \"EON PI?\"",
                          direct("EON-DEL=1234"),
                          direct("EON-DEL=5678"),
                          direct("EON-PI=D3C4"),
                          direct("EON-TA=D3C4,1"),
                          direct("EON-TP=D3C4,1"),
                          direct("EON-PS=D3C4,Andere  "),
                          direct("EON-AFB=D3C4,N,91.7,104.2"),
                          direct("EON-AFB=D3C4,+,93.6"),
                          direct("EON-AFB=D3C4,+,96.3,97"),
                          direct("EON-AFB=D3C4,+,100.4,88.8"),
                          direct("EON-AFB=D3C4,+,106.5,87.7"),
                          direct("GS=0A,2A,15A"),
                          "FREQ 97.25MHZ",
                          ":POW 66.5DBUV",
                          ":OUTPUT:STAT ON",
                          ":STEREO:AUDIO:FREQ 0.4KHZ"}));
    // One pause before each command and one for the answer to the question; none for the identification.
    EXPECT_NEAR(clock.sleptMs(), 50.0 * static_cast<double>(all.size() - 1), 1.0);
    EXPECT_EQ(text("Input_HF_Freq_Label"), "97.25");
    EXPECT_EQ(text("Status_17"), "97.25");
    EXPECT_EQ(text("Input_HF_Pegel_Label"), "66.5");
    EXPECT_EQ(text("Status_13"), "66.5");
    EXPECT_EQ(text("Input_AF_Freq_Label"), "0.4");
    EXPECT_EQ(text("Status_14"), "0.4");
}

TEST_F(OpeningTest, SendsTheSameFromTheButtonThatSendsEverything) {
    start();
    const Lines opening = sent();
    click("Btn_SetRdsStereo");
    // Without the identification, the base state and the impedance before it, the output and the audio frequency after.
    EXPECT_EQ(sent(), Lines(opening.begin() + 7, opening.end() - 2));
}

}  // namespace
}  // namespace kdx::test
