#pragma once

#include "sim/scpi.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace kdx::simserver {

/// Cuts what a client writes on a link into program messages, which end with END or with a line feed outside quotes.
class MessageBuffer {
public:
    /// Longest program message.
    static constexpr std::size_t kLongest = 65536;

    struct Taken {
        std::vector<std::string> messages;  ///< complete ones, with the line feed that ended them
        bool overrun = false;               ///< a message, the last one, has become too long: all is dropped up to END
    };
    /// @param end whether END came with the last of the bytes.
    Taken take(std::string_view bytes, bool end);
    /// Drops a message that has begun.
    void clear() { *this = MessageBuffer(); }
    /// A message has begun and not ended yet.
    [[nodiscard]] bool hasBegun() const { return m_dropping || !m_message.empty(); }

private:
    std::string m_message;
    sim::Quotes m_quotes;
    bool m_dropping = false;
};

}  // namespace kdx::simserver
