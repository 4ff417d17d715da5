// Commands and queries of the coder, a line each: one that is refused changes nothing.
#include "harness.h"

#include "sim/coder.h"
#include "support/fakeclock.h"

#include <array>

namespace {

using kdx::fuzz::demand;

constexpr std::array kQuestions = {"PS",     "PI",   "PTY",     "TP",     "TA",      "MS",    "DI",  "RT",
                                   "RT-N",   "CT",   "AF1",     "AF2",    "AF3",     "AF4",   "AF5", "GS",
                                   "3A",     "3A-N", "8A",      "8A-N",   "STORE",   "BIN",   "RDS", "RDS-DEV",
                                   "RDS-PH", "PIL",  "PIL-DEV", "PIL-PH", "MPX-DEV", "SRC",   "IMP", "MODE",
                                   "PRE",    "ARI",  "ARI-DEV", "ARI-ID", "BK",      "EON-PI"};

std::string stateOf(const kdx::sim::Coder& coder) {
    std::string state;
    for (const char* question : kQuestions) {
        const kdx::sim::Reply reply = coder.query(question);
        demand(reply.error == kdx::sim::ScpiError::None && reply.answer, "what is known is answered");
        state.append(*reply.answer).append("\n");
    }
    return state;
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const kdx::test::FakeClock clock;
    kdx::sim::InstrumentSettings settings;
    kdx::sim::Coder coder(clock, settings);
    std::string before = stateOf(coder);
    int left = 20;  // more lines would show nothing new, only take longer
    for (const std::string_view line : kdx::fuzz::split({reinterpret_cast<const char*>(data), size}, "\n")) {
        const kdx::sim::Reply reply = coder.query(line);
        demand(reply.answer || reply.error != kdx::sim::ScpiError::None, "a query is answered or refused");
        const bool refused = coder.command(line) != kdx::sim::ScpiError::None;
        std::string now = stateOf(coder);
        demand(!refused || now == before, "a command that is refused changes nothing");
        before = std::move(now);
        if (--left == 0) break;
    }
    return 0;
}
