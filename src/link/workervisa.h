#pragma once

#include <chrono>
#include <functional>
#include <memory>
#include <thread>

#include "link/visa.h"

namespace kdx {

/// Spends the time while a call is under way in another thread.
class CallWaiter {
public:
    virtual ~CallWaiter() = default;
    /// Returns when the call is over, or before that when nobody wants to wait for it any longer.
    virtual void waitUntil(const std::function<bool()>& over) = 0;
    /// Whether it is over is to be looked at again. Said by the other thread, which must not be kept waiting.
    virtual void wake() = 0;
};

/// Carries the calls of another implementation out in a thread of its own, strictly one after the other, while the
/// caller's thread is with a waiter. A call that the waiter gives up is aborted where the implementation can do that,
/// and left behind where it cannot: it ends at once with kAborted, and the next one waits its turn.
class WorkerVisa final : public Visa {
public:
    explicit WorkerVisa(std::shared_ptr<Visa> visa);
    /// Leaves a call behind that does not end; the implementation then lives as long as that.
    ~WorkerVisa() override;
    WorkerVisa(const WorkerVisa&) = delete;
    WorkerVisa& operator=(const WorkerVisa&) = delete;

    /// @param waiter lent; with null, as before a window is there and after, a call simply blocks, but the closing of a
    /// session no longer than two seconds, and what is under way then is aborted for it.
    void setWaiter(CallWaiter* waiter);

    VisaStatus viOpenDefaultRM(VisaHandle& resourceManager) override;
    VisaStatus viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) override;
    /// A session that opens after the waiter has given up is closed again.
    VisaStatus viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                      std::uint32_t openTimeoutMs, VisaHandle& session) override;
    VisaStatus viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) override;
    VisaStatus viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) override;
    /// Is carried out also when it is not waited for.
    VisaStatus viClose(VisaHandle object) override;
    [[nodiscard]] std::vector<std::string> findResources() override;

    /// Lets so much time pass as if it were a call. @returns false when the waiter has given it up before.
    [[nodiscard]] bool pause(std::chrono::nanoseconds duration);

private:
    struct Job;
    class Queue;

    std::shared_ptr<Queue> m_queue;  // the thread's too
    std::thread m_thread;
};

}  // namespace kdx
