#include "link/lanvisa.h"

#include "link/hostlookup.h"
#include "link/lanresource.h"
#include "link/rpcchannel.h"
#include "link/visastatus.h"
#include "vxi11.h"
#include "vxi11/numbers.h"

#include <rpc/pmap_prot.h>

#include <algorithm>
#include <variant>

namespace kdx {

namespace {

using std::chrono::steady_clock;

constexpr std::size_t kSmallestMaxReceive = 1024;                 // every device must take as much
constexpr std::size_t kLargestTransfer = std::size_t{64} * 1024;  // bytes in one call

VisaStatus statusOf(RpcOutcome outcome) {
    switch (outcome) {
        case RpcOutcome::Done:
            return visa::kSuccess;
        case RpcOutcome::TimedOut:
            return visa::kTimeout;
        case RpcOutcome::Lost:
            return visa::kConnectionLost;
        case RpcOutcome::Unavailable:
            return visa::kResourceNotFound;
        case RpcOutcome::Failed:
            break;
    }
    return visa::kInputOutput;
}

VisaStatus statusOfDeviceError(long error) {
    switch (error) {
        case vxi11::kNoError:
            return visa::kSuccess;
        case vxi11::kDeviceNotAccessible:
        case vxi11::kInvalidAddress:
            return visa::kResourceNotFound;
        case vxi11::kInvalidLink:  // the device has forgotten us, as after its restart
            return visa::kConnectionLost;
        case vxi11::kLockedByAnotherLink:
            return visa::kResourceLocked;
        case vxi11::kIoTimeout:
            return visa::kTimeout;
        case vxi11::kAborted:
            return visa::kAborted;
        default:
            return visa::kInputOutput;
    }
}

VisaStatus combined(RpcOutcome outcome, long deviceError) {
    return outcome == RpcOutcome::Done ? statusOfDeviceError(deviceError) : statusOf(outcome);
}

u_long millisecondsUntil(Deadline deadline) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - steady_clock::now());
    return left.count() > 0 ? static_cast<u_long>(left.count()) : 0;
}

/// Asks the host for the port of its VXI-11 core channel: version 2 of the port mapper over TCP, which all devices
/// know.
VisaStatus askForCorePort(const sockaddr_in& address, std::uint16_t portMapperPort, Deadline deadline,
                          const std::atomic_bool& aborting, std::uint16_t& corePort) {
    RpcChannel portMapper(PMAPPROG, PMAPVERS, aborting);
    if (!portMapper.connect(address, portMapperPort, deadline)) return visa::kResourceNotFound;
    pmap wanted{DEVICE_CORE, DEVICE_CORE_VERSION, IPPROTO_TCP, 0};
    std::uint32_t port = 0;
    const RpcOutcome outcome = portMapper.call(
        PMAPPROC_GETPORT, 0, [&](XDR* xdr) { return xdr_pmap(xdr, &wanted); },
        [&](XDR* xdr) { return xdr_uint32_t(xdr, &port); }, deadline);
    if (outcome != RpcOutcome::Done) return statusOf(outcome);
    if (port == 0) return visa::kResourceNotFound;  // not registered
    if (port > 0xFFFF) return visa::kInputOutput;
    corePort = static_cast<std::uint16_t>(port);
    return visa::kSuccess;
}

}  // namespace

/// One link to one device, over a connection of its own.
struct LanVisa::Link {
    explicit Link(const std::atomic_bool& aborted) : aborting(aborted) {}

    VisaHandle manager = 0;
    const std::atomic_bool& aborting;
    RpcChannel channel{DEVICE_CORE, DEVICE_CORE_VERSION, aborting};
    Device_Link id = 0;
    std::size_t maxReceive = kSmallestMaxReceive;  ///< the most bytes that the device takes in one call

    VisaStatus connect(const sockaddr_in& address, const LanOptions& options, Deadline deadline) {
        std::uint16_t port = options.corePort;
        if (port == 0) {
            const VisaStatus status = askForCorePort(address, options.portMapperPort, deadline, aborting, port);
            if (status != visa::kSuccess) return status;
        }
        return channel.connect(address, port, deadline) ? visa::kSuccess : visa::kResourceNotFound;
    }

    VisaStatus create(std::string device, bool locked, Deadline deadline) {
        Create_LinkParms wanted{manager, locked, 0, device.data()};
        Create_LinkResp made{};
        const RpcOutcome outcome = channel.call(
            create_link, device.size(), [&](XDR* xdr) { return xdr_Create_LinkParms(xdr, &wanted); },
            [&](XDR* xdr) { return xdr_Create_LinkResp(xdr, &made); }, deadline);
        const VisaStatus status = combined(outcome, made.error);
        if (status != visa::kSuccess) return status;
        id = made.lid;
        if (const auto most = static_cast<std::uint32_t>(made.maxRecvSize); most > 0) maxReceive = most;
        return status;
    }
};

LanVisa::LanVisa(LanOptions options) : m_options(options) {}

LanVisa::~LanVisa() = default;

VisaStatus LanVisa::viOpenDefaultRM(VisaHandle& resourceManager) {
    resourceManager = ++m_lastHandle;
    m_managers.insert(resourceManager);
    return visa::kSuccess;
}

VisaStatus LanVisa::viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) {
    if (!m_managers.contains(object) && find(object) == nullptr) return visa::kInvalidObject;
    return describeStatus(status, description);
}

VisaStatus LanVisa::viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                           std::uint32_t openTimeoutMs, VisaHandle& session) {
    if (!m_managers.contains(resourceManager)) return visa::kInvalidObject;
    const auto parsed = parseLanResource(resource);
    if (const auto* const failure = std::get_if<VisaStatus>(&parsed)) return *failure;
    const LanResource& wanted = std::get<LanResource>(parsed);

    const auto connectTime = openTimeoutMs > 0 ? std::chrono::milliseconds(openTimeoutMs) : m_options.connectTimeout;
    auto link = std::make_unique<Link>(m_aborting);
    link->manager = resourceManager;
    const VisaStatus status = open(wanted, accessMode == 1, steady_clock::now() + connectTime, *link);
    if (status != visa::kSuccess) return unlessAborted(status);
    session = ++m_lastHandle;
    m_links.emplace(session, std::move(link));
    return visa::kSuccess;
}

VisaStatus LanVisa::open(const LanResource& wanted, bool locked, Deadline connectDeadline, Link& link) const {
    VisaStatus status = visa::kResourceNotFound;
    for (const sockaddr_in& address : resolveHost(wanted.host, connectDeadline, m_aborting)) {
        status = link.connect(address, m_options, connectDeadline);
        if (status != visa::kResourceNotFound) break;
    }
    if (status != visa::kSuccess) return status;
    return link.create(wanted.device, locked, steady_clock::now() + m_options.ioTimeout + m_options.answerMargin);
}

VisaStatus LanVisa::viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) {
    written = 0;
    Link* const link = find(session);
    if (link == nullptr) return visa::kInvalidObject;
    const Deadline deadline = steady_clock::now() + m_options.ioTimeout;
    const std::size_t most = std::min(link->maxReceive, kLargestTransfer);
    while (!bytes.empty()) {
        const std::span<const char> part = bytes.first(std::min(bytes.size(), most));
        Device_WriteParms wanted{};
        wanted.lid = link->id;
        wanted.io_timeout = millisecondsUntil(deadline);
        wanted.lock_timeout = wanted.io_timeout;
        wanted.flags = vxi11::kFlagWaitLock | (part.size() == bytes.size() ? vxi11::kFlagEnd : 0);
        wanted.data.data_len = static_cast<u_int>(part.size());
        wanted.data.data_val = const_cast<char*>(part.data());  // only read from
        Device_WriteResp done{};
        const RpcOutcome outcome = link->channel.call(
            device_write, part.size(), [&](XDR* xdr) { return xdr_Device_WriteParms(xdr, &wanted); },
            [&](XDR* xdr) { return xdr_Device_WriteResp(xdr, &done); }, deadline + m_options.answerMargin);
        const VisaStatus status = combined(outcome, done.error);
        if (status != visa::kSuccess) return unlessAborted(status);
        const auto taken = static_cast<std::uint32_t>(done.size);
        if (taken == 0 || taken > part.size()) return visa::kInputOutput;
        written += static_cast<std::int32_t>(taken);
        bytes = bytes.subspan(taken);
    }
    return visa::kSuccess;
}

VisaStatus LanVisa::viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) {
    count = 0;
    Link* const link = find(session);
    if (link == nullptr) return visa::kInvalidObject;
    const Deadline deadline = steady_clock::now() + m_options.ioTimeout;
    while (!buffer.empty()) {
        const std::span<char> room = buffer.first(std::min(buffer.size(), kLargestTransfer));
        Device_ReadParms wanted{};
        wanted.lid = link->id;
        wanted.requestSize = room.size();
        wanted.io_timeout = millisecondsUntil(deadline);
        wanted.lock_timeout = wanted.io_timeout;
        wanted.flags = vxi11::kFlagWaitLock;
        Device_ErrorCode error = 0;
        long reason = 0;
        u_int got = 0;
        // Straight into the buffer, and checked against it: the length that the device states is not to be trusted.
        const auto decode = [&](XDR* xdr) {
            return xdr_Device_ErrorCode(xdr, &error) && xdr_long(xdr, &reason) && xdr_u_int(xdr, &got) &&
                   got <= room.size() && xdr_opaque(xdr, room.data(), got);
        };
        const RpcOutcome outcome = link->channel.call(
            device_read, 0, [&](XDR* xdr) { return xdr_Device_ReadParms(xdr, &wanted); }, decode,
            deadline + m_options.answerMargin);
        const VisaStatus status = combined(outcome, error);
        if (status != visa::kSuccess) return unlessAborted(status);
        count += static_cast<std::int32_t>(got);
        buffer = buffer.subspan(got);
        if ((reason & vxi11::kReasonEnd) != 0) return visa::kSuccess;
        if ((reason & vxi11::kReasonTermChar) != 0) return visa::kTermCharacter;
        // Some devices never give END. A line feed ends every answer; when the count stopped the device, one may as
        // well stand in the middle.
        const bool stoppedByCount = (reason & vxi11::kReasonRequestCount) != 0;
        if (got > 0 && room[got - 1] == '\n' && !stoppedByCount) return visa::kSuccess;
        if (got == 0) return visa::kInputOutput;  // neither bytes nor an end: it would never be over
    }
    return visa::kMaxCountReached;
}

VisaStatus LanVisa::viClose(VisaHandle object) {
    if (const auto found = m_links.find(object); found != m_links.end()) {
        destroyLink(*found->second);
        m_links.erase(found);
        return visa::kSuccess;
    }
    if (m_managers.erase(object) == 0) return visa::kInvalidObject;
    std::erase_if(m_links, [&](const auto& entry) {
        if (entry.second->manager != object) return false;
        destroyLink(*entry.second);
        return true;
    });
    return visa::kSuccess;
}

/// A wait that was aborted ends like one that lasted too long.
VisaStatus LanVisa::unlessAborted(VisaStatus status) const {
    return m_aborting ? visa::kAborted : status;
}

LanVisa::Link* LanVisa::find(VisaHandle session) {
    const auto found = m_links.find(session);
    return found == m_links.end() ? nullptr : found->second.get();
}

/// Whatever the device says to it, the session is over.
void LanVisa::destroyLink(Link& link) {
    Device_Error ignored{};
    link.channel.call(
        destroy_link, 0, [&](XDR* xdr) { return xdr_Device_Link(xdr, &link.id); },
        [&](XDR* xdr) { return xdr_Device_Error(xdr, &ignored); }, steady_clock::now() + m_options.closeTimeout);
}

}  // namespace kdx
