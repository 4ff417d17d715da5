// Numbers in texts from outside, in stored settings and in commands.
#include "harness.h"

#include "base/numbers.h"
#include "settings/storedvalue.h"
#include "sim/scpi.h"

#include <cmath>

namespace {

using kdx::fuzz::demand;

/// The C library's reading of what begins the text and is written with these signs alone, in which both agree.
double plainNumber(std::string_view text) {
    return std::strtod(std::string(text.substr(0, text.find_first_not_of("0123456789.eE+-"))).c_str(), nullptr);
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    FuzzedDataProvider input(data, size);
    const int decimals = input.ConsumeIntegralInRange(0, 20);
    const std::string text = kdx::fuzz::nextText(input);
    const std::string other = input.ConsumeRemainingBytesAsString();

    const double number = kdx::leadingNumber(text);
    if (!text.starts_with(' ') && !text.starts_with('\t')) {
        demand(number == plainNumber(text), "a number is read as everywhere");
    }
    const std::string shown = kdx::shortestDecimal(number);
    demand(!std::isfinite(number) || kdx::shortestDecimal(kdx::leadingNumber(shown)) == shown, "what is shown reads");
    demand(!kdx::fixedDecimal(number, decimals).empty(), "every number can be shown");

    const int position = kdx::storedPosition(text, -180, 180);
    demand(position >= -180 && position <= 180, "a position lies within its bar");
    for (const int option : {kdx::storedOption(text, 1, 5), kdx::storedNumber(text, 1, 5), kdx::storedEntry(text, 5)}) {
        demand(option >= -1 && option < 5, "an option is one of those there are");
    }
    demand(!(kdx::liesBetween(text, other, text) || kdx::liesBetween(text, text, other)), "limits do not lie between");

    const auto parameter = kdx::sim::readNumber(text);
    demand(!parameter || parameter->value == kdx::leadingNumber(kdx::sim::trimmed(text)), "a parameter is that number");
    const auto whole = kdx::sim::readWhole(text);
    demand(!whole || parameter || !kdx::isDecimal(text), "a whole number is a number");
    return 0;
}
