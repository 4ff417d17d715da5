#include "link/resource.h"

#include <gtest/gtest.h>

#include <ostream>

namespace kdx {
namespace {

using Kind = Resource::Kind;

struct ResourceCase {
    std::string_view text;
    Kind kind;
    bool wellFormed;
    std::string_view address = {};
    std::string_view device = {};
    friend void PrintTo(const ResourceCase& resource, std::ostream* out) { *out << '"' << resource.text << '"'; }
};

class ResourceText : public ::testing::TestWithParam<ResourceCase> {};

TEST_P(ResourceText, IsTakenApart) {
    const Resource resource = parseResource(GetParam().text);
    EXPECT_EQ(resource.kind, GetParam().kind);
    EXPECT_EQ(resource.wellFormed, GetParam().wellFormed);
    EXPECT_EQ(resource.address, GetParam().address);
    EXPECT_EQ(resource.device, GetParam().device);
}

INSTANTIATE_TEST_SUITE_P(
    Lan, ResourceText,
    ::testing::Values(ResourceCase{"TCPIP::host::INSTR", Kind::Lan, true, "host"},
                      ResourceCase{"tcpip0:: a b ::gpib0,28::instr", Kind::Lan, true, " a b ", "gpib0,28"},
                      ResourceCase{"TCPIP", Kind::Lan, false}, ResourceCase{"TCPIP::::INSTR", Kind::Lan, false},
                      ResourceCase{"TCPIP::host::SOCKET", Kind::Lan, false},
                      ResourceCase{"TCPIP::a::b::c::INSTR", Kind::Lan, false}));

INSTANTIATE_TEST_SUITE_P(Gpib, ResourceText,
                         ::testing::Values(ResourceCase{"GPIB0::28::INSTR", Kind::Gpib, true, "28"},
                                           ResourceCase{"GPIB::30::INSTR", Kind::Gpib, true, "30"},
                                           ResourceCase{"gpib12::05::3::instr", Kind::Gpib, true, "05", "3"},
                                           ResourceCase{"GPIB0::31::INSTR", Kind::Gpib, false},
                                           ResourceCase{"GPIB0::2::31::INSTR", Kind::Gpib, false},
                                           ResourceCase{"GPIB0::99999999999999999999::INSTR", Kind::Gpib, false},
                                           ResourceCase{"GPIB0::-1::INSTR", Kind::Gpib, false},
                                           ResourceCase{"GPIB0::abc::INSTR", Kind::Gpib, false},
                                           ResourceCase{"GPIB0::::INSTR", Kind::Gpib, false},
                                           ResourceCase{"GPIB", Kind::Gpib, false}));

INSTANTIATE_TEST_SUITE_P(OfAnotherKind, ResourceText,
                         ::testing::Values(ResourceCase{"", Kind::Unknown, false},
                                           ResourceCase{"TCP", Kind::Unknown, false},
                                           ResourceCase{"GPIBx::2::INSTR", Kind::Unknown, false},
                                           ResourceCase{"USB0::1::2::INSTR", Kind::Unknown, false},
                                           ResourceCase{" TCPIP::host::INSTR", Kind::Unknown, false}));

TEST(ResourceText, IsTakenApartToWhatItWasMadeOf) {
    EXPECT_EQ(resourceText(Resource::Kind::Lan, "10.0.0.7::inst0"), "TCPIP::10.0.0.7::inst0::INSTR");
    EXPECT_EQ(resourceText(Resource::Kind::Gpib, "28"), "GPIB0::28::INSTR");
    const std::string text = resourceText(Resource::Kind::Lan, "host");
    const Resource parts = parseResource(text);
    EXPECT_TRUE(parts.wellFormed && parts.kind == Resource::Kind::Lan);
    EXPECT_EQ(parts.address, "host");
}

}  // namespace
}  // namespace kdx
