#include "air/airtime.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

#include "base/clock.h"

namespace kdx::air {

namespace {

using namespace std::chrono;

constexpr std::string_view kForm = "0000-00-00 00:00:00";  // a digit for each 0, the rest as it stands
constexpr int kFirstYear = 2000;
constexpr int kLastYear = 2099;

AirTime timeOf(year_month_day date, milliseconds sinceMidnight) {
    return AirTime{sys_days{date}} + sinceMidnight;
}

}  // namespace

AirTime airTimeOf(const Clock& clock) {
    const Date today = clock.today();
    const milliseconds sinceMidnight{static_cast<std::int64_t>(std::floor(clock.secondsSinceMidnight() * 1000))};
    return timeOf(year{today.year} / today.month / today.day, sinceMidnight);
}

std::optional<AirTime> parseAirTime(std::string_view text) {
    const bool hasForm = std::equal(text.begin(), text.end(), kForm.begin(), kForm.end(),
                                    [](char c, char form) { return form == '0' ? c >= '0' && c <= '9' : c == form; });
    if (!hasForm) return std::nullopt;
    const auto number = [text](std::size_t at, std::size_t length) {
        int value = 0;
        std::from_chars(text.data() + at, text.data() + at + length, value);
        return value;
    };
    const year_month_day date = year{number(0, 4)} / number(5, 2) / number(8, 2);
    const int hour = number(11, 2);
    const int minute = number(14, 2);
    const int second = number(17, 2);
    const bool isTime = date.ok() && hour < 24 && minute < 60 && second < 60;
    if (!isTime || date.year() < year{kFirstYear} || date.year() > year{kLastYear}) return std::nullopt;
    return timeOf(date, hours{hour} + minutes{minute} + seconds{second});
}

}  // namespace kdx::air
