#include "link/hostlookup.h"

#include <netdb.h>
#include <sys/socket.h>

#include <algorithm>
#include <condition_variable>
#include <cstring>
#include <memory>
#include <mutex>
#include <optional>
#include <thread>
#include <utility>

namespace kdx {

namespace {

using Addresses = std::vector<sockaddr_in>;

/// What the helper thread finds out; it belongs to both, since the one who asks may be gone before the answer comes.
struct Lookup {
    std::mutex mutex;
    std::condition_variable done;
    std::optional<Addresses> addresses;
};

Addresses lookUp(const std::string& host, int flags) {
    addrinfo hints{};
    hints.ai_family = AF_INET;  // VXI-11 knows no other
    hints.ai_socktype = SOCK_STREAM;
    hints.ai_flags = flags;
    addrinfo* first = nullptr;
    if (getaddrinfo(host.c_str(), nullptr, &hints, &first) != 0) return {};
    const std::unique_ptr<addrinfo, decltype(&freeaddrinfo)> list(first, &freeaddrinfo);
    Addresses addresses;
    for (const addrinfo* entry = first; entry != nullptr; entry = entry->ai_next) {
        sockaddr_in address{};
        std::memcpy(&address, entry->ai_addr, sizeof address);
        addresses.push_back(address);
    }
    return addresses;
}

}  // namespace

Addresses resolveHost(const std::string& host, Deadline deadline, const std::atomic_bool& aborting) {
    if (Addresses numeric = lookUp(host, AI_NUMERICHOST); !numeric.empty()) return numeric;
    // The system's call has no time-out of its own and cannot be stopped: silent name servers hold it for half a
    // minute. So a thread waits for it that nobody waits for.
    const auto lookup = std::make_shared<Lookup>();
    std::thread([lookup, host] {
        Addresses found = lookUp(host, 0);
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
