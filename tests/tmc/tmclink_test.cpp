#include <gtest/gtest.h>

#include <QListWidget>

#include <array>
#include <sstream>

#include "support/kdxsimtest.h"

namespace kdx::test {
namespace {

/// A message by its numbers, and what the instrument says of it.
struct Message {
    unsigned event;
    unsigned location;
    unsigned extent;
    unsigned direction;
    unsigned duration;
    bool diversion;

    [[nodiscard]] std::string code() const {
        const unsigned block2 = 8U | duration;  // a single-group message
        const unsigned block3 = (diversion ? 0x8000U : 0U) | (direction << 14U) | (extent << 11U) | event;
        return QString::asprintf("0%01X%04X%04X", block2, block3, location).toStdString();
    }
    [[nodiscard]] std::string words() const {
        std::ostringstream text;
        text << "traffic message: event " << event << ", location " << location << ", extent " << extent
             << ", direction " << (direction == 1 ? "backward" : "forward") << ", duration " << duration << ", "
             << (diversion ? "diversion" : "no diversion") << ", F 1, T 0";
        return text.str();
    }
};

const std::string kFirstVariant = "01,106100CD46";
const std::string kSecondVariant = "01,100066CD46";

class TmcLinkTest : public KdxSimTest {
protected:
    /// Opens the session and adds three messages to the list.
    void prepare(const QStringList& simOptions = {}) {
        startBoth(simOptions);
        openSession();
        for (std::size_t i = 0; i < messages.size(); ++i) {
            const Message& m = messages[i];
            addMessage(static_cast<int>(10 * i), static_cast<int>(7 * i), static_cast<int>(m.extent),
                       static_cast<int>(m.direction), static_cast<int>(m.duration), m.diversion);
            messages[i].event = codeIn("TMC_Event_Combo");
            messages[i].location = codeIn("TMC_Loc_Combo");
        }
        takeTraffic();
    }
    void startCycling(const char* seconds) {
        click("optMultiMessage");
        type("txtCycleTime", seconds);
        click("TMC_Senden_Taste");
    }
    /// The number that the chosen entry ends in.
    unsigned codeIn(const char* combo) { return find<QComboBox>(combo)->currentText().right(5).toUInt(); }
    [[nodiscard]] std::string code(std::size_t message) const { return "02," + messages.at(message).code(); }

    std::vector<Message> messages = {
        {0, 0, 2, 0, 0, false},
        {0, 0, 7, 1, 5, true},
        {0, 0, 0, 1, 3, false},
    };
};

TEST_F(TmcLinkTest, ThreeMessagesCycleWithTheAnnouncementAlternatingAtTheirTimes) {
    struct Sent {
        std::string command;
        double at;
    };
    std::vector<Sent> sentAt;
    prepare();
    watched->beforeWrite = [&](const std::string& command) {
        sentAt.push_back({command, clock.secondsSinceMidnight()});
    };
    startCycling("2.5");
    const double start = clock.secondsSinceMidnight();
    time->advance(std::chrono::milliseconds(2499));
    EXPECT_TRUE(std::none_of(sentAt.begin(), sentAt.end(), [](const Sent& s) {
        return s.command.find("3A=") != std::string::npos || s.command.find("8A=") != std::string::npos;
    }));
    time->advance(std::chrono::seconds(17));
    std::erase_if(sentAt, [](const Sent& s) {
        return s.command.find("3A=") == std::string::npos && s.command.find("8A=") == std::string::npos;
    });
    // Seven ticks in twenty seconds; the second message of the list is the first to go.
    const std::array<std::size_t, 7> order = {1, 2, 0, 1, 2, 0, 1};
    ASSERT_EQ(sentAt.size(), 2 * order.size());
    for (std::size_t tick = 0; tick < order.size(); ++tick) {
        const std::string& variant = tick % 2 == 0 ? kFirstVariant : kSecondVariant;
        const double due = start + 2.5 * (static_cast<double>(tick) + 1);
        EXPECT_EQ(sentAt[2 * tick].command, ":STEREO:DIRECT \"3A=" + variant + '"') << tick;
        EXPECT_EQ(sentAt[2 * tick + 1].command, ":STEREO:DIRECT \"8A=" + code(order[tick]) + '"') << tick;
        // Each command comes after the pause of 50 ms.
        EXPECT_NEAR(sentAt[2 * tick].at, due + 0.05, 1e-5) << tick;
        EXPECT_NEAR(sentAt[2 * tick + 1].at, due + 0.1, 1e-5) << tick;
    }
    EXPECT_EQ(find<QListWidget>("TMC_List")->currentRow(), 1);
}

TEST_F(TmcLinkTest, TheInstrumentHasTheLastAnnouncementAndMessageAndCountsThem) {
    prepare();
    EXPECT_EQ(ask("3A-N"), "0");
    EXPECT_EQ(ask("8A-N"), "0");
    startCycling("1");
    const std::array<std::size_t, 5> order = {1, 2, 0, 1, 2};
    for (std::size_t tick = 0; tick < order.size(); ++tick) {
        time->advance(std::chrono::seconds(1));
        EXPECT_EQ(ask("3A"), tick % 2 == 0 ? kFirstVariant : kSecondVariant) << tick;
        EXPECT_EQ(ask("8A"), code(order[tick])) << tick;
        EXPECT_EQ(ask("3A-N"), std::to_string(tick + 1));
        EXPECT_EQ(ask("8A-N"), std::to_string(tick + 1));
        EXPECT_EQ(data.ReadIni("RDS", "TMC", dataSetFile("1")), code(order[tick])) << tick;
    }
    click("Stop_Timer");
    time->advance(std::chrono::seconds(5));
    EXPECT_EQ(ask("8A-N"), "5");
    EXPECT_EQ(failures(traffic), 0);
}

TEST_F(TmcLinkTest, ASingleMessageReachesTheInstrumentOnce) {
    prepare();
    find<QListWidget>("TMC_List")->setCurrentRow(2);
    click("TMC_Senden_Taste");
    time->advance(std::chrono::seconds(10));
    EXPECT_EQ(ask("8A"), code(2));
    EXPECT_EQ(ask("8A-N"), "1");
    EXPECT_EQ(ask("3A"), kFirstVariant);
    EXPECT_EQ(ask("3A-N"), "1");
}

TEST_F(TmcLinkTest, TheTraceOfTheInstrumentSaysInWordsWhatWasSent) {
    prepare({QStringLiteral("--trace")});
    startCycling("1");
    time->advance(std::chrono::seconds(3));
    click("Stop_Timer");
    click("GTL_Taste");
    Lines decoded;
    std::istringstream printed(sim.end());
    for (std::string line; std::getline(printed, line);) {
        const std::size_t text = line.find_first_not_of(' ');
        if (text > 0 && (line.find("open data") == text || line.find("traffic message") == text)) {
            decoded.push_back(line.substr(text));
        }
    }
    const std::string announced = "open data in group 8A, application CD46 (traffic messages), ";
    EXPECT_EQ(decoded,
              (Lines{announced + "gap of 8 groups, service 4, activity 1 s, window 1 s, delay 0 s", messages[1].words(),
                     announced + "location table 1, alternative frequencies yes, enhanced mode no, scope national "
                                 "regional",
                     messages[2].words(), announced + "gap of 8 groups, service 4, activity 1 s, window 1 s, delay 0 s",
                     messages[0].words()}));
}

}  // namespace
}  // namespace kdx::test
