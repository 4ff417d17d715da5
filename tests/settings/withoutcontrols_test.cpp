#include "settings/withoutcontrols.h"

#include <gtest/gtest.h>

#include <ostream>

namespace kdx {
namespace {

using namespace std::string_literals;

struct ControlsCase {
    std::string entered;
    std::string plain;
    friend void PrintTo(const ControlsCase& value, std::ostream* out) {
        *out << ::testing::PrintToString(value.entered);
    }
};

class WithoutControls : public ::testing::TestWithParam<ControlsCase> {};

TEST_P(WithoutControls, GivesOneLineOfPlainText) {
    EXPECT_EQ(withoutControls(GetParam().entered), GetParam().plain);
}

INSTANTIATE_TEST_SUITE_P(Values, WithoutControls,
                         ::testing::Values(ControlsCase{"", ""}, ControlsCase{"RADIO 1", "RADIO 1"},
                                           ControlsCase{"  a  b  ", "  a  b  "}, ControlsCase{"a\tb", "a b"},
                                           ControlsCase{"a\r\nb", "a b"}, ControlsCase{"a\n\rb", "a  b"},
                                           ControlsCase{"a\r\n\r\nb", "a  b"}, ControlsCase{"a\rb\nc", "a b c"},
                                           ControlsCase{"\r\n\ta\r\n", "a"},  // pasted with the end of its line
                                           ControlsCase{"\t a \n", " a "}, ControlsCase{" \ta", "  a"},
                                           ControlsCase{"\r\n\t", ""},
                                           ControlsCase{"a\0b\x7F"
                                                        "c\x1A"s,
                                                        "a b c"},
                                           ControlsCase{"\x80\xFC\x81\xA0", "\x80\xFC\x81\xA0"}));

}  // namespace
}  // namespace kdx
