// Round trips of "*IDN?" through our LAN client: bench_lan_ours HOST [N]
#include "link/lanvisa.h"

#include "roundtrips.h"

#include <array>
#include <cstdio>
#include <string>
#include <string_view>

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: %s HOST [N]\n", argv[0]);
        return 2;
    }
    kdx::LanVisa visa;
    kdx::VisaHandle manager = 0;
    kdx::VisaHandle session = 0;
    visa.viOpenDefaultRM(manager);
    const std::string resource = "TCPIP::" + std::string(argv[1]) + "::INSTR";
    if (const kdx::VisaStatus status = visa.viOpen(manager, resource, 0, 0, session); status != 0) {
        std::fprintf(stderr, "%s cannot be opened: %d\n", resource.c_str(), status);
        return 1;
    }
    constexpr std::string_view kQuestion = "*IDN?";
    std::array<char, 60> answer;
    return kdx::bench::measureRoundTrips(kdx::bench::roundTripsWanted(argc, argv), [&] {
        std::int32_t count = 0;
        return visa.viWrite(session, kQuestion, count) == 0 && visa.viRead(session, answer, count) >= 0 && count > 0;
    });
}
