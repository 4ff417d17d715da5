#pragma once

#include "simserver/coreclient.h"
#include "simserver/fakedevice.h"
#include "simserver/vxi11server.h"

#include <gtest/gtest.h>

#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace kdx::simserver {

/// A server with a fake device behind it, running in its own thread.
class Vxi11Test : public ::testing::Test {
protected:
    void SetUp() override {
        Vxi11Options options;
        options.maxLinks = 3;
        adjust(options);
        options.trace = [this](std::string_view line) {
            const std::lock_guard guard(m_traceMutex);
            m_trace.emplace_back(line);
        };
        m_server = std::make_unique<Vxi11Server>(m_device, options);
        m_thread = std::thread([this] { m_server->run(); });
    }
    /// For a test that needs other options.
    virtual void adjust(Vxi11Options&) {}
    void TearDown() override {
        m_server->stop();
        m_thread.join();
    }
    [[nodiscard]] unsigned short port() const { return m_server->corePort(); }
    std::vector<std::string> trace() {
        const std::lock_guard guard(m_traceMutex);
        return m_trace;
    }

    std::mutex m_traceMutex;
    std::vector<std::string> m_trace;
    FakeDevice m_device;
    std::unique_ptr<Vxi11Server> m_server;
    std::thread m_thread;
};

}  // namespace kdx::simserver
