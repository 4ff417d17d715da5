#include "sim/status.h"

#include <array>
#include <utility>

namespace kdx::sim {

namespace {

// Standard event status register.
constexpr int kOperationComplete = 1;
constexpr int kQueryError = 4;
constexpr int kDeviceError = 8;
constexpr int kExecutionError = 16;
constexpr int kCommandError = 32;

// Status byte.
constexpr int kErrorsQueued = 4;
constexpr int kMessageAvailable = 16;
constexpr int kEventSummary = 32;
constexpr int kMasterSummary = 64;

int eventOf(ScpiError error) {
    const int hundreds = -static_cast<int>(error) / 100;
    constexpr std::array<int, 5> kEvents = {0, kCommandError, kExecutionError, kDeviceError, kQueryError};
    return kEvents[static_cast<std::size_t>(hundreds)];
}

}  // namespace

void Status::report(ScpiError error) {
    m_errors.push(error);
    m_events |= eventOf(error);
}

void Status::operationComplete() {
    m_events |= kOperationComplete;
}

int Status::takeEvents() {
    return std::exchange(m_events, 0);
}

void Status::clear() {
    m_errors.clear();
    m_events = 0;
}

int Status::byte(bool messageAvailable) const {
    int bits = (m_errors.empty() ? 0 : kErrorsQueued) | (messageAvailable ? kMessageAvailable : 0) |
               ((m_events & eventEnable) == 0 ? 0 : kEventSummary);
    if ((bits & m_serviceEnable) != 0) bits |= kMasterSummary;
    return bits;
}

// The summary bit cannot be its own cause.
void Status::setServiceEnable(int bits) {
    m_serviceEnable = bits & ~kMasterSummary;
}

}  // namespace kdx::sim
