/// A VISA library for the tests: one instrument, which takes commands and gives each back when it is read. A command
/// that begins with "STATUS " makes the operation itself give the number that follows; so does a resource name.

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

namespace {

#ifdef KDX_WIDE
using Unsigned = std::uint64_t;  // as on systems where the library takes "unsigned long" for the standard's 32 bits
using Signed = std::int64_t;
#else
using Unsigned = std::uint32_t;
using Signed = std::int32_t;
#endif

constexpr Unsigned kManager = 0x80000001;  // handles are unsigned in the standard
constexpr Unsigned kSession = 0xFFFFFFF0;
constexpr std::int32_t kInvalidObject = -1073807346;

std::string held;

std::int32_t statusIn(const std::string& text) {
    return text.starts_with("STATUS ") ? std::atoi(text.c_str() + 7) : 0;
}

}  // namespace

extern "C" {

std::int32_t viOpenDefaultRM(Unsigned* resourceManager) {
    *resourceManager = kManager;
    return 0;
}

#ifndef KDX_WITHOUT_READ
std::int32_t viRead(Unsigned session, unsigned char* buffer, Unsigned size, Unsigned* count) {
    if (session != kSession) return kInvalidObject;
    const Unsigned taken = held.size() < size ? static_cast<Unsigned>(held.size()) : size;
    std::copy_n(held.data(), taken, buffer);
    held.erase(0, taken);
    *count = taken;
    return held.empty() ? 0 : 1073676294;
}
#endif

#ifndef KDX_WITHOUT_CLOSE
std::int32_t viClose(Unsigned object) {
    return object == kSession || object == kManager ? 0 : kInvalidObject;
}
#endif

#ifndef KDX_WITHOUT_LIST
// Three instruments, or none when KDX_FAKE_VISA_EMPTY is set.
std::int32_t viFindRsrc(Unsigned resourceManager, char* /*expression*/, Unsigned* list, Unsigned* count,
                        char* description) {
    if (resourceManager != kManager) return kInvalidObject;
    if (std::getenv("KDX_FAKE_VISA_EMPTY") != nullptr) return -1073807343;
    *list = kSession;
    *count = 3;
    std::strcpy(description, "GPIB0::28::INSTR");
    return 0;
}

std::int32_t viFindNext(Unsigned list, char* description) {
    if (list != kSession) return kInvalidObject;
    const bool second = std::strcmp(description, "GPIB0::28::INSTR") == 0;
    std::strcpy(description, second ? "ASRL1::INSTR" : "TCPIP0::127.0.0.1::inst0::INSTR");
    return 0;
}
#endif

std::int32_t viOpen(Unsigned resourceManager, char* resource, Unsigned accessMode, Unsigned openTimeout,
                    Unsigned* session) {
    if (resourceManager != kManager) return kInvalidObject;
    *session = kSession;
    held = std::string(resource) + " " + std::to_string(accessMode) + " " + std::to_string(openTimeout);
    return statusIn(resource);
}

#ifndef KDX_WITHOUT_DESCRIPTIONS
std::int32_t viStatusDesc(Unsigned object, Signed status, char* description) {
    std::snprintf(description, 256, "status %d of %u", static_cast<int>(status), static_cast<unsigned>(object));
    return status == 7 ? 1073676421 : 0;
}
#endif

#ifndef KDX_WITHOUT_ATTRIBUTES
std::int32_t viSetAttribute(Unsigned object, Unsigned attribute, std::uintptr_t value) {
    if (object != kSession) return kInvalidObject;
    held += " " + std::to_string(attribute) + "=" + std::to_string(value);
    return value == 6667 ? kInvalidObject : 0;
}
#endif

std::int32_t viWrite(Unsigned session, const unsigned char* bytes, Unsigned count, Unsigned* written) {
    if (session != kSession) return kInvalidObject;
    held.assign(reinterpret_cast<const char*>(bytes), count);
    const std::int32_t status = statusIn(held);
    *written = status < 0 ? 0 : count;
    return status;
}

}  // extern "C"
