// Answers of the instrument to the questions for everything: what is made of them is a file that can be applied, and
// commands that the virtual instrument understands or refuses.
#include "harness.h"
#include "madeupvisa.h"

#include "link/instrument.h"
#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/profilefile.h"
#include "settings/programstate.h"
#include "sim/virtualinstrument.h"
#include "station/readout.h"
#include "station/setupfile.h"
#include "support/fakeclock.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    kdx::fuzz::MadeUpVisa visa(input);
    kdx::ProgramState state;
    kdx::DataFolder files("/nonexistent");
    const kdx::Captions captions(files);
    kdx::test::FakeClock clock;
    kdx::Instrument instrument(visa, state, files, captions, clock);
    instrument.open("TCPIP", "127.0.0.1");

    const kdx::Readout first = kdx::readOut(instrument);
    const kdx::Readout second = kdx::readOut(instrument);
    demand(kdx::differences(first, first).empty(), "what is the same does not differ");

    kdx::sim::VirtualInstrument simulated(clock);
    for (const auto& [key, command] : kdx::commandsFor(kdx::differences(first, second), first)) {
        demand(!key.empty() && !command.empty(), "every command has a text");
        simulated.execute(command);
    }
    simulated.execute("*CLS");
    demand(simulated.execute("*IDN?") == std::string(kdx::sim::kDefaultIdentification) + "\n", "it answers on");

    kdx::ProfileText text("[Own]\r\nA=1\r\n");
    kdx::keep(first, text);
    demand(text.value("Own", "A") == "1", "no answer becomes a setting of its own");
    demand(text.section("Own").size() == 1, "no answer becomes a setting in another section");
    return 0;
}
