#include "scenario/playtest.h"
#include "settings/profilefile.h"
#include "sim/scpi.h"
#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/sourcefolder.h"

namespace kdx::test {
namespace {

using ShippedScenarios = PlayTest;

TEST_F(ShippedScenarios, TheInstrumentTakesAllThatTheySend) {
    folder.copyShipped();
    int taken = 0;
    scenario::RunOptions alone;
    alone.nobodyThere = true;
    int files = 0;
    for (const auto& file : std::filesystem::directory_iterator(sourceFolder() / "Daten" / "Scenarios")) {
        SCOPED_TRACE(file.path());
        const scenario::Scenario scenario = read(readFile(file.path()).value());
        begun.clear();
        sim::VirtualInstrument instrument(clock);
        instrument.onUnit([&](const sim::CommandUnit& unit, sim::ScpiError error) {
            if (begun.empty()) return;  // the opening: its first removal of a network names none
            EXPECT_EQ(static_cast<int>(error), 0) << unit.header << " " << unit.parameter;
            ++taken;
        });
        sim::SimVisa link(instrument);
        Session simulated(link, state, data, captions, clock, [] {});
        EXPECT_EQ(simulated.open("TCPIP", "10.0.0.1"), 0);
        simulated.load(Profile::ofFile(data, dataSetFile(std::to_string(scenario.dataSet.value()))));
        const auto outcome = scenario::Runner({simulated, state, clock, *this, *this}).run(scenario, alone);
        EXPECT_TRUE(outcome.complete);
        EXPECT_EQ(outcome.unmet, 0U);
        EXPECT_TRUE(scenario.restore);
        ++files;
    }
    EXPECT_EQ(files, 6);
    EXPECT_GT(taken, 500);
}

}  // namespace
}  // namespace kdx::test
