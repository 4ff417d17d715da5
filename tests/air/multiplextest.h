#pragma once

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

#include "air/airtest.h"
#include "air/demodulator.h"
#include "air/multiplex.h"

namespace kdx::air {

/// A virtual instrument whose stereo coder is on, with a total deviation of 75 kHz and nothing else; what it sends is
/// kept, bits and samples.
class MultiplexTest : public AirTest {
protected:
    explicit MultiplexTest(int sampleRate = kMultiplexRate) : rate(sampleRate), multiplex(sampleRate) {
        tell(":STEREO:STATE ON;:STEREO:DEVIATION 75000HZ");
        tell(":STEREO:RDS:STATE OFF");
    }

    void data() { tell(":STEREO:RDS:STATE ON"); }
    void pilot() { tell(":STEREO:PILOT:STATE ON"); }
    void tone(const std::string& kilohertz, const std::string& mode) {
        tell(":STEREO:SOURCE LFGEN;:STEREO:AUDIO:MODE " + mode + ";:STEREO:AUDIO:FREQUENCY " + kilohertz + "KHZ");
    }
    void ari(const std::string& type, const std::string& area) {
        tell(":STEREO:ARI:STATE ON;:STEREO:ARI:TYPE:STATE ON;:STEREO:ARI:TYPE " + type + ";:STEREO:ARI:BK " + area);
    }

    void send(double seconds) {
        for (const AirTime end = broadcast.time() + Ticks{std::llround(seconds * 19000)}; broadcast.time() < end;) {
            const OnAir sent = broadcast.next();
            const auto more = multiplex.add(sent, broadcast.transmission().settings);
            samples.insert(samples.end(), more.begin(), more.end());
            keepBits(sent);
        }
    }
    /// The samples of so many seconds.
    std::span<const float> sent(double seconds) {
        samples.clear();
        const auto count = static_cast<std::size_t>(std::llround(seconds * rate));
        while (samples.size() < count) send(0.01);
        return std::span<const float>(samples).first(count);
    }
    /// Its deviation, in hertz.
    [[nodiscard]] double deviationOf(std::span<const float> part, double frequency) const {
        return std::abs(amplitudeOf(part, frequency, rate)) * 100000;
    }
    static double peakOf(std::span<const float> part) {
        double peak = 0;
        for (const float sample : part) peak = std::max(peak, std::abs(static_cast<double>(sample)));
        return peak * 100000;
    }
    static double greatestStepOf(std::span<const float> part) {
        double step = 0;
        for (std::size_t at = 1; at < part.size(); ++at)
            step = std::max(step, std::abs(static_cast<double>(part[at]) - static_cast<double>(part[at - 1])));
        return step;
    }
    /// Of the bits that a receiver finds, how many are wrong or missing but for the last few, which are under way.
    [[nodiscard]] std::size_t bitErrors(std::optional<double> axis = {}) const {
        const std::vector<bool> found = dataBits(samples, rate, axis);
        constexpr std::size_t kUnderWay = 20;
        std::size_t errors = 0;
        for (std::size_t at = 1; at + kUnderWay < bits.size(); ++at) {
            if (at - 1 >= found.size() || found[at - 1] != bits[at]) ++errors;
        }
        return errors;
    }

    int rate;
    Multiplex multiplex;
    std::vector<float> samples;
    std::vector<bool> bits;

private:
    void keepBits(const OnAir& sent) {
        const auto bytes = bitsOf(sent.group);
        for (std::size_t bit = 0; bit < kBitsOfGroup; ++bit) {
            const unsigned byte = sent.kind == OnAir::Kind::Pattern ? sent.pattern : bytes.at(bit / 8);
            if (sent.kind != OnAir::Kind::Nothing) bits.push_back((byte >> (7 - bit % 8) & 1U) != 0);
        }
    }
};

}  // namespace kdx::air
