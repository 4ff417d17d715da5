#include "af/othernetwork.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "station/transmitter.h"
#include "support/linkfixture.h"

namespace kdx::test {
namespace {

using ::testing::ElementsAre;
using ::testing::StartsWith;

/// The removal that leads the steps of a network, as it goes over the link.
class NetworkRemoval : public ::testing::Test, protected LinkFixture {
protected:
    NetworkRemoval() { state.InstrumentOnline = true; }

    void remove() {
        Steps steps;
        OtherNetwork().appendSteps(steps);
        steps.resize(2);
        EXPECT_TRUE(transmitter.run(steps));
    }

    const std::string query = coder("EON PI?");
    Transmitter transmitter{instrument, params};
};

TEST_F(NetworkRemoval, TakesAllNetworksOfTheCoder) {
    visa.answersTo[query] = "\"1234,5678\"\n";
    remove();
    EXPECT_THAT(sent(), ElementsAre(query, direct("EON-DEL=1234"), direct("EON-DEL=5678")));
}

TEST_F(NetworkRemoval, FindsNoFurtherEntryInAListThatEndsInAComma) {
    visa.answersTo[query] = "\" D3C2,D3C3,\"\n";
    remove();
    EXPECT_THAT(sent(), ElementsAre(query, direct("EON-DEL=D3C2"), direct("EON-DEL=D3C3")));
}

TEST_F(NetworkRemoval, IsOneDeleteWithAnEmptyValueAfterAFailedQuery) {
    visa.readStatus = visa::kTimeout;
    remove();
    EXPECT_THAT(sent(), ElementsAre(query, direct("EON-DEL=")));
    EXPECT_THAT(failures, ElementsAre("Fehler: -1073807339"));
}

TEST_F(NetworkRemoval, LogsItsQueryUnderItsName) {
    state.LogEnabled = true;
    visa.answersTo[query] = "\" D3C2,\"\n";
    remove();
    EXPECT_THAT(folder.read("RDS_log.txt"), StartsWith("         EON-PI= :STEREO:DIRECT? \"EON PI?\"\r\n"));
}

}  // namespace
}  // namespace kdx::test
