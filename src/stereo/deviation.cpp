#include "stereo/deviation.h"

#include "base/numbers.h"

namespace kdx {

std::string deviationSetting(const Deviation& deviation, int tensOfHertz) {
    return rightmost(std::string(deviation.digits, '0') + std::to_string(tensOfHertz), deviation.digits);
}

std::string deviationText(const Deviation& deviation, int tensOfHertz) {
    // In whole numbers: 0.05 has no exact binary form, and its half must not fall to either side by chance.
    const int unit = deviation.decimals == 1 ? 10 : 1;
    const int perKilohertz = 100 / unit;
    const int rounded = tensOfHertz / unit + (2 * (tensOfHertz % unit) >= unit ? 1 : 0);
    const std::string fraction = "00" + std::to_string(rounded % perKilohertz);
    return std::to_string(rounded / perKilohertz) + "." +
           rightmost(fraction, static_cast<std::size_t>(deviation.decimals)) + " kHz";
}

std::string pilotPhaseSetting(int degrees) {
    return rightmost("00" + std::to_string(degrees), 2);
}

}  // namespace kdx
