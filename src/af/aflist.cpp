#include "af/aflist.h"

#include <algorithm>
#include <utility>

#include "base/numbers.h"
#include "base/split.h"
#include "coder/listlead.h"
#include "settings/storedvalue.h"

namespace kdx {

std::string newOrFurtherList(int number) {
    return std::string(number == 1 ? kNewListLead : kFurtherListLead);
}

std::size_t afCount(std::string_view list) {
    return static_cast<std::size_t>(std::count(list.begin(), list.end(), ','));
}

std::string rewrittenForMethodB(std::string_view list) {
    const auto parts = splitForDisplay(list);
    if (!parts) return std::string(list);
    std::string pairs = parts->tuned;
    for (const std::string& frequency : parts->frequencies) pairs += "," + parts->tuned + "," + frequency;
    return pairs;
}

std::optional<std::string> afValue(std::string_view list, int number, AfMethod method) {
    if (method == AfMethod::B && afCount(list) > kMostAfsOfMethodB) return std::nullopt;
    return newOrFurtherList(number) + (method == AfMethod::B ? rewrittenForMethodB(list) : std::string(list));
}

std::optional<AfList> splitForDisplay(std::string_view list) {
    std::size_t comma = list.find(',');
    if (comma == std::string_view::npos) return std::nullopt;
    AfList parts{std::string(list.substr(0, comma)), {}};
    while (comma != std::string_view::npos) {
        list.remove_prefix(comma + 1);
        comma = list.find(',');
        parts.frequencies.emplace_back(list.substr(0, comma));
    }
    return parts;
}

std::string joined(const AfList& list) {
    std::string text = list.tuned;
    for (const std::string& frequency : list.frequencies) text += "," + frequency;
    return text;
}

bool isTunedFrequency(std::string_view text) {
    const double megahertz = leadingNumber(text);
    return megahertz >= 86 && megahertz <= 108;
}

bool isAlternativeFrequency(std::string_view text) {
    // The lower bound is not the tuned frequency's: lists are kept and sent with these bounds, both on purpose.
    const double megahertz = leadingNumber(text);
    return megahertz >= 87.5 && megahertz <= 108.0;
}

namespace {

/// A table's column or a line of a letter is a list, too: semicolons and blanks between entries become commas.
std::string withCommas(std::string_view text) {
    std::string list;
    bool between = false;
    for (const char c : text) {
        if (c == ';' || c == ' ' || c == '\t' || c == '\n' || c == '\r') {
            between = true;
            continue;
        }
        if (between && c != ',' && !list.empty() && list.back() != ',') list += ',';
        between = false;
        list += c;
    }
    return list;
}

/// Two whole numbers with a comma between them may be one.
bool mayBeDecimal(std::string_view text, std::size_t entries) {
    return entries == 2 && text.find('.') == std::string_view::npos && text.find(',') != std::string_view::npos;
}

/// The number that the entry of a list is; nothing when it is no allowed AF.
std::optional<std::string> frequencyOf(std::string_view entry) {
    auto number = decimalNumber(entry);
    return number && isAlternativeFrequency(*number) ? number : std::nullopt;
}

}  // namespace

std::vector<std::string> pastedFrequencies(std::string_view text) {
    std::vector<std::string> frequencies;
    const std::string commaList = withCommas(text);
    for (const std::string_view piece : split(commaList, ",")) {
        auto frequency = frequencyOf(piece);
        if (!frequency) return {};
        frequencies.push_back(std::move(*frequency));
    }
    return mayBeDecimal(text, frequencies.size()) ? std::vector<std::string>() : frequencies;
}

std::optional<std::string_view> wrongFrequency(std::string_view text) {
    constexpr std::string_view kBetween = ",; \t\r\n";
    std::optional<std::string_view> wrong;
    std::size_t entries = 0;
    for (std::size_t at = text.find_first_not_of(kBetween); at < text.size(); ++entries) {
        const std::size_t end = std::min(text.find_first_of(kBetween, at), text.size());
        const std::string_view entry = text.substr(at, end - at);
        if (!wrong && !frequencyOf(entry)) wrong = entry;
        at = text.find_first_not_of(kBetween, end);
    }
    return entries < 2 || mayBeDecimal(text, entries) ? std::nullopt : wrong;
}

void sortFrequencies(std::vector<std::string>& frequencies) {
    std::stable_sort(frequencies.begin(), frequencies.end(), [](const std::string& left, const std::string& right) {
        return leadingNumber(left) < leadingNumber(right);
    });
}

std::string withOneDecimal(std::string_view tuned) {
    std::string text(tuned);
    switch (tuned.find('.')) {
        case std::string_view::npos:
            return (text + ".00").substr(0, leadingNumber(tuned) < 100 ? 4 : 5);
        case 2:
            return (text + "00").substr(0, 4);
        case 3:
            return (text + "00").substr(0, 5);
        default:
            return text;
    }
}

}  // namespace kdx
