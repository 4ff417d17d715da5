#include "app/ctl/readablefile.h"

#include <cstdint>
#include <limits>

#include "app/ctl/output.h"
#include "base/paths.h"
#include "settings/profilefile.h"

namespace kdx::ctl {

std::optional<std::string> bytesOf(Output& output, const std::string& file) {
    auto bytes = readFile(pathFromUtf8(file), std::numeric_limits<std::uintmax_t>::max());  // a log may be long
    if (!bytes) output.problem(file + " cannot be read");
    return bytes;
}

bool areNone(Output& output, const std::string& file, const std::vector<std::size_t>& lines, const std::string& wrong) {
    for (const std::size_t line : lines)
        output.problem(std::string(file).append(", line ").append(std::to_string(line)).append(": ").append(wrong));
    return lines.empty();
}

}  // namespace kdx::ctl
