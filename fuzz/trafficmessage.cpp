// Traffic messages made of an event's and a location's entry, as the message table keeps them and the coder gets them.
#include "harness.h"

#include "sim/coder.h"
#include "support/fakeclock.h"
#include "tmc/groupcode.h"
#include "tmc/messagelist.h"

#include <cmath>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    const auto bits = [&input](std::size_t count) { return kdx::lastBits(input.ConsumeIntegralInRange(0, 7), count); };
    const int count = input.ConsumeIntegralInRange(1, 50);
    const int position = input.ConsumeIntegralInRange(0, count - 1);
    kdx::GroupBits fields{bits(1), bits(1), bits(3), bits(1), bits(1), bits(3), {}, {}};
    const std::string event = kdx::fuzz::nextText(input);
    const std::string location = kdx::fuzz::nextText(input);
    const double eventNumber = kdx::entryNumber(event), locationNumber = kdx::entryNumber(location);
    fields.event = kdx::lastBits(eventNumber, 11);
    fields.location = kdx::lastBits(locationNumber, 16);

    const std::string code = kdx::groupCode(fields);
    demand(code.size() == kdx::kGroupCodeLength, "a group code has ten characters");
    demand(kdx::codeOfMessage(kdx::messageEntry(location, event, code)) == code, "an entry keeps its code");
    const auto fits = [](double number) { return number >= 0 && number < 65536; };
    if (fits(eventNumber) && fits(locationNumber)) {
        const kdx::test::FakeClock clock;
        kdx::sim::InstrumentSettings settings;
        kdx::sim::Coder coder(clock, settings);
        demand(coder.command("8A=02," + code) == kdx::sim::ScpiError::None, "the coder takes the message");
    }
    const int next = kdx::nextPosition(position, count);
    demand(next >= 0 && next < count, "the next message is one of the list");
    demand(!std::isnan(kdx::cycleTimeMs(event)), "a change time is a number");
    return 0;
}
