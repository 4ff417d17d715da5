#pragma once

#include "simserver/vxi11server.h"

#include <atomic>
#include <mutex>
#include <new>
#include <string>
#include <string_view>
#include <vector>

namespace kdx::simserver {

/// Answers "NAME?" by "NAME" and a line feed, "LONG?" by 500 bytes, everything else by nothing; has no memory left for
/// "HUGE"; writes down what it got.
class FakeDevice final : public sim::MessageDevice {
public:
    std::string execute(std::string_view message) override {
        const std::lock_guard guard(m_mutex);
        m_got.emplace_back(message);
        while (!message.empty() && (message.back() == '\n' || message.back() == '\r')) message.remove_suffix(1);
        if (message == "HUGE") throw std::bad_alloc();
        if (message == "LONG?") return std::string(499, 'x') + "\n";
        if (!message.empty() && message.back() == '?') {
            return std::string(message.substr(0, message.size() - 1)) + "\n";
        }
        return {};
    }
    void clear() override { ++clears; }
    unsigned char statusByte(bool messageAvailable) const override { return messageAvailable ? 0x34 : 0x24; }
    void report(sim::ScpiError error) override {
        const std::lock_guard guard(m_mutex);
        m_errors.push_back(static_cast<int>(error));
    }

    std::vector<std::string> got() {
        const std::lock_guard guard(m_mutex);
        return m_got;
    }

    /// The errors reported so far.
    std::vector<int> errors() {
        const std::lock_guard guard(m_mutex);
        return m_errors;
    }

    std::atomic<int> clears = 0;

private:
    std::mutex m_mutex;
    std::vector<std::string> m_got;
    std::vector<int> m_errors;
};

}  // namespace kdx::simserver
