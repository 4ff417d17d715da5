#include "vxi11/ipv4networks.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace kdx::vxi11 {
namespace {

TEST(Ipv4Networks, AnAddressIsWrittenAsPeopleWriteIt) {
    EXPECT_EQ(dotted(0xC0A80105), "192.168.1.5");
    EXPECT_EQ(dotted(0), "0.0.0.0");
    EXPECT_EQ(dotted(0xFFFFFFFF), "255.255.255.255");
}

TEST(Ipv4Networks, OnesOwnMachineIsInOne) {
    const auto networks = ipv4Networks();
    EXPECT_TRUE(std::ranges::any_of(networks, [](const Ipv4Network& network) { return network.holds(0x7F000001); }));
}

TEST(Ipv4Networks, ANetworkOfTwoHasNoAddressForEverybody) {
    EXPECT_EQ((Ipv4Network{0xC0A80105, 0xFFFFFF00, 0}.broadcast()), 0xC0A801FF);
    EXPECT_EQ((Ipv4Network{0xC0A80105, 0xFFFFFFFE, 0}.broadcast()), std::nullopt);
}

}  // namespace
}  // namespace kdx::vxi11
