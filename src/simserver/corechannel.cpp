#include "simserver/corechannel.h"

#include "base/codepage.h"
#include "base/printable.h"
#include "link/resource.h"
#include "simserver/coreanswers.h"
#include "vxi11/numbers.h"
#include "vxi11/xdr.h"

#include <vxi11.h>

#include <algorithm>
#include <array>
#include <utility>

namespace kdx::simserver {
namespace {

using std::chrono::milliseconds;

constexpr std::size_t kLongestMessage = 65536;
constexpr std::size_t kMostParked = 256;

// Where the length words of the fields of variable length stand in the arguments.
constexpr std::size_t kDeviceNameAt = 12;
constexpr std::size_t kWriteDataAt = 16;

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
    : RpcProgram(DEVICE_CORE, DEVICE_CORE_VERSION), m_loop(loop), m_device(device), m_options(std::move(options)) {}

void CoreChannel::call(std::uint32_t procedure, std::string_view arguments, ConnectionId from, const RpcReply& reply) {
    const auto generically = [&](const char* name, std::function<void(Link&)> action) {
        withArguments<Device_GenericParms>(arguments, xdr_Device_GenericParms, reply, [&](const auto& parms) {
            generic(parms, from, reply, name, std::move(action));
        });
    };
    switch (procedure) {
        case create_link:
            withArguments<Create_LinkParms>(
                arguments, xdr_Create_LinkParms, reply, [&](const auto& parms) { createLink(parms, from, reply); },
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
            // The group execute trigger means the same as the common command; whether it means anything, the device
            // knows.
            generically("trigger", [this](Link&) { m_device.execute("*TRG"); });
            break;
        case device_clear:
            generically("clear", [this](Link& link) { clear(link); });
            break;
        case device_remote:
            generically("remote", [](Link&) {});
            break;
        case device_local:
            generically("local", [](Link&) {});
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
        case create_intr_chan:
        case destroy_intr_chan:
            reply(errorOnly(vxi11::kNotSupported));
            break;
        default:
            reply({{}, PROC_UNAVAIL});
    }
    retryParked();
}

void CoreChannel::createLink(const Create_LinkParms& parms, ConnectionId from, const RpcReply& reply) {
    const std::string name = parms.device;
    const auto fail = [reply](ErrorCode error) { reply(createLinkAnswer({error, 0, 0, 0})); };
    if (!isDeviceName(name)) return fail(vxi11::kDeviceNotAccessible);
    const bool withLock = parms.lockDevice != 0;
    const auto create = [this, from, reply, fail, name, withLock] {
        if (m_links.size() >= m_options.maxLinks) {
            fail(vxi11::kOutOfResources);
            return true;
        }
        const LinkId id = ++m_lastLink;
        m_links[id].owner = from;
        if (withLock) m_lockHolder = id;
        trace(id, withLock ? "opened with lock: " : "opened: ", name);
        reply(createLinkAnswer({vxi11::kNoError, id, m_abortPort, m_options.maxRecvSize}));
        return true;
    };
    if (!withLock) {
        create();
        return;
    }
    start({.connection = from,
           .link = std::nullopt,
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
    const auto take = [this, id = parms.lid, end, reply, fail,
                       data = std::string(parms.data.data_val, parms.data.data_len)] {
        Link& link = m_links.at(id);
        if (link.input.size() + data.size() > kLongestMessage) {
            trace(id, "message too long, dropped");
            link.input.clear();
            fail(vxi11::kIoError);
            return true;
        }
        link.input += data;
        if (end && !link.input.empty()) {
            trace(id, "< ", link.input);
            // A new message discards the rest of an answer that nobody fetched, so that client and device agree again.
            link.output = m_device.execute(std::exchange(link.input, {}));
            if (!link.output.empty()) trace(id, "> ", link.output);
        }
        reply(writeAnswer(vxi11::kNoError, data.size()));
        return true;
    };
    start({.connection = from,
           .link = parms.lid,
           .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
           .lockTimeout = milliseconds(parms.lock_timeout),
           .ioTimeout = milliseconds(parms.io_timeout),
           .perform = take,
           .fail = fail});
}

void CoreChannel::read(const Device_ReadParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto give = [this, id = parms.lid, most = parms.requestSize, flags = parms.flags, termChar = parms.termChar,
                       reply] {
        Link& link = m_links.at(id);
        if (link.output.empty() && most > 0) return false;
        std::size_t count = std::min<std::size_t>(most, link.output.size());
        long reason = 0;
        if ((flags & vxi11::kFlagTermChar) != 0) {
            const std::size_t found = link.output.find(termChar);
            if (found < count) {
                count = found + 1;
                reason |= vxi11::kReasonTermChar;
            }
        }
        if (count == most) reason |= vxi11::kReasonRequestCount;
        if (count > 0 && count == link.output.size()) reason |= vxi11::kReasonEnd;
        std::string data = link.output.substr(0, count);
        link.output.erase(0, count);
        reply(readAnswer(vxi11::kNoError, reason, std::move(data)));
        return true;
    };
    start({.connection = from,
           .link = parms.lid,
           .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
           .lockTimeout = milliseconds(parms.lock_timeout),
           .ioTimeout = milliseconds(parms.io_timeout),
           .perform = give,
           .fail = [this, reply](ErrorCode error) {
               if (error == vxi11::kIoTimeout) m_device.unansweredRead();
               reply(readAnswer(error, 0, {}));
           }});
}

void CoreChannel::lock(const Device_LockParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto take = [this, id = parms.lid, reply] {
        m_lockHolder = id;
        trace(id, "locks");
        reply(errorOnly(vxi11::kNoError));
        return true;
    };
    start({.connection = from,
           .link = parms.lid,
           .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
           .lockTimeout = milliseconds(parms.lock_timeout),
           .perform = take,
           .fail = [reply](ErrorCode error) { reply(errorOnly(error)); }});
}

void CoreChannel::readStatusByte(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply) {
    const auto give = [this, id = parms.lid, reply] {
        unsigned char status = m_device.statusByte();
        if (!m_links.at(id).output.empty()) status |= kMessageAvailable;
        reply(statusByteAnswer(vxi11::kNoError, status));
        return true;
    };
    start({.connection = from,
           .link = parms.lid,
           .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
           .lockTimeout = milliseconds(parms.lock_timeout),
           .ioTimeout = milliseconds(parms.io_timeout),
           .perform = give,
           .fail = [reply](ErrorCode error) { reply(statusByteAnswer(error, 0)); }});
}

void CoreChannel::generic(const Device_GenericParms& parms, ConnectionId from, const RpcReply& reply, const char* name,
                          std::function<void(Link&)> action) {
    start({.connection = from,
           .link = parms.lid,
           .waitForLock = (parms.flags & vxi11::kFlagWaitLock) != 0,
           .lockTimeout = milliseconds(parms.lock_timeout),
           .ioTimeout = milliseconds(parms.io_timeout),
           .perform =
               [this, id = parms.lid, reply, name, action = std::move(action)] {
                   trace(id, name);
                   action(m_links.at(id));
                   reply(errorOnly(vxi11::kNoError));
                   return true;
               },
           .fail = [reply](ErrorCode error) { reply(errorOnly(error)); }});
}

CoreChannel::ErrorCode CoreChannel::unlock(LinkId id, ConnectionId from) {
    if (find(id, from) == nullptr) return vxi11::kInvalidLink;
    if (m_lockHolder != id) return vxi11::kNoLockHeld;
    m_lockHolder.reset();
    trace(id, "unlocks");
    return vxi11::kNoError;
}

CoreChannel::ErrorCode CoreChannel::destroyLink(LinkId id, ConnectionId from) {
    if (find(id, from) == nullptr) return vxi11::kInvalidLink;
    removeLink(id);
    return vxi11::kNoError;
}

CoreChannel::ErrorCode CoreChannel::abort(LinkId link) {
    if (!m_links.contains(link)) return vxi11::kInvalidLink;
    trace(link, "aborted");
    for (auto operation = m_parked.begin(); operation != m_parked.end();) {
        if (operation->link == link) {
            m_loop.cancel(operation->timer);
            operation->fail(vxi11::kAborted);
            operation = m_parked.erase(operation);
        } else {
            ++operation;
        }
    }
    return vxi11::kNoError;
}

void CoreChannel::connectionClosed(ConnectionId connection) {
    for (auto operation = m_parked.begin(); operation != m_parked.end();) {
        if (operation->connection == connection) {
            m_loop.cancel(operation->timer);
            operation = m_parked.erase(operation);
        } else {
            ++operation;
        }
    }
    for (auto link = m_links.begin(); link != m_links.end();) {
        const auto next = std::next(link);
        if (link->second.owner == connection) removeLink(link->first);
        link = next;
    }
    retryParked();
}

void CoreChannel::start(Operation operation) {
    if (advance(operation)) return;
    if (m_parked.size() >= kMostParked) return operation.fail(vxi11::kOutOfResources);
    m_parked.push_back(std::move(operation));
    park(std::prev(m_parked.end()));
}

// True: it is done and answered. False: it waits, for the lock until lockPassed, then for data.
bool CoreChannel::advance(Operation& operation) {
    if (operation.link && find(*operation.link, operation.connection) == nullptr) {
        operation.fail(vxi11::kInvalidLink);
        return true;
    }
    if (!operation.lockPassed && lockedAgainst(operation.link)) {
        if (!operation.waitForLock) operation.fail(vxi11::kLockedByAnotherLink);
        return !operation.waitForLock;
    }
    operation.lockPassed = true;
    return operation.perform();
}

void CoreChannel::park(Parked::iterator operation) {
    const bool forLock = !operation->lockPassed;
    const auto timeout = forLock ? operation->lockTimeout : operation->ioTimeout;
    operation->timer = m_loop.callAt(std::chrono::steady_clock::now() + timeout, [this, operation, forLock] {
        operation->fail(forLock ? vxi11::kLockedByAnotherLink : vxi11::kIoTimeout);
        m_parked.erase(operation);
    });
}

// What one waiting call does may be what another one waits for, so it goes on until none gets any further.
void CoreChannel::retryParked() {
    for (bool changed = true; changed;) {
        changed = false;
        for (auto operation = m_parked.begin(); operation != m_parked.end();) {
            const auto current = operation++;
            const bool hadPassed = current->lockPassed;
            if (advance(*current)) {
                m_loop.cancel(current->timer);
                m_parked.erase(current);
                changed = true;
            } else if (current->lockPassed != hadPassed) {
                m_loop.cancel(current->timer);
                park(current);
            }
        }
    }
}

void CoreChannel::clear(Link& link) {
    link.input.clear();
    link.output.clear();
    m_device.clear();
}

void CoreChannel::removeLink(LinkId id) {
    m_links.erase(id);
    if (m_lockHolder == id) m_lockHolder.reset();
    trace(id, "closed");
}

// A link belongs to the connection it was made on; to others it does not exist.
CoreChannel::Link* CoreChannel::find(LinkId id, ConnectionId from) {
    const auto found = m_links.find(id);
    return found != m_links.end() && found->second.owner == from ? &found->second : nullptr;
}

bool CoreChannel::lockedAgainst(std::optional<LinkId> link) const {
    return m_lockHolder && m_lockHolder != link;
}

void CoreChannel::trace(LinkId link, std::string_view what, std::string_view text) const {
    if (!m_options.trace) return;
    m_options.trace("link " + std::to_string(link) + " " + std::string(what) + printable(text));
}

}  // namespace kdx::simserver
