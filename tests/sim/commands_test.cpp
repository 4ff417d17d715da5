#include <algorithm>
#include <cctype>
#include <ostream>

#include "base/codepage.h"
#include "sim/simtest.h"

namespace kdx::sim {
namespace {

std::string lowerCase(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(), [](unsigned char c) { return std::tolower(c); });
    return text;
}

/// A command of the program, a query for what it set, and the answer expected. `before` makes sure that the answer is
/// a different one until the command is carried out.
struct CommandCase {
    const char* name;
    const char* before;
    const char* command;
    const char* query;
    const char* answer;
    friend void PrintTo(const CommandCase& c, std::ostream* out) { *out << c.command; }
};

std::string nameOf(const ::testing::TestParamInfo<CommandCase>& test) {
    return test.param.name;
}

class EveryCommand : public SimTest, public ::testing::WithParamInterface<CommandCase> {
protected:
    // Settings are kept as they are told by a second instrument, one spelling each.
    void expectUnderstood(const std::string& command) {
        VirtualInstrument fresh(clock);
        fresh.execute(GetParam().before);
        const std::string query = GetParam().query;
        const std::string expected = std::string(GetParam().answer) + "\n";
        EXPECT_NE(fresh.execute(query), expected) << "the case would pass without the command";
        EXPECT_EQ(fresh.execute(command), "") << command;
        EXPECT_EQ(fresh.execute(query), expected) << command;
        EXPECT_EQ(fresh.execute("SYST:ERR?"), "0,\"No error\"\n") << command;
    }
};

TEST_P(EveryCommand, SetsWhatTheQueryAnswers) {
    expectUnderstood(GetParam().command);
}

TEST_P(EveryCommand, IsUnderstoodInAnyLetterCaseOfItsHeader) {
    const std::string command = GetParam().command;
    // A coder command keeps its text; everything in front of the quote may change.
    const std::string head = command.substr(0, command.find('"'));
    const std::string rest = command.substr(head.size());
    expectUnderstood(lowerCase(head) + rest);
    expectUnderstood(upperCase(head) + rest);
}

TEST_P(EveryCommand, IsUnderstoodWithAndWithoutTheLeadingColonAndALineEnd) {
    const std::string command = GetParam().command;
    const std::string bare = command.front() == ':' ? command.substr(1) : command;
    expectUnderstood(bare);
    expectUnderstood(":" + bare);
    expectUnderstood(bare + "\n");
    expectUnderstood(" " + bare + " \r\n");
}

TEST_P(EveryCommand, IsUnderstoodBetweenOthersOfOneMessage) {
    const std::string command = GetParam().command;
    expectUnderstood("*CLS;" + command + ";*OPC");
}

constexpr const char* kPs = ":STEREO:DIRECT? \"PS\"";
constexpr const char* kNetwork = ":STEREO:DIRECT \"EON-PI=D3C2\"";

INSTANTIATE_TEST_SUITE_P(
    Rds, EveryCommand,
    ::testing::Values(
        CommandCase{"PS", "", R"(:STEREO:DIRECT "PS=RADIO   ")", kPs, R"("RADIO   ")"},
        CommandCase{"PI", "", R"(:STEREO:DIRECT "PI=D3C2")", R"(:STEREO:DIRECT? "PI")", R"("D3C2")"},
        CommandCase{"PTY", "", R"(:STEREO:DIRECT "PTY=07")", R"(:STEREO:DIRECT? "PTY")", R"("07")"},
        CommandCase{"TpOn", "", ":stereo:rds:traffic:program ON", R"(:STEREO:DIRECT? "TP")", R"("1")"},
        CommandCase{"TpOff", ":stereo:rds:traffic:program ON", ":stereo:rds:traffic:program OFF",
                    R"(:STEREO:DIRECT? "TP")", R"("0")"},
        CommandCase{"TA", "", R"(:STEREO:DIRECT "TA=1")", R"(:STEREO:DIRECT? "TA")", R"("1")"},
        CommandCase{"MS", "", R"(:STEREO:DIRECT "MS=S")", R"(:STEREO:DIRECT? "MS")", R"("S")"},
        CommandCase{"DI", "", R"(:STEREO:DIRECT "DI=15")", R"(:STEREO:DIRECT? "DI")", R"("15")"},
        CommandCase{"RT", "", R"(:STEREO:DIRECT "RT=10,0,News; sport, weather")", R"(:STEREO:DIRECT? "RT")",
                    R"("News; sport, weather")"},
        CommandCase{"RTA", "", R"(:STEREO:DIRECT "RT=5,1,Text A")", R"(:STEREO:DIRECT? "RT-N")", R"("5,1")"},
        CommandCase{"DelRt", R"(:STEREO:DIRECT "RT=10,0,News")", R"(:STEREO:DIRECT "RT=0,0,")",
                    R"(:STEREO:DIRECT? "RT")", R"("")"},
        CommandCase{"Uhr", "", R"(:STEREO:DIRECT "CT=23:59:58,31.12.09")", R"(:STEREO:DIRECT? "CT")",
                    R"("23:59:58,31.12.09")"},
        CommandCase{"UhrOff", R"(:STEREO:DIRECT "CT=23:59:58,31.12.09")", R"(:STEREO:DIRECT "CT=off")",
                    R"(:STEREO:DIRECT? "CT")", R"("off")"},
        CommandCase{"RdsOn", "", ":stereo:rds:state ON", R"(:STEREO:DIRECT? "RDS")", R"("1")"},
        CommandCase{"RdsOff", ":stereo:rds:state ON", ":stereo:rds:state OFF", R"(:STEREO:DIRECT? "RDS")", R"("0")"},
        CommandCase{"RdsDeviation", "", ":STEREO:RDS:DEVIATION 3500HZ", R"(:STEREO:DIRECT? "RDS-DEV")", R"("350")"},
        CommandCase{"RdsPhase", "", R"(:STEREO:DIRECT "RDS-PH=90")", R"(:STEREO:DIRECT? "RDS-PH")", R"("90")"},
        CommandCase{"Af1", "", R"(:STEREO:DIRECT "AF=N,87.6,90.1,94.3")", R"(:STEREO:DIRECT? "AF1")",
                    R"("87.6,90.1,94.3")"},
        CommandCase{"Af2", R"(:STEREO:DIRECT "AF=N,87.6,90.1,94.3")", R"(:STEREO:DIRECT "AF=+,99.2,101.5")",
                    R"(:STEREO:DIRECT? "AF2")", R"("99.2,101.5")"},
        CommandCase{"GroupSeq", "", R"(:STEREO:DIRECT "GS=0A,2A,8A")", R"(:STEREO:DIRECT? "GS")", R"("0A,2A,8A")"},
        CommandCase{"Store", "", R"(:STEREO:DIRECT "STORE=3")", R"(:STEREO:DIRECT? "STORE")", R"("3")"},
        CommandCase{"Recall", ":STEREO:DIRECT \"STORE=1\";:STEREO:DIRECT \"PS=OTHER   \"", R"(:STEREO:DIRECT "DS=1")",
                    kPs, R"("KDX-X4  ")"},
        CommandCase{"Oda", "", R"(:STEREO:DIRECT "3A=01,106100CD46")", R"(:STEREO:DIRECT? "3A")", R"("01,106100CD46")"},
        CommandCase{"Tmc", "", R"(:STEREO:DIRECT "8A=02,0810013039")", R"(:STEREO:DIRECT? "8A")", R"("02,0810013039")"},
        CommandCase{"Test", "", R"(:STEREO:DIRECT "BIN=4")", R"(:STEREO:DIRECT? "BIN")", R"("4")"},
        CommandCase{"TestOff", R"(:STEREO:DIRECT "BIN=4")", R"(:STEREO:DIRECT "BIN=0")", R"(:STEREO:DIRECT? "BIN")",
                    R"("0")"}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    OtherNetworks, EveryCommand,
    ::testing::Values(
        CommandCase{"Pi", "", kNetwork, R"(:STEREO:DIRECT? "EON-PI")", R"(" D3C2,")"},
        CommandCase{"Ps", kNetwork, R"(:STEREO:DIRECT "EON-PS=D3C2,RADIO 1 ")", R"(:STEREO:DIRECT? "EON-PS,D3C2")",
                    R"("RADIO 1 ")"},
        CommandCase{"Pty", kNetwork, R"(:STEREO:DIRECT "EON-PTY=D3C2,9")", R"(:STEREO:DIRECT? "EON-PTY,D3C2")",
                    R"("09")"},
        CommandCase{"Tp", kNetwork, R"(:STEREO:DIRECT "EON-TP=D3C2,1")", R"(:STEREO:DIRECT? "EON-TP,D3C2")", R"("1")"},
        CommandCase{"Ta", kNetwork, R"(:STEREO:DIRECT "EON-TA=D3C2,1")", R"(:STEREO:DIRECT? "EON-TA,D3C2")", R"("1")"},
        CommandCase{"Afa", kNetwork, R"(:STEREO:DIRECT "EON-AFA=D3C2,87.6,90.1")", R"(:STEREO:DIRECT? "EON-AFA,D3C2")",
                    R"("87.6,90.1")"},
        CommandCase{"Afb1", kNetwork, R"(:STEREO:DIRECT "EON-AFB=D3C2,N,87.6,90.1")",
                    R"(:STEREO:DIRECT? "EON-AFB,D3C2,1")", R"("87.6,90.1")"},
        CommandCase{"Afb2", ":STEREO:DIRECT \"EON-PI=D3C2\";:STEREO:DIRECT \"EON-AFB=D3C2,N,87.6\"",
                    R"(:STEREO:DIRECT "EON-AFB=D3C2,+,99.2,101.5")", R"(:STEREO:DIRECT? "EON-AFB,D3C2,2")",
                    R"("99.2,101.5")"},
        CommandCase{"Del", kNetwork, R"(:STEREO:DIRECT "EON-DEL=D3C2")", R"(:STEREO:DIRECT? "EON PI?")", R"(" ")"}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    Stereo, EveryCommand,
    ::testing::Values(
        CommandCase{"MpxDeviation", "", ":STEREO:DEVIATION 6750HZ", R"(:STEREO:DIRECT? "MPX-DEV")", R"("675")"},
        CommandCase{"MpxDeviationShort", "", ":STEREO:DEVIATION 675HZ", R"(:STEREO:DIRECT? "MPX-DEV")", R"("67.5")"},
        CommandCase{"SourceOff", "STEREO:STAT ON", "STEREO:STAT OFF", R"(:STEREO:DIRECT? "SRC")", R"("0")"},
        CommandCase{"SourceLr", "", "STEREO:STAT ON;:stereo:source LREXT", R"(:STEREO:DIRECT? "SRC")", R"("1")"},
        CommandCase{"SourceSp", "", "STEREO:STAT ON;:stereo:source SPEXT", R"(:STEREO:DIRECT? "SRC")", R"("2")"},
        CommandCase{"SourceLf", "", "STEREO:STAT ON;:stereo:source LFGEN", R"(:STEREO:DIRECT? "SRC")", R"("3")"},
        CommandCase{"Impedance600", ":STEREO:EXTERNAL:IMP 100000", ":STEREO:EXTERNAL:IMP 600",
                    R"(:STEREO:DIRECT? "IMP")", R"("1")"},
        CommandCase{"Impedance100k", "", ":STEREO:EXTERNAL:IMP 100000", R"(:STEREO:DIRECT? "IMP")", R"("2")"},
        CommandCase{"ModeLeft", "", ":stereo:audio:mode LEFT", R"(:STEREO:DIRECT? "MODE")", R"("1")"},
        CommandCase{"ModeRight", "", ":stereo:audio:mode RIGHT", R"(:STEREO:DIRECT? "MODE")", R"("2")"},
        CommandCase{"ModeRel", ":stereo:audio:mode LEFT", ":stereo:audio:mode REL", R"(:STEREO:DIRECT? "MODE")",
                    R"("3")"},
        CommandCase{"ModeReml", "", ":stereo:audio:mode REML", R"(:STEREO:DIRECT? "MODE")", R"("4")"},
        CommandCase{"ModeRnel", "", ":stereo:audio:mode RNEL", R"(:STEREO:DIRECT? "MODE")", R"("5")"},
        CommandCase{"PreemphasisOff", ":stereo:audio:preemphasis:state ON", ":stereo:audio:preemphasis:state OFF",
                    R"(:STEREO:DIRECT? "PRE")", R"("0")"},
        CommandCase{"Preemphasis50", "", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 50us",
                    R"(:STEREO:DIRECT? "PRE")", R"("1")"},
        CommandCase{"Preemphasis75", "", ":stereo:audio:preemphasis:state ON;:stereo:audio:preemphasis 75us",
                    R"(:STEREO:DIRECT? "PRE")", R"("2")"},
        CommandCase{"PilotOn", "", ":stereo:pilot:state ON", R"(:STEREO:DIRECT? "PIL")", R"("1")"},
        CommandCase{"PilotOff", ":stereo:pilot:state ON", ":stereo:pilot:state OFF", R"(:STEREO:DIRECT? "PIL")",
                    R"("0")"},
        CommandCase{"PilotDeviation", "", ":STEREO:PILOT:DEVIATION 7000HZ", R"(:STEREO:DIRECT? "PIL-DEV")", R"("700")"},
        CommandCase{"PilotPhaseNegative", "", ":STEREO:PILOT:PHASE -4DEG", R"(:STEREO:DIRECT? "PIL-PH")", R"("-4")"},
        CommandCase{"PilotPhasePadded", "", ":STEREO:PILOT:PHASE 02DEG", R"(:STEREO:DIRECT? "PIL-PH")", R"("2")"},
        CommandCase{"AriOn", "", ":stereo:ari:state ON", R"(:STEREO:DIRECT? "ARI")", R"("1")"},
        CommandCase{"AriOff", ":stereo:ari:state ON", ":stereo:ari:state OFF", R"(:STEREO:DIRECT? "ARI")", R"("0")"},
        CommandCase{"AriDeviation", "", ":stereo:ari:deviation 4000HZ", R"(:STEREO:DIRECT? "ARI-DEV")", R"("400")"},
        CommandCase{"AriIdOff", ":stereo:ari:type:state ON", ":stereo:ari:type:state OFF",
                    R"(:STEREO:DIRECT? "ARI-ID")", R"("0")"},
        CommandCase{"AriIdDk", "", ":stereo:ari:type:state ON;:stereo:ari:type DK", R"(:STEREO:DIRECT? "ARI-ID")",
                    R"("1")"},
        CommandCase{"AriIdBk", "", ":stereo:ari:type:state ON;:stereo:ari:type BK", R"(:STEREO:DIRECT? "ARI-ID")",
                    R"("2")"},
        CommandCase{"AriIdBkDk", "", ":stereo:ari:type:state ON;:stereo:ari:type BKDK", R"(:STEREO:DIRECT? "ARI-ID")",
                    R"("3")"},
        CommandCase{"AriBk", "", ":stereo:ari:bk D", R"(:STEREO:DIRECT? "BK")", R"("D")"},
        CommandCase{"StereoOn", "", "STEREO:STAT ON", ":STEREO:STATE?", "1"},
        CommandCase{"StereoOff", "STEREO:STAT ON", "STEREO:STAT OFF", ":STEREO:STATE?", "0"}),
    nameOf);

INSTANTIATE_TEST_SUITE_P(
    Generator, EveryCommand,
    ::testing::Values(CommandCase{"FmOn", "", "FM:STAT ON", "FM:STAT?", "1"},
                      CommandCase{"FmOff", "FM:STAT ON", "FM:STAT OFF", "FM:STAT?", "0"},
                      CommandCase{"AmOff", "AM:STAT ON", "AM:STAT OFF", "AM:STAT?", "0"},
                      CommandCase{"OutputOn", "", ":OUTPUT:STAT ON", "OUTPUT:STAT?", "1"},
                      CommandCase{"OutputOff", ":OUTP:STAT 1", ":OUTPUT:STAT OFF", "OUTPUT:STAT?", "0"},
                      CommandCase{"Frequency", "", "FREQ 98.5MHZ", "FREQ?", "98.5"},
                      CommandCase{"Level", "", ":POW 67.5DBUV", "POW?", "67.5"},
                      CommandCase{"Audio", "", ":STEREO:AUDIO:FREQ 15KHZ", ":STEREO:AUDIO:FREQ?", "15"}),
    nameOf);

/// The coder's own short form of a setting and what the generator then answers to the same setting's query.
struct ShortFormCase {
    const char* command;
    const char* query;
    const char* answer;
    friend void PrintTo(const ShortFormCase& c, std::ostream* out) { *out << c.command; }
};

class ShortForm : public SimTest, public ::testing::WithParamInterface<ShortFormCase> {};

TEST_P(ShortForm, IsTheSameSettingAsTheGeneratorsOwn) {
    EXPECT_NE(ask(GetParam().query), GetParam().answer);
    coder(GetParam().command);
    EXPECT_EQ(ask(GetParam().query), GetParam().answer);
    EXPECT_EQ(error(), 0);
}

INSTANTIATE_TEST_SUITE_P(
    Coder, ShortForm,
    ::testing::Values(ShortFormCase{"TP=1", ":STEREO:RDS:TRAFFIC:PROGRAM?", "1"},
                      ShortFormCase{"RDS=1", ":STEREO:RDS:STATE?", "1"},
                      ShortFormCase{"RDS-DEV=350", ":STEREO:RDS:DEVIATION?", "3500"},
                      ShortFormCase{"RDS-PH=90", ":STEREO:RDS:PHASE?", "90"},
                      ShortFormCase{"MPX-DEV=675", ":STEREO:DEVIATION?", "6750"},
                      ShortFormCase{"SRC=2", ":STEREO:SOURCE?;STATE?", "SPEXT;1"},
                      ShortFormCase{"IMP=2", ":STEREO:EXTERNAL:IMPEDANCE?", "100000"},
                      ShortFormCase{"MODE=5", ":STEREO:AUDIO:MODE?", "RNEL"},
                      ShortFormCase{"PRE=2", ":STEREO:AUDIO:PREEMPHASIS?;PREEMPHASIS:STATE?", "75US;1"},
                      ShortFormCase{"PIL=1", ":STEREO:PILOT:STATE?", "1"},
                      ShortFormCase{"PIL-DEV=700", ":STEREO:PILOT:DEVIATION?", "7000"},
                      ShortFormCase{"PIL-PH=-4", ":STEREO:PILOT:PHASE?", "-4"},
                      ShortFormCase{"ARI=1", ":STEREO:ARI:STATE?", "1"},
                      ShortFormCase{"ARI-DEV=400", ":STEREO:ARI:DEVIATION?", "4000"},
                      ShortFormCase{"ARI-ID=3", ":STEREO:ARI:TYPE?;TYPE:STATE?", "BKDK;1"},
                      ShortFormCase{"BK=F", ":STEREO:ARI:BK?", "F"}, ShortFormCase{"bk=c", ":STEREO:ARI:BK?", "C"}));

}  // namespace
}  // namespace kdx::sim
