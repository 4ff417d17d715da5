// Resource strings.
#include "harness.h"

#include "link/lanresource.h"
#include "link/resource.h"

#include <string>

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using kdx::fuzz::demand;
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const kdx::Resource resource = kdx::parseResource(text);
    demand(resource.wellFormed != resource.address.empty(), "a good one has an address, a bad one none");
    demand(resource.wellFormed || resource.device.empty(), "a bad one has no device");
    for (const std::string_view part : {resource.address, resource.device}) {
        demand(part.find("::") == std::string_view::npos, "a part has no separator");
    }
    if (resource.wellFormed) {
        const std::string device = resource.device.empty() ? "" : "::" + std::string(resource.device);
        const std::string parts = "::" + std::string(resource.address) + device + "::";
        demand(text.substr(text.find("::")).starts_with(parts), "the parts stand so in the text");
        demand(text.size() - text.find("::") == parts.size() + 5, "and nothing but the last word behind them");
    }
    const auto parsed = kdx::parseLanResource(text);
    const auto* const lan = std::get_if<kdx::LanResource>(&parsed);
    const bool isLan = resource.wellFormed && resource.kind == kdx::Resource::Kind::Lan;
    demand((lan != nullptr) == (isLan && text.find('\0') == std::string_view::npos), "a good one of the LAN is taken");
    demand(lan == nullptr || lan->host == resource.address, "the host stands as it was given");
    demand(lan == nullptr || !lan->device.empty(), "there always is a device");
    return 0;
}
