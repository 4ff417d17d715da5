#pragma once

#include <cmath>

namespace kdx::air {

/// Kaiser's window: the least that a finite pulse spills into other frequencies. @param place -1 to 1, 0 beyond.
[[nodiscard]] inline double kaiser(double place, double beta) {
    if (std::abs(place) >= 1) return 0;
    return std::cyl_bessel_i(0.0, beta * std::sqrt(1 - place * place)) / std::cyl_bessel_i(0.0, beta);
}

}  // namespace kdx::air
