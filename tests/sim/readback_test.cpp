#include <algorithm>
#include <array>
#include <ostream>
#include <vector>

#include "coder/sendparam.h"
#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "sim/simtest.h"
#include "sim/simvisa.h"
#include "support/tempfolder.h"

namespace kdx::sim {
namespace {

/// The program's own link, talking to the virtual instrument.
class ReadbackTest : public SimTest {
protected:
    void SetUp() override {
        ASSERT_EQ(library.viOpenDefaultRM(link.DefaultRm), visa::kSuccess);
        ASSERT_EQ(library.viOpen(link.DefaultRm, "TCPIP::simulated::INSTR", 0, 0, link.InstrSession), visa::kSuccess);
        state.InstrumentOnline = true;
        link.onFailure([this](const std::string& text, bool) {
            failures.push_back(text);
            return false;
        });
    }
    std::string networks() { return link.X4_Abfrage("EON-PI", "EON PI?"); }

    test::TempFolder folder;
    DataFolder data{folder.path()};
    ProgramState state;
    SimVisa library{instrument};
    std::vector<std::string> failures;
    Captions captions{data};
    Instrument link{library, state, data, captions, clock};
};

// Cuts the answer at its commas, as sending a data set does to remove what the coder holds.
std::vector<std::string> cutAtCommas(std::string answer) {
    std::vector<std::string> codes;
    for (std::size_t comma = answer.find(','); comma != std::string::npos; comma = answer.find(',')) {
        codes.push_back(answer.substr(comma < 4 ? 0 : comma - 4, std::min<std::size_t>(comma, 4)));
        answer.erase(0, comma + 1);
        if (answer.empty()) return codes;
    }
    codes.push_back(answer.front() == '"' ? answer.substr(1, 4) : answer.substr(0, 4));
    return codes;
}

struct NetworksCase {
    std::vector<std::string> networks;
    friend void PrintTo(const NetworksCase& c, std::ostream* out) { *out << c.networks.size() << " networks"; }
};

class HeldNetworks : public ReadbackTest, public ::testing::WithParamInterface<NetworksCase> {};

TEST_P(HeldNetworks, AreFoundByCuttingAtTheCommasAndByTakingCharactersTwoToFive) {
    for (const std::string& pi : GetParam().networks) link.Send2Gen(":STEREO:DIRECT \"EON-PI=" + pi + "\"");
    const std::string answer = networks();
    EXPECT_EQ(cutAtCommas(answer), GetParam().networks);
    EXPECT_EQ(answer.substr(1, 4), GetParam().networks.front());
}

TEST_P(HeldNetworks, AreAllGoneAfterEachOneFoundIsDeleted) {
    for (const std::string& pi : GetParam().networks) link.Send2Gen(":STEREO:DIRECT \"EON-PI=" + pi + "\"");
    for (const std::string& pi : cutAtCommas(networks())) link.Send2Gen(":STEREO:DIRECT \"EON-DEL=" + pi + "\"");
    EXPECT_EQ(networks(), " ");
    EXPECT_EQ(error(), 0);
    EXPECT_TRUE(failures.empty());
}

INSTANTIATE_TEST_SUITE_P(OneToEleven, HeldNetworks,
                         ::testing::Values(NetworksCase{{"D3C2"}}, NetworksCase{{"D3C2", "1234"}},
                                           NetworksCase{{"D3C2", "1234", "ABCD"}},
                                           NetworksCase{{"1001", "1002", "1003", "1004", "1005", "1006", "1007", "1008",
                                                         "1009", "100A", "100B"}}));

// Neither way of cutting finds anything that could be taken for a PI; the delete command that still goes out is
// refused by the coder and does no harm.
TEST_F(ReadbackTest, WithoutNetworksNothingIsFoundAndTheEmptyDeleteDoesNoHarm) {
    const std::string answer = networks();
    EXPECT_EQ(answer, " ");
    EXPECT_EQ(cutAtCommas(answer), std::vector<std::string>{" "});
    EXPECT_EQ(answer.substr(1, 4), "");
    link.Send2Gen(":STEREO:DIRECT \"EON-DEL= \"");
    link.Send2Gen(":STEREO:DIRECT \"EON-DEL=\"");
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(error(), 0);
    EXPECT_TRUE(failures.empty());
}

TEST_F(ReadbackTest, EveryQueryOfTheProgramGetsAnAnswer) {
    link.Send2Gen(":STEREO:DIRECT \"EON-PI=D3C2\"");
    constexpr std::array kQueries = {"ARI",
                                     "ARI-DEV",
                                     "ARI-ID",
                                     "BK",
                                     "AF1",
                                     "AF2",
                                     "AF3",
                                     "AF4",
                                     "AF5",
                                     "PS",
                                     "PI",
                                     "PTY",
                                     "RT",
                                     "CT",
                                     "MPX-DEV",
                                     "SRC",
                                     "PRE",
                                     "PIL",
                                     "PIL-DEV",
                                     "PIL-PH",
                                     "MODE",
                                     "RDS",
                                     "RDS-DEV",
                                     "GS",
                                     "IMP",
                                     "EON-PI",
                                     "EON-PS,D3C2",
                                     "EON-TP,D3C2",
                                     "EON-TA,D3C2",
                                     "EON-AFB,D3C2,1",
                                     "EON-AFB,D3C2,2",
                                     "EON-AFB,D3C2,3",
                                     "EON-AFB,D3C2,4",
                                     "EON-AFB,D3C2,5",
                                     "MS",
                                     "DI",
                                     "EON PI?"};
    for (const char* query : kQueries) {
        EXPECT_NE(link.X4_Abfrage("label", query), "") << query;
        EXPECT_EQ(error(), 0) << query;
    }
    EXPECT_EQ(link.VRN_Abfrage("Freq?", "FREQ"), "100");
    EXPECT_EQ(link.VRN_Abfrage("Pegel?", "POW"), "60");
    EXPECT_TRUE(failures.empty());
}

// What the dispatcher makes of every key, with a value as the controls give it.
TEST_F(ReadbackTest, EveryCommandOfTheDispatcherIsCarriedOutWithoutAnError) {
    const ParamContext context{"D3C2", "10:20:30", "11:22:33", "05.03.09"};
    const std::pair<const char*, const char*> kValues[] = {
        {"PS", "RADIO"},
        {"PI", "D3C2"},
        {"PTY", "7"},
        {"TP", "1"},
        {"TP", "0"},
        {"TA", "1"},
        {"MS", "S"},
        {"DI", "15"},
        {"RT", "Radiotext"},
        {"RTA", "Radiotext A"},
        {"DEL_RT", ""},
        {"UHR", ""},
        {"UHR", "off"},
        {"UHR", "AUS"},
        {"ZEIT", ""},
        {"RDS", "1"},
        {"RDS", "0"},
        {"RDS_HUB", "0350"},
        {"RDS_PHASE", "0"},
        {"AF1", "N,87.6,90.1"},
        {"AF2", "+,99.2,101.5"},
        {"AF3", "+,99.2,99.2,101.5"},
        {"AF4", "+,86.0"},
        {"AF5", "+,108.0"},
        {"GROUPSEQ", "0A,2A,8A"},
        {"GROUPSEQ_TN", "0A"},
        {"STORE", "3"},
        {"ODA", "01,106100CD46"},
        {"TMC", "02,0810013039"},
        {"TEST_M", "0"},
        {"TEST_D", "4"},
        {"EON_PI", "D3C2"},
        {"EON_PS", "OTHER"},
        {"EON_PTY", "9"},
        {"EON_TP", "1"},
        {"EON_TA", "1"},
        {"EON_AFA", "87.6,90.1"},
        {"EON_AFB1", "N,87.6,90.1"},
        {"EON_AFB2", "+,99.2"},
        {"EON_AFB3", "+,99.2"},
        {"EON_AFB4", "+,99.2"},
        {"EON_AFB5", "+,99.2"},
        {"EON_DEL", "D3C2"},
        {"MPX_HUB", "08000"},
        {"MPX_SOURCE", "0"},
        {"MPX_SOURCE", "1"},
        {"MPX_SOURCE", "2"},
        {"MPX_SOURCE", "3"},
        {"MPX_IMPEDANZ", "0"},
        {"MPX_IMPEDANZ", "1"},
        {"MPX_IMPEDANZ", "2"},
        {"STEREO_MODE", "0"},
        {"STEREO_MODE", "1"},
        {"STEREO_MODE", "2"},
        {"STEREO_MODE", "3"},
        {"STEREO_MODE", "4"},
        {"STEREO_MODE", "5"},
        {"PREEMPHASIS", "0"},
        {"PREEMPHASIS", "1"},
        {"PREEMPHASIS", "2"},
        {"PILOT", "0"},
        {"PILOT", "1"},
        {"PILOT_HUB", "1500"},
        {"PILOT_PHASE", "-4"},
        {"PILOT_PHASE", "05"},
        {"ARI", "0"},
        {"ARI", "1"},
        {"ARI-HUB", "0800"},
        {"ARI-ID", "0"},
        {"ARI-ID", "1"},
        {"ARI-ID", "2"},
        {"ARI-ID", "3"},
        {"ARI-BK", "F"},
        {"STEREO_EIN", ""},
        {"STEREO_AUS", ""},
        {"FM_EIN", ""},
        {"FM_AUS", ""},
        {"AM_AUS", ""},
        {"HF:PEGEL:STATE", "ON"},
        {"HF:PEGEL:STATE", "OFF"},
        {"HF-Frequenz", "98.5"},
        {"HF-Pegel", "0.1"},
        {"NF-Frequenz", "1"},
    };
    for (const auto& [key, given] : kValues) {
        std::string value = given;
        const auto command = composeCommand(key, value, context);
        ASSERT_TRUE(command.has_value()) << key;
        link.Send2Gen(*command);
        EXPECT_EQ(tell("SYST:ERR?"), "0,\"No error\"\n") << key << ": " << *command;
    }
    EXPECT_TRUE(failures.empty());
}

TEST_F(ReadbackTest, AnEmptyTextIsShownAsEmpty) {
    folder.write(kLanguageFile, "[test]\r\n144=empty\r\n");
    captions.load("test", "RDS");
    EXPECT_EQ(link.X4_Abfrage("RT?", "RT"), "RT: empty | ");
}

TEST_F(ReadbackTest, ValuesComeBackAsTheyWereSet) {
    link.Send2Gen(":STEREO:DIRECT \"PS=RADIO   \"");
    EXPECT_EQ(link.X4_Abfrage("PS?", "PS"), "RADIO   ");
    link.Send2Gen(":STEREO:PILOT:DEVIATION 6800HZ");
    EXPECT_EQ(link.X4_Abfrage("Pilot Hub?", "PIL-DEV"), "680");
    link.Send2Gen("FREQ 98.5MHZ");
    EXPECT_EQ(link.VRN_Abfrage("Freq?", "FREQ"), "98.5");
}

TEST_F(ReadbackTest, AQueryTheInstrumentDoesNotKnowFailsOnceAndTheNextOneWorks) {
    EXPECT_EQ(link.X4_Abfrage("?", "XYZ"), "");
    EXPECT_EQ(failures, std::vector<std::string>{"Fehler: -1073807339"});
    EXPECT_EQ(link.X4_Abfrage("PI?", "PI"), "1000");
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(error(), -420);
}

}  // namespace
}  // namespace kdx::sim
