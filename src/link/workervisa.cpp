#include "link/workervisa.h"

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <deque>
#include <exception>
#include <mutex>
#include <utility>

namespace kdx {

namespace {

constexpr std::chrono::seconds kLastPatience{2};  // for a session that is closed when nobody sees it any more

}  // namespace

/// One call. What it writes to belongs to it, since the caller may be gone before it ends.
struct WorkerVisa::Job {
    std::function<VisaStatus(Visa&)> call;
    std::function<void(Visa&, VisaStatus)> undo = nullptr;  ///< when nobody waits for what it gave
    bool closes = false;                                    ///< is carried out in any case

    VisaStatus status = visa::kSuccess;
    std::exception_ptr failure = nullptr;
    bool over = false;
    bool givenUp = false;
};

/// What the two threads share. Only the thread of the worker uses the implementation, but for setAborting.
class WorkerVisa::Queue {
public:
    explicit Queue(std::shared_ptr<Visa> visa) : m_visa(std::move(visa)) {}

    void setWaiter(CallWaiter* waiter) {
        const std::lock_guard guard(m_mutex);
        m_waiter = waiter;
    }

    /// @returns false when the job was given up: what it writes to must not be looked at then.
    bool perform(const std::shared_ptr<Job>& job) {
        std::unique_lock lock(m_mutex);
        m_jobs.push_back(job);
        m_changed.notify_all();
        if (CallWaiter* const waiter = m_waiter) {
            lock.unlock();
            waiter->waitUntil([this, &job] {
                const std::lock_guard guard(m_mutex);
                return job->over;
            });
            lock.lock();
        } else if (job->closes) {
            if (m_running != nullptr) abortRunning();
            m_changed.wait_for(lock, kLastPatience, [&job] { return job->over; });
        } else {
            m_changed.wait(lock, [&job] { return job->over; });
        }
        if (job->failure) std::rethrow_exception(job->failure);
        if (job->over) return true;
        job->givenUp = true;
        if (m_running == job.get()) abortRunning();
        return false;
    }

    /// The worker's thread.
    void work() {
        std::unique_lock lock(m_mutex);
        for (;;) {
            m_changed.wait(lock, [this] { return m_ending || !m_jobs.empty(); });
            if (m_jobs.empty()) break;
            const std::shared_ptr<Job> job = std::move(m_jobs.front());
            m_jobs.pop_front();
            if (job->givenUp && !job->closes) continue;
            m_running = job.get();
            lock.unlock();
            carryOut(*job);
            lock.lock();
            if (job->givenUp && job->undo) {
                lock.unlock();
                job->undo(*m_visa, job->status);
                lock.lock();
            }
            m_running = nullptr;
            if (std::exchange(m_aborting, false)) m_visa->setAborting(false);
            job->over = true;
            m_changed.notify_all();
            if (m_waiter != nullptr) m_waiter->wake();
        }
        m_ended = true;
        m_changed.notify_all();
    }

    /// No job comes any more. @returns whether the worker's thread is through.
    bool end() {
        std::unique_lock lock(m_mutex);
        m_ending = true;
        m_changed.notify_all();
        if (m_running != nullptr) abortRunning();
        return m_changed.wait_for(lock, kLastPatience, [this] { return m_ended; });
    }

private:
    void carryOut(Job& job) {
        try {
            job.status = job.call(*m_visa);
        } catch (...) {
            job.status = visa::kSystemError;
            job.failure = std::current_exception();
        }
    }

    void abortRunning() {
        m_aborting = true;
        m_visa->setAborting(true);
    }

    const std::shared_ptr<Visa> m_visa;
    std::mutex m_mutex;  // over everything below and the fields of the jobs
    std::condition_variable m_changed;
    std::deque<std::shared_ptr<Job>> m_jobs;
    Job* m_running = nullptr;
    CallWaiter* m_waiter = nullptr;
    bool m_aborting = false;
    bool m_ending = false;
    bool m_ended = false;
};

WorkerVisa::WorkerVisa(std::shared_ptr<Visa> visa)
    : m_queue(std::make_shared<Queue>(std::move(visa))), m_thread([queue = m_queue] { queue->work(); }) {}

WorkerVisa::~WorkerVisa() {
    if (m_queue->end()) {
        m_thread.join();
    } else {
        m_thread.detach();
    }
}

void WorkerVisa::setWaiter(CallWaiter* waiter) {
    m_queue->setWaiter(waiter);
}

VisaStatus WorkerVisa::viOpenDefaultRM(VisaHandle& resourceManager) {
    const auto made = std::make_shared<VisaHandle>(resourceManager);
    const auto job = std::make_shared<Job>(Job{[made](Visa& visa) { return visa.viOpenDefaultRM(*made); }});
    if (!m_queue->perform(job)) return visa::kAborted;
    resourceManager = *made;
    return job->status;
}

VisaStatus WorkerVisa::viStatusDesc(VisaHandle object, VisaStatus status, std::string& description) {
    const auto words = std::make_shared<std::string>(description);
    const auto job = std::make_shared<Job>(
        Job{[object, status, words](Visa& visa) { return visa.viStatusDesc(object, status, *words); }});
    if (!m_queue->perform(job)) return visa::kAborted;
    description = *words;
    return job->status;
}

VisaStatus WorkerVisa::viOpen(VisaHandle resourceManager, const std::string& resource, std::uint32_t accessMode,
                              std::uint32_t openTimeoutMs, VisaHandle& session) {
    const auto opened = std::make_shared<VisaHandle>(session);
    const auto job = std::make_shared<Job>(
        Job{[=](Visa& visa) { return visa.viOpen(resourceManager, resource, accessMode, openTimeoutMs, *opened); },
            [opened](Visa& visa, VisaStatus status) {
                if (status >= 0) visa.viClose(*opened);
            }});
    if (!m_queue->perform(job)) return visa::kAborted;
    session = *opened;
    return job->status;
}

VisaStatus WorkerVisa::viWrite(VisaHandle session, std::span<const char> bytes, std::int32_t& written) {
    const auto count = std::make_shared<std::int32_t>(0);
    const auto job = std::make_shared<Job>(Job{[session, count, text = std::string(bytes.begin(), bytes.end())](
                                                   Visa& visa) { return visa.viWrite(session, text, *count); }});
    written = 0;
    if (!m_queue->perform(job)) return visa::kAborted;
    written = *count;
    return job->status;
}

VisaStatus WorkerVisa::viRead(VisaHandle session, std::span<char> buffer, std::int32_t& count) {
    struct Answer {
        std::string bytes;
        std::int32_t count = 0;
    };
    // What the buffer holds beyond the answer stays as it is.
    const auto answer = std::make_shared<Answer>(Answer{std::string(buffer.begin(), buffer.end())});
    const auto job = std::make_shared<Job>(
        Job{[session, answer](Visa& visa) { return visa.viRead(session, answer->bytes, answer->count); }});
    count = 0;
    if (!m_queue->perform(job)) return visa::kAborted;
    std::copy(answer->bytes.begin(), answer->bytes.end(), buffer.begin());
    count = answer->count;
    return job->status;
}

VisaStatus WorkerVisa::viClose(VisaHandle object) {
    const auto job = std::make_shared<Job>(Job{[object](Visa& visa) { return visa.viClose(object); }, nullptr, true});
    return m_queue->perform(job) ? job->status : visa::kAborted;
}

std::vector<std::string> WorkerVisa::findResources() {
    const auto found = std::make_shared<std::vector<std::string>>();
    const auto job = std::make_shared<Job>(Job{[found](Visa& visa) {
        *found = visa.findResources();
        return visa::kSuccess;
    }});
    return m_queue->perform(job) ? *found : std::vector<std::string>();
}

bool WorkerVisa::pause(std::chrono::nanoseconds duration) {
    struct Rest {
        std::mutex mutex;
        std::condition_variable changed;
        bool over = false;
    };
    const auto rest = std::make_shared<Rest>();
    const auto job = std::make_shared<Job>(Job{[rest, duration](Visa&) {
        std::unique_lock lock(rest->mutex);
        rest->changed.wait_for(lock, duration, [&rest] { return rest->over; });
        return visa::kSuccess;
    }});
    if (m_queue->perform(job)) return true;
    const std::lock_guard guard(rest->mutex);
    rest->over = true;
    rest->changed.notify_all();
    return false;
}

}  // namespace kdx
