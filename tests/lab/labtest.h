#pragma once

#include <QTableWidget>

#include "sim/simvisa.h"
#include "sim/virtualinstrument.h"
#include "support/windowtest.h"

namespace kdx::test {

/// The window on the shipped data with a session to a virtual instrument.
class LabTest : public WindowTest {
protected:
    ~LabTest() override { end(); }
    Visa& instrumentLink() override { return link; }

    void open(const char* language = "deutsch") {
        folder.copyShipped();
        setGeneral("Sprache", "Sprache", language);
        start();
        heard = [this](const Traffic& traffic) {
            if (traffic.kind == Traffic::Kind::Written && !traffic.text.ends_with('?') &&
                traffic.text.find('?') == std::string::npos)
                commands.push_back(traffic.text);
        };
        openSession();
        commands.clear();
    }
    /// Somebody else works with the instrument.
    void send(const std::string& command) { link.viWrite(session->instrument.InstrSession, command, m_written); }
    Lines taken() { return std::exchange(commands, {}); }

    sim::VirtualInstrument instrument{clock};
    sim::SimVisa link{instrument};
    Lines commands;  ///< what went out, without the questions

private:
    std::int32_t m_written = 0;
};

}  // namespace kdx::test
