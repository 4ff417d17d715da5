#pragma once

#include "simserver/rpcclient.h"
#include "simserver/vxi11server.h"

#include <gtest/gtest.h>
#include <vxi11.h>

#include <atomic>
#include <memory>
#include <mutex>
#include <new>
#include <ostream>
#include <string>
#include <thread>
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

/// What a device_read has brought.
struct ReadResult {
    long error = 0;
    long reason = 0;
    std::string data;
    bool operator==(const ReadResult&) const = default;
};

inline void PrintTo(const ReadResult& result, std::ostream* out) {
    *out << "error " << result.error << ", reason " << result.reason << ", \"" << result.data << '"';
}

/// A client of the core channel with a call for each procedure that tests use.
class CoreClient : public RpcClient {
public:
    static constexpr long kWaitLock = 0x01;
    static constexpr long kEnd = 0x08;
    static constexpr long kTermChar = 0x80;

    using RpcClient::RpcClient;

    /// Put together by hand: the XDR routine would end the name at a NUL.
    static std::string linkArguments(const std::string& name, bool withLock = false, std::uint32_t lockTimeoutMs = 0) {
        const auto length = static_cast<std::uint32_t>(name.size());
        const std::string filled = name + std::string((4 - name.size() % 4) % 4, '\0');
        return word(1) + word(withLock ? 1 : 0) + word(lockTimeoutMs) + word(length) + filled;
    }
    static std::string writeArguments(long link, std::string text, long flags = kEnd, u_long lockTimeoutMs = 0) {
        return toXdr<Device_WriteParms>(
            {link, 1000, lockTimeoutMs, flags, {static_cast<u_int>(text.size()), text.data()}}, xdr_Device_WriteParms,
            text.size());
    }
    static std::string readArguments(long link, u_long size = 1000, u_long ioTimeoutMs = 1000, long flags = 0,
                                     char termChar = 0, u_long lockTimeoutMs = 0) {
        return toXdr<Device_ReadParms>({link, size, ioTimeoutMs, lockTimeoutMs, flags, termChar}, xdr_Device_ReadParms);
    }
    static std::string lockArguments(long link, long flags = 0, u_long lockTimeoutMs = 0) {
        return toXdr<Device_LockParms>({link, flags, lockTimeoutMs}, xdr_Device_LockParms);
    }
    static std::string genericArguments(long link, long flags = 0, u_long lockTimeoutMs = 0) {
        return toXdr<Device_GenericParms>({link, flags, lockTimeoutMs, 1000}, xdr_Device_GenericParms);
    }
    static std::string linkNumber(long link) { return toXdr<Device_Link>(link, xdr_Device_Link); }

    Create_LinkResp createLink(const std::string& name, bool withLock = false, std::uint32_t lockTimeoutMs = 0) {
        const std::string bytes = results(create_link, linkArguments(name, withLock, lockTimeoutMs));
        return *XdrDecoded<Create_LinkResp>(bytes, xdr_Create_LinkResp);
    }
    /// A client at another address than the others.
    static std::unique_ptr<CoreClient> elsewhere(unsigned short port) {
        return std::make_unique<CoreClient>(port, DEVICE_CORE, DEVICE_CORE_VERSION, kAnotherPeer);
    }

    /// A link to inst0; fails the test when there is none to be had.
    long open() {
        const Create_LinkResp link = createLink("inst0");
        EXPECT_EQ(link.error, 0);
        return link.lid;
    }
    Device_WriteResp write(long link, const std::string& text, long flags = kEnd) {
        return *XdrDecoded<Device_WriteResp>(results(device_write, writeArguments(link, text, flags)),
                                             xdr_Device_WriteResp);
    }
    static ReadResult readResult(std::string_view bytes) {
        const XdrDecoded<Device_ReadResp> read(bytes, xdr_Device_ReadResp, 8);
        EXPECT_TRUE(static_cast<bool>(read));
        return {read->error, read->reason, std::string(read->data.data_val, read->data.data_len)};
    }
    ReadResult read(long link, u_long size = 1000, u_long ioTimeoutMs = 1000, long flags = 0, char termChar = 0) {
        return readResult(results(device_read, readArguments(link, size, ioTimeoutMs, flags, termChar)));
    }
    /// The error of a procedure that answers nothing else (or as its first word).
    long error(std::uint32_t procedure, const std::string& arguments) {
        const std::string bytes = results(procedure, arguments);
        return *XdrDecoded<Device_ErrorCode>(std::string_view(bytes).substr(0, 4), xdr_Device_ErrorCode);
    }
};

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
