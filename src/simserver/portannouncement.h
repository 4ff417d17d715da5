#pragma once

#include "simserver/portmapper.h"
#include "simserver/registration.h"

#include <chrono>
#include <memory>
#include <string>
#include <vector>

namespace kdx::simserver {

/// Lets clients find programs by the port mapper: by one of our own when the port can be had, else by registering with
/// the one that runs on this machine.
class PortAnnouncement {
public:
    enum class Way {
        OwnMapper,   ///< we answer the questions ourselves
        Registered,  ///< a running port mapper knows the programs
        None         ///< nobody tells clients the port yet; see problem()
    };

    static constexpr std::chrono::milliseconds kLookAfterEvery{2000};

    /// Takes three seconds at most, when a port mapper runs but does not answer.
    /// @param bindAddress where the programs listen: a port mapper of our own listens there too.
    /// @param lookAfterEvery how often a running port mapper is asked whether it still knows the programs.
    PortAnnouncement(PollLoop& loop, std::vector<PortMapping> mappings, const std::string& bindAddress,
                     unsigned short mapperPort = kPortMapperPort,
                     std::chrono::milliseconds lookAfterEvery = kLookAfterEvery);
    PortAnnouncement(const PortAnnouncement&) = delete;
    PortAnnouncement& operator=(const PortAnnouncement&) = delete;

    /// As it was at the start: with None the registration is tried again, every `lookAfterEvery`.
    [[nodiscard]] Way way() const { return m_way; }
    /// For the user: why clients cannot find the programs, how they reach them all the same, and what to do about it.
    /// Empty unless way() is None.
    [[nodiscard]] const std::string& problem() const { return m_problem; }

private:
    Way m_way = Way::None;
    std::string m_problem;
    std::unique_ptr<PortMapper> m_mapper;
    std::unique_ptr<Registration> m_registration;
};

}  // namespace kdx::simserver
