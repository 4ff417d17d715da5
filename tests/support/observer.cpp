#include "support/observer.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdint>

namespace kdx::test {

Observer::Observer(const LanOptions& options) : m_visa(options) {
    VisaHandle manager = 0;
    m_visa.viOpenDefaultRM(manager);
    EXPECT_EQ(m_visa.viOpen(manager, "TCPIP::127.0.0.1::INSTR", 0, 0, m_session), visa::kSuccess);
}

void Observer::tell(const std::string& command) {
    std::int32_t written = 0;
    EXPECT_EQ(m_visa.viWrite(m_session, command, written), visa::kSuccess);
}

std::string Observer::ask(const std::string& query) {
    tell(query);
    std::string answer;
    VisaStatus status = visa::kMaxCountReached;
    while (status == visa::kMaxCountReached) {
        std::array<char, 256> buffer{};
        std::int32_t count = 0;
        status = m_visa.viRead(m_session, buffer, count);
        answer.append(buffer.data(), static_cast<std::size_t>(count));
    }
    EXPECT_EQ(status, visa::kSuccess) << query;
    return answer.substr(0, answer.find('\n'));
}

std::string Observer::askCoder(const std::string& name) {
    const std::string answer = ask(":STEREO:DIRECT? \"" + name + "\"");
    return answer.size() < 2 ? answer : answer.substr(1, answer.size() - 2);
}

std::vector<std::string> Observer::errors() {
    std::vector<std::string> errors;
    for (;;) {
        const std::string error = ask("SYST:ERR?");
        if (error.starts_with("0,")) return errors;
        errors.push_back(error);
    }
}

}  // namespace kdx::test
