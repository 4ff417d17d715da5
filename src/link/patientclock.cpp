#include "link/patientclock.h"

#include "link/workervisa.h"

namespace kdx {

void PatientClock::sleep(std::chrono::nanoseconds duration) {
    constexpr std::chrono::milliseconds kShort{150};  // nobody notices; the pause between two commands is one
    m_givenUp = duration > kShort && !m_worker.pause(duration);
    if (duration <= kShort) m_clock.sleep(duration);
}

}  // namespace kdx
