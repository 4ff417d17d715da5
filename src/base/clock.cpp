#include "base/clock.h"

#include <algorithm>
#include <thread>

#include "base/localtime.h"
#include "base/numbers.h"

namespace kdx {

namespace {

constexpr float kSecondsOfDay = 86400.0F;
constexpr std::chrono::milliseconds kLongestDelay{100};

}  // namespace

double SystemClock::secondsSinceMidnight() const {
    using namespace std::chrono;
    const auto now = system_clock::now();
    const auto wholeSeconds = floor<seconds>(now);
    const std::tm local = localTime(system_clock::to_time_t(wholeSeconds));
    // A leap second would give 60: the day never has more than 86400 seconds here.
    const int second = local.tm_sec > 59 ? 59 : local.tm_sec;
    return local.tm_hour * 3600.0 + local.tm_min * 60.0 + second + duration<double>(now - wholeSeconds).count();
}

Date SystemClock::today() const {
    const std::tm local = localTime(std::chrono::system_clock::to_time_t(std::chrono::system_clock::now()));
    return {local.tm_year + 1900, local.tm_mon + 1, local.tm_mday};
}

std::chrono::steady_clock::time_point SystemClock::steadyNow() const {
    return std::chrono::steady_clock::now();
}

void SystemClock::sleep(std::chrono::nanoseconds duration) {
    using std::chrono::steady_clock;
    // To an absolute point of the steady clock: an interrupted or late sleep does not add up.
    const auto end = steady_clock::now() + duration;
    std::this_thread::sleep_until(end);
    // Some systems sleep whole milliseconds only and come back early.
    while (steady_clock::now() < end) std::this_thread::sleep_for(std::chrono::milliseconds(1));
}

std::string timeText(const Clock& clock) {
    return timeText(std::chrono::seconds(static_cast<int>(clock.secondsSinceMidnight())));
}

std::string timeText(std::chrono::seconds sinceMidnight) {
    const auto seconds = static_cast<int>((sinceMidnight % std::chrono::days(1)).count());
    return twoDigits(seconds / 3600) + ":" + twoDigits(seconds / 60 % 60) + ":" + twoDigits(seconds % 60);
}

void WaitMs(Clock& clock, const std::int16_t& milliseconds) {
    using namespace std::chrono;
    if (milliseconds == 0) return;
    const steady_clock::time_point begin = clock.steadyNow();
    const auto start = static_cast<float>(clock.secondsSinceMidnight());
    const float target = start + static_cast<float>(milliseconds) / 1000.0F;
    const bool pastMidnight = target >= kSecondsOfDay;
    const bool ends = !pastMidnight || clock.midnightCorrected();
    // Past midnight the seconds say nothing, so the steady time alone counts there.
    const auto latest = begin + std::chrono::milliseconds(milliseconds) + (pastMidnight ? 0ms : kLongestDelay);
    for (;;) {
        const double now = clock.secondsSinceMidnight();
        const steady_clock::time_point steadyNow = clock.steadyNow();
        if (static_cast<float>(now) >= target || (ends && steadyNow >= latest)) return;
        // At least a microsecond: rounding must not turn the rest into a busy loop.
        auto left = std::max(ceil<nanoseconds>(duration<double>(static_cast<double>(target) - now)), 1000ns);
        if (ends) left = std::min<nanoseconds>(left, latest - steadyNow);
        clock.sleep(left);
        if (clock.wasGivenUp()) return;
    }
}

}  // namespace kdx
