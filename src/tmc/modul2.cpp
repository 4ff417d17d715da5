#include "tmc/modul2.h"

#include "base/numbers.h"

#include <cmath>

namespace kdx::Modul2 {

std::string ToBinary16(float value) {
    constexpr int kDigits = 16;
    if (!std::isfinite(value)) return std::string(kDigits, '0');
    std::string digits;
    for (int power = kDigits - 1; power >= 0; --power) {
        const float weight = std::ldexp(1.0F, power);
        const float digit = std::trunc(value / weight);
        digits += shortestDecimal(digit);
        value -= digit * weight;
    }
    return digits;
}

double BinaryToValue(std::string_view text) {
    double value = 0;
    for (const char character : text) value = value * 2 + leadingNumber({&character, 1});
    return value;
}

}  // namespace kdx::Modul2
