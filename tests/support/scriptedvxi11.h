#pragma once

#include <chrono>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "support/reaction.h"

namespace kdx::test {

/// A VXI-11 device and its port mapper on one port of the loopback address, which behaves as told. Devices behind it:
/// "inst0" and "gpib0,28". It serves in a thread of its own until it is destroyed.
class ScriptedVxi11 {
public:
    /// Procedures for which reactions can be set.
    static constexpr std::uint32_t kGetPort = 3, kCreateLink = 10, kWrite = 11, kRead = 12, kDestroyLink = 23;

    struct Write {
        long link;
        std::string data;
        long flags;
        unsigned long ioTimeout;
        unsigned long lockTimeout;
    };
    struct Read {
        unsigned long size;
        long flags;
        unsigned long ioTimeout;
        unsigned long lockTimeout;
    };
    struct Opened {
        std::string device;
        bool locked;
    };

    explicit ScriptedVxi11(std::uint16_t port = 0);
    ~ScriptedVxi11();
    ScriptedVxi11(const ScriptedVxi11&) = delete;
    ScriptedVxi11& operator=(const ScriptedVxi11&) = delete;

    [[nodiscard]] std::uint16_t port() const { return m_port; }

    /// The next calls of that procedure are met so, in turn; those after them are answered as they should be.
    void on(std::uint32_t procedure, const Reaction& reaction);
    /// The next answer that the link gives when it is read; links are numbered from 1.
    void answer(const std::string& bytes, long link = 1);
    /// Gives the answer to each complete command.
    void answerWith(std::function<std::string(long link, const std::string& command)> responder);
    void setMaxReceive(unsigned long bytes);

    [[nodiscard]] std::vector<Write> writes() const;
    [[nodiscard]] std::vector<unsigned long> readSizes() const;
    [[nodiscard]] std::vector<Read> reads() const;
    [[nodiscard]] std::vector<Opened> opened() const;
    [[nodiscard]] std::vector<std::uint32_t> calls() const;
    [[nodiscard]] std::vector<long> destroyed() const;

private:
    struct Connection {
        int descriptor;
        std::string received;
        bool deaf;
    };

    void serve();
    bool serveConnection(Connection& connection);
    bool isOverWithin(std::chrono::milliseconds time) const;
    bool handle(Connection& connection, std::string& message);
    std::string perform(std::uint32_t procedure, const Reaction& reaction, void* arguments, std::uint32_t callNumber);
    Reaction nextReaction(std::uint32_t procedure);

    int m_listener = -1;
    int m_wake[2] = {-1, -1};
    std::uint16_t m_port = 0;
    mutable std::mutex m_mutex;  // everything below
    std::map<std::uint32_t, std::deque<Reaction>> m_reactions;
    std::map<long, std::deque<std::string>> m_answers;
    std::map<long, std::string> m_commands;
    std::function<std::string(long, const std::string&)> m_responder;
    std::vector<Write> m_writes;
    std::vector<Read> m_reads;
    std::vector<Opened> m_opened;
    std::vector<std::uint32_t> m_calls;
    std::vector<long> m_destroyed;
    unsigned long m_maxReceive = 4096;
    std::thread m_thread;
};

}  // namespace kdx::test
