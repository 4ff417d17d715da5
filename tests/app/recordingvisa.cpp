/// A VISA library for the tests that writes down, a line each, what it is asked: in the file that KDX_VISA_RECORD
/// names. The address says how it behaves: at "dead" every write fails, at "broken" the opening ends in an exception,
/// and everywhere else an instrument takes what it is told and answers every question with a blank.

#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <stdexcept>
#include <string>

namespace {

constexpr std::uint32_t kSession = 7;
constexpr std::int32_t kConnectionLost = -1073807194;

bool dead = false;

void record(const std::string& line) {
    std::ofstream(std::getenv("KDX_VISA_RECORD"), std::ios::app) << line << std::endl;
}

}  // namespace

extern "C" {

std::int32_t viOpenDefaultRM(std::uint32_t* resourceManager) {
    *resourceManager = 1;
    return 0;
}

std::int32_t viStatusDesc(std::uint32_t /*object*/, std::int32_t /*status*/, char* description) {
    *description = '\0';
    return 0;
}

std::int32_t viOpen(std::uint32_t /*resourceManager*/, char* resource, std::uint32_t /*accessMode*/,
                    std::uint32_t /*openTimeout*/, std::uint32_t* session) {
    const std::string name(resource);
    if (name.find("broken") != std::string::npos) {
        record("broken");
        throw std::runtime_error("the library is broken");
    }
    dead = name.find("dead") != std::string::npos;
    *session = kSession;
    record("open " + name);
    return 0;
}

std::int32_t viWrite(std::uint32_t /*session*/, const unsigned char* /*bytes*/, std::uint32_t count,
                     std::uint32_t* written) {
    record("write");
    *written = dead ? 0 : count;
    return dead ? kConnectionLost : 0;
}

std::int32_t viRead(std::uint32_t /*session*/, unsigned char* buffer, std::uint32_t /*size*/, std::uint32_t* count) {
    buffer[0] = ' ';
    *count = 1;
    return 0;
}

std::int32_t viClose(std::uint32_t object) {
    record(object == kSession ? "close" : "close of what was never opened");
    return 0;
}

}  // extern "C"
