#include "link/lanresource.h"

#include <gtest/gtest.h>

#include <ostream>

namespace kdx {
namespace {

struct GoodName {
    std::string_view resource;
    std::string_view host;
    std::string_view device;
    friend void PrintTo(const GoodName& name, std::ostream* out) { *out << '"' << name.resource << '"'; }
};

class LanResourceName : public ::testing::TestWithParam<GoodName> {};

TEST_P(LanResourceName, IsTakenApart) {
    const auto parsed = parseLanResource(GetParam().resource);
    ASSERT_TRUE(std::holds_alternative<LanResource>(parsed));
    EXPECT_EQ(std::get<LanResource>(parsed).host, GetParam().host);
    EXPECT_EQ(std::get<LanResource>(parsed).device, GetParam().device);
}

INSTANTIATE_TEST_SUITE_P(Values, LanResourceName,
                         ::testing::Values(GoodName{"TCPIP::192.168.0.7::INSTR", "192.168.0.7", "inst0"},
                                           GoodName{"TCPIP::generator::INSTR", "generator", "inst0"},
                                           GoodName{"TCPIP0::host::INSTR", "host", "inst0"},
                                           GoodName{"TCPIP12::host::INSTR", "host", "inst0"},
                                           GoodName{"tcpip::Host::instr", "Host", "inst0"},
                                           GoodName{"TcpIp0::host::Inst2::Instr", "host", "Inst2"},
                                           GoodName{"TCPIP::host::inst0::INSTR", "host", "inst0"},
                                           GoodName{"TCPIP::host::gpib0,28::INSTR", "host", "gpib0,28"},
                                           GoodName{"TCPIP:: 10.0.0.1 ::INSTR", " 10.0.0.1 ", "inst0"},
                                           GoodName{"TCPIP::a:b::INSTR", "a:b", "inst0"},
                                           GoodName{"TCPIP::INSTR::INSTR", "INSTR", "inst0"},
                                           GoodName{"TCPIP::h\xF6st::INSTR", "h\xF6st", "inst0"}));

struct BadName {
    std::string_view resource;
    VisaStatus status;
    friend void PrintTo(const BadName& name, std::ostream* out) { *out << '"' << name.resource << '"'; }
};

class UnusableResourceName : public ::testing::TestWithParam<BadName> {};

TEST_P(UnusableResourceName, GivesTheStatusOfItsKind) {
    const auto parsed = parseLanResource(GetParam().resource);
    ASSERT_TRUE(std::holds_alternative<VisaStatus>(parsed));
    EXPECT_EQ(std::get<VisaStatus>(parsed), GetParam().status);
}

using namespace std::string_view_literals;
INSTANTIATE_TEST_SUITE_P(
    Values, UnusableResourceName,
    ::testing::Values(
        BadName{"", visa::kInvalidResourceName}, BadName{"TCPIP", visa::kInvalidResourceName},
        BadName{"TCPIP::", visa::kInvalidResourceName}, BadName{"TCPIP::host", visa::kInvalidResourceName},
        BadName{"TCPIP::INSTR", visa::kInvalidResourceName}, BadName{"TCPIP::::INSTR", visa::kInvalidResourceName},
        BadName{"TCPIP::host::::INSTR", visa::kInvalidResourceName},
        BadName{"TCPIP::host::a::b::INSTR", visa::kInvalidResourceName},
        BadName{"TCPIP::host::5025::SOCKET", visa::kInvalidResourceName},
        BadName{"TCPIP::host::INSTR ", visa::kInvalidResourceName},
        BadName{" TCPIP::host::INSTR", visa::kInvalidResourceName},
        BadName{"TCPIPX::host::INSTR", visa::kInvalidResourceName},
        BadName{"USB0::1::2::INSTR", visa::kInvalidResourceName},
        BadName{"TCPIP::ho\0st::INSTR"sv, visa::kInvalidResourceName}, BadName{"host", visa::kInvalidResourceName},
        BadName{"GPIBX", visa::kInvalidResourceName}, BadName{"GPIB0::28::INSTR", visa::kLibraryNotFound},
        BadName{"gpib::5::instr", visa::kLibraryNotFound}, BadName{"GPIB0::abc::INSTR", visa::kLibraryNotFound}));

}  // namespace
}  // namespace kdx
