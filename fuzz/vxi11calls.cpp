// What clients send to the VXI-11 server: calls of the core and the abort channel, by two connections.
// Whatever they were, the next client is served.
#include "harness.h"

#include "sim/virtualinstrument.h"
#include "simserver/abortchannel.h"
#include "simserver/corechannel.h"
#include "simserver/pollloop.h"
#include "simserver/tirpcxdr.h"
#include "support/fakeclock.h"
#include "vxi11/numbers.h"

#include <vxi11.h>

namespace {

using namespace kdx;
using fuzz::demand;
using simserver::ConnectionId;

constexpr std::size_t kHeader = 24;                     // of a reply that was accepted
constexpr std::size_t kProcedureAt = 20, kLinkAt = 40;  // in a call without credentials

/// The server numbers its links as it likes: by 1 an input means the first that it was given, by 2 the second.
void setLink(std::string& record, const std::vector<std::string>& links) {
    const std::uint32_t number = record.size() < kLinkAt + 4 ? 0 : xdrWord(record, kLinkAt);
    if (number >= 1 && number <= links.size()) record.replace(kLinkAt, 4, links[number - 1]);
}

/// A call without credentials.
template <class Arguments>
std::string call(std::uint32_t procedure, const Arguments& arguments, XdrRoutine<Arguments> routine) {
    std::string message;
    for (const std::uint32_t word : {1U, 0U, 2U, static_cast<unsigned>(DEVICE_CORE), 1U, procedure, 0U, 0U, 0U, 0U}) {
        message += toXdr<std::uint32_t>(word, xdr_uint32_t);
    }
    return message + toXdr(arguments, routine, 100);
}

std::string answerTo(simserver::RpcProgram& program, const std::string& message, ConnectionId from) {
    std::string answer;
    demand(program.handle(message, from, [&](const std::string& reply) { answer = reply; }), "a call is one");
    demand(answer.size() > kHeader, "a call is answered at once");
    return answer.substr(kHeader);
}

void identify(simserver::CoreChannel& core, ConnectionId from) {
    char name[] = "inst0", question[] = "*IDN?";
    const std::string created =
        answerTo(core, call<Create_LinkParms>(create_link, {1, 0, 0, name}, xdr_Create_LinkParms), from);
    const auto link = static_cast<Device_Link>(xdrWord(created, 4));
    const Device_WriteParms write{link, 0, 0, vxi11::kFlagEnd, {5, question}};
    answerTo(core, call<Device_WriteParms>(device_write, write, xdr_Device_WriteParms), from);
    const Device_ReadParms read{link, 100, 0, 0, 0, 0};
    const std::string answer = answerTo(core, call<Device_ReadParms>(device_read, read, xdr_Device_ReadParms), from);
    demand(answer.find(sim::kDefaultIdentification) != std::string::npos, "the next client learns the identification");
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const auto senders = input.ConsumeIntegral<std::uint8_t>();
    const test::FakeClock clock;
    sim::VirtualInstrument device(clock);
    simserver::PollLoop loop;
    simserver::Vxi11Options options;
    options.trace = [](std::string_view line) { demand(!line.empty(), "a line of the trace says something"); };
    simserver::CoreChannel core(loop, device, options);
    simserver::AbortChannel abort(core);
    std::vector<std::string> links;
    unsigned calls = 0, replies = 0;
    while (input.remaining_bytes() > 0) {
        std::string record = fuzz::nextText(input);
        setLink(record, links);
        const bool creates = record.size() > kLinkAt && xdrWord(record, kProcedureAt) == create_link;
        const auto send = [&, creates](const std::string& reply) {
            ++replies;
            demand(reply.size() >= 12 && xdrWord(reply, 4) == REPLY, "a reply is one");
            if (creates && reply.size() == kHeader + 16) links.push_back(reply.substr(kHeader + 4, 4));
        };
        const ConnectionId from = 1 + (senders >> (calls++ % 8) & 1U);
        const bool forAbort = record.size() >= 16 && xdrWord(record, 12) == DEVICE_ASYNC;
        if (!(forAbort ? static_cast<simserver::RpcProgram&>(abort) : core).handle(record, from, send)) break;
    }
    loop.callAt(std::chrono::steady_clock::now(), [&] { loop.stop(); });
    loop.run();  // calls that wait no time at all end here
    demand(replies <= calls, "a call is answered once");
    for (const ConnectionId client : {1, 2}) core.connectionClosed(client);
    identify(core, 3);
    return 0;
}
