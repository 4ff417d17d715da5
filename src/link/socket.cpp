#include "link/socket.h"

#include <utility>

namespace kdx {

Socket::Socket(Socket&& other) noexcept : m_handle(std::exchange(other.m_handle, kNone)) {}

Socket& Socket::operator=(Socket&& other) noexcept {
    if (this != &other) {
        close();
        m_handle = std::exchange(other.m_handle, kNone);
    }
    return *this;
}

}  // namespace kdx
