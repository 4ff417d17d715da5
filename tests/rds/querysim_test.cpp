// The read-back buttons against the virtual instrument: whatever the dispatcher sets is shown in words.
#include "rds/querypage.h"

#include <gmock/gmock.h>

#include <map>

#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/pagetest.h"

namespace kdx::test {
namespace {

const std::string kNoAnswer = "keine Antwort";

class QuerySimTest : public PageTest {
protected:
    QuerySimTest() {
        link.onFailure([this](const std::string& text, bool) {
            failures.push_back(text);
            return false;
        });
        page.label();
        EXPECT_EQ(library.viOpenDefaultRM(link.DefaultRm), visa::kSuccess);
        openSession();
    }
    ~QuerySimTest() override { EXPECT_TRUE(failures.empty()) << failures.front(); }
    QWidget& root() override { return page; }

    void openSession() {
        ASSERT_EQ(library.viOpen(link.DefaultRm, "GPIB0::28::INSTR", 0, 0, link.InstrSession), visa::kSuccess);
    }
    /// Sets a value as a control does.
    void set(const char* key, const std::string& value) { dispatcher.SendParam(key, std::string(value)); }
    /// Presses a button; what is shown then, as UTF-8.
    std::string read(const char* button) {
        click(button);
        return text("gelesen");
    }
    /// The oldest error the instrument has queued.
    std::string error() {
        const std::string answer = device.execute("SYST:ERR?");
        return answer.substr(0, answer.find('\n'));
    }
    void expectNoError() { EXPECT_EQ(error(), "0,\"No error\""); }

    sim::VirtualInstrument device{clock};
    sim::SimVisa library{device};
    Instrument link{library, state, data, captions, clock};
    ParamSender dispatcher{link, state, clock, [] {}};
    PageContext simulated{dispatcher, link, settings, state, statusRow, captions, dialogs, data, clock, tickers, marks};
    QueryPage page{simulated, nullptr};
};

TEST_F(QuerySimTest, EveryButtonShowsTheStateAfterSwitchingOn) {
    const std::map<const char*, std::string> shown = {
        {"Command1", "ARI aus\nARI Hub: 3500 Hz\naus\nA"},
        {"Command4", "AF1: AF1: leer | \nAF2: AF2: leer | \nAF3: AF3: leer | \nAF4: AF4: leer | \nAF5: AF5: leer | "},
        {"Command5", "KDX-X4  "},
        {"Command6", "1000"},
        {"Command7", "00"},
        {"Command8", "RT: leer | "},
        {"Command9", "off"},
        {"Command10", "100 MHz"},
        {"Command11", "FM Hub: 40000 Hz"},
        {"Command12", "Mod Quelle: 0"},
        {"Command13", "Aus"},
        {"Command14", "Pilot aus\nHub: 6750 Hz\nPhase: 0\xC2\xB0"},
        {"Command15", "3"},
        {"Command16", "RDS aus\nHub: 2000 Hz"},
        {"Command17", "0A,2A"},
        {"Command18", "Impedanz 600 "},
        {"Command20", "Musik"},
        {"Command21", "Stereo"},
        {"Command22", "60 dBm"},
    };
    for (const auto& [button, words] : shown) EXPECT_EQ(read(button), words) << button;
    expectNoError();
}

TEST_F(QuerySimTest, EveryDecoderInformationIsShownInWords) {
    const std::vector<std::string> words = {"Mono",
                                            "Stereo",
                                            "NN",
                                            "Stereo Kunstkopf",
                                            "Mono compressed",
                                            "Stereo compressed",
                                            "Stereo compressed Kunstkopf\"",
                                            "NN"};
    for (std::size_t i = 0; i < 16; ++i) {
        set("DI", std::to_string(i));
        EXPECT_EQ(read("Command21"), i < words.size() ? words[i] : kNoAnswer) << i;
    }
    expectNoError();
}

TEST_F(QuerySimTest, MusicSpeechAndEveryProgrammeTypeComeBack) {
    set("MS", "S");
    EXPECT_EQ(read("Command20"), "Sprache");
    set("MS", "M");
    EXPECT_EQ(read("Command20"), "Musik");
    for (int type = 0; type < 32; ++type) {
        set("PTY", std::to_string(type));
        EXPECT_EQ(read("Command7"), QStringLiteral("%1").arg(type, 2, 10, QLatin1Char('0')).toStdString());
    }
    expectNoError();
}

TEST_F(QuerySimTest, NameAndIdentificationComeBack) {
    set("PS", "M\xFCnchen");
    EXPECT_EQ(read("Command5"), "M\xC3\xBCnchen ");
    set("PI", "d3c2");
    EXPECT_EQ(read("Command6"), "D3C2");
    expectNoError();
}

TEST_F(QuerySimTest, TheTrafficFlagsAreTakenThoughNoButtonAsksForThem) {
    for (const char* key : {"TP", "TA"}) {
        for (const char* value : {"1", "0"}) set(key, value);
    }
    expectNoError();
}

TEST_F(QuerySimTest, PilotOnAndOffWithDeviationAndPhase) {
    set("PILOT", "1");
    set("PILOT_HUB", "0680");
    set("PILOT_PHASE", "-4");
    EXPECT_EQ(read("Command14"), "Pilot ein\nHub: 6800 Hz\nPhase: -4\xC2\xB0");
    set("PILOT", "0");
    set("PILOT_HUB", "0");
    EXPECT_EQ(read("Command14"), "Pilot aus\nHub: 0 Hz\nPhase: -4\xC2\xB0");
    expectNoError();
}

TEST_F(QuerySimTest, EveryAriTypeAndAreaComesBack) {
    set("ARI", "1");
    set("ARI-HUB", "0400");
    const std::vector<std::string> types = {"aus", "DK", "BK", "BK + DK"};
    for (std::size_t type = 0; type < types.size(); ++type) {
        set("ARI-ID", std::to_string(type));
        for (const char* area : {"A", "B", "C", "D", "E", "F"}) {
            set("ARI-BK", area);
            EXPECT_EQ(read("Command1"), "ARI ein\nARI Hub: 4000 Hz\n" + types[type] + "\n" + area);
        }
    }
    set("ARI", "0");
    EXPECT_EQ(read("Command1"), "ARI aus\nARI Hub: 4000 Hz\nBK + DK\nF");
    expectNoError();
}

TEST_F(QuerySimTest, SubcarrierAndMultiplexSettingsComeBack) {
    set("RDS", "1");
    set("RDS_HUB", "0350");
    EXPECT_EQ(read("Command16"), "RDS ein\nHub: 3500 Hz");
    set("MPX_HUB", "06750");
    EXPECT_EQ(read("Command11"), "FM Hub: 67500 Hz");
    for (const char* source : {"1", "2", "3", "0"}) {
        set("MPX_SOURCE", source);
        EXPECT_EQ(read("Command12"), std::string("Mod Quelle: ") + source);
    }
    set("MPX_IMPEDANZ", "2");
    EXPECT_EQ(read("Command18"), "Impedanz 100k ");
    set("MPX_IMPEDANZ", "1");
    EXPECT_EQ(read("Command18"), "Impedanz 600 ");
    for (const char* mode : {"1", "2", "3", "4", "5"}) {
        set("STEREO_MODE", mode);
        EXPECT_EQ(read("Command15"), mode);
    }
    const std::vector<std::string> preemphases = {"Aus", "50\xC2\xB5s", "75\xC2\xB5s"};
    for (std::size_t i = 0; i < preemphases.size(); ++i) {
        set("PREEMPHASIS", std::to_string(i));
        EXPECT_EQ(read("Command13"), preemphases[i]);
    }
    expectNoError();
}

TEST_F(QuerySimTest, FrequencyAndLevelComeBackWithTheirUnits) {
    set("HF-Frequenz", "98.5");
    set("HF-Pegel", "53.1");
    EXPECT_EQ(read("Command10"), "98.5 MHz");
    EXPECT_EQ(read("Command22"), "53.1 dBm");
    expectNoError();
}

TEST_F(QuerySimTest, RadiotextComesBackAndAnEmptyOneIsCalledEmpty) {
    set("RT", "News at ten");
    EXPECT_EQ(read("Command8"), "News at ten");
    set("RT", "   ");
    EXPECT_EQ(read("Command8"), "   ");
    set("DEL_RT", "");
    EXPECT_EQ(read("Command8"), "RT: leer | ");
    expectNoError();
}

TEST_F(QuerySimTest, TheClockComesBackWhileItRunsAndOffWhenSwitchedOff) {
    set("ZEIT", "");
    EXPECT_EQ(read("Command9"), "12:00:00,05.03.09");
    clock.set(13 * 3600 + 1.5);
    EXPECT_EQ(read("Command9"), "13:00:01,05.03.09");
    set("UHR", "AUS");
    EXPECT_EQ(read("Command9"), "off");
    expectNoError();
}

TEST_F(QuerySimTest, GroupSequenceComesBack) {
    set("GROUPSEQ", "0A,2A,4A,8A,14A");
    EXPECT_EQ(read("Command17"), "0A,2A,4A,8A,14A");
    expectNoError();
}

TEST_F(QuerySimTest, FiveShortListsComeBackOneALine) {
    set("AF1", "N,87.6,90.1");
    set("AF2", "+,99.2,101.5");
    set("AF3", "+,99.3");
    set("AF4", "+,99.4");
    EXPECT_EQ(read("Command4"), "AF1: 87.6,90.1\nAF2: 99.2,101.5\nAF3: 99.3\nAF4: 99.4\nAF5: AF5: leer | ");
    expectNoError();
}

/// 26 frequencies that begin with the tuned one: 129 characters or more.
std::string longList(int tuned) {
    std::string list = std::to_string(tuned) + ".5";
    for (int i = 0; i < 25; ++i) list += "," + std::to_string(88 + i % 10) + ".9";
    return list;
}

// A read takes 60 bytes, and what an answer has beyond them is the beginning of the next one. With lists of full length
// the answers fall behind the questions; a new session starts with nothing left over.
TEST_F(QuerySimTest, ListsLongerThanAReadAreCutAndReadOnByTheNextQuestion) {
    const std::string first = "\"" + longList(88) + "\"\n";
    for (int list = 0; list < 5; ++list) {
        set(("AF" + std::to_string(list + 1)).c_str(), (list == 0 ? "N," : "+,") + longList(88 + list));
    }
    ASSERT_GT(first.size(), 120U);
    ASSERT_LT(first.size(), 180U);
    const std::string third = first.substr(120, first.size() - 121);  // up to the line end
    const std::string second = "\"" + longList(89);
    EXPECT_EQ(read("Command4"), "AF1: " + first.substr(1, 58) + "\nAF2: " + first.substr(61, 58) +
                                    "\nAF3: " + third.substr(1, third.size() - 2) + "\nAF4: " + second.substr(1, 58) +
                                    "\nAF5: " + second.substr(61, 58));
    expectNoError();
    EXPECT_NE(read("Command6"), "1000");
    ASSERT_EQ(library.viClose(link.InstrSession), visa::kSuccess);
    openSession();
    EXPECT_EQ(read("Command6"), "1000");
}

class NetworksOfTheCoder : public QuerySimTest {
protected:
    void add(const char* pi, const char* ps, const char* tp, const char* ta) {
        state.eonIdentifier = pi;
        set("EON_PI", pi);
        set("EON_PS", ps);
        set("EON_TP", tp);
        set("EON_TA", ta);
    }
};

TEST_F(NetworksOfTheCoder, AreCalledEmptyWhenThereIsNone) {
    EXPECT_EQ(read("Command19"),
              "EON-PI:    / EON-PS:  EON-PS,: leer |  / EON-TP:  EON-TP,: leer |  / EON-TA:  EON-TA,: leer |  / "
              "\nEON-AFB1:  EON-AFB,,1: leer |  / \nEON-AFB2:  EON-AFB,,2: leer |  / "
              "\nEON-AFB3:  EON-AFB,,3: leer |  / \nEON-AFB4:  EON-AFB,,4: leer |  / "
              "\nEON-AFB5:  EON-AFB,,5: leer | ");
}

TEST_F(NetworksOfTheCoder, ShowTheirDataWithTheirLists) {
    add("D3C2", "OTHER", "1", "0");
    set("EON_AFB1", "N,87.6,90.1");
    set("EON_AFB2", "+,99.2,101.5");
    EXPECT_EQ(read("Command19"),
              "EON-PI:   D3C2, / EON-PS:  OTHER    / EON-TP:  1 / EON-TA:  0 / \nEON-AFB1:  87.6,90.1 / "
              "\nEON-AFB2:  99.2,101.5 / \nEON-AFB3:  EON-AFB,D3C2,3: leer |  / "
              "\nEON-AFB4:  EON-AFB,D3C2,4: leer |  / \nEON-AFB5:  EON-AFB,D3C2,5: leer | ");
    expectNoError();
}

TEST_F(NetworksOfTheCoder, AreAllNamedAndTheCurrentOneIsShown) {
    add("1001", "FIRST", "0", "0");
    add("1003", "THIRD", "0", "1");
    add("1002", "SECOND", "1", "1");
    EXPECT_THAT(
        read("Command19"),
        ::testing::StartsWith("EON-PI:   1001,1003,1002, / EON-PS:  SECOND   / EON-TP:  1 / EON-TA:  1 / \nEON-AFB1:"));
    state.eonIdentifier = "1003";
    EXPECT_THAT(
        read("Command19"),
        ::testing::StartsWith("EON-PI:   1001,1003,1002, / EON-PS:  THIRD    / EON-TP:  0 / EON-TA:  1 / \nEON-AFB1:"));
    expectNoError();
}

TEST_F(QuerySimTest, AnswersAreShownInTheWordsOfTheLanguage) {
    set("PILOT", "1");
    useLanguage("english");
    page.label();
    EXPECT_EQ(read("Command14"), "Pilot on\nDeviation: 6750 Hz\nPhase: 0\xC2\xB0");
    EXPECT_EQ(read("Command13"), captions.text(22));
    EXPECT_EQ(read("Command20"), "Music");
    EXPECT_EQ(read("Command8"), "RT: " + captions.text(144) + " | ");
}

}  // namespace
}  // namespace kdx::test
