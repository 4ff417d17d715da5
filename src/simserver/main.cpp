// kdx-sim: the virtual generator with its coder as a program of its own, a network instrument of the VXI-11 standard.

#include "base/clock.h"
#include "base/printable.h"
#include "settings/shownpath.h"
#include "settings/withoutcontrols.h"
#include "sim/virtualinstrument.h"
#include "simserver/linewriter.h"
#include "simserver/liveair.h"
#include "simserver/portannouncement.h"
#include "simserver/trace.h"
#include "simserver/vxi11server.h"

#include <poll.h>
#include <sys/signalfd.h>
#include <unistd.h>
#include <vxi11.h>
#include <CLI/CLI.hpp>

#include <cerrno>
#include <charconv>
#include <csignal>
#include <exception>
#include <functional>
#include <iostream>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <utility>

namespace {

constexpr int kFailed = 1;
constexpr int kWrongUsage = 2;

constexpr const char* kDescription =
    "The virtual signal generator with its stereo/RDS coder, as a VXI-11 network instrument.";
constexpr const char* kFooter =
    R"(Clients open it as TCPIP::ADDR::inst0::INSTR or TCPIP::ADDR::gpib0,N::INSTR (N: 0 to 30). They learn the port from the
port mapper, which kdx-sim is itself when port 111 is free and it may use it; otherwise it registers with the one that
runs.)";

struct Options {
    kdx::simserver::Vxi11Options server;
    std::string identification = kdx::sim::kDefaultIdentification;
    bool trace = false;
    kdx::simserver::LiveAir::Places air;
};

constexpr std::string_view kStandardOutput = "-";

/// Whether what is on the air goes to the standard output, which is left to it then.
bool isOutputTaken(const Options& options) {
    return options.air.groups == kStandardOutput || options.air.multiplex == kStandardOutput;
}

unsigned short portNumber(const std::string& text) {
    unsigned short port = 0;
    const char* end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, port);
    if (text.empty() || read.ec != std::errc() || read.ptr != end) {
        throw CLI::ValidationError("--port", "takes a number from 0 to 65535, not \"" + text + "\"");
    }
    return port;
}

void printLine(std::ostream& stream, std::string_view line) {
    stream << line << std::endl;
}

/// Tells the command line where its options belong. Of an option given twice the last counts.
void declareOptions(CLI::App& commandLine, Options& options) {
    const auto takePort = [&](const std::string& text) { options.server.port = portNumber(text); };
    commandLine
        .add_option_function<std::string>("--port", takePort, "TCP port of the instrument; any free one if left out")
        ->type_name("N")
        ->take_last();
    commandLine
        .add_option("--bind", options.server.bindAddress,
                    "IPv4 address to listen at; 127.0.0.1 (this machine only) if left out")
        ->type_name("ADDR")
        ->take_last();
    commandLine.add_option("--idn", options.identification, "the answer to *IDN?")->type_name("TEXT")->take_last();
    commandLine.add_flag("--trace", options.trace, "print what happens on every link")->disable_flag_override();
    commandLine
        .add_option("--groups", options.air.groups,
                    "write the RDS groups there as they go out, a line each; - for the standard output")
        ->type_name("FILE")
        ->take_last();
    commandLine
        .add_option("--mpx", options.air.multiplex,
                    "write the stereo multiplex there as it goes out, 228000 samples a second: a WAV file; - for bare "
                    "floats to the standard output")
        ->type_name("FILE")
        ->take_last();
    commandLine.set_help_flag("--help", "print this and end");
    commandLine.set_version_flag("--version", "kdx-sim " KDX_VERSION, "print the version and end");
    commandLine.footer(kFooter);
    commandLine.get_formatter()->column_width(16);
    commandLine.failure_message([](const CLI::App*, const CLI::Error& error) {
        return "kdx-sim: " + kdx::shownPath(error.what()) + "; --help lists the options\n";
    });
}

/// The virtual instrument, which may say in words what becomes of a message.
class TracedInstrument final : public kdx::sim::VirtualInstrument {
public:
    /// @param trace gets the words; null: nobody wants to know.
    TracedInstrument(const kdx::Clock& clock, const std::string& identification, kdx::simserver::LineWriter* trace)
        : VirtualInstrument(clock, identification), m_trace(trace) {
        if (m_trace != nullptr) onUnit([this](const auto& unit, auto error) { explain(unit, error); });
    }
    /// Who is to hear that a message was carried out.
    void onExecuted(std::function<void()> executed) { m_executed = std::move(executed); }
    std::string execute(std::string_view message) override {
        std::string answer = VirtualInstrument::execute(message);
        if (m_executed) m_executed();
        if (!m_words.empty()) m_trace->print("       " + kdx::printable(std::exchange(m_words, {})));
        return answer;
    }

private:
    void explain(const kdx::sim::CommandUnit& unit, kdx::sim::ScpiError error) {
        constexpr std::size_t kMost = 2000;  // of a message of thousands of commands the first ones will do
        if (m_words.size() > kMost) return;
        const std::string words = kdx::simserver::describe(unit, error);
        if (!words.empty()) m_words += (m_words.empty() ? "" : "; ") + words;
        if (m_words.size() > kMost) m_words += "; ...";
    }

    kdx::simserver::LineWriter* m_trace;
    std::function<void()> m_executed;
    std::string m_words;  // of the message under way
};

/// SIGINT and SIGTERM as something to wait for instead of the process's end. To be made before any thread, which would
/// get them otherwise.
class EndSignals {
public:
    EndSignals() {
        sigset_t signals;
        sigemptyset(&signals);
        sigaddset(&signals, SIGINT);
        sigaddset(&signals, SIGTERM);
        m_descriptor = kdx::FileDescriptor(::signalfd(-1, &signals, SFD_NONBLOCK | SFD_CLOEXEC));
        if (!m_descriptor.isOpen() || ::pthread_sigmask(SIG_BLOCK, &signals, nullptr) != 0) {
            throw std::system_error(errno, std::generic_category(), "signals");
        }
    }
    /// From now on they end the server's run, which must be over before this object is.
    void endRunOf(kdx::simserver::Vxi11Server& server) const {
        server.loop().watch(m_descriptor.number(), POLLIN, [&server](short) { server.stop(); });
    }

private:
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
    // Whoever reads what is printed may go away; that must not end this program.
    std::signal(SIGPIPE, SIG_IGN);
    const EndSignals endSignals;
    std::unique_ptr<kdx::simserver::LineWriter> trace;
    kdx::simserver::Vxi11Options serverOptions = options.server;
    if (options.trace) {
        trace = std::make_unique<kdx::simserver::LineWriter>(STDOUT_FILENO);
        serverOptions.trace = [&trace](std::string_view line) { trace->print(line); };
    }
    const kdx::SystemClock clock;
    TracedInstrument instrument(clock, kdx::withoutControls(options.identification), trace.get());
    kdx::simserver::Vxi11Server server(instrument, serverOptions);
    endSignals.endRunOf(server);
    const kdx::simserver::PortAnnouncement announcement(server.loop(),
                                                        {{DEVICE_CORE, DEVICE_CORE_VERSION, server.corePort()},
                                                         {DEVICE_ASYNC, DEVICE_ASYNC_VERSION, server.abortPort()}},
                                                        options.server.bindAddress);
    std::unique_ptr<kdx::simserver::LineWriter> problems;  // whoever does not read them holds nothing up
    std::optional<kdx::simserver::LiveAir> air;
    if (!options.air.groups.empty() || !options.air.multiplex.empty()) {
        problems = std::make_unique<kdx::simserver::LineWriter>(STDERR_FILENO);
        const auto tell = [&problems](const std::string& problem) {
            problems->print("kdx-sim: " + kdx::shownPath(problem));
        };
        air.emplace(server.loop(), instrument, clock, options.air, STDOUT_FILENO, tell);
        instrument.onExecuted([&air] { air->settingsChanged(); });
    }
    if (!announcement.problem().empty()) std::cerr << "kdx-sim: " << announcement.problem() << std::endl;
    printLine(isOutputTaken(options) ? std::cerr : std::cout, "ready: " + options.server.bindAddress + " port " +
                                                                  std::to_string(server.corePort()) + ", " +
                                                                  portMapperText(announcement.way()));
    server.run();
    return 0;
}

int run(int argc, char** argv) {
    Options options;
    CLI::App commandLine(kDescription, "kdx-sim");
    declareOptions(commandLine, options);
    try {
        commandLine.parse(argc, argv);
    } catch (const CLI::ParseError& end) {  // thrown to print help or version, too
        return commandLine.exit(end) == 0 ? 0 : kWrongUsage;
    }
    if (isOutputTaken(options) && (options.trace || options.air.groups == options.air.multiplex)) {
        std::cerr << "kdx-sim: only one of --trace, --groups - and --mpx - can have the standard output\n";
        return kWrongUsage;
    }
    if (!options.air.groups.empty() && kdx::isSameFile(options.air.groups, options.air.multiplex)) {
        std::cerr << "kdx-sim: --groups and --mpx name the same file\n";
        return kWrongUsage;
    }
    return serve(options);
}

}  // namespace

int main(int argc, char** argv) {
    try {
        return run(argc, argv);
    } catch (const std::exception& error) {
        std::cerr << "kdx-sim: " << kdx::shownPath(error.what()) << "\n";
        return kFailed;
    }
}
