#include "link/lanvisatest.h"

#include <algorithm>

#include "support/rawrecord.h"

namespace kdx::test {
namespace {

using std::chrono::steady_clock;

constexpr auto kIoTimeout = 200ms;
constexpr auto kMargin = 20ms;
constexpr auto kLongest = kIoTimeout * 5 / 4;

/// What a device sends that does not want the client to get on.
struct Lie {
    const char* name;
    Reaction reaction;
    VisaStatus status;  ///< of a read; a write may learn of it otherwise
    friend void PrintTo(const Lie& lie, std::ostream* out) { *out << lie.name; }
};

std::string tinyFragments() {
    std::string fragments;
    for (int i = 0; i < 10000; ++i) fragments.append("\0\0\0\1x", 5);
    return fragments;
}

TEST(LanOptionsTest, TheProgramsOwnTimesLeaveRoomWithinATimeOutAndAQuarter) {
    const LanOptions options;
    EXPECT_LE(options.ioTimeout + options.answerMargin + 50ms, options.ioTimeout * 5 / 4);
}

class LanVisaLie : public LanVisaTest, public ::testing::WithParamInterface<Lie> {
protected:
    LanVisaLie() {
        options.ioTimeout = kIoTimeout;
        options.answerMargin = kMargin;
        options.closeTimeout = kIoTimeout;
    }
    // Every time against a fresh connection: the one before may be given up.
    void openAnew() {
        liar = std::make_unique<ScriptedVxi11>();
        options.portMapperPort = liar->port();
        makeVisa();
        ASSERT_EQ(open(), visa::kSuccess);
    }
    // The shortest of three times counts: the machine may be busy.
    template <class Action>
    void expectInTime(std::uint32_t procedure, Action action) {
        auto shortest = steady_clock::duration::max();
        for (int attempt = 0; attempt < 3 && shortest >= kLongest; ++attempt) {
            openAnew();
            for (int i = 0; i < 40; ++i) liar->on(procedure, GetParam().reaction);
            const auto start = steady_clock::now();
            action();
            shortest = std::min(shortest, steady_clock::now() - start);
        }
        EXPECT_LT(shortest, kLongest);
    }

    std::unique_ptr<ScriptedVxi11> liar;
};

TEST_P(LanVisaLie, HoldsUpARead) {
    expectInTime(ScriptedVxi11::kRead, [this] { EXPECT_EQ(read(), GetParam().status); });
}

TEST_P(LanVisaLie, HoldsUpAWrite) {
    expectInTime(ScriptedVxi11::kWrite, [this] { EXPECT_LT(write(bytesOf(100)), 0); });
}

TEST_P(LanVisaLie, HoldsUpAnOpen) {
    expectInTime(ScriptedVxi11::kCreateLink, [this] { EXPECT_LT(open(), 0); });
}

TEST_P(LanVisaLie, HoldsUpAClose) {
    expectInTime(ScriptedVxi11::kDestroyLink, [this] { EXPECT_EQ(visa->viClose(session), visa::kSuccess); });
}

INSTANTIATE_TEST_SUITE_P(
    NoLonger, LanVisaLie,
    ::testing::Values(
        Lie{"silence", {.kind = Reaction::Kind::Silence}, visa::kTimeout},
        Lie{"a byte now and then",
            {.kind = Reaction::Kind::RawForEver, .raw = claims(1000), .again = "x", .pause = 10ms},
            visa::kTimeout},
        Lie{"half a mark, then silence",
            {.kind = Reaction::Kind::Raw, .raw = claims(1000).substr(0, 2)},
            visa::kTimeout},
        Lie{"the largest claim that is believed",
            {.kind = Reaction::Kind::Raw, .raw = claims(128 * 1024)},
            visa::kTimeout},
        Lie{"a huge claim", {.kind = Reaction::Kind::Raw, .raw = claims(0x7FFFFFFF)}, visa::kInputOutput},
        Lie{"empty fragments without end",
            {.kind = Reaction::Kind::RawForEver, .again = std::string(4096, '\0')},
            visa::kInputOutput},
        Lie{"tiny fragments without end",
            {.kind = Reaction::Kind::RawForEver, .again = tinyFragments()},
            visa::kInputOutput},
        Lie{"answers to an earlier call without end",
            {.kind = Reaction::Kind::RawForEver, .again = answerTo(1)},
            visa::kTimeout},
        Lie{"an answer to a later call", {.kind = Reaction::Kind::Raw, .raw = answerTo(99)}, visa::kInputOutput},
        Lie{"cut in the mark",
            {.kind = Reaction::Kind::RawAndClose, .raw = claims(1000).substr(0, 2)},
            visa::kConnectionLost},
        Lie{"cut in the middle",
            {.kind = Reaction::Kind::RawAndClose, .raw = claims(1000) + "xxxx"},
            visa::kConnectionLost}));

class LanVisaSlowDevice : public LanVisaLie {};

TEST_P(LanVisaSlowDevice, HasTheTimeOutForAWholeTransferAndNotForEachPart) {
    expectInTime(ScriptedVxi11::kRead, [this] { EXPECT_EQ(read(), GetParam().status); });
    EXPECT_GT(count, 0);
    EXPECT_LT(count, 10);
    expectInTime(ScriptedVxi11::kWrite, [this] { EXPECT_EQ(write(bytesOf(100)), GetParam().status); });
    EXPECT_GT(count, 0);
    EXPECT_LT(count, 10);
}

INSTANTIATE_TEST_SUITE_P(NoLonger, LanVisaSlowDevice,
                         ::testing::Values(Lie{"one byte at a time",
                                               {.reason = 0, .raw = "x", .number = 1, .pause = 50ms},
                                               visa::kTimeout}));

}  // namespace
}  // namespace kdx::test
