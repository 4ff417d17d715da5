#include "link/lanvisa.h"

#include "link/hostlookup.h"
#include "link/lanresource.h"
#include "link/rpcchannel.h"
#include "link/visastatus.h"
#include "vxi11/messages.h"
#include "vxi11/numbers.h"

#include <algorithm>
#include <optional>
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

VisaStatus statusOfDeviceError(std::int32_t error) {
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

VisaStatus combined(RpcOutcome outcome, std::int32_t deviceError) {
    return outcome == RpcOutcome::Done ? statusOfDeviceError(deviceError) : statusOf(outcome);
}

std::uint32_t millisecondsUntil(Deadline deadline) {
    const auto left = std::chrono::ceil<std::chrono::milliseconds>(deadline - steady_clock::now());
    return left.count() > 0 ? static_cast<std::uint32_t>(left.count()) : 0;
}

/// Whether there is one; it is taken then.
template <class Result>
bool taken(std::optional<Result> read, Result& result) {
    if (read) result = *read;
    return read.has_value();
}

/// Asks the host for the port of its VXI-11 core channel: version 2 of the port mapper over TCP, which all devices
/// know.
VisaStatus askForCorePort(Ipv4Address address, std::uint16_t portMapperPort, Deadline deadline,
                          const std::atomic_bool& aborting, std::uint16_t& corePort) {
    RpcChannel portMapper(vxi11::kPortMapper, vxi11::kPortMapperVersion, aborting);
    if (!portMapper.connect(address, portMapperPort, deadline)) return visa::kResourceNotFound;
    std::uint32_t port = 0;
    const RpcOutcome outcome = portMapper.call(
        vxi11::kGetPort, vxi11::getPortArguments(),
        [&](std::string_view results) { return taken(vxi11::portResult(results), port); }, deadline);
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
    RpcChannel channel{vxi11::kCore, vxi11::kCoreVersion, aborting};
    std::int32_t id = 0;
    std::size_t maxReceive = kSmallestMaxReceive;  ///< the most bytes that the device takes in one call

    VisaStatus connect(Ipv4Address address, const LanOptions& options, Deadline deadline) {
        std::uint16_t port = options.corePort;
        if (port == 0) {
            const VisaStatus status = askForCorePort(address, options.portMapperPort, deadline, aborting, port);
            if (status != visa::kSuccess) return status;
        }
        return channel.connect(address, port, deadline) ? visa::kSuccess : visa::kResourceNotFound;
    }

    VisaStatus create(const std::string& device, bool locked, Deadline deadline) {
        vxi11::CreatedLink made;
        const RpcOutcome outcome = channel.call(
            vxi11::kCreateLink, vxi11::argumentsOf(vxi11::CreateLink{manager, locked, 0, device}),
            [&](std::string_view results) { return taken(vxi11::createdLink(results), made); }, deadline);
        const VisaStatus status = combined(outcome, made.error);
        if (status != visa::kSuccess) return status;
        id = made.link;
        if (made.maxReceive > 0) maxReceive = made.maxReceive;
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
    for (Ipv4Address address : resolveHost(wanted.host, connectDeadline, m_aborting)) {
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
        vxi11::DeviceWrite wanted;
        wanted.link = link->id;
        wanted.ioTimeoutMs = millisecondsUntil(deadline);
        wanted.lockTimeoutMs = wanted.ioTimeoutMs;
        wanted.flags = vxi11::kFlagWaitLock | (part.size() == bytes.size() ? vxi11::kFlagEnd : 0);
        wanted.data = {part.data(), part.size()};
        vxi11::DeviceWritten done;
        const RpcOutcome outcome = link->channel.call(
            vxi11::kDeviceWrite, vxi11::argumentsOf(wanted),
            [&](std::string_view results) { return taken(vxi11::deviceWritten(results), done); },
            deadline + m_options.answerMargin);
        const VisaStatus status = combined(outcome, done.error);
        if (status != visa::kSuccess) return unlessAborted(status);
        if (done.size == 0 || done.size > part.size()) return visa::kInputOutput;
        written += static_cast<std::int32_t>(done.size);
        bytes = bytes.subspan(done.size);
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
        vxi11::DeviceRead wanted;
        wanted.link = link->id;
        wanted.size = static_cast<std::uint32_t>(room.size());
        wanted.ioTimeoutMs = millisecondsUntil(deadline);
        wanted.lockTimeoutMs = wanted.ioTimeoutMs;
        wanted.flags = vxi11::kFlagWaitLock;
        std::int32_t error = 0, reason = 0;
        std::size_t got = 0;
        const auto copy = [&](std::string_view results) {
            // Not more than was asked for: the length that the device states is not to be trusted.
            const auto read = vxi11::deviceWasRead(results, room.size());
            if (!read) return false;
            error = read->error;
            reason = read->reason;
            got = read->data.copy(room.data(), room.size());
            return true;
        };
        const RpcOutcome outcome =
            link->channel.call(vxi11::kDeviceRead, vxi11::argumentsOf(wanted), copy, deadline + m_options.answerMargin);
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
    link.channel.call(
        vxi11::kDestroyLink, vxi11::destroyLinkArguments(link.id),
        [](std::string_view results) { return vxi11::errorResult(results).has_value(); },
        steady_clock::now() + m_options.closeTimeout);
}

}  // namespace kdx
