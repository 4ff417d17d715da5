#include <gtest/gtest.h>

#include "window/everysetting.h"

namespace kdx::test {
namespace {

/// The values that a data set brings the instrument.
class WholeDataSet : public EverySetting {
protected:
    Lines values() {
        Lines values;
        for (const char* query :
             {":STEREO:AUDIO:PRE?", ":STEREO:AUDIO:PRE:STAT?", ":STEREO:PILOT:STATE?", ":STEREO:PILOT:DEV?",
              ":STEREO:PILOT:PHASE?", ":STEREO:ARI:STATE?", ":STEREO:RDS:STATE?", ":STEREO:RDS:DEV?",
              ":STEREO:RDS:TRAFFIC:PROGRAM?", "FREQ?", "POW?"}) {
            values.push_back(query + observer.ask(query));
        }
        for (const char* name :
             {"PI", "TA", "PS", "BIN", "MS", "RT", "AF1", "AF2", "AF3", "AF4", "AF5", "PTY", "EON-PI", "EON-TA,D3C4",
              "EON-TP,D3C4", "EON-PS,D3C4", "EON-AFB,D3C4,1", "EON-AFB,D3C4,5", "GS"}) {
            values.push_back(name + (" " + observer.askCoder(name)));
        }
        return values;
    }
};

TEST_F(WholeDataSet, BringsAnInstrumentThatWasResetBackToWhereItWas) {
    // Away from what the instrument has after a reset, and from what was stored.
    click("Pre_opt_2");
    scroll("Pilot_Hub_Scroll", 700);
    scroll("HScroll1", -3);
    click("Ari_OnOff");
    scroll("RDS_Hub_Scroll", 150);
    type("PI_T", "D3C2");
    click("Command3");
    click("Check1");
    click("TA_Check");
    type("PS_T", "ANDERES");
    click("PS_Taste");
    click("MS_opt_1");
    type("RT_Text1", "Anderer Text");
    click("RT_Taste1");
    select("PTY_Combo1", 3);
    type("EON_PI_Text", "D3C4");
    click("EON_PI_Taste");
    type("EON_PS_Text", "DRITTES");
    click("EON_PS_Taste");
    click("EON_TP_Check");
    click("EON_TP_Check");
    click("EON_AFB_Senden");
    click("Gruppe3");
    click("GS_Senden");
    const Lines before = values();
    observer.tell("*RST");
    EXPECT_NE(observer.askCoder("PS"), "ANDERES ");
    EXPECT_EQ(observer.errors(), kNoErrors);
    click("Btn_SetRdsStereo");
    EXPECT_EQ(values(), before);
    EXPECT_EQ(observer.errors(), kIllegalValue) << "the one delete without a network";
}

}  // namespace
}  // namespace kdx::test
