#include "simserver/corechannel.h"

#include "base/codepage.h"
#include "base/printable.h"
#include "link/resource.h"
#include "sim/scpi.h"
#include "simserver/coreanswers.h"
#include "simserver/tirpcxdr.h"
#include "vxi11/numbers.h"

#include <vxi11.h>

#include <algorithm>
#include <array>
#include <limits>
#include <utility>

namespace kdx::simserver {
namespace {

using std::chrono::milliseconds;

constexpr std::size_t kMostUnread = 65536;  // bytes of answers that wait on a link

// Where the length words of the fields of variable length stand in the arguments.
constexpr std::size_t kDeviceNameAt = 12;
constexpr std::size_t kWriteDataAt = 16;
constexpr std::size_t kHandleAt = 8;

bool isDeviceName(std::string_view name) {
    if (equalNoCase(name, "inst0")) return true;
    for (int address = 0; address <= kHighestGpibAddress; ++address) {
        if (equalNoCase(name, "gpib0," + std::to_string(address))) return true;
    }
    return false;
}

// Reads the arguments and calls the handler with them; what cannot be read is turned down.
template <class Arguments, class Handler>
void withArguments(std::string_view bytes, XdrRoutine<Arguments> routine, const RpcReply& reply, Handler handler,
                   std::size_t countAt = kNoCount) {
    const XdrDecoded<Arguments> arguments(bytes, routine, countAt);
    if (!arguments) return reply({{}, GARBAGE_ARGS});
    handler(*arguments);
}

}  // namespace

CoreChannel::CoreChannel(PollLoop& loop, sim::MessageDevice& device, Vxi11Options options)
    : RpcProgram(DEVICE_CORE, DEVICE_CORE_VERSION),
      m_device(device),
      m_options(std::move(options)),
      m_calls(
          loop, [this](const WaitingCall& call) { return obstacle(call); }, m_options.longestWait) {}

void CoreChannel::call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) {
    const auto generically = [&](const char* name, std::function<ErrorCode(Link&)> action) {
        withArguments<Device_GenericParms>(arguments, xdr_Device_GenericParms, reply, [&](const auto& parms) {
            generic(parms, from, reply, name, std::move(action));
        });
    };
    switch (procedure) {
        case create_link:
            withArguments<Create_LinkParms>(
                arguments, xdr_Create_LinkParms, reply,
                [&](const auto& parms) {
                    // Not the text that was decoded: that one ends at a NUL, and a name that only begins well is none.
                    const auto length = xdrWord(arguments, kDeviceNameAt);
                    createLink(parms, std::string(arguments.substr(kDeviceNameAt + 4, length)), from, reply);
                },
                kDeviceNameAt);
            break;
        case device_write:
            withArguments<Device_WriteParms>(
                arguments, xdr_Device_WriteParms, reply, [&](const auto& parms) { write(parms, from, reply); },
                kWriteDataAt);
            break;
        case device_read:
            withArguments<Device_ReadParms>(arguments, xdr_Device_ReadParms, reply,
                                            [&](const auto& parms) { read(parms, from, reply); });
            break;
        case device_readstb:
            withArguments<Device_GenericParms>(arguments, xdr_Device_GenericParms, reply,
                                               [&](const auto& parms) { readStatusByte(parms, from, reply); });
            break;
        case device_trigger:
            generically("trigger", [](Link&) { return vxi11::kNotSupported; });  // there is nothing to trigger
            break;
        case device_clear:
            generically("clear", [this](Link& link) {
                clear(link);
                return vxi11::kNoError;
            });
            break;
        case device_remote:
            generically("remote", [](Link&) { return vxi11::kNoError; });
            break;
        case device_local:
            generically("local", [](Link&) { return vxi11::kNoError; });
            break;
        case device_lock:
            withArguments<Device_LockParms>(arguments, xdr_Device_LockParms, reply,
                                            [&](const auto& parms) { lock(parms, from, reply); });
            break;
        case device_unlock:
            withArguments<Device_Link>(arguments, xdr_Device_Link, reply,
                                       [&](Device_Link link) { reply(errorOnly(unlock(link, from))); });
            break;
        case destroy_link:
            withArguments<Device_Link>(arguments, xdr_Device_Link, reply,
                                       [&](Device_Link link) { reply(errorOnly(destroyLink(link, from))); });
            break;
        case device_docmd:
            reply(docmdAnswer(vxi11::kNotSupported));
            break;
        case device_enable_srq:
            // Allowed, though no request ever comes: without an interrupt channel there is no way for it.
            withArguments<Device_EnableSrqParms>(
                arguments, xdr_Device_EnableSrqParms, reply,
                [&](const auto& parms) {
                    reply(errorOnly(find(parms.lid, from) == nullptr ? vxi11::kInvalidLink : vxi11::kNoError));
                },
                kHandleAt);
            break;
        case create_intr_chan:
        case destroy_intr_chan:
            reply(errorOnly(vxi11::kNotSupported));
            break;
        default:
            reply({{}, PROC_UNAVAIL});
    }
    m_calls.retry();
}

void CoreChannel::createLink(const Create_LinkParms& parms, const std::string& name, ConnectionId from,
                             const RpcReply& reply) {
    const auto fail = [reply](ErrorCode error) { reply(createLinkAnswer({error, 0, 0, 0})); };
    if (!isDeviceName(name)) return fail(vxi11::kDeviceNotAccessible);
    const bool withLock = parms.lockDevice != 0;
    const auto create = [this, from, reply, fail, name, withLock] {
        if (!isRoomFor(from)) {
            fail(vxi11::kOutOfResources);
            return true;
        }
        const LinkId id = freeId();
        m_links[id] = {.owner = from, .number = ++m_lastNumber, .input = {}, .overtakes = false, .output = {}};
        if (withLock) m_lockHolder = id;
        trace(id, withLock ? "opened with lock: " : "opened: ", name);
        reply(createLinkAnswer({vxi11::kNoError, id, m_abortPort, m_options.maxRecvSize}));
        return true;
    };
    if (!withLock) {
        create();
        return;
    }
    m_calls.start({.connection = from,
                   .waitForLock = true,
                   .lockTimeout = milliseconds(parms.lock_timeout),
                   .perform = create,
                   .fail = fail});
}

void CoreChannel::write(const Device_WriteParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto fail = [reply](ErrorCode error) { reply(writeAnswer(error, 0)); };
    if (find(parms.lid, from) != nullptr && parms.data.data_len > m_options.maxRecvSize) {
        return fail(vxi11::kParameterError);
    }
    const bool end = (parms.flags & vxi11::kFlagEnd) != 0;
    const auto take = [this, id = parms.lid, end, reply, data = std::string(parms.data.data_val, parms.data.data_len)] {
        carryOut(id, m_links.at(id), data, end);
        reply(writeAnswer(vxi11::kNoError, data.size()));
        return true;
    };
    m_calls.start({.connection = from,
                   .link = parms.lid,
                   .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
                   .lockTimeout = milliseconds(parms.lock_timeout),
                   .ioTimeout = milliseconds(parms.io_timeout),
                   .perform = take,
                   .fail = fail});
}

// One write may bring several messages, each with an answer of its own. A new one discards what nobody has fetched of
// the answers to those before, so that client and device agree again.
void CoreChannel::carryOut(LinkId id, Link& link, std::string_view bytes, bool end) {
    if (!link.input.hasBegun()) link.overtakes = !link.output.empty();
    const MessageBuffer::Taken taken = link.input.take(bytes, end);
    std::size_t unread = 0;
    for (const std::string& answer : link.output) unread += answer.size();
    bool deadlocked = false;
    for (const std::string& message : taken.messages) {
        trace(id, "< ", message);
        if (sim::trimmed(message).empty()) continue;
        dropOvertaken(id, link);
        if (link.output.empty()) unread = 0;
        std::string answer = m_device.execute(message);
        if (answer.empty()) continue;
        trace(id, "> ", answer);
        unread += answer.size();
        if (!deadlocked && unread > kMostUnread) {
            deadlocked = true;
            trace(id, "answers dropped, more than can be kept");
            link.output.clear();
            m_device.report(sim::ScpiError::QueryDeadlocked);
        }
        if (!deadlocked) link.output.push_back(std::move(answer));
    }
    if (!taken.overrun) return;
    dropOvertaken(id, link);
    trace(id, "message too long, dropped");
    m_device.report(sim::ScpiError::InputBufferOverrun);
}

void CoreChannel::dropOvertaken(LinkId id, Link& link) {
    if (!std::exchange(link.overtakes, false) || link.output.empty()) return;
    trace(id, "answer dropped that nobody has fetched");
    link.output.clear();
    m_device.report(sim::ScpiError::QueryInterrupted);
}

void CoreChannel::read(const Device_ReadParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto give = [this, id = parms.lid, most = parms.requestSize, flags = parms.flags, termChar = parms.termChar,
                       reply] {
        Link& link = m_links.at(id);
        if (link.output.empty() && most > 0) return false;
        const std::string unread = link.output.empty() ? std::string() : std::move(link.output.front());
        std::size_t count = std::min<std::size_t>(most, unread.size());
        long reason = 0;
        if ((flags & vxi11::kFlagTermChar) != 0) {
            const std::size_t found = unread.find(termChar);
            if (found < count) {
                count = found + 1;
                reason |= vxi11::kReasonTermChar;
            }
        }
        if (count == most) reason |= vxi11::kReasonRequestCount;
        if (count > 0 && count == unread.size()) reason |= vxi11::kReasonEnd;
        if (count < unread.size()) {
            link.output.front() = unread.substr(count);
        } else if (count > 0) {
            link.output.pop_front();
        }
        reply(readAnswer(vxi11::kNoError, reason, unread.substr(0, count)));
        return true;
    };
    m_calls.start({.connection = from,
                   .link = parms.lid,
                   .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
                   .lockTimeout = milliseconds(parms.lock_timeout),
                   .ioTimeout = milliseconds(parms.io_timeout),
                   .perform = give,
                   .fail = [this, reply](ErrorCode error) {
                       if (error == vxi11::kIoTimeout) m_device.report(sim::ScpiError::QueryUnterminated);
                       reply(readAnswer(error, 0, {}));
                   }});
}

void CoreChannel::lock(const Device_LockParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto take = [this, id = parms.lid, reply] {
        if (m_lockHolder == id) {  // a lock is not counted: the second one is as much in the way as a stranger's
            reply(errorOnly(vxi11::kLockedByAnotherLink));
            return true;
        }
        m_lockHolder = id;
        trace(id, "locks");
        reply(errorOnly(vxi11::kNoError));
        return true;
    };
    m_calls.start({.connection = from,
                   .link = parms.lid,
                   .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
                   .lockTimeout = milliseconds(parms.lock_timeout),
                   .perform = take,
                   .fail = [reply](ErrorCode error) { reply(errorOnly(error)); }});
}

void CoreChannel::readStatusByte(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto give = [this, id = parms.lid, reply] {
        reply(statusByteAnswer(vxi11::kNoError, m_device.statusByte(!m_links.at(id).output.empty())));
        return true;
    };
    m_calls.start({.connection = from,
                   .link = parms.lid,
                   .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
                   .lockTimeout = milliseconds(parms.lock_timeout),
                   .ioTimeout = milliseconds(parms.io_timeout),
                   .perform = give,
                   .fail = [reply](ErrorCode error) { reply(statusByteAnswer(error, 0)); }});
}

void CoreChannel::generic(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply, const char* name,
                          std::function<ErrorCode(Link&)> action) {
    m_calls.start({.connection = from,
                   .link = parms.lid,
                   .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
                   .lockTimeout = milliseconds(parms.lock_timeout),
                   .ioTimeout = milliseconds(parms.io_timeout),
                   .perform =
                       [this, id = parms.lid, reply, name, action = std::move(action)] {
                           trace(id, name);
                           reply(errorOnly(action(m_links.at(id))));
                           return true;
                       },
                   .fail = [reply](ErrorCode error) { reply(errorOnly(error)); }});
}

ErrorCode CoreChannel::unlock(LinkId id, ConnectionId from) {
    if (find(id, from) == nullptr) return vxi11::kInvalidLink;
    if (m_lockHolder != id) return vxi11::kNoLockHeld;
    m_lockHolder.reset();
    trace(id, "unlocks");
    return vxi11::kNoError;
}

ErrorCode CoreChannel::destroyLink(LinkId id, ConnectionId from) {
    if (find(id, from) == nullptr) return vxi11::kInvalidLink;
    removeLink(id, "closed");
    return vxi11::kNoError;
}

ErrorCode CoreChannel::abort(LinkId link) {
    if (!m_links.contains(link)) return vxi11::kInvalidLink;
    trace(link, "aborted");
    m_calls.abort(link);
    return vxi11::kNoError;
}

void CoreChannel::connectionClosed(ConnectionId connection) {
    m_calls.forget(connection);
    for (auto link = m_links.begin(); link != m_links.end();) {
        const auto next = std::next(link);
        if (link->second.owner == connection) removeLink(link->first, "closed with its connection");
        link = next;
    }
    m_calls.retry();
}

bool CoreChannel::mayBeSilent(ConnectionId connection) const {
    const bool hasLink = std::any_of(m_links.begin(), m_links.end(),
                                     [connection](const auto& entry) { return entry.second.owner == connection; });
    return hasLink || m_calls.anyOf(connection);
}

std::size_t CoreChannel::linksOf(std::uint32_t peer) const {
    return static_cast<std::size_t>(std::count_if(
        m_links.begin(), m_links.end(), [peer](const auto& entry) { return peerOf(entry.second.owner) == peer; }));
}

bool CoreChannel::isRoomFor(ConnectionId connection) const {
    return m_links.size() < m_options.maxLinks && linksOf(peerOf(connection)) < m_options.maxLinksOfOnePeer;
}

// Nobody can guess another one's, which is all that a call needs to be aborted.
LinkId CoreChannel::freeId() {
    std::uniform_int_distribution<LinkId> any(1, std::numeric_limits<std::int32_t>::max());
    LinkId id = any(m_random);
    while (m_links.contains(id)) id = any(m_random);
    return id;
}

void CoreChannel::clear(Link& link) {
    link.input.clear();
    link.output.clear();
    m_device.clear();
}

void CoreChannel::removeLink(LinkId id, std::string_view how) {
    if (m_lockHolder == id) m_lockHolder.reset();
    trace(id, how);
    m_links.erase(id);
}

// A link belongs to the connection it was made on; to others it does not exist.
CoreChannel::Link* CoreChannel::find(LinkId id, ConnectionId from) {
    const auto found = m_links.find(id);
    return found != m_links.end() && found->second.owner == from ? &found->second : nullptr;
}

ErrorCode CoreChannel::obstacle(const WaitingCall& call) {
    if (call.link && find(*call.link, call.connection) == nullptr) return vxi11::kInvalidLink;
    return m_lockHolder && m_lockHolder != call.link ? vxi11::kLockedByAnotherLink : vxi11::kNoError;
}

void CoreChannel::trace(LinkId link, std::string_view what, std::string_view text) const {
    if (!m_options.trace) return;
    m_options.trace("link " + std::to_string(m_links.at(link).number) + " " + std::string(what) + printable(text));
}

}  // namespace kdx::simserver
