#include "air/frequencies.h"

#include <cmath>

#include "air/characters.h"
#include "base/split.h"
#include "sim/scpi.h"

namespace kdx::air {

namespace {

constexpr std::uint16_t kNoLists = pairOf(kNoFrequencies, kFiller);

struct Frequency {
    std::string_view text;
    double megahertz = 0;
    std::optional<std::uint8_t> code;
};

std::vector<Frequency> frequenciesOf(std::string_view list) {
    std::vector<Frequency> frequencies;
    if (list.empty()) return frequencies;
    for (const std::string_view text : split(list, ",")) {
        const auto number = sim::readNumber(text);
        const double megahertz = number ? number->value : 0;
        frequencies.push_back({sim::trimmed(text), megahertz, frequencyCode(megahertz)});
    }
    return frequencies;
}

/// Behind the tuned frequency there are pairs, and each of them repeats it.
bool isMethodB(const std::vector<Frequency>& list) {
    if (list.size() < 3 || list.size() % 2 == 0) return false;
    const double tuned = list.front().megahertz;
    for (std::size_t i = 1; i < list.size(); i += 2) {
        if (list[i].megahertz != tuned && list[i + 1].megahertz != tuned) return false;
    }
    return true;
}

void tellLeftOut(const Frequency& frequency, const std::string& name, Warnings& warnings) {
    warnings.add(name + ": " + std::string(frequency.text) + " MHz has no code and is left out");
}

/// A list goes with its tuned frequency; false when that has no code.
bool hasTuned(const std::vector<Frequency>& list, const std::string& name, Warnings& warnings) {
    if (list.front().code) return true;
    warnings.add(name + ": the tuned frequency " + std::string(list.front().text) +
                 " MHz has no code, so the list is left out");
    return false;
}

/// Codes two by two, led by their count and filled up.
void appendCounted(std::vector<std::uint16_t>& pairs, const std::vector<std::uint8_t>& codes) {
    pairs.push_back(pairOf(kNoFrequencies + static_cast<unsigned>(codes.size()), codes.front()));
    for (std::size_t i = 1; i < codes.size(); i += 2)
        pairs.push_back(pairOf(codes[i], i + 1 < codes.size() ? codes[i + 1] : kFiller));
}

void appendMethodA(std::vector<std::uint16_t>& pairs, const std::vector<Frequency>& list, const std::string& name,
                   Warnings& warnings) {
    std::vector<std::uint8_t> codes;
    for (const Frequency& frequency : list) {
        if (frequency.code) {
            codes.push_back(*frequency.code);
        } else {
            tellLeftOut(frequency, name, warnings);
        }
    }
    // So many alternatives leave the tuned frequency no room. The receiver knows that one anyway.
    if (codes.size() > kMostFrequencies) codes.erase(codes.begin());
    if (!codes.empty()) appendCounted(pairs, codes);
}

void appendMethodB(std::vector<std::uint16_t>& pairs, const std::vector<Frequency>& list, const std::string& name,
                   Warnings& warnings) {
    if (!hasTuned(list, name, warnings)) return;
    std::vector<std::uint8_t> codes{*list.front().code};
    for (std::size_t i = 1; i < list.size(); i += 2) {
        const Frequency& first = list[i];
        const Frequency& second = list[i + 1];
        if (first.code && second.code) {
            codes.insert(codes.end(), {*first.code, *second.code});
        } else {
            tellLeftOut(first.code ? second : first, name, warnings);
        }
    }
    appendCounted(pairs, codes);
}

std::string numbered(const std::string& name, std::size_t index) {
    return name + " list " + std::to_string(index + 1);
}

}  // namespace

std::optional<std::uint8_t> frequencyCode(double megahertz) {
    constexpr double kTolerance = 1e-6;  // of decimals that a double cannot hold
    constexpr double kHighest = 204;
    const double steps = (megahertz - 87.5) * 10;
    const double whole = std::round(steps);
    if (!(std::abs(steps - whole) < kTolerance) || whole < 1 || whole > kHighest) return std::nullopt;
    return static_cast<std::uint8_t>(whole);
}

std::vector<std::uint16_t> methodA(std::string_view list, const std::string& name, Warnings& warnings) {
    std::vector<std::uint16_t> pairs;
    appendMethodA(pairs, frequenciesOf(list), name, warnings);
    return pairs;
}

std::vector<std::uint16_t> mappedPairs(const sim::AfLists& lists, const std::string& name, Warnings& warnings) {
    std::vector<std::uint16_t> pairs;
    for (std::size_t index = 0; index < sim::AfLists::kCount; ++index) {
        const auto list = frequenciesOf(lists.list(index));
        if (list.empty() || !hasTuned(list, numbered(name, index), warnings)) continue;
        for (std::size_t i = 1; i < list.size(); ++i) {
            if (list[i].code) {
                pairs.push_back(pairOf(*list.front().code, *list[i].code));
            } else {
                tellLeftOut(list[i], numbered(name, index), warnings);
            }
        }
    }
    return pairs;
}

void AlternativeFrequencies::take(const sim::AfLists& lists, Warnings& warnings) {
    std::vector<std::uint16_t> pairs;
    m_lengths.clear();
    for (std::size_t index = 0; index < sim::AfLists::kCount; ++index) {
        const auto list = frequenciesOf(lists.list(index));
        const auto append = isMethodB(list) ? appendMethodB : appendMethodA;
        const std::size_t before = pairs.size();
        append(pairs, list, numbered("AF", index), warnings);
        if (pairs.size() > before) m_lengths.push_back(pairs.size() - before);
    }
    if (pairs.empty()) pairs.push_back(kNoLists);
    if (pairs == m_pairs) return;
    m_pairs = std::move(pairs);
    m_next = 0;
}

std::uint16_t AlternativeFrequencies::next() {
    const std::uint16_t pair = m_pairs[m_next];
    m_next = (m_next + 1) % m_pairs.size();
    return pair;
}

}  // namespace kdx::air
