// Program messages to the virtual instrument: answers are bounded, the trace finds words for every command, and the
// instrument answers on.
#include "harness.h"

#include "sim/virtualinstrument.h"
#include "simserver/trace.h"
#include "support/fakeclock.h"

#include <algorithm>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    const std::string_view message(reinterpret_cast<const char*>(data), size);
    const kdx::test::FakeClock clock;
    kdx::sim::VirtualInstrument instrument(clock);
    instrument.onUnit([](const kdx::sim::CommandUnit& unit, kdx::sim::ScpiError error) {
        const bool refused = error != kdx::sim::ScpiError::None;
        demand(kdx::simserver::describe(unit, error).starts_with("refused: ") == refused, "a refusal is told");
    });

    constexpr std::size_t kLongestLine = 65537;
    const auto lines = static_cast<std::size_t>(std::count(message.begin(), message.end(), '\n')) + 1;
    const std::string answer = instrument.execute(message);
    demand(answer.size() <= lines * kLongestLine, "an answer is bounded");
    demand(answer.empty() || answer.back() == '\n', "an answer ends with its line");
    demand(instrument.execute("*CLS").empty(), "what asks nothing gets no answer");
    demand(instrument.execute("*IDN?") == std::string(kdx::sim::kDefaultIdentification) + "\n", "it answers on");
    demand(instrument.execute("SYST:ERR?") == "0,\"No error\"\n", "its errors can be emptied");
    return 0;
}
