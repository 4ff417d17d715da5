#pragma once

#include "link/deadline.h"
#include "link/visa.h"

#include <atomic>
#include <chrono>
#include <cstdint>
#include <map>
#include <memory>
#include <set>
#include <string>

namespace kdx {

struct LanResource;

/// Times and ports of the LAN client.
struct LanOptions {
    /// Until the host's name must be known and somebody have taken the connection, when viOpen gives no time of its
    /// own.
    std::chrono::milliseconds connectTimeout{3000};
    /// For a whole write or read; the VISA standard's default.
    std::chrono::milliseconds ioTimeout{2000};
    /// How much longer than the device itself we wait for its answer, since its own report of a time-out must reach us.
    /// Below a quarter of ioTimeout: with what is done besides, no call lasts longer than a time-out and a quarter.
    std::chrono::milliseconds answerMargin{400};
    /// For the device to let go of a link that is given up whatever it answers: somebody waits for the program to end.
    std::chrono::milliseconds closeTimeout{500};
    std::uint16_t portMapperPort = 111;
    std::uint16_t corePort = 0;  ///< 0: the port mapper is asked
};

/// VISA sessions to instruments on the network (VXI-11), without an installed library.
/// Resources: parseLanResource. Statuses that viOpen gives besides those: kResourceNotFound when the host is unknown,
/// nobody takes the connection, or there is no such device; kTimeout when somebody took it and then kept silent.
/// viWrite and viRead wait for a lock of somebody else within the I/O time-out; then they give kResourceLocked. They
/// give kTimeout, kConnectionLost (also ever after), kAborted as the cause is; kInputOutput when the device reports
/// another error, or answers nonsense (then the connection is given up).
class LanVisa final : public Visa {
public:
    explicit LanVisa(LanOptions options = {});
    ~LanVisa() override;

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override;
    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override;
    /// Blocks no longer than the connect and I/O time-outs.
    /// @param accessMode 0 for no lock, 1 for an exclusive one. @param openTimeoutMs replaces the connect time-out.
    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override;
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override;
    /// kSuccess when the answer's end came with the bytes (END, or a line feed at the end of them), kTermCharacter when
    /// the device stopped at its termination character, kMaxCountReached when the buffer is full before.
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override;
    /// Closing a resource manager closes its sessions. Succeeds also when the device is no longer there.
    VisaStatus viClose(VisaHandle object) override;
    void setAborting(bool aborting) override { m_aborting = aborting; }

private:
    struct Link;

    Link* find(VisaHandle session);
    void destroyLink(Link& link);

    [[nodiscard]] VisaStatus open(const LanResource& wanted, bool locked, Deadline connectDeadline, Link& link) const;
    [[nodiscard]] VisaStatus unlessAborted(VisaStatus status) const;

    LanOptions m_options;
    std::atomic_bool m_aborting = false;
    VisaHandle m_lastHandle = 0;  // never given twice: a closed handle stays invalid
    std::set<VisaHandle> m_managers;
    std::map<VisaHandle, std::unique_ptr<Link>> m_links;
};

}  // namespace kdx
