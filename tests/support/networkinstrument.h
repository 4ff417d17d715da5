#pragma once

#include <mutex>
#include <string>
#include <string_view>
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

}  // namespace kdx::test
