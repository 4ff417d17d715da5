#pragma once

#include "sim/messagedevice.h"
#include "sim/virtualinstrument.h"
#include "support/fakeclock.h"

namespace kdx::fuzz {

/// The virtual instrument as a server sees it, its clock standing still.
class InstrumentDevice final : public sim::MessageDevice {
public:
    std::string execute(std::string_view message) override { return m_instrument.execute(message); }
    void clear() override { m_instrument.deviceClear(); }
    unsigned char statusByte(bool messageAvailable) override { return m_instrument.statusByte(messageAvailable); }
    void report(sim::ScpiError error) override { m_instrument.report(error); }

private:
    test::FakeClock m_clock;
    sim::VirtualInstrument m_instrument{m_clock};
};

}  // namespace kdx::fuzz
