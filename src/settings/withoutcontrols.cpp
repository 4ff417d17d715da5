#include "settings/withoutcontrols.h"

namespace kdx {

namespace {

bool isControl(char c) {
    const auto byte = static_cast<unsigned char>(c);
    return byte < 0x20 || byte == 0x7F;
}

}  // namespace

std::string withoutControls(std::string_view text) {
    while (!text.empty() && isControl(text.front())) text.remove_prefix(1);
    while (!text.empty() && isControl(text.back())) text.remove_suffix(1);
    std::string plain;
    for (std::size_t at = 0; at < text.size(); ++at) {
        if (text.substr(at).starts_with("\r\n")) ++at;
        plain += isControl(text[at]) ? ' ' : text[at];
    }
    return plain;
}

}  // namespace kdx
