#include "sim/aflists.h"

#include "sim/scpi.h"

namespace kdx::sim {

namespace {

constexpr double kTunedLowestMegahertz = 86.0;
constexpr double kAlternativeLowestMegahertz = 87.5;
constexpr double kHighestMegahertz = 108.0;

}  // namespace

ScpiError AfLists::receive(std::string_view value) {
    const auto [mode, list] = cutAt(value, ',');
    const std::string_view letter = trimmed(mode);
    const bool append = letter == "+";
    if (!append && letter != "N" && letter != "n") return ScpiError::IllegalValue;
    if (!list) return ScpiError::MissingParameter;
    if (const ScpiError error = check(*list); error != ScpiError::None) return error;
    if (!append) *this = AfLists();
    if (m_used == kCount) return ScpiError::TooMuchData;
    m_lists[m_used++] = *list;
    return ScpiError::None;
}

ScpiError AfLists::check(std::string_view list) {
    if (list.size() > kMaxLength) return ScpiError::TooMuchData;
    const std::vector<std::string_view> frequencies = splitOutsideQuotes(list, ',');
    if (frequencies.size() > kMaxFrequencies) return ScpiError::TooMuchData;
    double tuned = 0;
    for (std::size_t i = 0; i < frequencies.size(); ++i) {
        if (trimmed(frequencies[i]).empty()) return ScpiError::MissingParameter;
        const auto frequency = readNumber(frequencies[i]);
        if (!frequency || !frequency->suffix.empty()) return ScpiError::IllegalValue;
        if (i == 0) tuned = frequency->value;
        // Method B repeats the tuned frequency, which may lie below the alternatives' band.
        const double lowest = frequency->value == tuned ? kTunedLowestMegahertz : kAlternativeLowestMegahertz;
        if (!(frequency->value >= lowest && frequency->value <= kHighestMegahertz)) return ScpiError::OutOfRange;
    }
    return ScpiError::None;
}

}  // namespace kdx::sim
