#pragma once

#include <deque>
#include <map>
#include <set>
#include <string>

#include "link/visa.h"

namespace kdx::sim {

class VirtualInstrument;

/// The virtual instrument behind the VISA operations, inside the program: whatever resource is opened, it is there.
class SimVisa final : public Visa {
public:
    /// @param instrument borrowed; all sessions talk to it.
    explicit SimVisa(VirtualInstrument& instrument) : m_instrument(instrument) {}

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override;
    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override;
    /// Every well-formed resource opens: "GPIB0::28::INSTR", "TCPIP::host::INSTR", "TCPIP::host::device::INSTR".
    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override;
    /// Each write is one whole program message.
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override;
    /// Reads at most one answer; with nothing to read it gives the time-out status at once, without the wait.
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override;
    /// A resource manager takes its sessions with it.
    VisaStatus viClose(VisaHandle object) override;

private:
    struct Session {
        VisaHandle resourceManager;
        std::deque<std::string> answers;  ///< unread answers, the first perhaps in part
    };

    VirtualInstrument& m_instrument;
    std::set<VisaHandle> m_resourceManagers;
    std::map<VisaHandle, Session> m_sessions;
    VisaHandle m_lastHandle = 0;  // handles are never used twice: a closed one stays invalid
};

}  // namespace kdx::sim
