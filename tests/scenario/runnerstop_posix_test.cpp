#include "scenario/playtest.h"
#include "support/fulldisk.h"

namespace kdx::test {
namespace {

using RunnerStopTest = PlayTest;

TEST_F(RunnerStopTest, AFullDiskUnderTheReportIsToldOnceAndEndsTheRunRestored) {
    const scenario::Report file(folder.path() / "report.csv");
    report = &file;
    ASSERT_EQ(file.begin(), std::nullopt);
    const FullDisk full;
    const auto outcome = play("restore: true\nsteps: [send: {TA: 1}, send: {TA: 0}]");
    EXPECT_TRUE(outcome.reportLost);
    EXPECT_FALSE(outcome.complete);
    EXPECT_EQ(heard,
              (Lines{"remember", "1 TA=1 0", "report lost", "finishes", "bring back", "restore TA= 0", "ended"}));
}

}  // namespace
}  // namespace kdx::test
