#pragma once

#include <condition_variable>
#include <functional>
#include <mutex>
#include <string>
#include <vector>

#include "support/fakevisa.h"

namespace kdx::test {

/// A scripted instrument whose calls can be made to hang, as those of a device that keeps silent. To be used by one
/// thread at a time and steered by another.
class HangingVisa final : public Visa {
public:
    /// From now on every opening, write and read hangs. @param abortable whether it can be ended, as ours
    /// can; the calls of a library cannot.
    void hang(bool abortable) {
        const std::lock_guard guard(m_mutex);
        m_hangs = true;
        m_abortable = abortable;
    }
    void goOn() {
        const std::lock_guard guard(m_mutex);
        m_hangs = false;
        m_changed.notify_all();
    }
    /// Waits until a call hangs.
    void waitForCall() {
        std::unique_lock lock(m_mutex);
        m_changed.wait(lock, [this] { return m_hanging; });
    }
    /// What was called, in order.
    std::vector<std::string> calls() {
        const std::lock_guard guard(m_mutex);
        return m_calls;
    }
    /// The most calls that were under way at the same time.
    int mostAtOnce() {
        const std::lock_guard guard(m_mutex);
        return m_mostAtOnce;
    }

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override { return m_fake.viOpenDefaultRM(resourceManager); }
    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override {
        return m_fake.viStatusDesc(object, status, description);
    }
    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override {
        return talk("open " + resource,
                    [&] { return m_fake.viOpen(resourceManager, resource, accessMode, openTimeoutMs, session); });
    }
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override {
        return talk("write " + std::string(bytes.begin(), bytes.end()),
                    [&] { return m_fake.viWrite(session, bytes, written); });
    }
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override {
        return talk("read", [&] { return m_fake.viRead(session, buffer, count); });
    }
    VisaStatus viClose(VisaHandle object) override {
        const std::lock_guard guard(m_mutex);
        m_calls.push_back("close");
        return m_fake.viClose(object);
    }
    void setAborting(bool aborting) override {
        const std::lock_guard guard(m_mutex);
        m_aborting = aborting;
        m_changed.notify_all();
    }

    FakeVisa& script() { return m_fake; }  ///< before the first call, or while none is under way

private:
    VisaStatus talk(const std::string& call, const std::function<VisaStatus()>& action) {
        std::unique_lock lock(m_mutex);
        m_calls.push_back(call);
        m_mostAtOnce = std::max(m_mostAtOnce, ++m_underWay);
        m_hanging = m_hangs;
        m_changed.notify_all();
        m_changed.wait(lock, [this] { return !m_hangs || (m_abortable && m_aborting); });
        m_hanging = false;
        const bool aborted = m_hangs;
        const VisaStatus status = aborted ? visa::kAborted : action();
        --m_underWay;
        return status;
    }

    FakeVisa m_fake;
    std::mutex m_mutex;
    std::condition_variable m_changed;
    std::vector<std::string> m_calls;
    bool m_hangs = false, m_abortable = false, m_aborting = false, m_hanging = false;
    int m_underWay = 0, m_mostAtOnce = 0;
};

}  // namespace kdx::test
