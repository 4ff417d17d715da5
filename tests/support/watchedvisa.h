#pragma once

#include <functional>
#include <string>

#include "link/visa.h"

namespace kdx::test {

/// Passes everything on to another implementation; a test may step in before a write or a read, and cut the link.
class WatchedVisa final : public Visa {
public:
    explicit WatchedVisa(Visa& visa) : m_visa(visa) {}

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override { return m_visa.viOpenDefaultRM(resourceManager); }
    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override {
        return m_visa.viStatusDesc(object, status, description);
    }
    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override {
        return cut ? visa::kResourceNotFound
                   : m_visa.viOpen(resourceManager, resource, accessMode, openTimeoutMs, session);
    }
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override {
        if (beforeWrite) beforeWrite(std::string(bytes.begin(), bytes.end()));
        return cut ? visa::kConnectionLost : m_visa.viWrite(session, bytes, written);
    }
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override {
        if (beforeRead) beforeRead();
        return cut ? visa::kConnectionLost : m_visa.viRead(session, buffer, count);
    }
    VisaStatus viClose(VisaHandle object) override { return m_visa.viClose(object); }

    std::function<void(const std::string& command)> beforeWrite;  ///< in the thread of the call
    std::function<void()> beforeRead;
    bool cut = false;

private:
    Visa& m_visa;
};

}  // namespace kdx::test
