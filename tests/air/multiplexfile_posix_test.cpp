#include "air/multiplexfiletest.h"
#include "support/fulldisk.h"

namespace kdx::air {
namespace {

using namespace std::chrono_literals;

TEST_F(MultiplexFiles, OnAFullDiskFail) {
    const test::FullDisk full;
    MultiplexFile file(path(), rate, SampleFormat::Float, 1s);
    file.goOn(broadcast.next(), broadcast.transmission().settings, 1s);
    EXPECT_FALSE(file.good());
    EXPECT_FALSE(file.close());
}

}  // namespace
}  // namespace kdx::air
