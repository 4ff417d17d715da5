// Composes the groups of a full coder and writes their lines down, and prints how long one core took. Usage:
// groups_speed SECONDS
#include <cstdio>
#include <cstdlib>
#include <ctime>

#include "air/broadcast.h"

int main(int argc, char** argv) {
    if (argc < 2) return 2;
    using namespace kdx::air;
    const auto start = parseAirTime("2026-01-01 12:00:00");
    if (!start) return 1;
    Broadcast broadcast(*start, {});
    for (const char* command :
         {":STEREO:STATE ON;:STEREO:RDS:STATE ON", ":STEREO:DIRECT \"RT=10,0,HERE IS THE NEWS\"",
          ":STEREO:DIRECT \"AF=N,98.5,87.6,88.1,93.6,101.2\"", ":STEREO:DIRECT \"EON-PI=D3C1\"",
          ":STEREO:DIRECT \"3A=01,106100CD46\"", ":STEREO:DIRECT \"8A=02,0B90E400CC\"",
          ":STEREO:DIRECT \"CT=12:00:00,01.01.26\"", ":STEREO:DIRECT \"GS=0A,2A,3A,8A,14A,14B,0B,15B\""}) {
        broadcast.execute(command, *start);
    }
    const auto end = *start + std::chrono::seconds{std::atoi(argv[1])};
    std::size_t characters = 0;  // what nobody looks at need not be made
    const std::clock_t begin = std::clock();
    while (broadcast.time() < end) {
        const OnAir sent = broadcast.next();
        characters += logLine(sent.group, broadcast.time()).size();
    }
    std::printf("seconds=%.3f characters=%zu\n", static_cast<double>(std::clock() - begin) / CLOCKS_PER_SEC,
                characters);
    return 0;
}
