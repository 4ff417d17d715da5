#include "simserver/vxi11server.h"

#include "simserver/abortchannel.h"
#include "simserver/corechannel.h"
#include "simserver/rpctcpserver.h"

namespace kdx::simserver {
namespace {

SilenceLimits limitsOf(const Vxi11Options& options) {
    return {.patience = options.patience, .longestSilence = options.longestSilence, .now = options.now};
}

}  // namespace

struct Vxi11Server::Parts {
    Parts(sim::MessageDevice& device, const Vxi11Options& options)
        : core(loop, device, options),
          abort(core),
          abortServer(loop, abort, options.bindAddress, 0, limitsOf(options)),
          coreServer(loop, core, options.bindAddress, options.port, limitsOf(options)) {
        core.setAbortPort(abortServer.port());
    }

    PollLoop loop;
    CoreChannel core;
    AbortChannel abort;
    RpcTcpServer abortServer;
    RpcTcpServer coreServer;
};

Vxi11Server::Vxi11Server(sim::MessageDevice& device, const Vxi11Options& options)
    : m_parts(std::make_unique<Parts>(device, options)) {}

Vxi11Server::~Vxi11Server() = default;

unsigned short Vxi11Server::corePort() const {
    return m_parts->coreServer.port();
}

unsigned short Vxi11Server::abortPort() const {
    return m_parts->abortServer.port();
}

PollLoop& Vxi11Server::loop() {
    return m_parts->loop;
}

void Vxi11Server::run() {
    m_parts->loop.run();
}

void Vxi11Server::stop() {
    m_parts->loop.stop();
}

}  // namespace kdx::simserver
