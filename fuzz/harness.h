#pragma once

#include <fuzzer/FuzzedDataProvider.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>
#include <vector>

/// What libFuzzer calls with each input.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace kdx::fuzz {

/// What has to hold whatever the input is; one for which it does not is a finding.
inline void demand(bool holds, const char* what) {
    if (holds) return;
    std::fprintf(stderr, "does not hold: %s\n", what);
    std::abort();
}

/// The next text of several: ends at a backslash, which the line end behind it goes with. Two stand for one.
inline std::string nextText(FuzzedDataProvider& input) {
    return input.ConsumeRandomLengthString();
}

/// The pieces between the separators; one at least.
inline std::vector<std::string_view> split(std::string_view text, std::string_view separators) {
    std::vector<std::string_view> pieces;
    for (;;) {
        const std::size_t end = text.find_first_of(separators);
        pieces.push_back(text.substr(0, end));
        if (end == std::string_view::npos) return pieces;
        text.remove_prefix(end + 1);
    }
}

}  // namespace kdx::fuzz
