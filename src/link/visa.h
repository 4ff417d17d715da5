#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace kdx {

/// 0 success, negative error, positive completion or warning (VISA library standard, status conventions).
using VisaStatus = std::int32_t;
/// Handle of a resource manager or of an instrument session.
using VisaHandle = std::int32_t;

/// Status values of the VISA standard that our own implementations give.
namespace visa {
constexpr VisaStatus kSuccess = 0;
constexpr VisaStatus kMaxCountReached = 1073676294;       // 3FFF0006: read stopped at the maximum count
constexpr VisaStatus kTermCharacter = 1073676293;         // 3FFF0005: read ended at the termination character
constexpr VisaStatus kSystemError = -1073807360;          // BFFF0000
constexpr VisaStatus kInvalidObject = -1073807346;        // BFFF000E: no such session
constexpr VisaStatus kResourceLocked = -1073807345;       // BFFF000F
constexpr VisaStatus kResourceNotFound = -1073807343;     // BFFF0011: nobody answers at the address
constexpr VisaStatus kInvalidResourceName = -1073807342;  // BFFF0012: the resource string cannot be parsed
constexpr VisaStatus kTimeout = -1073807339;              // BFFF0015
constexpr VisaStatus kAborted = -1073807312;              // BFFF0030
constexpr VisaStatus kInputOutput = -1073807298;          // BFFF003E
constexpr VisaStatus kNoListeners = -1073807265;          // BFFF005F: nobody on the bus; only a library says so
constexpr VisaStatus kLibraryNotFound = -1073807202;      // BFFF009E: no library can serve the resource
constexpr VisaStatus kConnectionLost = -1073807194;       // BFFF00A6
}  // namespace visa

/// The operations of the VISA standard that the program needs, under their published names.
class Visa {
public:
    virtual ~Visa() = default;
    /// Opens the default resource manager.
    virtual VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) = 0;
    /// Describes a status in words.
    virtual VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) = 0;
    /// Opens a session to an instrument ("GPIB0::28::INSTR", "TCPIP::host::INSTR", "TCPIP::host::device::INSTR").
    /// @param accessMode 0 for no lock; @param openTimeoutMs 0 for the implementation's own time.
    virtual VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                              std::uint32_t openTimeoutMs, VisaHandle& session) = 0;
    /// Writes the bytes as they stand; `written` gets the count taken over.
    virtual VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) = 0;
    /// Reads at most buffer.size() bytes; `count` gets how many. What does not fit is left for the next read.
    virtual VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) = 0;
    /// Closes a session or a resource manager.
    virtual VisaStatus viClose(VisaHandle object) = 0;
    /// The instruments that the implementation knows of, as resource strings (viFindRsrc, viFindNext); most know none.
    [[nodiscard]] virtual std::vector<std::string> findResources() { return {}; }
    /// While it is set the call under way ends as soon as it can, with kAborted. The only operation that another thread
    /// may use; an implementation that cannot end a call goes on with it.
    virtual void setAborting(bool /*aborting*/) {}
};

}  // namespace kdx
