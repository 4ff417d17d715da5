#include "sim/simvisa.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include "base/codepage.h"
#include "link/visastatus.h"
#include "sim/scpi.h"
#include "sim/virtualinstrument.h"

namespace kdx::sim {

namespace {

constexpr int kHighestGpibAddress = 30;

std::vector<std::string_view> fields(std::string_view resource) {
    std::vector<std::string_view> result;
    for (std::size_t end = resource.find("::"); end != std::string_view::npos; end = resource.find("::")) {
        result.push_back(resource.substr(0, end));
        resource.remove_prefix(end + 2);
    }
    result.push_back(resource);
    return result;
}

bool isInterface(std::string_view text, std::string_view kind) {
    const std::string_view board = text.substr(std::min(kind.size(), text.size()));
    return equalNoCase(text.substr(0, kind.size()), kind) && (board.empty() || isDecimal(board));
}

bool isGpibAddress(std::string_view text) {
    return isDecimal(text) && readWhole(text) <= kHighestGpibAddress;
}

// Interface and board, address, for LAN perhaps a device name, "INSTR".
bool isResource(std::string_view resource) {
    const std::vector<std::string_view> parts = fields(resource);
    const bool complete = std::none_of(parts.begin(), parts.end(), [](std::string_view part) { return part.empty(); });
    if (!complete || parts.size() < 3 || parts.size() > 4 || !equalNoCase(parts.back(), "INSTR")) return false;
    if (isInterface(parts[0], "TCPIP")) return true;
    return isInterface(parts[0], "GPIB") && std::all_of(parts.begin() + 1, parts.end() - 1, isGpibAddress);
}

}  // namespace

VisaStatus SimVisa::viOpenDefaultRM(VisaHandle& resourceManager) {
    resourceManager = ++m_lastHandle;
    m_resourceManagers.insert(resourceManager);
    return visa::kSuccess;
}

VisaStatus SimVisa::viStatusDesc(VisaHandle, VisaStatus status, std::string& description) {
    return describeStatus(status, description);
}

VisaStatus SimVisa::viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t, std::uint32_t,
                           VisaHandle& session) {
    session = 0;
    if (!m_resourceManagers.contains(resourceManager)) return visa::kInvalidObject;
    if (!isResource(resource)) return visa::kInvalidResourceName;
    session = ++m_lastHandle;
    m_sessions.emplace(session, Session{resourceManager, {}});
    return visa::kSuccess;
}

VisaStatus SimVisa::viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) {
    written = 0;
    const auto found = m_sessions.find(session);
    if (found == m_sessions.end()) return visa::kInvalidObject;
    std::string answer = m_instrument.execute({bytes.data(), bytes.size()});
    if (!answer.empty()) found->second.answers.push_back(std::move(answer));
    written = static_cast<std::int32_t>(bytes.size());
    return visa::kSuccess;
}

VisaStatus SimVisa::viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) {
    count = 0;
    const auto found = m_sessions.find(session);
    if (found == m_sessions.end()) return visa::kInvalidObject;
    auto& answers = found->second.answers;
    if (answers.empty()) {
        m_instrument.reportUnansweredRead();
        return visa::kTimeout;
    }
    std::string& answer = answers.front();
    const std::size_t taken = std::min(answer.size(), buffer.size());
    std::copy_n(answer.begin(), taken, buffer.begin());
    count = static_cast<std::int32_t>(taken);
    answer.erase(0, taken);
    if (!answer.empty()) return visa::kMaxCountReached;
    answers.pop_front();
    return visa::kSuccess;
}

VisaStatus SimVisa::viClose(VisaHandle object) {
    if (m_resourceManagers.erase(object) > 0) {
        std::erase_if(m_sessions, [object](const auto& entry) { return entry.second.resourceManager == object; });
        return visa::kSuccess;
    }
    return m_sessions.erase(object) > 0 ? visa::kSuccess : visa::kInvalidObject;
}

}  // namespace kdx::sim
