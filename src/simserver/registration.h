#pragma once

#include "simserver/portmapper.h"

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

namespace kdx::simserver {

class MapperClient;

/// Programs registered with the port mapper that runs on this machine, as long as this object lives: one that does not
/// take them now, is started later, or is started anew and has forgotten them, is told again within seconds.
class Registration {
public:
    /// Takes three seconds at most. @param address where the programs listen: the port mapper may listen there alone.
    /// @param lookAfterEvery how often the port mapper is asked whether it still knows.
    Registration(std::vector<PortMapping> mappings, std::string address, unsigned short mapperPort,
                 std::chrono::milliseconds lookAfterEvery);
    Registration(const Registration&) = delete;
    Registration& operator=(const Registration&) = delete;
    /// Takes the registration back, unless another program has it by now. Takes two seconds at most.
    ~Registration();

    /// At first, that is: it is tried again as long as it has not.
    [[nodiscard]] bool succeeded() const { return m_succeeded; }
    /// False: nobody listened at the port mapper's port.
    [[nodiscard]] bool mapperRuns() const { return m_mapperRuns; }

private:
    bool registerAll(MapperClient& mapper);
    void keepRegistered();

    std::vector<PortMapping> m_mappings;
    std::string m_address;
    unsigned short m_mapperPort;
    std::chrono::milliseconds m_lookAfterEvery;
    bool m_mapperRuns = false;
    bool m_succeeded = false;
    bool m_registered = false;  ///< by now; while the keeper runs only it looks at this
    std::mutex m_mutex;
    std::condition_variable m_ended;
    bool m_ending = false;
    std::thread m_keeper;
};

}  // namespace kdx::simserver
