// Makes a multiplex with all its parts, groups included, and prints how long one core took, and how much memory the
// process has after the first minute and at the end. Usage: multiplex_speed RATE SECONDS
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <fstream>
#include <string>

#include "air/broadcast.h"
#include "air/multiplex.h"

namespace {

/// In KiB.
long residentMemory() {
    std::ifstream status("/proc/self/status");
    std::string line;
    while (std::getline(status, line)) {
        if (line.starts_with("VmRSS:")) return std::atol(line.c_str() + line.find_first_of("0123456789"));
    }
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc < 3) return 2;
    using namespace kdx::air;
    using namespace std::chrono_literals;
    const auto start = parseAirTime("2026-01-01 12:00:00");
    if (!start) return 1;
    Broadcast broadcast(*start, {});
    for (const char* command :
         {":STEREO:STATE ON;:STEREO:SOURCE LFGEN;:STEREO:AUDIO:MODE RNEL;:STEREO:AUDIO:PREEMPHASIS:STATE ON",
          ":STEREO:PILOT:STATE ON;:STEREO:RDS:STATE ON",
          ":STEREO:ARI:STATE ON;:STEREO:ARI:TYPE:STATE ON;:STEREO:ARI:TYPE BKDK", ":STEREO:DEVIATION 75000HZ",
          ":STEREO:DIRECT \"RT=10,0,HERE IS THE NEWS\"", ":STEREO:DIRECT \"CT=12:00:00,01.01.26\""}) {
        broadcast.execute(command, *start);
    }
    Multiplex multiplex(std::atoi(argv[1]));
    const auto end = *start + std::chrono::seconds{std::atoi(argv[2])};
    long memory = 0;
    double last = 0;  // what nobody looks at need not be made
    const std::clock_t begin = std::clock();
    while (broadcast.time() < end) {
        const OnAir sent = broadcast.next();
        last += static_cast<double>(multiplex.add(sent, broadcast.transmission().settings).back());
        if (memory == 0 && broadcast.time() >= *start + 60s) memory = residentMemory();
    }
    const double seconds = static_cast<double>(std::clock() - begin) / CLOCKS_PER_SEC;
    std::printf("seconds=%.2f first_kb=%ld last_kb=%ld sum=%g\n", seconds, memory, residentMemory(), last);
    return 0;
}
