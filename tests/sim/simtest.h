#pragma once

#include <gtest/gtest.h>

#include <string>

#include "sim/virtualinstrument.h"
#include "support/fakeclock.h"

namespace kdx::sim {

/// A virtual instrument just switched on, and short ways to talk to it.
class SimTest : public ::testing::Test {
protected:
    /// The answer to a message, with its line end; "" when there is none.
    std::string tell(const std::string& message) { return instrument.execute(message); }
    /// The generator's answer without its line end.
    std::string ask(const std::string& query) {
        std::string answer = tell(query);
        EXPECT_FALSE(answer.empty()) << query;
        if (!answer.empty()) {
            EXPECT_EQ(answer.back(), '\n') << query;
            answer.pop_back();
        }
        return answer;
    }
    /// Sends a coder command.
    void coder(const std::string& command) { EXPECT_EQ(tell(":STEREO:DIRECT \"" + command + "\""), "") << command; }
    /// The coder's answer as it comes, quotes included, without the line end.
    std::string askCoder(const std::string& query) { return ask(":STEREO:DIRECT? \"" + query + "\""); }
    /// Takes the oldest error; only its number.
    int error() { return std::stoi(tell("SYST:ERR?")); }

    test::FakeClock clock;
    VirtualInstrument instrument{clock};
};

}  // namespace kdx::sim
