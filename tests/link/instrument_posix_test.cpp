#include "link/instrumenttest.h"
#include "support/fulldisk.h"

namespace kdx::test {
namespace {

TEST_F(InstrumentTest, AFullDiskUnderTheLogStopsNothing) {
    const FullDisk disk;
    EXPECT_EQ(askCoder("\"RADIO\"\n"), "RADIO");
    EXPECT_TRUE(failures.empty());
    EXPECT_FALSE(instrument.log.isWritable());
}

}  // namespace
}  // namespace kdx::test
