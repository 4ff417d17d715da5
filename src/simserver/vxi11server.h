#pragma once

#include "sim/messagedevice.h"
#include "simserver/pollloop.h"

#include <chrono>
#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace kdx::simserver {

/// What can be chosen about a server.
struct Vxi11Options {
    std::string bindAddress = "127.0.0.1";  ///< IPv4 in dotted form; others than this machine only when asked for
    unsigned short port = 0;                ///< of the core channel; 0: any free one
    /// Longest data of one device_write. The least that the standard allows, on purpose: some clients forget the END
    /// flag on messages of more than 1024 bytes unless they have to send them in such pieces.
    std::size_t maxRecvSize = 1024;
    std::size_t maxLinks = 64;
    std::size_t maxLinksOfOnePeer = 48;  ///< of all links that one address may have, so that others find room
    /// Longest wait for a lock or an answer, whatever a call asks for.
    std::chrono::milliseconds longestWait = std::chrono::minutes(10);
    /// A client that keeps silent for so long without a link, or in the middle of a call, is cut off.
    std::chrono::milliseconds patience = std::chrono::minutes(1);
    /// So is one that keeps silent for so long with a link: or two addresses could keep all of them for ever.
    std::chrono::milliseconds longestSilence = std::chrono::hours(12);
    /// The time that silence is measured by.
    std::function<PollLoop::TimePoint()> now = std::chrono::steady_clock::now;
    std::function<void(std::string_view)> trace = {};  ///< gets a line for each thing that happens on a link
};

/// Makes a device a network instrument of the VXI-11 standard, under the names "inst0" and "gpib0,0" to "gpib0,30":
/// core and abort channel; interrupt channel, service requests and bus commands are not supported.
/// Every link has an input and an output buffer of its own; a lock holds for the device under all its names.
class Vxi11Server {
public:
    /// Listens at once; serves in run(), and only there calls the device, which must outlive the server.
    /// Throws std::system_error when address or port cannot be had.
    explicit Vxi11Server(sim::MessageDevice& device, const Vxi11Options& options = {});
    ~Vxi11Server();

    [[nodiscard]] unsigned short corePort() const;
    [[nodiscard]] unsigned short abortPort() const;

    /// The loop that serves; other services may be run in it too.
    [[nodiscard]] PollLoop& loop();
    /// Serves until stop() was called.
    void run();
    /// Ends run(); may be called from any thread and from a signal handler.
    void stop();

private:
    struct Parts;
    std::unique_ptr<Parts> m_parts;
};

}  // namespace kdx::simserver
