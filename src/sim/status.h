#pragma once

#include <string>

#include "sim/errorqueue.h"

namespace kdx::sim {

/// The instrument's status reporting by IEEE 488.2 and SCPI: errors, events, what of them is enabled, and the byte that
/// sums it up. Nothing happens in this instrument that the operation and questionable registers could tell of, so of
/// these there is only what clients set.
class Status {
public:
    /// Queues an error and notes its kind as an event.
    void report(ScpiError error);
    /// Notes that all is done: commands are, as soon as they have been carried out.
    void operationComplete();

    /// The oldest error, taken out; see ErrorQueue::pop.
    std::string popError() { return m_errors.pop(); }
    /// The event register, which is empty afterwards.
    int takeEvents();
    /// Empties errors and events.
    void clear();

    /// 4 errors are queued, 16 an answer waits to be fetched, 32 an enabled event has happened, 64 one of the others
    /// for which service is enabled is set.
    [[nodiscard]] int byte(bool messageAvailable) const;

    [[nodiscard]] int serviceEnable() const { return m_serviceEnable; }
    void setServiceEnable(int bits);

    int eventEnable = 0;
    /// What clients set of the operation or the questionable register group.
    struct Group {
        int enable = 0;
        int positiveTransition = 32767;
        int negativeTransition = 0;
    };
    Group operation;
    Group questionable;
    /// An answer has begun to be put together: to a question of the message under way it is one that waits.
    bool answerBegun = false;

private:
    ErrorQueue m_errors;
    int m_events = 128;  // power on
    int m_serviceEnable = 0;
};

}  // namespace kdx::sim
