#include "app/ctl/pacedclock.h"

#include <cmath>

namespace kdx::ctl {

namespace {

constexpr double kDay = 86400;

}  // namespace

double PacedClock::secondsSinceMidnight() const {
    return std::fmod(m_clock.secondsSinceMidnight() + std::chrono::duration<double>(ahead()).count(), kDay);
}

Date PacedClock::today() const {
    using namespace std::chrono;
    const Date date = m_clock.today();
    const double seconds = m_clock.secondsSinceMidnight() + duration<double>(ahead()).count();
    const sys_days day = year(date.year) / month(static_cast<unsigned>(date.month)) / date.day;
    const year_month_day shown(day + days(static_cast<int>(seconds / kDay)));
    return {static_cast<int>(shown.year()), static_cast<int>(static_cast<unsigned>(shown.month())),
            static_cast<int>(static_cast<unsigned>(shown.day()))};
}

std::chrono::steady_clock::time_point PacedClock::steadyNow() const {
    return m_clock.steadyNow() + ahead();
}

void PacedClock::sleep(std::chrono::nanoseconds duration) {
    m_clock.sleep(std::chrono::duration_cast<std::chrono::nanoseconds>(Duration(duration) / m_factor));
}

void PacedClock::hasten(double factor) {
    m_begin = m_clock.steadyNow();
    m_factor = factor;
}

std::chrono::nanoseconds PacedClock::ahead() const {
    if (m_factor == 1) return std::chrono::nanoseconds(0);
    const Duration past = m_clock.steadyNow() - m_begin;
    return std::chrono::duration_cast<std::chrono::nanoseconds>(past * (m_factor - 1));
}

}  // namespace kdx::ctl
