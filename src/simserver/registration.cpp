#include "simserver/registration.h"

#include "simserver/mapperclient.h"
#include "simserver/socket.h"

#include <chrono>
#include <system_error>
#include <utility>

namespace kdx::simserver {
namespace {

using namespace std::chrono_literals;
using std::chrono::steady_clock;

constexpr auto kTimeToRegister = 3s;
constexpr auto kTimeToLookAfter = 1s;
constexpr auto kTimeToTakeBack = 1s;

// At any address of this machine: whoever asks for all of them in vain is in somebody's way.
bool anybodyListens(std::uint32_t port) {
    try {
        listenTcp("0.0.0.0", static_cast<unsigned short>(port));
        return false;
    } catch (const std::system_error&) {
        return true;
    }
}

bool add(MapperClient& mapper, const PortMapping& mapping) {
    if (mapper.add(mapping)) return true;
    // Somebody is registered already. If he crashed and left that behind, nobody listens there any more.
    const std::uint32_t holder = mapper.portOf(mapping).value_or(0);
    if (holder == 0 || anybodyListens(holder)) return false;
    mapper.remove(mapping);
    return mapper.add(mapping);
}

}  // namespace

Registration::Registration(std::vector<PortMapping> mappings, std::string address, unsigned short mapperPort,
                           std::chrono::milliseconds lookAfterEvery)
    : m_mappings(std::move(mappings)),
      m_address(std::move(address)),
      m_mapperPort(mapperPort),
      m_lookAfterEvery(lookAfterEvery) {
    MapperClient mapper(m_address, m_mapperPort, steady_clock::now() + kTimeToRegister);
    m_mapperRuns = mapper.isConnected();
    m_succeeded = m_registered = registerAll(mapper);
    m_keeper = std::thread([this] { keepRegistered(); });
}

Registration::~Registration() {
    {
        const std::lock_guard guard(m_mutex);
        m_ending = true;
    }
    m_ended.notify_all();
    m_keeper.join();
    if (!m_registered) return;
    MapperClient mapper(m_address, m_mapperPort, steady_clock::now() + kTimeToTakeBack);
    for (const PortMapping& mapping : m_mappings) {
        if (mapper.portOf(mapping) == mapping.port) mapper.remove(mapping);
    }
}

// All of them or none.
bool Registration::registerAll(MapperClient& mapper) {
    if (!mapper.isConnected()) return false;
    for (std::size_t i = 0; i < m_mappings.size(); ++i) {
        if (add(mapper, m_mappings[i])) continue;
        for (std::size_t taken = 0; taken < i; ++taken) mapper.remove(m_mappings[taken]);
        return false;
    }
    return true;
}

void Registration::keepRegistered() {
    std::unique_lock guard(m_mutex);
    while (!m_ended.wait_for(guard, m_lookAfterEvery, [this] { return m_ending; })) {
        guard.unlock();
        MapperClient mapper(m_address, m_mapperPort, steady_clock::now() + kTimeToLookAfter);
        if (m_registered) {
            for (const PortMapping& mapping : m_mappings) {
                if (mapper.portOf(mapping) == 0U) mapper.add(mapping);
            }
        } else {
            m_registered = registerAll(mapper);
        }
        guard.lock();
    }
}

}  // namespace kdx::simserver
