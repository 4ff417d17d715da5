#include <gtest/gtest.h>

#include <vector>

#include "air/receivercharacters.h"
#include "base/codepage.h"
#include "coder/rdscharacters.h"

namespace kdx::air {
namespace {

std::string shown(std::vector<std::uint8_t> codes) {
    return shownText(codes);
}

TEST(ShownCharacters, AreThoseOfTheBasicSet) {
    // IEC 62106, annex E: one of every column.
    EXPECT_EQ(shown({0x20, 0x31, 0x42, 0x5A, 0x61, 0x7A}), " 1BZaz");
    EXPECT_EQ(shown({0x80, 0x91, 0xA9, 0xB2, 0xC1, 0xD7, 0xE4, 0xFE}), "áä€²ÀÖŷŧ");
    EXPECT_EQ(shown({0x24, 0xAB, 0x5E, 0x60, 0x7E, 0x8D, 0x9D, 0xA4, 0xA8}), "¤$―‖¯ßǧǦπ");
}

TEST(ShownCharacters, AreBlankWhereTheSetHasNone) {
    EXPECT_EQ(shown({0x00, 0x0A, 0x0D, 0x1F, 0x7F, 0xFF}), "      ");
}

TEST(ShownCharacters, AreThoseThatTheCoderWasGiven) {
    int sent = 0;
    for (int byte = 0; byte < 256; ++byte) {
        const char character = static_cast<char>(byte);
        const auto code = rdsCode(character);
        if (!code) continue;
        ++sent;
        EXPECT_EQ(shown({*code}), toUtf8({&character, 1})) << byte;
    }
    EXPECT_GT(sent, 150);
}

}  // namespace
}  // namespace kdx::air
