#pragma once

#include <gtest/gtest.h>

#include "coder/step.h"
#include "support/linkfixture.h"

namespace kdx::test {

/// A part of a data set on its own: its settings files, and an open session that takes its steps.
class PartTest : public ::testing::Test, protected LinkFixture {
protected:
    PartTest() { state.InstrumentOnline = true; }

    /// Key and value of each step.
    static Lines shown(const Steps& steps) {
        Lines lines;
        for (const Step& step : steps) {
            EXPECT_EQ(step.kind, Step::Kind::Parameter);
            lines.push_back(step.key + "=" + step.value);
        }
        return lines;
    }
    /// What goes to the instrument for the steps.
    Lines sentFor(const Steps& steps) {
        for (const Step& step : steps) params.SendParam(step.key, std::string(step.value));
        return sent();
    }
};

}  // namespace kdx::test
