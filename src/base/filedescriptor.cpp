#include "base/filedescriptor.h"

#include <unistd.h>

#include <utility>

namespace kdx {

FileDescriptor::FileDescriptor(FileDescriptor&& other) noexcept : m_number(std::exchange(other.m_number, -1)) {}

FileDescriptor& FileDescriptor::operator=(FileDescriptor&& other) noexcept {
    if (this != &other) {
        close();
        m_number = std::exchange(other.m_number, -1);
    }
    return *this;
}

bool FileDescriptor::close() {
    return m_number < 0 || ::close(std::exchange(m_number, -1)) == 0;
}

}  // namespace kdx
