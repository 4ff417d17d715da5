#pragma once

#include <string>

#include "link/visa.h"

namespace kdx {

/// What passed between the program and the instrument, for whoever wants to watch it.
struct Traffic {
    enum class Kind { Written, Read, Logged };
    Kind kind;
    std::string text;       ///< the command, the answer as read (60 characters) or the log line without its end
    VisaStatus status = 0;  ///< of the write or read
};

/// Hears of everything written, read and logged (logged: also while the log file is off).
class TrafficWatcher {
public:
    virtual ~TrafficWatcher() = default;
    virtual void passed(const Traffic& traffic) = 0;
};

}  // namespace kdx
