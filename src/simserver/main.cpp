// kdx-sim: the virtual generator with its coder as a program of its own, a network instrument of the VXI-11 standard.

#include "base/clock.h"
#include "sim/virtualinstrument.h"
#include "simserver/portannouncement.h"
#include "simserver/trace.h"
#include "simserver/vxi11server.h"

#include <poll.h>
#include <sys/signalfd.h>
#include <vxi11.h>

#include <cerrno>
#include <charconv>
#include <csignal>
#include <exception>
#include <iostream>
#include <span>
#include <stdexcept>
#include <string>
#include <string_view>
#include <system_error>

namespace {

constexpr std::string_view kHelp = R"(Usage: kdx-sim [options]
The virtual signal generator with its stereo/RDS coder, as a VXI-11 network instrument.

  --port N      TCP port of the instrument; any free one if left out
  --bind ADDR   IPv4 address to listen at; 127.0.0.1 (this machine only) if left out
  --idn TEXT    the answer to *IDN?
  --trace       print what happens on every link
  --help        print this and end
  --version     print the version and end

Clients open it as TCPIP::ADDR::inst0::INSTR or TCPIP::ADDR::gpib0,N::INSTR (N: 0 to 30). They learn the port from the
port mapper, which kdx-sim is itself when port 111 is free and it may use it; otherwise it registers with the one that
runs.
)";

struct Options {
    kdx::simserver::Vxi11Options server;
    std::string identification = kdx::sim::kDefaultIdentification;
    bool help = false;
    bool version = false;
};

unsigned short portNumber(const std::string& text) {
    unsigned short port = 0;
    const char* end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, port);
    if (text.empty() || read.ec != std::errc() || read.ptr != end) {
        throw std::invalid_argument("--port takes a number from 0 to 65535, not \"" + text + "\"");
    }
    return port;
}

void printLine(std::string_view line) {
    std::cout << line << std::endl;
}

// Throws std::invalid_argument with a message for the user.
Options readOptions(std::span<char*> arguments) {
    Options options;
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        const std::string option = arguments[i];
        const auto value = [&]() -> std::string {
            if (i + 1 == arguments.size()) throw std::invalid_argument(option + " takes a value");
            return arguments[++i];
        };
        if (option == "--port") {
            options.server.port = portNumber(value());
        } else if (option == "--bind") {
            options.server.bindAddress = value();
        } else if (option == "--idn") {
            options.identification = value();
        } else if (option == "--trace") {
            options.server.trace = printLine;
        } else if (option == "--help") {
            options.help = true;
        } else if (option == "--version") {
            options.version = true;
        } else {
            throw std::invalid_argument("unknown option \"" + option + "\"; --help lists them all");
        }
    }
    return options;
}

/// The virtual instrument as the server sees it.
class InstrumentDevice final : public kdx::sim::MessageDevice {
public:
    /// @param explains whether what a message asks of the coder is printed in words, too.
    InstrumentDevice(const std::string& identification, bool explains)
        : m_instrument(m_clock, identification), m_explains(explains) {}
    std::string execute(std::string_view message) override {
        if (m_explains) {
            const std::string words = kdx::simserver::describe(message);
            if (!words.empty()) printLine("       " + words);
        }
        return m_instrument.execute(message);
    }
    void clear() override { m_instrument.deviceClear(); }
    unsigned char statusByte() override { return m_instrument.statusByte(); }
    void unansweredRead() override { m_instrument.reportUnansweredRead(); }

private:
    kdx::SystemClock m_clock;
    kdx::sim::VirtualInstrument m_instrument;
    bool m_explains;
};

/// Makes SIGINT and SIGTERM end the server's run instead of the process.
class EndSignals {
public:
    explicit EndSignals(kdx::simserver::Vxi11Server& server) : m_loop(server.loop()) {
        sigset_t signals;
        sigemptyset(&signals);
        sigaddset(&signals, SIGINT);
        sigaddset(&signals, SIGTERM);
        m_descriptor = kdx::FileDescriptor(::signalfd(-1, &signals, SFD_NONBLOCK | SFD_CLOEXEC));
        if (!m_descriptor.isOpen() || ::sigprocmask(SIG_BLOCK, &signals, nullptr) != 0) {
            throw std::system_error(errno, std::generic_category(), "signals");
        }
        m_loop.watch(m_descriptor.number(), POLLIN, [&server](short) { server.stop(); });
    }
    EndSignals(const EndSignals&) = delete;
    EndSignals& operator=(const EndSignals&) = delete;
    ~EndSignals() { m_loop.forget(m_descriptor.number()); }

private:
    kdx::simserver::PollLoop& m_loop;
    kdx::FileDescriptor m_descriptor;
};

std::string portMapperText(kdx::simserver::PortAnnouncement::Way way) {
    switch (way) {
        case kdx::simserver::PortAnnouncement::Way::OwnMapper:
            return "answers port-mapper questions itself";
        case kdx::simserver::PortAnnouncement::Way::Registered:
            return "registered with the running port mapper";
        case kdx::simserver::PortAnnouncement::Way::None:
            break;
    }
    return "unknown to any port mapper";
}

int serve(const Options& options) {
    // The RPC library writes to the port mapper without a guard; one that hangs up must not end this program.
    std::signal(SIGPIPE, SIG_IGN);
    InstrumentDevice device(options.identification, options.server.trace != nullptr);
    kdx::simserver::Vxi11Server server(device, options.server);
    const EndSignals endSignals(server);
    const kdx::simserver::PortAnnouncement announcement(server.loop(),
                                                        {{DEVICE_CORE, DEVICE_CORE_VERSION, server.corePort()},
                                                         {DEVICE_ASYNC, DEVICE_ASYNC_VERSION, server.abortPort()}},
                                                        options.server.bindAddress);
    if (!announcement.problem().empty()) std::cerr << "kdx-sim: " << announcement.problem() << std::endl;
    printLine("ready: " + options.server.bindAddress + " port " + std::to_string(server.corePort()) + ", " +
              portMapperText(announcement.way()));
    server.run();
    return 0;
}

}  // namespace

int main(int argc, char** argv) {
    constexpr int kFailed = 1;
    constexpr int kWrongUsage = 2;
    try {
        const Options options = readOptions(std::span(argv, static_cast<std::size_t>(argc)).subspan(1));
        if (options.help) {
            std::cout << kHelp;
            return 0;
        }
        if (options.version) {
            printLine("kdx-sim " KDX_VERSION);
            return 0;
        }
        return serve(options);
    } catch (const std::invalid_argument& error) {
        std::cerr << "kdx-sim: " << error.what() << "\n";
        return kWrongUsage;
    } catch (const std::exception& error) {
        std::cerr << "kdx-sim: " << error.what() << "\n";
        return kFailed;
    }
}
