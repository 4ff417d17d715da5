#include "air/multiplexfile.h"

#include <cstring>

#include "air/multiplexfiletest.h"
#include "air/multiplextest.h"
#include "settings/profilefile.h"

namespace kdx::air {
namespace {

using namespace std::chrono_literals;

TEST_F(MultiplexFiles, HoldTheSamples) {
    write(SampleFormat::Float);
    EXPECT_EQ(numbers<float>(), samples);
}

TEST_F(MultiplexFiles, SayWhatFullScaleIs) {
    write(SampleFormat::Float);
    EXPECT_TRUE(chunk("ICMT").starts_with("stereo multiplex; full scale 1.0 = 100 kHz deviation"));
}

TEST_F(MultiplexFiles, OfSixteenBitsKeepTheBandOfTheData) {
    write(SampleFormat::SixteenBit);
    const auto steps = numbers<std::int16_t>();
    ASSERT_EQ(steps.size(), samples.size());
    std::vector<float> read;
    for (std::size_t at = 0; at < steps.size(); ++at) {
        read.push_back(static_cast<float>(steps[at]) / 32768);
        ASSERT_NEAR(read[at], samples[at], 0.5001 / 32768);
    }
    EXPECT_LE(decibelsBeside(std::span<const float>(read).first(1U << 18U), 54600, 59400, rate), -60);
}

TEST_F(MultiplexFiles, ThatMayGetTooLongForAWavFileHaveRoomForWiderSizes) {
    const auto firstChunk = [this](SampleFormat format) {
        MultiplexFile file(path(), rate, format, 2h);
        file.goOn(broadcast.next(), broadcast.transmission().settings, 1s);
        EXPECT_TRUE(file.close());
        EXPECT_TRUE(readFile(path())->starts_with("RIFF"));
        return readFile(path())->substr(12, 4);
    };
    EXPECT_EQ(firstChunk(SampleFormat::SixteenBit), "fmt ");
    EXPECT_EQ(firstChunk(SampleFormat::Float), "JUNK");  // becomes the table of wider sizes beyond 4 GiB
    EXPECT_EQ(numbers<float>().size(), static_cast<std::size_t>(rate));
}

TEST_F(MultiplexFiles, InAFolderThatIsNotThereFail) {
    MultiplexFile file((folder.path() / "missing" / "multiplex.wav").string(), rate, SampleFormat::Float, 1s);
    EXPECT_FALSE(file.good());
    file.add(broadcast.next(), broadcast.transmission().settings);
    EXPECT_FALSE(file.close());
}

}  // namespace
}  // namespace kdx::air
