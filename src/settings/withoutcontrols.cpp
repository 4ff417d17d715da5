#include "settings/withoutcontrols.h"

#include "base/printable.h"

namespace kdx {

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
