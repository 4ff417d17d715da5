#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

#include "sim/coderclock.h"
#include "sim/errorqueue.h"
#include "sim/setup.h"
#include "sim/transmission.h"

namespace kdx::sim {

/// The stereo/RDS coder: reads the commands and queries of its own language, which reach it inside the generator's
/// ":STEREO:DIRECT". Letter case of names does not matter, and a blank in a name stands for the hyphen.
class Coder {
public:
    static constexpr std::size_t kMemories = 5;

    /// @param settings the instrument's settings, shared with the generator's own commands; must outlive the coder.
    Coder(const Clock& clock, InstrumentSettings& settings) : m_settings(settings), m_clock(clock) {}

    /// Carries out a command: a name, "=" and a value ("PS=RADIO 1 "). A command that is refused changes nothing.
    ScpiError command(std::string_view text);

    /// Answers a query: a name, for some of them a comma and an argument, a question mark at the end or not ("PS",
    /// "EON PI?", "EON-AFB,D3C2,1"). There is an answer whenever the name is known, even if only an empty one.
    [[nodiscard]] Reply query(std::string_view text) const;

    /// What goes on the air.
    [[nodiscard]] Transmission transmission() const {
        return {m_settings, m_openData.last, m_traffic.last, m_clock.lead()};
    }

    /// Stops the clock and forgets the open-data and traffic messages. Memories are kept.
    void reset();

private:
    /// Group messages given to the coder: the last one as sent, and how many there were.
    struct Messages {
        std::string last;
        unsigned long count = 0;
    };
    struct Row;
    static const Row* rowOf(std::string_view name);

    ScpiError setPs(std::string_view value);
    ScpiError setPi(std::string_view value);
    ScpiError setRadiotext(std::string_view value);
    ScpiError setGroupSequence(std::string_view value);
    ScpiError setTrafficMessage(std::string_view value);
    ScpiError setOpenData(std::string_view value);
    ScpiError store(std::string_view value);
    ScpiError recall(std::string_view value);
    [[nodiscard]] std::string filledMemories() const;

    InstrumentSettings& m_settings;
    CoderClock m_clock;
    Messages m_openData;
    Messages m_traffic;
    std::array<std::optional<Setup>, kMemories> m_memories;
};

}  // namespace kdx::sim
