// Round trips of "*IDN?" through liblxi, the yardstick of our own client: bench_lan_liblxi HOST [N]
#include "roundtrips.h"

#include <lxi.h>

#include <array>
#include <cstdio>
#include <string_view>

int main(int argc, char** argv) {
    if (argc < 2) {
        std::fprintf(stderr, "usage: %s HOST [N]\n", argv[0]);
        return 2;
    }
    constexpr int kTimeoutMs = 2000;
    lxi_init();
    const int device = lxi_connect(argv[1], 0, nullptr, kTimeoutMs, VXI11);
    if (device < 0) {
        std::fprintf(stderr, "%s cannot be opened\n", argv[1]);
        return 1;
    }
    constexpr std::string_view kQuestion = "*IDN?";
    std::array<char, 60> answer;
    const int result = kdx::bench::measureRoundTrips(kdx::bench::roundTripsWanted(argc, argv), [&] {
        const auto length = static_cast<int>(kQuestion.size());
        return lxi_send(device, kQuestion.data(), length, kTimeoutMs) == length &&
               lxi_receive(device, answer.data(), static_cast<int>(answer.size()), kTimeoutMs) > 0;
    });
    lxi_disconnect(device);
    return result;
}
