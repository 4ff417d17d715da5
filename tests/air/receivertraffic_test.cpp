#include <chrono>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "air/broadcast.h"
#include "air/receivercharacters.h"
#include "air/receivertest.h"
#include "air/receivertrafficwords.h"

namespace kdx::air {
namespace {

/// Traffic messages in group 8A, announced.
class ReceivedMessages : public ReceiverTest {
protected:
    ReceivedMessages() { hear("D3C2 3410 0066 CD46"); }

    [[nodiscard]] static TrafficTexts texts() {
        const auto lookUp = [](std::map<unsigned, std::string> list) {
            return [list = std::move(list)](unsigned number) {
                const auto found = list.find(number);
                return found == list.end() ? std::string() : found->second;
            };
        };
        return {lookUp({{1, "traffic problem"}, {101, "stationary traffic"}}), lookUp({{101, "Land Probia"}})};
    }
    [[nodiscard]] const std::vector<ReceivedTraffic::Message>& messages() const { return shown().traffic.messages; }
    [[nodiscard]] std::string words(std::size_t index) const { return inWords(messages().at(index).message, texts()); }
};

TEST_F(ReceivedMessages, OfOneGroupAreWhole) {
    // ISO 14819-1, single-group message: T 0, F 1, duration 101; diversion 1, direction 1, extent 010, event
    // 00001100101; location 101.
    hear("D3C2 840D D065 0065");
    ASSERT_EQ(messages().size(), 1U);
    const TrafficMessage& message = messages()[0].message;
    EXPECT_FALSE(message.multiGroup);
    EXPECT_EQ(message.event, 101U);
    EXPECT_EQ(message.location, 101U);
    EXPECT_EQ(message.extent, 2U);
    EXPECT_EQ(message.duration, 5U);
    EXPECT_TRUE(message.backward);
    EXPECT_TRUE(message.diversion);
    EXPECT_EQ(words(0),
              "event 101 stationary traffic, location 101 Land Probia, extent 2, direction backward, duration 5, "
              "diversion");
}

TEST_F(ReceivedMessages, ThatNoListKnowsAreNumbers) {
    hear("D3C2 8408 0007 FFFF");
    EXPECT_EQ(words(0), "event 7, location 65535, extent 0, direction forward, duration 0, no diversion");
    EXPECT_EQ(inWords(messages()[0].message, {}), words(0));
}

TEST_F(ReceivedMessages, ThatAreRepeatedAreCounted) {
    hear({"D3C2 8408 0007 FFFF", "D3C2 8408 0001 FFFF", "D3C2 8408 0007 FFFF"});
    ASSERT_EQ(messages().size(), 2U);
    EXPECT_EQ(messages()[0].times, 2U);
    EXPECT_EQ(messages()[0].lastGroup, 4U);
    EXPECT_EQ(messages()[1].times, 1U);
    EXPECT_EQ(messages()[1].lastGroup, 3U);
}

TEST_F(ReceivedMessages, AboutTheSameEventThereTakeTheOldOnesPlace) {
    hear({"D3C2 8408 0007 FFFF", "D3C2 840B 1807 FFFF"});
    ASSERT_EQ(messages().size(), 1U);
    EXPECT_EQ(words(0), "event 7, location 65535, extent 3, direction forward, duration 3, no diversion");
    EXPECT_EQ(messages()[0].times, 1U);
}

TEST_F(ReceivedMessages, WithAnErrorAreNone) {
    hear({"D3C2 8408 ---- FFFF", "D3C2 8408 0007 ----", "D3C2 ---- 0007 FFFF"});
    EXPECT_TRUE(messages().empty());
    hear("---- 8408 0007 FFFF");
    EXPECT_EQ(messages().size(), 1U);
}

// ISO 14819-1, multi-group message: T 0, F 0, continuity index 001. First group: 1, direction 0, extent 010, event
// 00001100101; location 101. Second: 0, second 1, 01 to follow, and 28 bits; third: 0, 0, 00, and 28 bits. Together
// these are 0010 00101 (length 5), 0011 10000 (limit 80), 1001 00000000001 (event 1), 1100 1010101010101010 (reserved)
// and three zeros to fill up: 229C240, 0E55550.
constexpr const char* kFirst = "D3C2 8401 9065 0065";
constexpr const char* kSecond = "D3C2 8401 5229 C240";
constexpr const char* kThird = "D3C2 8401 00E5 5550";
constexpr const char* kWords =
    "event 101 stationary traffic, location 101 Land Probia, extent 2, direction forward, length 5 km, speed limit 80 "
    "km/h, also event 1 traffic problem, label 12 (reserved)";

TEST_F(ReceivedMessages, OfSeveralGroupsArePutTogether) {
    hear({kFirst, kSecond});
    EXPECT_TRUE(messages().empty());
    hear(kThird);
    ASSERT_EQ(messages().size(), 1U);
    EXPECT_TRUE(messages()[0].message.multiGroup);
    EXPECT_EQ(messages()[0].message.details,
              (std::vector<TrafficMessage::Detail>{{2, 5}, {3, 16}, {9, 1}, {12, 0xAAAA}}));
    EXPECT_EQ(words(0), kWords);
}

TEST_F(ReceivedMessages, OfSeveralGroupsMayHaveEachOfThemRepeated) {
    hear({kFirst, kFirst, kSecond, kSecond, "D3C2 0408 E0CD 2020", "D3C2 8408 0007 FFFF", kThird, kThird});
    ASSERT_EQ(messages().size(), 2U);
    EXPECT_EQ(words(1), kWords);
}

TEST_F(ReceivedMessages, OfSeveralGroupsMayFollowEachOtherAsOne) {
    hear({kFirst, kSecond, kThird, kFirst, kSecond, kThird});
    ASSERT_EQ(messages().size(), 1U);
    EXPECT_EQ(messages()[0].times, 2U);
}

TEST_F(ReceivedMessages, OfSeveralGroupsAreNotMixedUpWithAnotherContinuityIndex) {
    hear({kFirst, "D3C2 8402 5229 C240", "D3C2 8402 00E5 5550"});
    EXPECT_TRUE(messages().empty());
    // The same contents under index 2, and 1 goes on.
    hear({"D3C2 8402 9065 0066", kSecond, "D3C2 8402 5229 C240", kThird});
    ASSERT_EQ(messages().size(), 1U);
    EXPECT_EQ(messages()[0].message.location, 101U);
    hear("D3C2 8402 00E5 5550");
    ASSERT_EQ(messages().size(), 2U);
    EXPECT_EQ(messages()[1].message.location, 102U);
}

TEST_F(ReceivedMessages, OfSeveralGroupsNeedAllOfThem) {
    hear({kSecond, kThird});
    EXPECT_TRUE(messages().empty()) << "no first group";
    hear({kFirst, kThird});
    EXPECT_TRUE(messages().empty()) << "no second group";
    hear({"D3C2 8401 9066 0065", kThird});
    EXPECT_TRUE(messages().empty()) << "another first group has begun anew";
    hear({kSecond, kThird});
    EXPECT_EQ(messages().size(), 1U);
}

TEST_F(ReceivedMessages, OfSeveralGroupsDoNotWaitForEver) {
    hear(kFirst);
    for (int i = 0; i < 171; ++i) hear("D3C2 0408 E0CD 2020");
    hear({kSecond, kThird});
    EXPECT_TRUE(messages().empty());
    hear(kFirst);
    for (int i = 0; i < 170; ++i) hear("D3C2 0408 E0CD 2020");
    hear({kSecond, kThird});
    EXPECT_EQ(messages().size(), 1U);
}

TEST_F(ReceivedMessages, OfFiveGroupsHaveAllTheirContents) {
    // Label 10 with FFFF each time: 1010 and sixteen ones, five times and a bit: A FFFF A FFFF | A FFFF A FFFF ...
    hear({"D3C2 8406 9065 0065", "D3C2 8406 7AFF FFAF", "D3C2 8406 2FFF AFFF", "D3C2 8406 1FAF FFFA",
          "D3C2 8406 0FFF FAFF"});
    ASSERT_EQ(messages().size(), 1U);
    const auto& details = messages()[0].message.details;
    EXPECT_EQ(details, (std::vector<TrafficMessage::Detail>(5, {10, 0xFFFF}))) << "and no part of a sixth";
}

TEST_F(ReceivedMessages, AreOnlyKnownOnceTheyAreAnnounced) {
    Receiver other;
    other.take(groupOfBlocks("D3C2 8408 0007 FFFF"));
    EXPECT_TRUE(other.state().traffic.messages.empty());
    EXPECT_EQ(other.state().traffic.unannounced, 1U);
    other.take(groupOfBlocks("D3C2 3410 0066 CD47"));
    other.take(groupOfBlocks("D3C2 8408 0007 FFFF"));
    EXPECT_EQ(other.state().traffic.messages.size(), 1U);
    EXPECT_EQ(other.state().traffic.unannounced, 1U);
    EXPECT_EQ(other.state().traffic.application, 0xCD47);
}

TEST_F(ReceivedMessages, ComeInTheGroupThatIsAnnounced) {
    // 11A: 10110.
    hear({"D3C2 3416 0066 CD46", "D3C2 B408 0007 FFFF", "D3C2 8408 0001 FFFF"});
    ASSERT_EQ(messages().size(), 1U);
    EXPECT_EQ(messages()[0].message.event, 7U);
    hear({"D3C2 3400 0066 CD46", "D3C2 B408 0002 FFFF", "D3C2 8408 0002 FFFF"});
    EXPECT_EQ(messages().size(), 1U) << "in no group of its own";
}

TEST_F(ReceivedMessages, EndWhenAnotherApplicationTakesTheGroupOver) {
    hear({"D3C2 3412 0000 4BD7", "D3C2 8408 0001 FFFF"});
    EXPECT_EQ(messages().size(), 1U) << "that was another group";
    hear({"D3C2 3410 0000 4BD7", "D3C2 8408 0007 FFFF"});
    EXPECT_EQ(messages().size(), 1U);
}

TEST_F(ReceivedMessages, HaveTheirServiceInTheAnnouncements) {
    // Variant 0: 00 00 000001 1 0 0110; variant 1: 01 10 000100 00 00 00, and 01 11 000101 01 10 11; variant 2:
    // 10 1101 00 11100000.
    const auto& traffic = shown().traffic;
    ASSERT_TRUE(traffic.table);
    EXPECT_FALSE(traffic.timing);
    EXPECT_FALSE(traffic.country);
    EXPECT_EQ(traffic.table->number, 1U);
    EXPECT_TRUE(traffic.table->alternativeFrequencies && traffic.table->national && traffic.table->regional);
    EXPECT_FALSE(traffic.table->enhanced || traffic.table->international || traffic.table->urban);
    hear("D3C2 3410 6100 CD46");
    ASSERT_TRUE(traffic.timing);
    EXPECT_EQ(traffic.timing->gap, 8U);
    EXPECT_EQ(traffic.timing->service, 4U);
    hear("D3C2 3410 715B CD46");
    EXPECT_EQ(traffic.timing->gap, 11U);
    EXPECT_EQ(traffic.timing->service, 5U);
    EXPECT_EQ(traffic.timing->activity, 2U);
    EXPECT_EQ(traffic.timing->window, 4U);
    EXPECT_EQ(traffic.timing->delay, 3U);
    hear("D3C2 3410 B4E0 CD46");
    ASSERT_TRUE(traffic.country);
    EXPECT_EQ(traffic.country->country, 0xDU);
    EXPECT_EQ(traffic.country->extended, 0xE0U);
    EXPECT_EQ(traffic.table->number, 1U);
}

TEST_F(ReceivedMessages, AreToldApartFromTuningInformation) {
    // T 1: variants 4 and 5 the provider's name, 7 a mapped frequency, each once.
    hear({"D3C2 8414 5261 6469", "D3C2 8415 6F20 3120", "D3C2 8417 011A 1234", "D3C2 8417 011A 1234",
          "D3C2 8418 1234 5678", "D3C2 841F FFFF FFFF"});
    EXPECT_TRUE(messages().empty());
    EXPECT_EQ(shownText(shown().traffic.provider), "Radio 1 ");
    ASSERT_EQ(shown().traffic.tuning.size(), 2U);
    EXPECT_EQ(inWords(shown().traffic.tuning[0], {}),
              "tuning information for traffic messages, variant 7: network 1234 on 90.1 MHz where this one is on 87.6 "
              "MHz, T 1");
}

TEST_F(ReceivedMessages, AreToldApartFromAdministration) {
    hear({"D3C2 8400 1234 5678", "D3C2 8407 9065 0065"});
    EXPECT_TRUE(messages().empty());
}

TEST_F(ReceivedMessages, AreThreeHundredAtMost) {
    for (unsigned location = 0; location < 301; ++location)
        receiver.take({{0xD3C2, 0x8408, 0x0007, static_cast<std::uint16_t>(location)}});
    ASSERT_EQ(messages().size(), 300U);
    EXPECT_EQ(messages().front().message.location, 1U);
    EXPECT_EQ(messages().back().message.location, 300U);
}

/// What the virtual coder sends when it is told one group after the other.
class SentMessages : public ReceiverTest {
protected:
    SentMessages() {
        tell(":STEREO:RDS:STATE ON");
        coder("GS=0A,8A,3A");
    }
    void tell(const char* command) { m_broadcast.execute(command, m_broadcast.time()); }
    void coder(const std::string& command) { tell((":STEREO:DIRECT \"" + command + "\"").c_str()); }
    void hearTurns(int turns) {
        for (int group = 3 * turns; group > 0; --group) {
            const auto& [block1, block2, block3, block4] = m_broadcast.next().group.blocks;
            receiver.take({{block1, block2, block3, block4}});
        }
    }

private:
    Broadcast m_broadcast{AirTime{std::chrono::sys_days{std::chrono::year{2026} / 1 / 1}}, {}};
};

TEST_F(SentMessages, OfSeveralGroupsArePutTogether) {
    coder("3A=01,106100CD46");
    hearTurns(1);
    for (const char* command : {"8A=02,0190650065", "8A=02,015229C240", "8A=02,0100E55550"}) {
        coder(command);
        hearTurns(3);
    }
    ASSERT_EQ(shown().traffic.messages.size(), 1U);
    EXPECT_EQ(shown().traffic.messages[0].message.details.size(), 4U);
    EXPECT_EQ(shown().traffic.messages[0].times, 3U);
}

TEST_F(SentMessages, WithoutAnAnnouncementArePassedOver) {
    coder("8A=02,0890650065");
    hearTurns(5);
    EXPECT_TRUE(shown().traffic.messages.empty());
    EXPECT_EQ(shown().traffic.unannounced, 5U);
}

struct WordsCase {
    OpenDataGroup group;
    const char* words;
    friend void PrintTo(const WordsCase& c, std::ostream* out) { *out << c.words; }
};
class TrafficGroupWords : public ::testing::TestWithParam<WordsCase> {};

TEST_P(TrafficGroupWords, SayWhatTheGroupIs) {
    EXPECT_EQ(inWords(trafficGroupOf(GetParam().group), {}), GetParam().words);
}

INSTANTIATE_TEST_SUITE_P(
    Kinds, TrafficGroupWords,
    ::testing::Values(
        WordsCase{{0b01101, 0xD065, 0x0065},
                  "traffic message: event 101, location 101, extent 2, direction backward, duration 5, diversion, F 1, "
                  "T 0"},
        WordsCase{{0b00001, 0x9065, 0x0065},
                  "traffic message of several groups, continuity index 1, first group: event 101, location 101, extent "
                  "2, direction forward, F 0, T 0"},
        WordsCase{{0b00001, 0x5229, 0xC240},
                  "traffic message of several groups, continuity index 1, second group, 1 to follow, content 229C240, "
                  "F 0, T 0"},
        WordsCase{{0b00110, 0x00E5, 0x5550},
                  "traffic message of several groups, continuity index 6, further group, 0 to follow, content 0E55550, "
                  "F 0, T 0"},
        WordsCase{{0b00000, 0x1234, 0x5678}, "administration of encrypted traffic messages: 1234 5678, F 0, T 0"},
        WordsCase{{0b00111, 0x1234, 0x5678},
                  "traffic message of several groups with the reserved continuity index 7, F 0, T 0"},
        WordsCase{
            {0b10100, 0x5261, 0x6469},
            "tuning information for traffic messages, variant 4: first half of the provider's name \"Radi\", T 1"},
        WordsCase{{0b10101, 0x6F20, 0x3120},
                  "tuning information for traffic messages, variant 5: second half of the provider's name \"o 1 \", T "
                  "1"},
        WordsCase{{0b10110, 0x05CD, 0x1234},
                  "tuning information for traffic messages, variant 6: network 1234 on 88.0 MHz, none, T 1"},
        WordsCase{{0b11000, 0xD3C2, 0x1234},
                  "tuning information for traffic messages, variant 8: networks D3C2, 1234, T 1"},
        // 000001 0110 000100.
        WordsCase{{0b11001, 0x0584, 0x1234},
                  "tuning information for traffic messages, variant 9: network 1234 with location table 1, scope 6, "
                  "service 4, T 1"},
        WordsCase{{0b11111, 0x0584, 0x1234}, "tuning information for traffic messages, variant 15: 0584 1234, T 1"}));

struct DetailCase {
    TrafficMessage::Detail detail;
    const char* words;
    friend void PrintTo(const DetailCase& c, std::ostream* out) { *out << c.words; }
};
class TrafficDetailWords : public ::testing::TestWithParam<DetailCase> {};

TEST_P(TrafficDetailWords, SayWhatTheFieldMeans) {
    TrafficMessage message;
    message.multiGroup = true;
    message.details.push_back(GetParam().detail);
    EXPECT_EQ(inWords(message, {}),
              std::string("event 0, location 0, extent 0, direction forward, ") + GetParam().words);
}

INSTANTIATE_TEST_SUITE_P(
    Labels, TrafficDetailWords,
    ::testing::Values(
        DetailCase{{0, 3}, "duration 3"}, DetailCase{{1, 0}, "urgency one step up"},
        DetailCase{{1, 5}, "with diversion"}, DetailCase{{1, 7}, "extent 16 more"},
        DetailCase{{2, 0}, "length above 100 km"}, DetailCase{{2, 10}, "length 10 km"},
        DetailCase{{2, 11}, "length 12 km"}, DetailCase{{2, 15}, "length 20 km"}, DetailCase{{2, 16}, "length 25 km"},
        DetailCase{{2, 31}, "length 100 km"}, DetailCase{{3, 24}, "speed limit 120 km/h"},
        DetailCase{{4, 7}, "quantity 7"}, DetailCase{{5, 200}, "quantity 200"},
        DetailCase{{6, 41}, "supplementary information 41"}, DetailCase{{7, 33}, "from 08:15"},
        DetailCase{{7, 95}, "from 23:45"}, DetailCase{{8, 96}, "until 00:00, days later 0"},
        DetailCase{{8, 131}, "until 11:00, days later 1"}, DetailCase{{8, 201}, "until day of the month 1"},
        DetailCase{{8, 231}, "until day of the month 31"}, DetailCase{{8, 232}, "until middle of month 1"},
        DetailCase{{8, 255}, "until end of month 12"}, DetailCase{{9, 124}, "also event 124"},
        DetailCase{{10, 5}, "diversion by location 5"}, DetailCase{{11, 5}, "destination location 5"},
        DetailCase{{12, 5}, "label 12 (reserved)"}, DetailCase{{13, 5}, "caused at location 5"},
        DetailCase{{14, 0}, "separator"}, DetailCase{{15, 0}, "label 15 (reserved)"}));

}  // namespace
}  // namespace kdx::air
