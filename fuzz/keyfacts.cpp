// Values of the key table: what is called legal is taken by the instrument.
#include "harness.h"

#include "coder/keyfacts.h"
#include "coder/sendparam.h"
#include "sim/virtualinstrument.h"
#include "support/fakeclock.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace kdx;
    FuzzedDataProvider input(data, size);
    const auto& all = keyFacts();
    const std::string key(all[input.ConsumeIntegralInRange<std::size_t>(0, all.size() - 1)].key);
    std::string value = input.ConsumeRemainingBytesAsString();
    if (wrongValue(key, value)) return 0;

    const test::FakeClock clock;
    sim::VirtualInstrument instrument(clock);
    instrument.execute(":STEREO:DIRECT \"EON-PI=D3C0\"");
    instrument.execute(":STEREO:DIRECT \"AF=N,98.5\"");
    instrument.execute("*CLS");
    if (key == "EON_DEL") value = "D3C0";  // any other network is not there
    const auto command = composeCommand(key, value, {"D3C0", "08:15:30", "23:59:58", "05.03.09"});
    instrument.execute(command.value());
    fuzz::demand(instrument.execute("SYST:ERR?").starts_with("0,"), "the instrument takes what is called legal");
    return 0;
}
