// Receives the data of a multiplex as the tests do, but for as long as is wanted, with instrument commands besides, and
// prints how many bits were wrong. Usage: multiplex_reception RATE SECONDS [COMMAND...]
#include <cstdio>
#include <cstdlib>
#include <vector>

#include "air/broadcast.h"
#include "air/demodulator.h"
#include "air/multiplex.h"

namespace {

using namespace kdx::air;

constexpr std::size_t kPartSeconds = 10;
constexpr std::size_t kPartBits = 11875;
constexpr std::size_t kMarginBits = 38;  // of what is still under way when a part is over

void append(const OnAir& sent, std::vector<bool>& bits) {
    const auto bytes = bitsOf(sent.group);
    for (std::size_t bit = 0; bit < kBitsOfGroup; ++bit) bits.push_back((bytes.at(bit / 8) >> (7 - bit % 8) & 1U) != 0);
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 3) return 2;
    const int rate = std::atoi(argv[1]);
    if (rate <= 0) return 2;
    const auto start = parseAirTime("2026-01-01 12:00:00");
    if (!start) return 1;
    Broadcast broadcast(*start, {});
    for (const char* command :
         {":STEREO:STATE ON;:STEREO:SOURCE LFGEN;:STEREO:AUDIO:MODE RNEL;:STEREO:DEVIATION 75000HZ",
          ":STEREO:PILOT:STATE ON;:STEREO:RDS:STATE ON", ":STEREO:DIRECT \"RT=10,0,HERE IS THE NEWS\"",
          ":STEREO:DIRECT \"CT=12:00:00,01.01.26\""}) {
        broadcast.execute(command, *start);
    }
    for (int at = 3; at < argc; ++at) broadcast.execute(argv[at], *start);
    Multiplex multiplex(rate);
    std::vector<float> samples;
    std::vector<bool> bits;
    std::size_t received = 0;
    std::size_t wrong = 0;
    const auto part = kPartSeconds * static_cast<std::size_t>(rate);
    const std::size_t partWithMargin = part + part * kMarginBits / kPartBits;
    for (const std::size_t wanted = static_cast<std::size_t>(std::atoi(argv[2])) / kPartSeconds * kPartBits;
         received < wanted;) {
        const OnAir sent = broadcast.next();
        append(sent, bits);
        const auto more = multiplex.add(sent, broadcast.transmission().settings);
        samples.insert(samples.end(), more.begin(), more.end());
        if (samples.size() < partWithMargin) continue;
        const auto found = dataBits(samples, rate);
        for (std::size_t at = 0; at < kPartBits; ++at) wrong += found.at(at) != bits.at(at + 1) ? 1 : 0;
        received += kPartBits;
        samples.erase(samples.begin(), samples.begin() + static_cast<std::ptrdiff_t>(part));
        bits.erase(bits.begin(), bits.begin() + kPartBits);
    }
    std::printf("bits=%zu wrong=%zu\n", received, wrong);
    return 0;
}
