#include "sim/simvisa.h"

#include <algorithm>

#include "link/resource.h"
#include "link/visastatus.h"
#include "sim/virtualinstrument.h"

namespace kdx::sim {

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
    if (!parseResource(resource).wellFormed) return visa::kInvalidResourceName;
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
        m_instrument.report(ScpiError::QueryUnterminated);
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
