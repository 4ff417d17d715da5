#pragma once

#include "link/instrument.h"

#include "settings/datafolder.h"
#include "settings/programstate.h"
#include "support/fakeclock.h"
#include "support/fakevisa.h"
#include "support/tempfolder.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace kdx::test {

using Lines = std::vector<std::string>;

inline constexpr VisaHandle kSession = 17;

/// An answer as ReadFromGen gives it: filled with blanks to the buffer's 60 characters.
inline std::string filled(std::string answer) {
    answer.resize(60, ' ');
    return answer;
}

/// The command transport between a scripted VISA library, a data folder of its own and a clock that stands still.
class InstrumentTest : public ::testing::Test {
protected:
    InstrumentTest() {
        m_state.InstrumentOnline = true;
        m_state.LogEnabled = true;
        m_instrument.InstrSession = kSession;
        m_instrument.setCaptionSource([](int number) { return "<" + std::to_string(number) + ">"; });
    }
    [[nodiscard]] std::string log() const { return m_folder.read(kCommandLog); }
    [[nodiscard]] std::string askCoder(const std::string& answer) {
        m_visa.answers = {answer};
        return m_instrument.X4_Abfrage("PS", "PS?");
    }
    [[nodiscard]] std::string askGenerator(const std::string& answer) {
        m_visa.answers = {answer};
        return m_instrument.VRN_Abfrage("HF", "FREQ");
    }

    TempFolder m_folder;
    FakeClock m_clock{100};
    FakeVisa m_visa;
    ProgramState m_state;
    DataFolder m_data{m_folder.path()};
    Lines m_errors;
    bool m_stopAtFailure = false;  // press the button that stops the running sequence
    Instrument m_instrument{m_visa, m_state, m_data, m_clock, [this](const auto& text, bool sequence) {
                                m_errors.push_back(text);
                                return sequence && m_stopAtFailure;
                            }};
};

}  // namespace kdx::test
