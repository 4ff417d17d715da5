#pragma once

#include "link/lanvisa.h"

#include "support/scriptedvxi11.h"

#include <gmock/gmock.h>

#include <chrono>
#include <memory>
#include <string>

namespace kdx::test {

using namespace std::chrono_literals;

// Far more than the time-outs below, far less than a hang: the machine may be busy.
inline constexpr auto kBounded = 5s;

/// That many letters.
inline std::string bytesOf(std::size_t count) {
    std::string bytes;
    for (std::size_t i = 0; i < count; ++i) bytes += static_cast<char>('a' + i % 26);
    return bytes;
}

/// The LAN client against a scripted device.
class LanVisaTest : public ::testing::Test {
protected:
    LanVisaTest() { useTimes(2s, 2s); }

    void useTimes(std::chrono::milliseconds connectTimeout, std::chrono::milliseconds ioTimeout) {
        options.connectTimeout = connectTimeout;
        options.ioTimeout = ioTimeout;
        options.answerMargin = 50ms;
        options.portMapperPort = device.port();
        makeVisa();
    }
    /// For a test that runs into the time-outs.
    void useShortTimes() { useTimes(150ms, 100ms); }

    void makeVisa() {
        visa = std::make_unique<LanVisa>(options);
        visa->viOpenDefaultRM(manager);
    }
    VisaStatus open(const std::string& resource = "TCPIP::127.0.0.1::INSTR") {
        return visa->viOpen(manager, resource, 0, 0, session);
    }
    VisaStatus write(const std::string& text) { return visa->viWrite(session, text, count); }
    VisaStatus read(std::size_t size = 60) {
        std::string buffer(size, ' ');
        const VisaStatus status = visa->viRead(session, buffer, count);
        got = buffer.substr(0, static_cast<std::size_t>(count));
        rest = buffer.substr(static_cast<std::size_t>(count));
        return status;
    }

    ScriptedVxi11 device;
    LanOptions options;
    std::unique_ptr<LanVisa> visa;
    VisaHandle manager = 0;
    VisaHandle session = 0;
    std::int32_t count = -1;
    std::string got;
    std::string rest;
};

}  // namespace kdx::test
