#pragma once

#include <string>
#include <string_view>

#include "sim/errorqueue.h"

namespace kdx::sim {

/// An instrument as whatever carries messages to it sees it. All calls come from one thread.
class MessageDevice {
public:
    virtual ~MessageDevice() = default;
    /// Carries out one program message; its line end may still be there.
    /// @returns the response message with its line end, or "" when nothing was asked.
    virtual std::string execute(std::string_view message) = 0;
    /// Device clear: whatever is in progress ends; settings and the error queue stay.
    virtual void clear() = 0;
    /// The status byte of IEEE 488.2.
    /// @param messageAvailable whether the client has an answer to fetch: bit 4.
    [[nodiscard]] virtual unsigned char statusByte(bool messageAvailable) const = 0;
    /// Takes an error of the message exchange, which only the transport notices: -363, -410, -420, -430.
    virtual void report(ScpiError error) = 0;
};

}  // namespace kdx::sim
