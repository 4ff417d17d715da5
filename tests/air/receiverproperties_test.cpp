#include <gmock/gmock.h>

#include <algorithm>
#include <array>
#include <chrono>
#include <cstdio>
#include <map>
#include <ostream>
#include <random>
#include <set>
#include <tuple>

#include "air/broadcast.h"
#include "air/receivercharacters.h"
#include "air/receivertest.h"
#include "base/codepage.h"
#include "coder/rdscharacters.h"

namespace kdx::air {

static void PrintTo(const FrequencyList& list, std::ostream* out) {
    *out << (list.methodB ? "B " : "A ") << list.tuned << ':';
    for (const auto& [kilohertz, regional] : list.alternatives) *out << ' ' << kilohertz << (regional ? "r" : "");
}
static bool operator<(const FrequencyList::Alternative& left, const FrequencyList::Alternative& right) {
    return std::tie(left.kilohertz, left.regional) < std::tie(right.kilohertz, right.regional);
}
static bool operator<(const FrequencyList& left, const FrequencyList& right) {
    return std::tie(left.methodB, left.tuned, left.alternatives) <
           std::tie(right.methodB, right.tuned, right.alternatives);
}
static bool operator<(const ReceivedNetwork::Mapped& left, const ReceivedNetwork::Mapped& right) {
    return std::tie(left.tuned, left.other) < std::tie(right.tuned, right.other);
}

namespace {

using ListSet = std::set<FrequencyList>;
using MappedSet = std::set<ReceivedNetwork::Mapped>;

/// One other network as it is set.
struct Network {
    std::string ps;
    int pty = 0;
    bool tp = false, ta = false;
    FrequencyList methodA;
    MappedSet mapped;
};

/// What is set, in the terms of what a radio shows.
struct Settings {
    std::string pi;
    std::string ps, radiotext;  // UTF-8
    bool radiotextB = false;
    int pty = 0, decoderInfo = 0;
    bool tp = false, ta = false, music = false;
    ListSet frequencies;
    std::map<std::string, Network> networks;
    OpenDataGroup message;
};

std::string quotedTwice(const std::string& text) {
    std::string quoted;
    for (const char c : text) quoted.append(c == '"' ? 2 : 1, c);
    return quoted;
}

template <typename T>
std::set<T> setOf(const std::vector<T>& values) {
    return {values.begin(), values.end()};
}

/// An instrument whose settings are drawn by lot, and a radio that hears it.
class RandomBroadcast {
public:
    explicit RandomBroadcast(unsigned seed) : m_random(seed) {
        m_broadcast.execute(":STEREO:RDS:STATE ON", m_broadcast.time());
    }

    Settings expected;
    Receiver receiver;
    std::vector<std::string> warnings;

    /// Draws everything anew but the PI.
    void draw() {
        expected.ps = padded(text("PS=", 8));
        drawRadiotext();
        expected.pty = set("PTY=", 31);
        expected.decoderInfo = set("DI=", 15);
        expected.tp = set("TP=", 1) == 1;
        expected.ta = set("TA=", 1) == 1;
        expected.music = flag();
        coder(std::string("MS=") + (expected.music ? "M" : "S"));
        drawFrequencies();
        drawNetworks();
        expected.message = {static_cast<std::uint8_t>(0x08 + number(0, 7)), word(), word()};
        coder("3A=01," + digits({0x10, 0x0066, 0xCD46}));
        coder("8A=02," + digits(expected.message));
        drawSequence();
    }
    void drawPi() {
        expected.pi = hex(word());
        coder("PI=" + expected.pi);
    }

    /// Lets the radio hear so many turns of the sequence, from the bits on; now and then one of them is wrong.
    void hear(int turns, int oneWrongOf) {
        for (std::size_t group = static_cast<std::size_t>(turns) * m_ring; group > 0; --group) {
            const OnAir sent = m_broadcast.next();
            ASSERT_EQ(sent.kind, OnAir::Kind::Group);
            for (unsigned byte : bitsOf(sent.group)) {
                if (oneWrongOf != 0) byte ^= wrongBits(oneWrongOf);
                for (unsigned bit = 8; bit-- > 0;) {
                    if (const auto heard = m_blocks.take((byte >> bit & 1U) != 0)) receiver.take(*heard);
                }
            }
        }
    }

    /// So many turns take all that there is to the radio once.
    [[nodiscard]] int turns() const { return std::max({m_pairs, m_parts, 16}) + 1; }
    int number(int lowest, int highest) { return std::uniform_int_distribution(lowest, highest)(m_random); }
    [[nodiscard]] const BlockReceiver& blocks() const { return m_blocks; }
    void tell(const std::string& command) { m_broadcast.execute(command, m_broadcast.time()); }

private:
    bool flag() { return number(0, 1) == 1; }
    std::uint16_t word() { return static_cast<std::uint16_t>(number(0, 0xFFFF)); }
    unsigned wrongBits(int oneWrongOf) {
        unsigned bits = 0;
        for (unsigned bit = 0; bit < 8; ++bit) bits |= (number(1, oneWrongOf) == 1 ? 1U : 0U) << bit;
        return bits;
    }
    void coder(const std::string& command) { tell(":STEREO:DIRECT \"" + quotedTwice(command) + "\""); }
    int set(const std::string& command, int highest) {
        const int value = number(0, highest);
        coder(command + std::to_string(value));
        return value;
    }
    static std::string hex(unsigned value) {
        std::array<char, 8> digits{};
        (void)std::snprintf(digits.data(), digits.size(), "%04X", value);
        return digits.data();
    }
    static std::string digits(const OpenDataGroup& group) {
        return hex(group.bits).substr(2) + hex(group.block3) + hex(group.block4);
    }
    static std::string padded(std::string utf8) {
        for (auto characters = fromUtf8(utf8).size(); characters < 8; ++characters) utf8 += ' ';
        return utf8;
    }

    /// Sends a text of characters that RDS has, and gives it in UTF-8.
    std::string text(const std::string& command, int longest) {
        std::string characters;
        for (int length = number(0, longest); length > 0;) {
            const char character = static_cast<char>(number(0x20, 0xFF));
            if (!rdsCode(character)) continue;
            characters += character;
            --length;
        }
        coder(command + characters);
        return toUtf8(characters);
    }
    void drawRadiotext() {
        const bool flagB = flag();
        const std::string drawn = text(std::string("RT=0,") + (flagB ? "1," : "0,"), 64);
        if (drawn.empty()) return;  // the text that the radio has stays
        if (expected.radiotext.empty()) {
            expected.radiotextB = flagB;
        } else if (drawn != expected.radiotext) {
            expected.radiotextB = !expected.radiotextB;
        }
        expected.radiotext = drawn;
    }

    static std::string megahertz(int kilohertz) {
        return std::to_string(kilohertz / 1000) + "." + std::to_string(kilohertz / 100 % 10);
    }
    /// So many frequencies, all different, each with a code.
    std::vector<int> frequencies(int count) {
        std::vector<int> drawn;
        while (drawn.size() < static_cast<std::size_t>(count)) {
            const int kilohertz = 87500 + 100 * number(1, 204);
            if (std::find(drawn.begin(), drawn.end(), kilohertz) == drawn.end()) drawn.push_back(kilohertz);
        }
        return drawn;
    }
    static std::string joined(const std::vector<int>& frequencies) {
        std::string text;
        for (const int kilohertz : frequencies) text += "," + megahertz(kilohertz);
        return text;
    }
    static FrequencyList methodA(const std::vector<int>& frequencies) {
        FrequencyList list;
        for (const int kilohertz : frequencies) list.alternatives.push_back({kilohertz, false});
        return list;
    }
    /// As the list of method A, or as pairs with the tuned frequency.
    FrequencyList drawList(std::vector<int>& sent) {
        const auto drawn = frequencies(number(1, 12));
        if (drawn.size() == 1 || flag()) {
            sent = drawn;
            return methodA(drawn);
        }
        FrequencyList list{true, drawn[0], {}};
        sent = {drawn[0]};
        for (std::size_t i = 1; i < drawn.size(); ++i) {
            const bool tunedFirst = flag();
            sent.insert(sent.end(), {tunedFirst ? drawn[0] : drawn[i], tunedFirst ? drawn[i] : drawn[0]});
            list.alternatives.push_back({drawn[i], tunedFirst == (drawn[0] > drawn[i])});
        }
        return list;
    }
    void drawFrequencies() {
        expected.frequencies.clear();
        m_pairs = 0;
        for (int list = 0, count = number(1, 5); list < count; ++list) {
            std::vector<int> sent;
            expected.frequencies.insert(drawList(sent));
            coder((list == 0 ? "AF=N" : "AF=+") + joined(sent));
            m_pairs += static_cast<int>(sent.size()) / 2 + 1;
        }
    }
    void drawNetworks() {
        for (auto network = expected.networks.begin(); network != expected.networks.end();) {
            if (flag()) {
                coder("EON-DEL=" + network->first);
                network = expected.networks.erase(network);
            } else {
                ++network;
            }
        }
        while (expected.networks.empty() || (expected.networks.size() < 3 && flag())) {
            const std::string pi = hex(word());
            coder("EON-PI=" + pi);
            expected.networks[pi];
        }
        m_parts = 0;
        for (auto& [pi, network] : expected.networks) drawNetwork(pi, network);
    }
    void drawNetwork(const std::string& pi, Network& network) {
        network.ps = padded(text("EON-PS=" + pi + ",", 8));
        network.pty = set("EON-PTY=" + pi + ",", 31);
        network.tp = set("EON-TP=" + pi + ",", 1) == 1;
        network.ta = set("EON-TA=" + pi + ",", 1) == 1;
        const auto list = frequencies(number(1, 8));
        coder("EON-AFA=" + pi + joined(list));
        network.methodA = methodA(list);
        network.mapped.clear();
        m_parts += 5 + static_cast<int>(list.size()) / 2 + 1;
        for (int i = 0, count = number(1, 3); i < count; ++i) {
            const auto mapped = frequencies(number(2, 5));
            coder("EON-AFB=" + pi + (i == 0 ? ",N" : ",+") + joined(mapped));
            for (std::size_t at = 1; at < mapped.size(); ++at) network.mapped.insert({mapped[0], mapped[at]});
            m_parts += static_cast<int>(mapped.size()) - 1;
        }
    }
    void drawSequence() {
        std::vector<std::string> slots = {"0A", "2A", "3A", "8A", "14A"};
        for (const char* more : {"0B", "4A", "14B", "15B", "0A", "2A"}) {
            if (flag()) slots.emplace_back(more);
        }
        std::shuffle(slots.begin(), slots.end(), m_random);
        std::string sequence;
        for (const std::string& slot : slots) sequence += (sequence.empty() ? "" : ",") + slot;
        coder("GS=" + sequence);
        m_ring = slots.size();
    }

    std::mt19937 m_random;
    Broadcast m_broadcast{AirTime{std::chrono::sys_days{std::chrono::year{2026} / 1 / 1}} + std::chrono::hours{12},
                          [this](const std::string& text) { warnings.push_back(text); }};
    BlockReceiver m_blocks;
    std::size_t m_ring = 0;
    int m_pairs = 0;
    int m_parts = 0;
};

void expectShown(const RadioState& shown, const Settings& expected) {
    EXPECT_EQ(shown.pi, hexWord(expected.pi));
    EXPECT_EQ(shown.psText(), expected.ps);
    EXPECT_EQ(shown.radiotextText(), expected.radiotext);
    if (!expected.radiotext.empty()) {
        EXPECT_TRUE(shown.isRadiotextWhole());
        EXPECT_EQ(shown.radiotextB, expected.radiotextB);
    }
    EXPECT_EQ(shown.pty, expected.pty);
    EXPECT_EQ(shown.decoderInfoNumber(), expected.decoderInfo);
    EXPECT_EQ(shown.tp, expected.tp);
    EXPECT_EQ(shown.ta, expected.ta);
    EXPECT_EQ(shown.music, expected.music);
    EXPECT_EQ(setOf(shown.frequencies), expected.frequencies);
    for (const auto& [pi, network] : expected.networks) {
        const auto found = std::find_if(shown.networks.begin(), shown.networks.end(),
                                        [word = hexWord(pi)](const auto& other) { return other.pi == word; });
        ASSERT_NE(found, shown.networks.end());
        EXPECT_EQ(shownText(found->ps), network.ps);
        EXPECT_EQ(found->pty, network.pty);
        EXPECT_EQ(found->tp, network.tp);
        EXPECT_EQ(found->ta, network.ta);
        EXPECT_EQ(found->frequencies, network.methodA);
        EXPECT_EQ(setOf(found->mapped), network.mapped);
    }
    ASSERT_FALSE(shown.traffic.messages.empty());
    EXPECT_EQ(shown.traffic.messages.back().message, trafficGroupOf(expected.message).message);
}

TEST(RandomSettings, AreWhatARadioShows) {
    for (unsigned seed = 0; seed < 1500 && !::testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE(seed);
        RandomBroadcast air(seed);
        air.drawPi();
        air.draw();
        air.hear(air.turns(), 0);
        EXPECT_THAT(air.warnings, ::testing::IsEmpty());
        EXPECT_EQ(air.blocks().wrongBlocks(), 0U);
        expectShown(air.receiver.state(), air.expected);
        EXPECT_EQ(air.receiver.state().networks.size(), air.expected.networks.size());
        EXPECT_EQ(air.receiver.state().traffic.messages.size(), 1U);
    }
}

TEST(RandomSettings, AreWhatARadioShowsAfterAChange) {
    for (unsigned seed = 0; seed < 200 && !::testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE(seed);
        RandomBroadcast air(seed);
        air.drawPi();
        air.draw();
        air.hear(air.number(1, air.turns()), 0);
        air.draw();
        air.hear(5 * air.turns(), 0);
        EXPECT_THAT(air.warnings, ::testing::IsEmpty());
        expectShown(air.receiver.state(), air.expected);
    }
}

TEST(RandomSettings, AreWhatARadioShowsInSpiteOfErrors) {
    // One bit of 2000 is wrong: of twenty groups one has a block with errors.
    for (unsigned seed = 0; seed < 100 && !::testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE(seed);
        RandomBroadcast air(seed);
        air.drawPi();
        air.draw();
        air.hear(10 * air.turns(), 2000);
        EXPECT_GT(air.blocks().wrongBlocks(), 0U);
        expectShown(air.receiver.state(), air.expected);
    }
}

TEST(RandomSettings, OfAnotherProgrammeBeginAnew) {
    for (unsigned seed = 0; seed < 100 && !::testing::Test::HasFailure(); ++seed) {
        SCOPED_TRACE(seed);
        RandomBroadcast air(seed);
        air.drawPi();
        air.draw();
        air.hear(5, 0);
        air.drawPi();
        air.hear(air.turns() + 20, 0);
        expectShown(air.receiver.state(), air.expected);
    }
}

TEST(RandomDays, ChangeAtMidnightOnTheRadiosClockToo) {
    using namespace std::chrono;
    std::mt19937 random(7);
    for (int i = 0; i < 300; ++i) {
        const sys_days day = sys_days{2000y / January / 1} + days{std::uniform_int_distribution(0, 36523)(random)};
        const year_month_day date{day};
        const int second = std::uniform_int_distribution(30, 59)(random);
        std::array<char, 64> command{};
        (void)std::snprintf(command.data(), command.size(), ":STEREO:DIRECT \"CT=23:59:%02d,%02u.%02u.%02d\"", second,
                            static_cast<unsigned>(date.day()), static_cast<unsigned>(date.month()),
                            static_cast<int>(date.year()) % 100);
        Broadcast broadcast(AirTime{sys_days{2026y / January / 1}}, {});
        broadcast.execute(":STEREO:RDS:STATE ON", broadcast.time());
        broadcast.execute(command.data(), broadcast.time());
        Receiver receiver;
        for (int group = 0; group < 360; ++group) {
            const auto& [block1, block2, block3, block4] = broadcast.next().group.blocks;
            receiver.take({{block1, block2, block3, block4}});
        }
        const auto clock = receiver.state().clock;
        ASSERT_TRUE(clock) << command.data();
        EXPECT_EQ(clock->utc, day + days{1}) << command.data();
        EXPECT_EQ(clock->offset, 0min);
    }
}

}  // namespace
}  // namespace kdx::air
