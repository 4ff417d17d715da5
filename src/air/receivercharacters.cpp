#include "air/receivercharacters.h"

#include <array>
#include <string_view>

namespace kdx::air {

namespace {

// Sixteen codes a line, from 20 on.
constexpr std::array<std::u16string_view, 14> kRows = {
    u" !\"#¤%&'()*+,-./", u"0123456789:;<=>?", u"@ABCDEFGHIJKLMNO", u"PQRSTUVWXYZ[\\]―_", u"‖abcdefghijklmno",
    u"pqrstuvwxyz{|}¯ ",  u"áàéèíìóòúùÑÇŞß¡Ĳ", u"âäêëîïôöûüñçşǧıĳ", u"ªα©‰Ǧěňőπ€£$←↑→↓",  u"º¹²³±İńűµ¿÷°¼½¾§",
    u"ÁÀÉÈÍÌÓÒÚÙŘČŠŽÐĿ",  u"ÂÄÊËÎÏÔÖÛÜřčšžđŀ", u"ÃÅÆŒŷÝÕØÞŊŔĆŚŹŦð", u"ãåæœŵýõøþŋŕćśźŧ "};
constexpr unsigned kFirst = 0x20;
constexpr unsigned kRowLength = 16;

void appendUtf8(std::string& text, unsigned codePoint) {
    constexpr unsigned kLow = 0x3F;
    constexpr unsigned kFollows = 0x80;
    if (codePoint < kFollows) {
        text += static_cast<char>(codePoint);
        return;
    }
    if (codePoint < 0x800) {
        text += static_cast<char>(0xC0U | codePoint >> 6U);
    } else {
        text += static_cast<char>(0xE0U | codePoint >> 12U);
        text += static_cast<char>(kFollows | (codePoint >> 6U & kLow));
    }
    text += static_cast<char>(kFollows | (codePoint & kLow));
}

}  // namespace

std::string shownText(std::span<const std::uint8_t> codes) {
    std::string text;
    for (const unsigned code : codes)
        appendUtf8(text, code < kFirst ? u' ' : kRows.at((code - kFirst) / kRowLength).at(code % kRowLength));
    return text;
}

}  // namespace kdx::air
