// Group sequences, stored ones of any kind and composed ones; the coder takes what was composed.
#include "harness.h"

#include "groups/groupsequence.h"
#include "settings/profilefile.h"
#include "sim/coder.h"
#include "support/fakeclock.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    kdx::GroupSequence sequence;
    const std::string stored = kdx::fuzz::nextText(input);
    sequence.groups = stored;
    kdx::Steps steps;
    sequence.appendSteps(steps);
    demand(steps.size() == (stored.empty() ? 0 : 1), "what is stored is sent");
    demand(stored.empty() || steps[0].value + stored.back() == stored, "without its last character");
    demand(sequence.exceedsReading() == (stored.size() > kdx::kLongestValue), "a long one cannot be read back");

    std::string composed = kdx::groupText(input.ConsumeIntegralInRange(0, kdx::kGroups - 1));
    for (int groups = 1; groups < 256 && input.remaining_bytes() > 0; ++groups) {
        composed += kdx::groupText(input.ConsumeIntegralInRange(0, kdx::kGroups - 1));
    }
    const kdx::test::FakeClock clock;
    kdx::sim::InstrumentSettings settings;
    kdx::sim::Coder coder(clock, settings);
    const std::string value = kdx::sequenceToSend(composed);
    demand(coder.command("GS=" + value) == kdx::sim::ScpiError::None, "the coder takes what was composed");
    demand(coder.query("GS").answer == value, "and has it then");
    return 0;
}
