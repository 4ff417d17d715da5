#include "support/scriptedvxi11.h"

#include "support/loopbackport.h"
#include "support/rawrecord.h"
#include "vxi11.h"

#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <rpc/pmap_prot.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <stdexcept>
#include <utility>

namespace kdx::test {

namespace {

template <class Fields>
std::string encoded(bool_t (*coder)(XDR*, Fields*), Fields& fields) {
    std::string bytes(70000, '\0');
    XDR xdr;
    xdrmem_create(&xdr, bytes.data(), static_cast<u_int>(bytes.size()), XDR_ENCODE);
    if (!coder(&xdr, &fields)) throw std::runtime_error("a scripted reply cannot be encoded");
    bytes.resize(xdr_getpos(&xdr));
    return bytes;
}

template <class Fields>
Fields decoded(bool_t (*coder)(XDR*, Fields*), void* xdr) {
    Fields fields{};
    if (!coder(static_cast<XDR*>(xdr), &fields)) throw std::runtime_error("a call cannot be decoded");
    return fields;
}

template <class Fields>
void freeFields(bool_t (*coder)(XDR*, Fields*), Fields& fields) {
    XDR xdr{};
    xdr.x_op = XDR_FREE;
    coder(&xdr, &fields);
}

/// False when the client has gone, which is its right.
bool sendAll(int descriptor, const std::string& bytes) {
    std::size_t sent = 0;
    while (sent < bytes.size()) {
        const ssize_t taken = send(descriptor, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
        if (taken <= 0) return false;
        sent += static_cast<std::size_t>(taken);
    }
    return true;
}

}  // namespace

ScriptedVxi11::ScriptedVxi11(std::uint16_t port) {
    m_listener = listenOnLoopback(16, port, m_port);
    if (pipe(m_wake) != 0) throw std::runtime_error("no pipe");
    m_thread = std::thread([this] { serve(); });
}

ScriptedVxi11::~ScriptedVxi11() {
    close(m_wake[1]);
    m_thread.join();
    close(m_wake[0]);
    close(m_listener);
}

void ScriptedVxi11::on(std::uint32_t procedure, const Reaction& reaction) {
    const std::lock_guard lock(m_mutex);
    m_reactions[procedure].push_back(reaction);
}

void ScriptedVxi11::answer(const std::string& bytes, long link) {
    const std::lock_guard lock(m_mutex);
    m_answers[link].push_back(bytes);
}

void ScriptedVxi11::answerWith(std::function<std::string(long, const std::string&)> responder) {
    const std::lock_guard lock(m_mutex);
    m_responder = std::move(responder);
}

void ScriptedVxi11::setMaxReceive(unsigned long bytes) {
    const std::lock_guard lock(m_mutex);
    m_maxReceive = bytes;
}

std::vector<ScriptedVxi11::Write> ScriptedVxi11::writes() const {
    const std::lock_guard lock(m_mutex);
    return m_writes;
}

std::vector<unsigned long> ScriptedVxi11::readSizes() const {
    std::vector<unsigned long> sizes;
    for (const Read& read : reads()) sizes.push_back(read.size);
    return sizes;
}

std::vector<ScriptedVxi11::Read> ScriptedVxi11::reads() const {
    const std::lock_guard lock(m_mutex);
    return m_reads;
}

std::vector<ScriptedVxi11::Opened> ScriptedVxi11::opened() const {
    const std::lock_guard lock(m_mutex);
    return m_opened;
}

std::vector<std::uint32_t> ScriptedVxi11::calls() const {
    const std::lock_guard lock(m_mutex);
    return m_calls;
}

std::vector<long> ScriptedVxi11::destroyed() const {
    const std::lock_guard lock(m_mutex);
    return m_destroyed;
}

void ScriptedVxi11::serve() {
    std::vector<Connection> connections;
    for (;;) {
        std::vector<pollfd> waiting = {{m_wake[0], POLLIN, 0}, {m_listener, POLLIN, 0}};
        for (const Connection& connection : connections) {
            waiting.push_back({connection.deaf ? -1 : connection.descriptor, POLLIN, 0});
        }
        if (poll(waiting.data(), waiting.size(), -1) < 0) continue;
        if (waiting[0].revents != 0) break;
        for (std::size_t i = connections.size(); i-- > 0;) {
            if (waiting[i + 2].revents == 0 || serveConnection(connections[i])) continue;
            close(connections[i].descriptor);
            connections.erase(connections.begin() + static_cast<std::ptrdiff_t>(i));
        }
        if (waiting[1].revents != 0) {
            const int descriptor = accept4(m_listener, nullptr, nullptr, SOCK_CLOEXEC);
            const int on = 1;
            setsockopt(descriptor, IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
            if (descriptor >= 0) connections.push_back({descriptor, {}, false});
        }
    }
    for (const Connection& connection : connections) close(connection.descriptor);
}

/// False when the connection is over.
bool ScriptedVxi11::serveConnection(Connection& connection) {
    std::array<char, 65536> piece;
    const ssize_t got = recv(connection.descriptor, piece.data(), piece.size(), 0);
    if (got <= 0) return false;
    std::string& received = connection.received;
    received.append(piece.data(), static_cast<std::size_t>(got));
    while (received.size() >= 4) {
        const std::size_t length = wordAt(received, 0) & ~kLastFragment;
        if (received.size() < 4 + length) break;
        std::string message = received.substr(4, length);
        received.erase(0, 4 + length);
        if (!handle(connection, message)) return false;
    }
    return true;
}

Reaction ScriptedVxi11::nextReaction(std::uint32_t procedure) {
    std::deque<Reaction>& script = m_reactions[procedure];
    if (script.empty()) return {};
    Reaction reaction = script.front();
    script.pop_front();
    return reaction;
}

/// Waits, but for its own end.
bool ScriptedVxi11::isOverWithin(std::chrono::milliseconds time) const {
    pollfd wake{m_wake[0], POLLIN, 0};
    return poll(&wake, 1, static_cast<int>(time.count())) != 0;
}

/// Serves one call; false when the connection is to be closed.
bool ScriptedVxi11::handle(Connection& connection, std::string& message) {
    const int descriptor = connection.descriptor;
    constexpr std::size_t kHeader = 40;  // with neither credentials nor verifier
    if (message.size() < kHeader) return false;
    const std::uint32_t callNumber = wordAt(message, 0);
    const std::uint32_t procedure = wordAt(message, 20);
    XDR xdr;
    xdrmem_create(&xdr, message.data() + kHeader, static_cast<u_int>(message.size() - kHeader), XDR_DECODE);
    std::string reply;
    Reaction reaction;
    {
        const std::lock_guard lock(m_mutex);
        m_calls.push_back(procedure);
        reaction = nextReaction(procedure);
        reply = perform(procedure, reaction, &xdr, callNumber);
    }
    if (reaction.kind != Reaction::Kind::RawForEver && isOverWithin(reaction.pause)) return false;
    switch (reaction.kind) {
        case Reaction::Kind::Answer:
            sendAll(descriptor, record(reply));
            return true;
        case Reaction::Kind::AnswerInPieces:
            for (const char byte : record(reply)) sendAll(descriptor, std::string(1, byte));
            return true;
        case Reaction::Kind::AnswerInFragments:
            sendAll(descriptor, fragments(reply));
            return true;
        case Reaction::Kind::AnswerTwice: {
            std::string late;
            appendWord(late, callNumber - 1);
            sendAll(descriptor, record(late + reply.substr(4)) + record(reply));
            return true;
        }
        case Reaction::Kind::Silence:
            return true;
        case Reaction::Kind::StopReading:
            connection.deaf = true;
            return true;
        case Reaction::Kind::Close:
            return false;
        case Reaction::Kind::Raw:
            sendAll(descriptor, reaction.raw.value_or(""));
            return true;
        case Reaction::Kind::RawAndClose:
            sendAll(descriptor, reaction.raw.value_or(""));
            return false;
        case Reaction::Kind::RawForEver:
            sendAll(descriptor, reaction.raw.value_or(""));
            while (sendAll(descriptor, reaction.again) && !isOverWithin(reaction.pause)) continue;
            return false;
    }
    return false;
}

/// Does what the call asks for and gives the reply message.
std::string ScriptedVxi11::perform(std::uint32_t procedure, const Reaction& reaction, void* arguments,
                                   std::uint32_t callNumber) {
    std::string reply;
    for (const std::uint32_t word : {callNumber, 1U, 0U, 0U, 0U, reaction.acceptState}) appendWord(reply, word);
    if (reaction.acceptState != 0) return reply;
    switch (procedure) {
        case kGetPort:
            appendWord(reply, reaction.number.value_or(m_port));
            return reply;
        case kCreateLink: {
            auto wanted = decoded(xdr_Create_LinkParms, arguments);
            const std::string device = wanted.device;
            m_opened.push_back({device, wanted.lockDevice != 0});
            freeFields(xdr_Create_LinkParms, wanted);
            Create_LinkResp made{};
            made.error = device == "inst0" || device == "gpib0,28" ? reaction.error : 3;
            made.lid = static_cast<long>(m_opened.size());
            made.maxRecvSize = m_maxReceive;
            return reply + encoded(xdr_Create_LinkResp, made);
        }
        case kWrite: {
            auto wanted = decoded(xdr_Device_WriteParms, arguments);
            const std::string data(wanted.data.data_val, wanted.data.data_len);
            m_writes.push_back({wanted.lid, data, wanted.flags, wanted.io_timeout, wanted.lock_timeout});
            std::string& command = m_commands[wanted.lid];
            command += data.substr(0, reaction.number.value_or(static_cast<std::uint32_t>(data.size())));
            if ((wanted.flags & 8) != 0) {
                if (m_responder) m_answers[wanted.lid].push_back(m_responder(wanted.lid, command));
                command.clear();
            }
            freeFields(xdr_Device_WriteParms, wanted);
            Device_WriteResp done{reaction.error, reaction.number.value_or(static_cast<std::uint32_t>(data.size()))};
            return reply + encoded(xdr_Device_WriteResp, done);
        }
        case kRead: {
            auto wanted = decoded(xdr_Device_ReadParms, arguments);
            m_reads.push_back({wanted.requestSize, wanted.flags, wanted.io_timeout, wanted.lock_timeout});
            std::deque<std::string>& answers = m_answers[wanted.lid];
            Device_ReadResp done{};
            done.error = reaction.error;
            std::string part;
            if (reaction.raw) {
                part = *reaction.raw;
            } else if (answers.empty() && done.error == 0) {
                done.error = 15;  // nothing came within the I/O time-out
            } else if (done.error == 0) {
                part = answers.front().substr(0, wanted.requestSize);
                answers.front().erase(0, part.size());
                done.reason = part.size() == wanted.requestSize ? 1 : 0;
                if (answers.front().empty()) {
                    done.reason |= 4;
                    answers.pop_front();
                }
            }
            done.reason = reaction.reason.value_or(done.reason);
            done.data.data_len = static_cast<u_int>(part.size());
            done.data.data_val = part.data();
            return reply + encoded(xdr_Device_ReadResp, done);
        }
        case kDestroyLink: {
            m_destroyed.push_back(decoded(xdr_Device_Link, arguments));
            Device_Error done{reaction.error};
            return reply + encoded(xdr_Device_Error, done);
        }
        default:
            throw std::runtime_error("an unexpected call");
    }
}

}  // namespace kdx::test
