#pragma once

#include <string>
#include <string_view>

namespace kdx {

/// An entered text as it can be sent and kept in one line of a profile file: control characters become blanks, CR LF
/// a single one; those at either end are left out. Blanks stay as typed.
[[nodiscard]] std::string withoutControls(std::string_view text);

}  // namespace kdx
