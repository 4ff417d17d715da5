#include "scenario/report.h"

#include <gtest/gtest.h>

#include "scenario/playtest.h"

namespace kdx::test {
namespace {

using ReportTest = PlayTest;
using scenario::Report;

TEST_F(ReportTest, OnlyAPlainFileIsWritten) {
    for (const std::filesystem::path& other :
         {std::filesystem::path("/dev/full"), folder.path(), folder.path() / "nothing" / "report.csv"}) {
        EXPECT_EQ(Report(other).begin(), scenario::ReportFault::Unwritable) << other;
    }
    std::filesystem::create_symlink(folder.data() / "other", folder.data() / "link");
    EXPECT_EQ(Report(folder.data() / "link").begin(), scenario::ReportFault::Unwritable);
}

}  // namespace
}  // namespace kdx::test
