#include "settings/renameover.h"

#include <gtest/gtest.h>

#include "support/fakeclock.h"

namespace kdx {
namespace {

using namespace std::chrono_literals;

class RenameOverTest : public ::testing::Test {
protected:
    /// The system's answers, one after the other; the last one again and again.
    bool renamed(std::vector<std::errc> answers) {
        return renameOver("from", "to", m_clock, [&](const auto& from, const auto& to, std::error_code& error) {
            EXPECT_EQ(from, "from");
            EXPECT_EQ(to, "to");
            ++m_tries;
            error = std::make_error_code(answers.front());
            if (answers.size() > 1) answers.erase(answers.begin());
        });
    }

    test::FakeClock m_clock;
    int m_tries = 0;
};

TEST_F(RenameOverTest, WaitsForNothingWhenItIsDoneAtOnce) {
    EXPECT_TRUE(renamed({std::errc()}));
    EXPECT_EQ(m_tries, 1);
    EXPECT_EQ(m_clock.sleptMs(), 0);
}

TEST_F(RenameOverTest, TriesAgainWhileAnotherProgramReadsThere) {
    EXPECT_TRUE(renamed({std::errc::permission_denied, std::errc::permission_denied, std::errc()}));
    EXPECT_EQ(m_tries, 3);
    EXPECT_EQ(m_clock.sleptMs(), 20);
}

TEST_F(RenameOverTest, GivesUpAfterAFifthOfASecond) {
    EXPECT_FALSE(renamed({std::errc::permission_denied}));
    EXPECT_EQ(m_clock.sleptMs(), 200);
}

TEST_F(RenameOverTest, DoesNotWaitForWhatTimeDoesNotMend) {
    EXPECT_FALSE(renamed({std::errc::no_space_on_device}));
    EXPECT_EQ(m_tries, 1);
    EXPECT_EQ(m_clock.sleptMs(), 0);
}

}  // namespace
}  // namespace kdx
