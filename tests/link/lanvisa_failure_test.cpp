#include "link/lanvisatest.h"

namespace kdx::test {
namespace {

TEST_F(LanVisaTest, AConnectionThatBreaksAtAReadIsLostForGood) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Close});
    EXPECT_EQ(read(), -1073807194);
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(write("*RST"), visa::kConnectionLost);
        EXPECT_EQ(read(), visa::kConnectionLost);
    }
    EXPECT_EQ(visa->viClose(session), visa::kSuccess);
    EXPECT_EQ(open(), visa::kSuccess);
}

TEST_F(LanVisaTest, AConnectionThatBreaksAtAWriteIsLostForGood) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::Close});
    EXPECT_EQ(write("*RST"), visa::kConnectionLost);
    EXPECT_EQ(count, 0);
    EXPECT_EQ(write("*RST"), visa::kConnectionLost);
}

TEST_F(LanVisaTest, ADeviceThatDiesBetweenTwoCallsIsALostConnectionAndNoSignal) {
    auto mortal = std::make_unique<ScriptedVxi11>();
    options.portMapperPort = mortal->port();
    makeVisa();
    ASSERT_EQ(open(), visa::kSuccess);
    mortal.reset();
    EXPECT_EQ(write(bytesOf(5000)), visa::kConnectionLost);
    EXPECT_EQ(write(bytesOf(5000)), visa::kConnectionLost);
    EXPECT_EQ(read(), visa::kConnectionLost);
}

TEST_F(LanVisaTest, ARequestThatCannotBeSentWholeEndsTheConnection) {
    useTimes(2s, 2s);
    options.ioTimeout = 1ms;
    options.answerMargin = 1ms;
    device.setMaxReceive(0xFFFFFFFF);
    makeVisa();
    VisaStatus status = open();
    for (int attempt = 0; status == visa::kTimeout && attempt < 1000; ++attempt) status = open();  // a busy machine
    ASSERT_EQ(status, visa::kSuccess);
    device.on(ScriptedVxi11::kWrite, {.kind = Reaction::Kind::StopReading});
    const std::string text = bytesOf(60000);
    int writes = 0;
    do {
        status = write(text);
    } while (status == visa::kTimeout && ++writes < 5000);
    EXPECT_GT(writes, 1);
    EXPECT_EQ(status, visa::kConnectionLost);
}

struct Garbage {
    const char* name;
    std::string bytes;
    VisaStatus status;
    friend void PrintTo(const Garbage& garbage, std::ostream* out) { *out << garbage.name; }
};

class LanVisaGarbage : public LanVisaTest, public ::testing::WithParamInterface<Garbage> {};

TEST_P(LanVisaGarbage, IsReportedAndEndsTheConnection) {
    useShortTimes();
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Raw, .raw = GetParam().bytes});
    EXPECT_EQ(read(), GetParam().status);
    EXPECT_EQ(count, 0);
    if (GetParam().status == visa::kInputOutput) {
        EXPECT_EQ(read(), visa::kConnectionLost);
    }
    device.on(ScriptedVxi11::kCreateLink, {.kind = Reaction::Kind::Raw, .raw = GetParam().bytes});
    EXPECT_LT(open(), 0);
    device.on(ScriptedVxi11::kGetPort, {.kind = Reaction::Kind::Raw, .raw = GetParam().bytes});
    EXPECT_LT(open(), 0);
    EXPECT_EQ(open(), visa::kSuccess);
}

/// A message of these 32-bit words, with its record mark.
std::string message(const std::vector<std::uint32_t>& words) {
    std::string bytes;
    const auto append = [&bytes](std::uint32_t word) {
        for (const int shift : {24, 16, 8, 0}) bytes += static_cast<char>((word >> shift) & 0xFF);
    };
    append(0x80000000U | static_cast<std::uint32_t>(words.size() * 4));
    for (const std::uint32_t word : words) append(word);
    return bytes;
}

/// The answer "1" to a read, with a verifier of so many words.
std::string withVerifier(std::uint32_t count) {
    std::vector<std::uint32_t> words = {2, 1, 0, 1, 4 * count};
    words.insert(words.end(), count, 0x01020304);
    words.insert(words.end(), {0, 0, 4, 2, 0x310A0000});
    return message(words);
}

// The read is the second call on its connection, so the number 2 is what its answer bears.
INSTANTIATE_TEST_SUITE_P(
    Replies, LanVisaGarbage,
    ::testing::Values(
        Garbage{"text", "HTTP/1.1 400 Bad Request\r\n\r\n", visa::kInputOutput},
        Garbage{"enormous fragment", std::string("\xFF\xFF\xFF\xFF", 4), visa::kInputOutput},
        Garbage{"empty message", message({}), visa::kInputOutput},
        Garbage{"number of a call never made", message({99, 1, 0, 0, 0, 0, 0, 4, 0}), visa::kInputOutput},
        Garbage{"number zero", message({0, 1, 0, 0, 0, 0, 0, 4, 0}), visa::kInputOutput},
        Garbage{"a call instead of a reply", message({2, 0, 2, 395183, 1, 12, 0, 0, 0, 0}), visa::kInputOutput},
        Garbage{"a reply that is only its number", message({2}), visa::kInputOutput},
        Garbage{"refused", message({2, 1, 1, 0, 2, 2}), visa::kInputOutput},
        Garbage{"unknown reply state", message({2, 1, 77}), visa::kInputOutput},
        Garbage{"verifier too long", message({2, 1, 0, 0, 0x7FFFFFFF, 0}), visa::kInputOutput},
        Garbage{"verifier a word too long", withVerifier(101), visa::kInputOutput},
        Garbage{"procedure unknown there", message({2, 1, 0, 0, 0, 3}), visa::kInputOutput},
        Garbage{"unknown accept state", message({2, 1, 0, 0, 0, 0xFFFFFFFF}), visa::kInputOutput},
        Garbage{"no results", message({2, 1, 0, 0, 0, 0}), visa::kInputOutput},
        Garbage{"results cut short", message({2, 1, 0, 0, 0, 0, 0, 4, 8, 0x31320A00}), visa::kInputOutput},
        Garbage{"more data than there is", message({2, 1, 0, 0, 0, 0, 0, 4, 0xFFFFFFF0}), visa::kInputOutput},
        Garbage{"half a record mark", std::string("\x80\x00", 2), visa::kTimeout},
        Garbage{"half a message", std::string("\x80\x00\x00\x40\x00\x00", 6), visa::kTimeout}));

TEST_F(LanVisaTest, AReplyMayBearAVerifier) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Raw,
                                     .raw = message({2, 1, 0, 1, 5, 0x01020304, 0x05000000, 0, 0, 4, 2, 0x310A0000})});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

TEST_F(LanVisaTest, AVerifierMayHaveTheLengthThatTheStandardAllows) {
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kRead, {.kind = Reaction::Kind::Raw, .raw = withVerifier(100)});
    EXPECT_EQ(read(), visa::kSuccess);
    EXPECT_EQ(got, "1\n");
}

}  // namespace
}  // namespace kdx::test
