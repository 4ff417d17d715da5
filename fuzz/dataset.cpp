// Profile files of any kind as general settings and data set: the whole of them is loaded and sent as when a session
// is opened, and the instrument answers on.
#include "harness.h"

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "station/session.h"
#include "support/fakeclock.h"
#include "support/tempfolder.h"

#include <stdexcept>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    FuzzedDataProvider input(data, size);
    static const kdx::test::TempFolder folder;
    folder.write(kdx::kGeneralSettings, kdx::fuzz::nextText(input));
    folder.write(kdx::dataSetFile("1"), input.ConsumeRemainingBytesAsString());

    kdx::test::FakeClock clock;
    kdx::sim::VirtualInstrument instrument(clock);
    kdx::sim::SimVisa visa(instrument);
    kdx::ProgramState state;
    kdx::DataFolder files(folder.path());
    const kdx::Captions captions(files);
    kdx::Session session(visa, state, files, captions, clock, [] {});
    session.load();
    demand(session.open("TCPIP", "127.0.0.1") == kdx::visa::kSuccess, "the virtual instrument is there");
    try {
        demand(session.sendOpening(), "nobody stopped it");
    } catch (const std::overflow_error&) {  // a deviation that no number can hold is refused so, on purpose
    }
    session.close();
    instrument.execute("*CLS");
    demand(instrument.execute("*IDN?") == std::string(kdx::sim::kDefaultIdentification) + "\n", "it answers on");
    return 0;
}
