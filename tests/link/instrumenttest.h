#pragma once

#include <gtest/gtest.h>

#include <string>

#include "support/linkfixture.h"

namespace kdx::test {

inline constexpr VisaHandle kSession = 17;

/// An answer as ReadFromGen gives it: filled with blanks to the buffer's 60 characters.
inline std::string filled(std::string answer) {
    answer.resize(60, ' ');
    return answer;
}

/// The command transport on a bench of its own; the captions read "<143>".
class InstrumentTest : public ::testing::Test, protected LinkFixture {
protected:
    InstrumentTest() {
        clock.set(100);
        state.InstrumentOnline = true;
        state.LogEnabled = true;
        instrument.InstrSession = kSession;
        folder.write(kLanguageFile, "[test]\r\n142=<142>\r\n143=<143>\r\n144=<144>\r\n");
        captions.load("test", "RDS");
    }
    [[nodiscard]] std::string log() const { return folder.read(kCommandLog); }
    [[nodiscard]] std::string askCoder(const std::string& answer) {
        visa.answers = {answer};
        return instrument.X4_Abfrage("PS", "PS?");
    }
    [[nodiscard]] std::string askGenerator(const std::string& answer) {
        visa.answers = {answer};
        return instrument.VRN_Abfrage("HF", "FREQ");
    }
};

}  // namespace kdx::test
