#include <gtest/gtest.h>

#include "link/lanvisa.h"
#include "support/loopbackport.h"
#include "support/rawrecord.h"
#include "support/scriptedvxi11.h"
#include "support/windowtest.h"

namespace kdx::test {
namespace {

using std::chrono::steady_clock;
using namespace std::chrono_literals;

/// The whole window on a device of the network that behaves as told, through the program's own LAN client.
class LanSessionTest : public WindowTest {
protected:
    LanSessionTest() {
        folder.copyShipped();
        setGeneral("BUS", "INTERFACE", "TCPIP");
    }

    ~LanSessionTest() override { end(); }

    void startOn(std::uint16_t port, const char* host = "127.0.0.1") {
        setGeneral("ADRESSEN", "KDX_TCPIP", host);
        end();
        link = std::make_unique<LanVisa>(LanOptions{.connectTimeout = 400ms,
                                                    .ioTimeout = 400ms,
                                                    .answerMargin = 200ms,
                                                    .closeTimeout = 400ms,
                                                    .portMapperPort = port});
        start();
    }
    /// Opens the session, in which the device is asked for its name and for the networks that it knows.
    void openOn(const std::string& identification = "KDX,TEST\n") {
        ++links;
        device.answer(identification, links);
        device.answer("\" \"\n", links);
        openSession();
    }
    std::string readBackWith(const std::string& bytes) {
        device.answer(bytes, links);
        click("Command5");
        return text("gelesen");
    }
    std::string lastBox() const { return dialogs.shown.empty() ? "" : dialogs.shown.back().text.toStdString(); }
    Visa& instrumentLink() override { return *link; }

    ScriptedVxi11 device;
    long links = 0;
    std::unique_ptr<LanVisa> link;
};

TEST_F(LanSessionTest, OpensSendsAndReadsBack) {
    startOn(device.port());
    openOn();
    EXPECT_EQ(window->windowTitle().trimmed(), QStringLiteral("KDX,TEST"));
    EXPECT_NE(readBackWith("\"MESSTURM\"\n").find("MESSTURM"), std::string::npos);
    click("GTL_Taste");
    EXPECT_EQ(device.destroyed().size(), 1U);
}

TEST_F(LanSessionTest, TheEndOfTheProgramLetsTheDeviceGo) {
    startOn(device.port());
    openOn();
    end();
    EXPECT_EQ(device.destroyed().size(), 1U);
}

TEST_F(LanSessionTest, ADeviceThatNoLongerAnswersHoldsTheEndUpForHalfASecondAtMost) {
    startOn(device.port());
    link = std::make_unique<LanVisa>(LanOptions{.portMapperPort = device.port()});  // the program's own times
    start();
    openOn();
    device.on(ScriptedVxi11::kDestroyLink, {.kind = Reaction::Kind::Silence});
    const auto begin = steady_clock::now();
    end();
    EXPECT_LT(steady_clock::now() - begin, 900ms);
}

class UnreachableInstrument : public LanSessionTest {
protected:
    void expectNotFound(const char* status) {
        dialogs.expectedMessages = 1;
        const auto begin = steady_clock::now();
        openSession();
        EXPECT_LT(steady_clock::now() - begin, 3s);
        EXPECT_EQ(lastBox(), std::string("Please Check Device! ") + status);
        EXPECT_EQ(dialogs.shown.back().title, QStringLiteral("Interface Error"));
        EXPECT_FALSE(state.InstrumentOnline);
        EXPECT_TRUE(find("INIT_Taste")->isEnabled());
        // The address can be mended and tried again.
        dialogs.inputs = {QStringLiteral("127.0.0.1")};
        find("Adr1_Label")->setFocus();
        press("Adr1_Label", Qt::Key_Space);
        EXPECT_EQ(general("ADRESSEN", "KDX_TCPIP"), "127.0.0.1");
    }
};

TEST_F(UnreachableInstrument, AnUnknownHostIsTold) {
    startOn(device.port(), "no-such-host.invalid");
    expectNotFound("-1073807343");
    openOn();
    EXPECT_TRUE(state.InstrumentOnline);
}

TEST_F(UnreachableInstrument, AnAddressThatCannotBeReadIsTold) {
    startOn(device.port(), "::");
    expectNotFound("-1073807342");
}

TEST_F(UnreachableInstrument, AHostWithoutAnInstrumentIsTold) {
    startOn(closedPort());
    expectNotFound("-1073807343");
}

TEST_F(UnreachableInstrument, AHostThatTakesNoConnectionIsGivenUp) {
    const DeafPort deaf;
    startOn(deaf.port());
    expectNotFound("-1073807343");
}

TEST_F(UnreachableInstrument, AHostThatKeepsSilentIsGivenUp) {
    device.on(ScriptedVxi11::kGetPort, {.kind = Reaction::Kind::Silence});
    startOn(device.port());
    expectNotFound("-1073807339");
}

TEST_F(UnreachableInstrument, GpibWithoutALibraryIsTold) {
    setGeneral("BUS", "INTERFACE", "IEC");
    startOn(device.port());
    dialogs.expectedMessages = 1;
    openSession();
    EXPECT_EQ(lastBox(), "Please Check Device! -1073807202");
}

TEST_F(LanSessionTest, ADeviceThatNeverAnswersIsToldAndTheWindowGoesOn) {
    startOn(device.port());
    openOn();
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Silence});
    dialogs.expectedMessages = 1;
    const auto begin = steady_clock::now();
    click("Command5");
    EXPECT_LT(steady_clock::now() - begin, 3s);
    EXPECT_EQ(lastBox(), "Fehler: -1073807339");
    EXPECT_NE(readBackWith("\"MESSTURM\"\n").find("MESSTURM"), std::string::npos);
}

TEST_F(LanSessionTest, ALostConnectionIsToldAndTheSessionCanBeOpenedAgain) {
    startOn(device.port());
    openOn();
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::Close});
    dialogs.expectedMessages = 1;
    type("PS_T", "ANDERES");
    click("PS_Taste");
    EXPECT_EQ(lastBox(), "Fehler: -1073807194");
    EXPECT_EQ(data.ReadIni("RDS", "PS", dataSetFile("1")), "ANDERES");  // typed is typed
    click("GTL_Taste");
    openOn();
    EXPECT_EQ(device.opened().size(), 2U);
    EXPECT_NE(readBackWith("\"MESSTURM\"\n").find("MESSTURM"), std::string::npos);
}

constexpr const char* kTimeout = "-1073807339";
constexpr const char* kError = "-1073807298";

/// What a device sends that does not want the program to get on.
struct Lie {
    const char* name;
    Reaction reaction;
    const char* statusOfRead;
    const char* statusOfOpening;
    friend void PrintTo(const Lie& lie, std::ostream* out) { *out << lie.name; }
};

class LyingInstrument : public LanSessionTest, public ::testing::WithParamInterface<Lie> {
protected:
    LyingInstrument() { startOn(liar->port()); }

    static void behave(ScriptedVxi11& honest) {
        honest.answer("KDX,TEST\n");
        honest.answer("\" \"\n");
    }
    void expectBoxInTime(const char* button, std::uint32_t procedure, const std::string& words) {
        for (int i = 0; i < 5; ++i) liar->on(procedure, GetParam().reaction);
        dialogs.expectedMessages = 1;
        const auto begin = steady_clock::now();
        click(button);
        EXPECT_LT(steady_clock::now() - begin, 1800ms);  // connect, I/O and close time-outs are 400, 600 and 400 ms
        EXPECT_EQ(lastBox(), words);
    }
    /// A device that keeps to the rules, at the same address.
    void expectThatAnHonestOneIsOpened() {
        const std::uint16_t port = liar->port();
        liar.reset();
        ScriptedVxi11 honest(port);
        behave(honest);
        openSession();
        EXPECT_TRUE(state.InstrumentOnline);
        EXPECT_EQ(window->windowTitle().trimmed(), QStringLiteral("KDX,TEST"));
        honest.answer("\"MESSTURM\"\n");
        click("Command5");
        EXPECT_NE(text("gelesen").find("MESSTURM"), std::string::npos);
        end();
        EXPECT_EQ(honest.destroyed().size(), 1U);
    }

    std::unique_ptr<ScriptedVxi11> liar = std::make_unique<ScriptedVxi11>();
};

TEST_P(LyingInstrument, IsToldInTimeWhenAValueIsReadBackAndTheWindowGoesOn) {
    behave(*liar);
    openSession();
    ASSERT_TRUE(state.InstrumentOnline);
    expectBoxInTime("Command5", ScriptedVxi11::kRead, std::string("Fehler: ") + GetParam().statusOfRead);
    click("GTL_Taste");
    expectThatAnHonestOneIsOpened();
}

TEST_P(LyingInstrument, IsToldInTimeWhenTheSessionIsOpenedAndTheWindowGoesOn) {
    expectBoxInTime("INIT_Taste", ScriptedVxi11::kCreateLink,
                    std::string("Please Check Device! ") + GetParam().statusOfOpening);
    EXPECT_FALSE(state.InstrumentOnline);
    expectThatAnHonestOneIsOpened();
}

INSTANTIATE_TEST_SUITE_P(
    EveryLie, LyingInstrument,
    ::testing::Values(
        Lie{"a byte a second",
            {.kind = Reaction::Kind::RawForEver, .raw = claims(1000), .again = "x", .pause = 1s},
            kTimeout,
            kTimeout},
        Lie{"a huge claim", {.kind = Reaction::Kind::Raw, .raw = claims(0x7FFFFFFF)}, kError, kError},
        // The opening is the first call itself.
        Lie{"answers to the first call without end",
            {.kind = Reaction::Kind::RawForEver, .again = answerTo(1)},
            kTimeout,
            kError},
        Lie{"an answer to a later call", {.kind = Reaction::Kind::Raw, .raw = answerTo(9999)}, kError, kError}));

TEST_F(LanSessionTest, AnIdentificationOfAnyLengthBecomesTheTitle) {
    for (const auto& [bytes, title] : {std::pair<std::string, std::string>{"", std::string(60, ' ')},
                                       {"K", "K" + std::string(59, ' ')},
                                       {std::string(60, 'x'), std::string(60, 'x')},
                                       {std::string("A\0\x1B\x7F\n", 5), "A" + std::string(59, ' ')}}) {
        startOn(device.port());
        openOn(bytes);
        EXPECT_EQ(window->windowTitle().toStdString(), title);
    }
}

TEST_F(LanSessionTest, AnswersOfAnyLengthAndContentAreShown) {
    startOn(device.port());
    openOn();
    const std::string before = readBackWith("\"MESSTURM\"\n");
    const auto around = before.find("MESSTURM");
    ASSERT_NE(around, std::string::npos);
    EXPECT_EQ(readBackWith("\"\x1B[2J<b>&\t\"\n"), before.substr(0, around) + "\x1B[2J<b>&\t");
    readBackWith("");
    readBackWith("\n");
    readBackWith("x");
    readBackWith(std::string("\0", 1));
    EXPECT_NE(readBackWith("\"" + std::string(59, 'y')).find(std::string(50, 'y')), std::string::npos);
    EXPECT_NE(readBackWith("\"MESSTURM\"\n").find("MESSTURM"), std::string::npos);
    // What did not fit into one answer stands there for the next readings.
    readBackWith("\"" + std::string(497, 'z') + "\"\n");
    for (int piece = 2; piece <= 9; ++piece) {
        click("Command5");
        EXPECT_NE(text("gelesen").find("zz"), std::string::npos) << piece;
    }
    EXPECT_NE(readBackWith("\"MESSTURM\"\n").find("MESSTURM"), std::string::npos);
}

}  // namespace
}  // namespace kdx::test
