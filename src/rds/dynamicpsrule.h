#pragma once

#include <string>

namespace kdx {

/// What one step of the dynamic PS has to remember.
struct DynamicPsRecord {
    std::string ps;    ///< the text the toggle mode showed last; empty at first
    int position = 0;  ///< scroll mode: where the field starts, from 1
    int length = 0;    ///< length of the radiotext at the last step
};

/// The marker that takes turns with the typed PS.
inline constexpr const char* kPsMarker = ">--<>--<";

/// Scroll mode: the 8 characters to show next; moves the record on. A text of n characters is shown at positions 1 to
/// n + 1, the last one blank.
[[nodiscard]] std::string nextScrollPs(DynamicPsRecord& record, const std::string& radiotext);
/// Toggle mode: the marker and the typed PS in turn.
[[nodiscard]] std::string nextTogglePs(DynamicPsRecord& record, const std::string& typedPs);
/// Page mode: cuts the radiotext into pages and leaves the PS blank. @throws std::out_of_range for 72 characters and
/// more.
[[nodiscard]] std::string nextPagePs(DynamicPsRecord& record, const std::string& radiotext);

}  // namespace kdx
