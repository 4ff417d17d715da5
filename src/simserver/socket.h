#pragma once

#include <string>

namespace kdx::simserver {

/// An open file descriptor, closed when this goes.
class FileDescriptor {
public:
    FileDescriptor() = default;
    explicit FileDescriptor(int number) : m_number(number) {}
    FileDescriptor(FileDescriptor&& other) noexcept;
    FileDescriptor& operator=(FileDescriptor&& other) noexcept;
    ~FileDescriptor();

    /// The system's number of it; -1: nothing is open.
    [[nodiscard]] int number() const { return m_number; }

private:
    int m_number = -1;
};

/// Opens a TCP socket that listens and never blocks.
/// @param address IPv4 address in dotted form; port 0 takes any free one. Throws std::system_error.
FileDescriptor listenTcp(const std::string& address, unsigned short port);

/// Opens a UDP socket that never blocks; arguments and errors as listenTcp().
FileDescriptor bindUdp(const std::string& address, unsigned short port);

/// The port that a bound socket has. Throws std::system_error.
unsigned short localPort(const FileDescriptor& socket);

}  // namespace kdx::simserver
