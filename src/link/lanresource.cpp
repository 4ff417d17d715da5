#include "link/lanresource.h"

#include "link/resource.h"

namespace kdx {

std::variant<LanResource, VisaStatus> parseLanResource(std::string_view resource) {
    const Resource parts = parseResource(resource);
    if (parts.kind == Resource::Kind::Gpib) return visa::kLibraryNotFound;
    if (!parts.wellFormed) return visa::kInvalidResourceName;
    if (resource.find('\0') != std::string_view::npos) return visa::kInvalidResourceName;  // cut there on its way
    LanResource found;
    found.host = parts.address;
    if (!parts.device.empty()) found.device = parts.device;
    return found;
}

}  // namespace kdx
