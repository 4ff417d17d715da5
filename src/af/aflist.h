#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace kdx {

// A list text is the tuned frequency followed by its alternative frequencies (AFs): decimal MHz with a point, separated
// by single commas, "87.6,90.1,94.3". All texts are 8-bit Windows-1252.

/// Lists of a data set; they are numbered from 1.
inline constexpr int kAfLists = 5;
/// Most AFs that a list sent with method B may hold.
inline constexpr std::size_t kMostAfsOfMethodB = 12;

/// Most AFs of a list, which method A can have: a receiver counts no further.
inline constexpr std::size_t kMostAfsOfMethodA = 25;

/// Kinds of lists the editor works on: those of the own programme and those of the other network.
inline constexpr const char* kAfKind = "AF";
inline constexpr const char* kEonAfKind = "EON AF";

enum class AfMethod { A, B };

/// What leads the sent list `number` (1 to 5): "N," starts a new set with list 1, "+," adds the others to it.
[[nodiscard]] std::string newOrFurtherList(int number);

/// How many AFs the list holds: its commas.
[[nodiscard]] std::size_t afCount(std::string_view list);

/// The list in the form of method B: the tuned frequency alone, then each AF as a pair with the tuned frequency;
/// T,a1,a2 becomes T,T,a1,T,a2. A list without AFs has no pairs and stays as it is.
[[nodiscard]] std::string rewrittenForMethodB(std::string_view list);

/// What is sent for list `number` (1 to 5); nothing when the list has too many AFs for method B.
[[nodiscard]] std::optional<std::string> afValue(std::string_view list, int number, AfMethod method);

/// A list taken apart for showing it.
struct AfList {
    std::string tuned;
    std::vector<std::string> frequencies;
};

/// The list's pieces; nothing for a list without AFs, which is never shown.
[[nodiscard]] std::optional<AfList> splitForDisplay(std::string_view list);

/// The list text of a tuned frequency and its AFs, all taken as they stand.
[[nodiscard]] std::string joined(const AfList& list);

/// Whether the text's leading number is an allowed tuned frequency: 86 to 108 MHz, both included.
[[nodiscard]] bool isTunedFrequency(std::string_view text);

/// Whether the text's leading number is an allowed AF: 87.5 to 108.0 MHz, both included.
[[nodiscard]] bool isAlternativeFrequency(std::string_view text);

/// The frequencies of a list that was typed or pasted in one go, each an allowed AF; one or none when it is no such
/// list. A single comma between whole numbers is none: it may be a decimal one.
[[nodiscard]] std::vector<std::string> pastedFrequencies(std::string_view text);

/// The first entry of such a list that is no allowed AF, as a part of the text; nothing where the text is no list or
/// each entry is one.
[[nodiscard]] std::optional<std::string_view> wrongFrequency(std::string_view text);

/// The frequencies from the lowest to the highest.
void sortFrequencies(std::vector<std::string>& frequencies);

/// The tuned frequency with one decimal, further ones cut off and not rounded. A text whose point is not its third or
/// fourth character stays as it is.
[[nodiscard]] std::string withOneDecimal(std::string_view tuned);

}  // namespace kdx
