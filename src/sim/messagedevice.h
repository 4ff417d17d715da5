#pragma once

#include <string>
#include <string_view>

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
    /// The status byte of IEEE 488.2; bit 4 (message available) is added by the transport.
    virtual unsigned char statusByte() = 0;
    /// A client has read in vain: nothing came within its time-out.
    virtual void unansweredRead() = 0;
};

}  // namespace kdx::sim
