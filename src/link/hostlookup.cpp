#include "link/hostlookup.h"

#include <algorithm>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <thread>
#include <utility>

namespace kdx {

namespace {

using Addresses = std::vector<Ipv4Address>;

/// What the helper thread finds out; it belongs to both, since the one who asks may be gone before the answer comes.
struct Lookup {
    std::mutex mutex;
    std::condition_variable done;
    std::optional<Addresses> addresses;
};

}  // namespace

Addresses resolveHost(const std::string& host, Deadline deadline, const std::atomic_bool& aborting) {
    if (Addresses numeric = hostAddresses(host, true); !numeric.empty()) return numeric;
    // The system's call has no time-out of its own and cannot be stopped: silent name servers hold it for half a
    // minute. So a thread waits for it that nobody waits for.
    const auto lookup = std::make_shared<Lookup>();
    std::thread([lookup, host] {
        Addresses found = hostAddresses(host, false);
        const std::lock_guard guard(lookup->mutex);
        lookup->addresses = std::move(found);
        lookup->done.notify_one();
    }).detach();
    std::unique_lock guard(lookup->mutex);
    while (!aborting && std::chrono::steady_clock::now() < deadline) {
        const Deadline look = std::min(deadline, std::chrono::steady_clock::now() + kAbortLatency);
        if (lookup->done.wait_until(guard, look, [&] { return lookup->addresses.has_value(); })) break;
    }
    return lookup->addresses.value_or(Addresses());
}

}  // namespace kdx
