#pragma once

#include <algorithm>
#include <string>

#include "harness.h"
#include "link/visa.h"

namespace kdx::fuzz {

/// An instrument that answers with the input's texts, one a question, and its statuses.
class MadeUpVisa final : public Visa {
public:
    explicit MadeUpVisa(FuzzedDataProvider& input) : m_input(input) {}
    VisaStatus viOpenDefaultRM(VisaHandle&) override { return visa::kSuccess; }
    VisaStatus viStatusDesc(VisaHandle, VisaStatus, std::string&) override { return nextStatus(); }
    VisaStatus viOpen(VisaHandle, const std::string&, std::uint32_t, std::uint32_t, VisaHandle&) override {
        return visa::kSuccess;
    }
    VisaStatus viWrite(VisaHandle, std::span<const char>, std::int32_t&) override { return nextStatus(); }
    VisaStatus viRead(VisaHandle, std::span<char> buffer, std::int32_t& count) override {
        const std::string answer = m_input.ConsumeRandomLengthString(buffer.size());
        std::copy(answer.begin(), answer.end(), buffer.begin());
        count = static_cast<std::int32_t>(answer.size());
        return nextStatus();
    }
    VisaStatus viClose(VisaHandle) override { return nextStatus(); }

private:
    VisaStatus nextStatus() {
        return m_input.PickValueInArray({visa::kSuccess, visa::kMaxCountReached, visa::kTimeout});
    }

    FuzzedDataProvider& m_input;
};

}  // namespace kdx::fuzz
