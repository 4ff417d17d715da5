#pragma once

#include <functional>
#include <span>
#include <string>
#include <string_view>

#include "link/visa.h"

namespace kdx::test {

/// A link that a test may cut, and listen in on.
class CutVisa final : public Visa {
public:
    explicit CutVisa(Visa& visa) : m_visa(visa) {}

    VisaStatus viOpenDefaultRM(VisaHandle& manager) override { return m_visa.viOpenDefaultRM(manager); }
    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override {
        return m_visa.viStatusDesc(object, status, description);
    }
    VisaStatus viOpen(VisaHandle manager, const std::string& resource, std::uint32_t mode, std::uint32_t timeoutMs,
                      VisaHandle& session) override {
        return cut ? visa::kResourceNotFound : m_visa.viOpen(manager, resource, mode, timeoutMs, session);
    }
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override {
        if (beforeWrite) beforeWrite({bytes.data(), bytes.size()});
        return cut ? visa::kConnectionLost : m_visa.viWrite(session, bytes, written);
    }
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override {
        return cut ? visa::kConnectionLost : m_visa.viRead(session, buffer, count);
    }
    VisaStatus viClose(VisaHandle object) override { return m_visa.viClose(object); }

    bool cut = false;
    std::function<void(std::string_view)> beforeWrite;  ///< hears of every message, in the thread of the call

private:
    Visa& m_visa;
};

}  // namespace kdx::test
