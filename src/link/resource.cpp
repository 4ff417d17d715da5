#include "link/resource.h"

#include "base/codepage.h"
#include "base/numbers.h"
#include "base/split.h"

#include <algorithm>
#include <vector>

namespace kdx {

namespace {

bool isInterface(std::string_view part, std::string_view keyword) {
    if (!equalNoCase(part.substr(0, keyword.size()), keyword)) return false;
    const std::string_view board = part.substr(keyword.size());
    return board.empty() || isDecimal(board);
}

Resource::Kind kindOf(std::string_view part) {
    if (isInterface(part, "TCPIP")) return Resource::Kind::Lan;
    return isInterface(part, "GPIB") ? Resource::Kind::Gpib : Resource::Kind::Unknown;
}

bool isGpibAddress(std::string_view part) {
    return isDecimal(part) && leadingNumber(part) <= kHighestGpibAddress;
}

}  // namespace

Resource parseResource(std::string_view text) {
    const std::vector<std::string_view> parts = split(text, "::");
    Resource resource;
    resource.kind = kindOf(parts.front());
    if (resource.kind == Resource::Kind::Unknown || parts.size() < 3 || parts.size() > 4) return resource;
    const bool onGpib = resource.kind == Resource::Kind::Gpib;
    const bool usable = std::all_of(parts.begin() + 1, parts.end() - 1,
                                    [&](auto part) { return onGpib ? isGpibAddress(part) : !part.empty(); });
    if (!usable || !equalNoCase(parts.back(), "INSTR")) return resource;
    resource.wellFormed = true;
    resource.address = parts[1];
    if (parts.size() == 4) resource.device = parts[2];
    return resource;
}

std::string resourceText(Resource::Kind kind, const std::string& address) {
    return (kind == Resource::Kind::Lan ? "TCPIP::" : "GPIB0::") + address + "::INSTR";
}

}  // namespace kdx
