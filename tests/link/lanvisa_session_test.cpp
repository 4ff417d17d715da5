#include "link/lanvisatest.h"

namespace kdx::test {
namespace {

using ::testing::ElementsAre;

TEST_F(LanVisaTest, SeveralSessionsDoNotDisturbEachOther) {
    device.answerWith([](long link, const std::string& command) { return std::to_string(link) + command; });
    VisaHandle sessions[3] = {};
    for (VisaHandle& handle : sessions) {
        ASSERT_EQ(open(), visa::kSuccess);
        handle = session;
    }
    for (const VisaHandle handle : sessions) {
        session = handle;
        EXPECT_EQ(write("?"), visa::kSuccess);
    }
    std::string all;
    for (const VisaHandle handle : {sessions[2], sessions[0], sessions[1]}) {
        session = handle;
        EXPECT_EQ(read(), visa::kSuccess);
        all += got;
    }
    EXPECT_EQ(all, "3?1?2?");
}

TEST_F(LanVisaTest, AClosedSessionIsNoSessionAndItsHandleIsNotGivenAgain) {
    ASSERT_EQ(open(), visa::kSuccess);
    const VisaHandle first = session;
    EXPECT_EQ(visa->viClose(first), visa::kSuccess);
    EXPECT_THAT(device.destroyed(), ElementsAre(1));
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(read(), visa::kInvalidObject);
    EXPECT_EQ(visa->viClose(first), visa::kInvalidObject);

    ASSERT_EQ(open(), visa::kSuccess);
    EXPECT_NE(session, first);
    EXPECT_EQ(write("*RST"), visa::kSuccess);
    session = first;
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(device.writes().size(), 1U);
}

TEST_F(LanVisaTest, AHandleNeverGivenIsNoSession) {
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(read(), visa::kInvalidObject);
    EXPECT_EQ(visa->viClose(4711), visa::kInvalidObject);
    session = manager;
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
}

TEST_F(LanVisaTest, ClosingAResourceManagerClosesItsSessionsOnly) {
    VisaHandle other = 0;
    visa->viOpenDefaultRM(other);
    ASSERT_EQ(open(), visa::kSuccess);
    const VisaHandle first = session;
    ASSERT_EQ(visa->viOpen(other, "TCPIP::127.0.0.1::INSTR", 0, 0, session), visa::kSuccess);
    EXPECT_EQ(visa->viClose(manager), visa::kSuccess);
    EXPECT_EQ(write("*RST"), visa::kSuccess);
    session = first;
    EXPECT_EQ(write("*RST"), visa::kInvalidObject);
    EXPECT_EQ(open(), visa::kInvalidObject);
}

TEST_F(LanVisaTest, ClosingEndsAlsoWhenTheDeviceNoLongerAnswers) {
    useShortTimes();
    ASSERT_EQ(open(), visa::kSuccess);
    device.on(ScriptedVxi11::kDestroyLink, {.kind = Reaction::Kind::Silence});
    const auto start = std::chrono::steady_clock::now();
    EXPECT_EQ(visa->viClose(session), visa::kSuccess);
    EXPECT_LT(std::chrono::steady_clock::now() - start, kBounded);
}

TEST_F(LanVisaTest, StatusesAreDescribed) {
    std::string text;
    EXPECT_EQ(visa->viStatusDesc(manager, visa::kTimeout, text), visa::kSuccess);
    EXPECT_THAT(text, ::testing::HasSubstr("time-out"));
    EXPECT_EQ(visa->viStatusDesc(manager, -4711, text), 1073676421);
    EXPECT_THAT(text, ::testing::HasSubstr("-4711"));
    EXPECT_EQ(visa->viStatusDesc(4711, 0, text), visa::kInvalidObject);
}

}  // namespace
}  // namespace kdx::test
