#include "link/lanresource.h"

#include <algorithm>
#include <vector>

namespace kdx {

namespace {

std::string upperCase(std::string_view text) {
    std::string upper(text);
    for (char& c : upper) {
        if (c >= 'a' && c <= 'z') c = static_cast<char>(c - 'a' + 'A');
    }
    return upper;
}

bool isInterface(std::string_view part, std::string_view keyword) {
    const std::string upper = upperCase(part);
    return upper.starts_with(keyword) && std::all_of(upper.begin() + static_cast<std::ptrdiff_t>(keyword.size()),
                                                     upper.end(), [](char c) { return c >= '0' && c <= '9'; });
}

std::vector<std::string_view> splitAtDoubleColons(std::string_view text) {
    std::vector<std::string_view> parts;
    for (;;) {
        const std::size_t end = text.find("::");
        parts.push_back(text.substr(0, end));
        if (end == std::string_view::npos) return parts;
        text.remove_prefix(end + 2);
    }
}

}  // namespace

std::variant<LanResource, VisaStatus> parseLanResource(std::string_view resource) {
    const std::vector<std::string_view> parts = splitAtDoubleColons(resource);
    if (isInterface(parts.front(), "GPIB")) return visa::kLibraryNotFound;
    const bool wellFormed = (parts.size() == 3 || parts.size() == 4) && isInterface(parts.front(), "TCPIP") &&
                            upperCase(parts.back()) == "INSTR" &&
                            std::none_of(parts.begin(), parts.end(), [](auto part) { return part.empty(); }) &&
                            resource.find('\0') == std::string_view::npos;  // a name would be cut there on its way
    if (!wellFormed) return visa::kInvalidResourceName;
    LanResource found;
    found.host = parts[1];
    if (parts.size() == 4) found.device = parts[2];
    return found;
}

}  // namespace kdx
