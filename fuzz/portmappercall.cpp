// What is asked of the port mapper.
#include "harness.h"

#include "simserver/portmapper.h"
#include "simserver/tirpcxdr.h"

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    static kdx::simserver::PollLoop loop;
    static kdx::simserver::PortMapper mapper(loop, {{0x0607AF, 1, 1024}}, "127.0.0.1", 0);
    int replies = 0;
    const bool isCall = mapper.handle({reinterpret_cast<const char*>(data), size}, 1, [&](const std::string& reply) {
        ++replies;
        demand(reply.size() >= 12 && kdx::xdrWord(reply, 4) == REPLY, "a reply is one");
    });
    demand(replies == (isCall ? 1 : 0), "a call is answered once");
    return 0;
}
