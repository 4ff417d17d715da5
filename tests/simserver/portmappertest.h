#pragma once

#include "simserver/portmapper.h"

#include "simserver/rpcclient.h"

#include <gtest/gtest.h>
#include <netinet/in.h>
#include <rpc/pmap_prot.h>
#include <vxi11.h>

#include <string>
#include <thread>

namespace kdx::simserver {

inline constexpr std::uint32_t kCore = DEVICE_CORE;
inline constexpr std::uint32_t kAsync = DEVICE_ASYNC;

inline std::string question(std::uint32_t program, std::uint32_t version, std::uint32_t protocol,
                            std::uint32_t port = 0) {
    return toXdr<pmap>({program, version, protocol, port}, xdr_pmap);
}

/// A loop that runs in a thread of its own while the object lives.
class RunningLoop {
public:
    explicit RunningLoop(PollLoop& loop) : m_loop(loop), m_thread([&loop] { loop.run(); }) {}
    RunningLoop(const RunningLoop&) = delete;
    RunningLoop& operator=(const RunningLoop&) = delete;
    ~RunningLoop() {
        m_loop.stop();
        m_thread.join();
    }

private:
    PollLoop& m_loop;
    std::thread m_thread;
};

}  // namespace kdx::simserver
