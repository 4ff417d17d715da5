#pragma once

#include "link/deadline.h"
#include "link/socket.h"

#include <string>
#include <vector>

namespace kdx {

/// The IPv4 addresses of a host; empty when it is unknown, or when the system's name service has not said until the
/// deadline, or until `aborting` is set by another thread.
std::vector<Ipv4Address> resolveHost(const std::string& host, Deadline deadline,
                                     const std::atomic_bool& aborting = kNeverAborted);

}  // namespace kdx
