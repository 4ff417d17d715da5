#pragma once

#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <mutex>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "link/lanvisa.h"
#include "sim/virtualinstrument.h"
#include "simserver/vxi11server.h"

namespace kdx::test {

/// The virtual instrument as a VXI-11 device of this machine, in a thread of its own; writes down what it was told.
class NetworkInstrument {
public:
    /// @param clock what the coder's clock runs by; outlives this.
    explicit NetworkInstrument(const Clock& clock) : m_device(clock), m_thread([this] { m_server.run(); }) {}
    ~NetworkInstrument() {
        m_server.stop();
        m_thread.join();
    }
    NetworkInstrument(const NetworkInstrument&) = delete;
    NetworkInstrument& operator=(const NetworkInstrument&) = delete;

    [[nodiscard]] LanOptions reachedBy() const {
        LanOptions options;
        options.corePort = m_server.corePort();
        return options;
    }
    /// Every message since the last call; and the words of an error where the exchange went wrong.
    std::vector<std::string> takeReceived() { return m_device.takeReceived(); }

private:
    /// Only the server's thread comes near the instrument itself.
    class Device final : public sim::VirtualInstrument {
    public:
        using VirtualInstrument::VirtualInstrument;
        std::string execute(std::string_view message) override {
            note(message);
            return VirtualInstrument::execute(message);
        }
        void report(sim::ScpiError error) override {
            // The rest of an answer of more than 60 bytes is never fetched; the next command overtakes it.
            if (error != sim::ScpiError::QueryInterrupted) note(sim::errorText(error));
            VirtualInstrument::report(error);
        }
        std::vector<std::string> takeReceived() {
            const std::lock_guard guard(m_mutex);
            return std::exchange(m_received, {});
        }

    private:
        void note(std::string_view message) {
            const std::lock_guard guard(m_mutex);
            m_received.emplace_back(message);
        }

        std::mutex m_mutex;
        std::vector<std::string> m_received;
    };

    Device m_device;
    simserver::Vxi11Server m_server{m_device};
    std::thread m_thread;
};

/// Another client of the same instrument.
class Observer {
public:
    explicit Observer(const LanOptions& options) : m_visa(options) {
        VisaHandle manager = 0;
        m_visa.viOpenDefaultRM(manager);
        EXPECT_EQ(m_visa.viOpen(manager, "TCPIP::127.0.0.1::INSTR", 0, 0, m_session), visa::kSuccess);
    }
    void tell(const std::string& command) {
        std::int32_t written = 0;
        EXPECT_EQ(m_visa.viWrite(m_session, command, written), visa::kSuccess);
    }
    /// The whole answer without its line end.
    std::string ask(const std::string& query) {
        tell(query);
        std::string answer;
        VisaStatus status = visa::kMaxCountReached;
        while (status == visa::kMaxCountReached) {
            std::array<char, 256> buffer{};
            std::int32_t count = 0;
            status = m_visa.viRead(m_session, buffer, count);
            answer.append(buffer.data(), static_cast<std::size_t>(count));
        }
        EXPECT_EQ(status, visa::kSuccess) << query;
        return answer.substr(0, answer.find('\n'));
    }
    /// A value of the coder, without the quotes around it.
    std::string askCoder(const std::string& name) {
        const std::string answer = ask(":STEREO:DIRECT? \"" + name + "\"");
        return answer.size() < 2 ? answer : answer.substr(1, answer.size() - 2);
    }
    /// Takes everything out of the error queue.
    std::vector<std::string> errors() {
        std::vector<std::string> errors;
        for (;;) {
            const std::string error = ask("SYST:ERR?");
            if (error.starts_with("0,")) return errors;
            errors.push_back(error);
        }
    }

private:
    LanVisa m_visa;
    VisaHandle m_session = 0;
};

}  // namespace kdx::test
