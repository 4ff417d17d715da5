#pragma once

#include "base/filedescriptor.h"

#include <string>

namespace kdx::simserver {

/// Opens a TCP socket that listens and never blocks.
/// @param address IPv4 address in dotted form; port 0 takes any free one. Throws std::system_error.
FileDescriptor listenTcp(const std::string& address, unsigned short port);

/// Opens a UDP socket that never blocks; arguments and errors as listenTcp().
FileDescriptor bindUdp(const std::string& address, unsigned short port);

/// Opens a UDP socket that gets what is sent to a broadcast address, beside other programs that want it too.
/// Otherwise as bindUdp().
FileDescriptor bindUdpBroadcast(const std::string& address, unsigned short port);

/// The port that a bound socket has. Throws std::system_error.
unsigned short localPort(const FileDescriptor& socket);

}  // namespace kdx::simserver
