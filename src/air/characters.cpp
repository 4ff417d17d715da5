#include "air/characters.h"

#include "base/codepage.h"
#include "coder/rdscharacters.h"

namespace kdx::air {

void writeCodes(std::string_view text, std::span<std::uint8_t> codes, const std::string& name, Warnings& warnings) {
    for (std::size_t at = 0; at < codes.size(); ++at) {
        const char character = at < text.size() ? text[at] : ' ';
        const auto code = rdsCode(character);
        if (!code) {
            warnings.add(name + ": \"" + toUtf8({&character, 1}) +
                         "\" has no place in the RDS character set and is sent as a blank");
        }
        codes[at] = code.value_or(' ');
    }
}

}  // namespace kdx::air
