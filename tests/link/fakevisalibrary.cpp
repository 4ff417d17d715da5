/// A VISA library for the tests: one instrument, which takes commands and gives each back when it is read. A command
/// that begins with "STATUS " makes the operation itself give the number that follows; so does a resource name.

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

namespace {

constexpr std::uint32_t kManager = 0x80000001;  // handles are unsigned in the standard
constexpr std::uint32_t kSession = 0xFFFFFFF0;
constexpr std::int32_t kInvalidObject = -1073807346;

std::string held;

std::int32_t statusIn(const std::string& text) {
    return text.starts_with("STATUS ") ? std::atoi(text.c_str() + 7) : 0;
}

}  // namespace

extern "C" {

std::int32_t viOpenDefaultRM(std::uint32_t* resourceManager) {
    *resourceManager = kManager;
    return 0;
}

#ifndef KDX_WITHOUT_READ
std::int32_t viRead(std::uint32_t session, unsigned char* buffer, std::uint32_t size, std::uint32_t* count) {
    if (session != kSession) return kInvalidObject;
    const std::uint32_t taken = held.size() < size ? static_cast<std::uint32_t>(held.size()) : size;
    std::memcpy(buffer, held.data(), taken);
    held.erase(0, taken);
    *count = taken;
    return held.empty() ? 0 : 1073676294;
}
#endif

#ifndef KDX_WITHOUT_CLOSE
std::int32_t viClose(std::uint32_t object) {
    return object == kSession || object == kManager ? 0 : kInvalidObject;
}
#endif

std::int32_t viOpen(std::uint32_t resourceManager, char* resource, std::uint32_t accessMode, std::uint32_t openTimeout,
                    std::uint32_t* session) {
    if (resourceManager != kManager) return kInvalidObject;
    *session = kSession;
    held = std::string(resource) + " " + std::to_string(accessMode) + " " + std::to_string(openTimeout);
    return statusIn(resource);
}

std::int32_t viStatusDesc(std::uint32_t object, std::int32_t status, char* description) {
    std::snprintf(description, 256, "status %d of %u", status, object);
    return status == 7 ? 1073676421 : 0;
}

std::int32_t viWrite(std::uint32_t session, const unsigned char* bytes, std::uint32_t count, std::uint32_t* written) {
    if (session != kSession) return kInvalidObject;
    held.assign(reinterpret_cast<const char*>(bytes), count);
    const std::int32_t status = statusIn(held);
    *written = status < 0 ? 0 : count;
    return status;
}

}  // extern "C"
