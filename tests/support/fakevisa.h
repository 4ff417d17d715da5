#pragma once

#include <algorithm>
#include <deque>
#include <map>
#include <string>
#include <vector>

#include "link/visa.h"

namespace kdx::test {

/// A scripted instrument: records every write, hands out the answers in turn, gives the statuses it is told to give.
class FakeVisa final : public Visa {
public:
    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override {
        calls.push_back("viOpenDefaultRM");
        resourceManager = ++m_lastHandle;
        return rmStatus;
    }
    VisaStatus viStatusDesc(VisaHandle, VisaStatus status, std::string& description) override {
        calls.push_back("viStatusDesc " + std::to_string(status));
        description = "described";
        return descStatus;
    }
    VisaStatus viOpen(VisaHandle, const std::string& resource, std::uint32_t accessMode, std::uint32_t openTimeoutMs,
                      VisaHandle& session) override {
        calls.push_back("viOpen " + resource + " " + std::to_string(accessMode) + " " + std::to_string(openTimeoutMs));
        if (openStatus >= 0) session = ++m_lastHandle;
        return openStatus;
    }
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& count) override {
        const std::string text(bytes.begin(), bytes.end());
        written.push_back(text);
        sessions.push_back(session);
        const VisaStatus status = next(writeStatuses, writeStatus);
        count = status < 0 ? 0 : static_cast<std::int32_t>(bytes.size());
        if (const auto answer = answersTo.find(text); status >= 0 && answer != answersTo.end()) {
            answers.push_back(answer->second);
        }
        return status;
    }
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override {
        sessions.push_back(session);
        ++reads;
        count = 0;
        const VisaStatus status = next(readStatuses, readStatus);
        if (status < 0) return status;
        if (answers.empty()) return visa::kTimeout;
        std::string& answer = answers.front();
        const std::size_t taken = std::min(answer.size(), buffer.size());
        std::copy_n(answer.begin(), taken, buffer.begin());
        count = static_cast<std::int32_t>(taken);
        answer.erase(0, taken);
        if (!answer.empty()) return visa::kMaxCountReached;
        answers.pop_front();
        return status;
    }
    VisaStatus viClose(VisaHandle object) override {
        calls.push_back("viClose " + std::to_string(object));
        return closeStatus;
    }

    std::vector<std::string> written;              ///< every command, in order
    std::vector<std::string> calls;                ///< all other operations, in order
    std::vector<VisaHandle> sessions;              ///< the session of every write and read
    std::deque<std::string> answers;               ///< handed out in turn
    std::map<std::string, std::string> answersTo;  ///< command -> answer queued when it is written
    std::deque<VisaStatus> writeStatuses;          ///< given in turn, then writeStatus
    std::deque<VisaStatus> readStatuses;           ///< given in turn, then readStatus
    VisaStatus rmStatus = 0;
    VisaStatus descStatus = 0;
    VisaStatus openStatus = 0;
    VisaStatus writeStatus = 0;
    VisaStatus readStatus = 0;
    VisaStatus closeStatus = 0;
    int reads = 0;

private:
    static VisaStatus next(std::deque<VisaStatus>& script, VisaStatus otherwise) {
        if (script.empty()) return otherwise;
        const VisaStatus status = script.front();
        script.pop_front();
        return status;
    }
    VisaHandle m_lastHandle = 100;
};

}  // namespace kdx::test
