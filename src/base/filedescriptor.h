#pragma once

namespace kdx {

/// An open file descriptor of a POSIX system - a file, a socket, a pipe - closed when this goes.
class FileDescriptor {
public:
    FileDescriptor() = default;
    explicit FileDescriptor(int number) : m_number(number) {}
    FileDescriptor(FileDescriptor&& other) noexcept;
    FileDescriptor& operator=(FileDescriptor&& other) noexcept;
    ~FileDescriptor() { close(); }

    /// The system's number of it; -1: nothing is open.
    [[nodiscard]] int number() const { return m_number; }
    [[nodiscard]] bool isOpen() const { return m_number >= 0; }
    /// False when the system reports a failure: some file systems tell only here that the bytes did not fit.
    bool close();

private:
    int m_number = -1;
};

}  // namespace kdx
