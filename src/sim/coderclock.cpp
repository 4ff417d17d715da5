#include "sim/coderclock.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "base/clock.h"
#include "base/codepage.h"
#include "base/numbers.h"
#include "sim/scpi.h"

namespace kdx::sim {

namespace {

using namespace std::chrono;

constexpr std::string_view kForm = "00:00:00,00.00.00";  // a digit for each 0, the rest as it stands
constexpr int kCentury = 2000;

bool hasForm(std::string_view text) {
    return std::equal(text.begin(), text.end(), kForm.begin(), kForm.end(),
                      [](char c, char form) { return form == '0' ? c >= '0' && c <= '9' : c == form; });
}

// The two digits at each place of the form: hours, minutes, seconds, day, month, year.
std::array<int, 6> fields(std::string_view text) {
    std::array<int, 6> values{};
    for (std::size_t i = 0; i < values.size(); ++i) values[i] = (text[3 * i] - '0') * 10 + (text[3 * i + 1] - '0');
    return values;
}

}  // namespace

ScpiError CoderClock::set(std::string_view value) {
    value = trimmed(value);
    if (equalNoCase(value, "off")) {
        stop();
        return ScpiError::None;
    }
    if (!hasForm(value)) return ScpiError::IllegalValue;
    const auto [hour, minute, second, dayOfMonth, monthOfYear, yearOfCentury] = fields(value);
    const year_month_day date{year{kCentury + yearOfCentury}, month{static_cast<unsigned>(monthOfYear)},
                              day{static_cast<unsigned>(dayOfMonth)}};
    if (hour > 23 || minute > 59 || second > 59 || !date.ok()) return ScpiError::OutOfRange;
    m_lead = Time{sys_days{date}} + hours{hour} + minutes{minute} + seconds{second} - now();
    return ScpiError::None;
}

std::string CoderClock::text() const {
    if (!m_lead) return "off";
    const Time time = now() + *m_lead;
    const auto midnight = floor<days>(time);
    const year_month_day date{midnight};
    const hh_mm_ss clock{floor<seconds>(time - midnight)};
    const auto twoDigitsOf = [](auto number) { return twoDigits(static_cast<int>(number)); };
    return twoDigitsOf(clock.hours().count()) + ":" + twoDigitsOf(clock.minutes().count()) + ":" +
           twoDigitsOf(clock.seconds().count()) + "," + twoDigitsOf(static_cast<unsigned>(date.day())) + "." +
           twoDigitsOf(static_cast<unsigned>(date.month())) + "." + twoDigits(static_cast<int>(date.year()));
}

CoderClock::Time CoderClock::now() const {
    const Date today = m_clock.today();
    const year_month_day date{year{today.year}, month{static_cast<unsigned>(today.month)},
                              day{static_cast<unsigned>(today.day)}};
    return sys_days{date} + milliseconds{std::llround(m_clock.secondsSinceMidnight() * 1000.0)};
}

}  // namespace kdx::sim
