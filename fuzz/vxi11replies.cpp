// What a device and its port mapper send to the LAN client: replies as records, and bytes that need be none.
#include "harness.h"

#include "base/filedescriptor.h"
#include "link/lanvisa.h"
#include "vxi11/rpcrecord.h"

#include <sys/socket.h>
#include <unistd.h>

#include <deque>

namespace {

using kdx::fuzz::demand;

std::deque<std::string> scripts;            // what the next peers send
std::vector<kdx::FileDescriptor> peerEnds;  // open until the client is done, or it could not send any more

}  // namespace

/// Takes the place of the system's: whoever connects gets an end of a pair of sockets whose other end has sent all its
/// replies and hung up. So it needs no port, no second thread and no waiting.
extern "C" int connect(int descriptor, const sockaddr* /*address*/, socklen_t /*length*/) {
    int ends[2];
    if (scripts.empty() || ::socketpair(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK | SOCK_CLOEXEC, 0, ends) != 0) return -1;
    const kdx::FileDescriptor clientEnd(ends[0]);
    peerEnds.emplace_back(ends[1]);
    const ssize_t sent = ::send(ends[1], scripts.front().data(), scripts.front().size(), MSG_NOSIGNAL);
    demand(sent == static_cast<ssize_t>(scripts.front().size()), "all replies find room");
    scripts.pop_front();
    ::shutdown(ends[1], SHUT_WR);
    return ::dup2(ends[0], descriptor) == descriptor ? 0 : -1;
}

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    scripts = {kdx::framed(kdx::fuzz::nextText(input)), {}};
    while (input.remaining_bytes() > 0) {
        const std::string text = kdx::fuzz::nextText(input);
        scripts.back() += input.remaining_bytes() > 0 ? kdx::framed(text) : text;  // the last bytes may be anything
    }

    kdx::LanVisa visa;
    kdx::VisaHandle manager = 0, session = 0;
    visa.viOpenDefaultRM(manager);
    if (visa.viOpen(manager, "TCPIP::127.0.0.1::INSTR", 0, 0, session) == kdx::visa::kSuccess) {
        const std::string command = "*IDN?";
        std::int32_t count = -1;
        const kdx::VisaStatus written = visa.viWrite(session, command, count);
        demand(count >= 0 && count <= 5 && (written != kdx::visa::kSuccess || count == 5),
               "what is written is counted");
        for (int read = 0; read < 2; ++read) {
            std::string buffer(60, '\x7F');
            count = -1;
            const kdx::VisaStatus status = visa.viRead(session, buffer, count);
            demand(count >= 0 && count <= 60, "an answer stays within the buffer");
            demand(status != kdx::visa::kMaxCountReached || count == 60, "a full buffer is full");
        }
        demand(visa.viClose(session) == kdx::visa::kSuccess, "a session can be closed whatever came");
    }
    peerEnds.clear();
    return 0;
}
