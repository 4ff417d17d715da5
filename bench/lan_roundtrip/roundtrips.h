#pragma once

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <vector>

namespace kdx::bench {

/// Asks `count` times and prints the microseconds of one round trip: the mean, the median and the fastest.
/// @param ask false when no answer came; then the program's result is 1.
inline int measureRoundTrips(int count, const std::function<bool()>& ask) {
    using Clock = std::chrono::steady_clock;
    std::vector<double> microseconds;
    for (int i = 0; i < count; ++i) {
        const Clock::time_point start = Clock::now();
        if (!ask()) {
            std::fprintf(stderr, "question %d was not answered\n", i + 1);
            return 1;
        }
        microseconds.push_back(std::chrono::duration<double, std::micro>(Clock::now() - start).count());
    }
    if (microseconds.empty()) return 1;
    double sum = 0;
    for (const double each : microseconds) sum += each;
    std::sort(microseconds.begin(), microseconds.end());
    std::printf("mean %.2f median %.2f fastest %.2f us\n", sum / count, microseconds[microseconds.size() / 2],
                microseconds.front());
    return 0;
}

/// The number of round trips asked for on the command line: "program HOST [N]".
inline int roundTripsWanted(int argc, char** argv) {
    return argc > 2 ? std::atoi(argv[2]) : 10000;
}

}  // namespace kdx::bench
