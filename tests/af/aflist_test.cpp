#include "af/aflist.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frequencylists.h"

#include <ostream>

namespace kdx {
namespace {

using test::listOf;
using ::testing::ElementsAre;

struct Rewriting {
    const char* list;
    const char* rewritten;
    friend void PrintTo(const Rewriting& row, std::ostream* out) { *out << '"' << row.list << '"'; }
};

class MethodB : public ::testing::TestWithParam<Rewriting> {};

TEST_P(MethodB, PairsEachAfWithTheTunedFrequency) {
    EXPECT_EQ(rewrittenForMethodB(GetParam().list), GetParam().rewritten);
}

INSTANTIATE_TEST_SUITE_P(Lists, MethodB,
                         ::testing::Values(Rewriting{"T,a1,a2,a3", "T,T,a1,T,a2,T,a3"},
                                           Rewriting{"87.6,90.1,94.3", "87.6,87.6,90.1,87.6,94.3"},
                                           Rewriting{"87.6,90.1", "87.6,87.6,90.1"}, Rewriting{"87.6", "87.6"},
                                           Rewriting{"", ""}, Rewriting{"87.6,", "87.6,87.6,"},
                                           Rewriting{",90.1,94.3", ",,90.1,,94.3"},
                                           Rewriting{"T,a,,b", "T,T,a,T,,T,b"}));

struct Value {
    std::string list;
    int number;
    AfMethod method;
    std::optional<std::string> value;
    friend void PrintTo(const Value& row, std::ostream* out) {
        *out << row.number << (row.method == AfMethod::A ? "A \"" : "B \"") << row.list << '"';
    }
};

class AfValue : public ::testing::TestWithParam<Value> {};

TEST_P(AfValue, StartsASetWithListOneAndAddsTheOthers) {
    EXPECT_EQ(afValue(GetParam().list, GetParam().number, GetParam().method), GetParam().value);
}

INSTANTIATE_TEST_SUITE_P(
    Lists, AfValue,
    ::testing::Values(Value{"87.6,90.1,94.3", 1, AfMethod::A, "N,87.6,90.1,94.3"},
                      Value{"87.6,90.1,94.3", 1, AfMethod::B, "N,87.6,87.6,90.1,87.6,94.3"},
                      Value{"87.6,90.1,94.3", 2, AfMethod::A, "+,87.6,90.1,94.3"},
                      Value{"87.6,90.1,94.3", 5, AfMethod::B, "+,87.6,87.6,90.1,87.6,94.3"},
                      Value{"87.6", 1, AfMethod::A, "N,87.6"}, Value{"87.6", 1, AfMethod::B, "N,87.6"},
                      Value{"87.6", 3, AfMethod::A, "+,87.6"}, Value{"87.65,x", 4, AfMethod::A, "+,87.65,x"},
                      Value{listOf(13), 1, AfMethod::B, std::nullopt}, Value{listOf(13), 2, AfMethod::B, std::nullopt},
                      Value{listOf(13), 1, AfMethod::A, "N," + listOf(13)},
                      Value{listOf(40), 2, AfMethod::A, "+," + listOf(40)},
                      Value{listOf(12), 1, AfMethod::B, "N," + rewrittenForMethodB(listOf(12))}));

TEST(AfListTest, TwelveAfsWithMethodBBecomeTwelvePairsAfterTheTunedFrequency) {
    EXPECT_EQ(afCount(rewrittenForMethodB(listOf(12))), 24U);
}

TEST(AfListTest, TheCommasAreTheCountOfAfs) {
    EXPECT_EQ(afCount(""), 0U);
    EXPECT_EQ(afCount("87.6"), 0U);
    EXPECT_EQ(afCount("87.6,90.1"), 1U);
    EXPECT_EQ(afCount(listOf(13)), 13U);
}

TEST(AfListTest, TheFirstListStartsANewSetAndTheOthersAreAdded) {
    EXPECT_EQ(newOrFurtherList(1), "N,");
    for (const int number : {2, 3, 4, 5}) EXPECT_EQ(newOrFurtherList(number), "+,") << number;
}

TEST(AfListTest, AListIsTakenApartAtTheCommas) {
    const auto parts = splitForDisplay("87.6,90.1,94.3");
    ASSERT_TRUE(parts);
    EXPECT_EQ(parts->tuned, "87.6");
    EXPECT_THAT(parts->frequencies, ElementsAre("90.1", "94.3"));
}

TEST(AfListTest, EmptyPiecesAreRowsToo) {
    const auto parts = splitForDisplay(",90.1,,");
    ASSERT_TRUE(parts);
    EXPECT_EQ(parts->tuned, "");
    EXPECT_THAT(parts->frequencies, ElementsAre("90.1", "", ""));
}

TEST(AfListTest, AListWithoutACommaIsNotShown) {
    EXPECT_FALSE(splitForDisplay(""));
    EXPECT_FALSE(splitForDisplay("87.6"));
}

TEST(AfListTest, JoiningPutsSingleCommasBetweenThePieces) {
    EXPECT_EQ(joined({"87.6", {"90.1", "94.3"}}), "87.6,90.1,94.3");
    EXPECT_EQ(joined({"87.6", {}}), "87.6");
    EXPECT_EQ(joined({"", {"90.1"}}), ",90.1");
    EXPECT_EQ(joined({"", {}}), "");
    EXPECT_EQ(joined({"87.6", {"90,1"}}), "87.6,90,1");
}

struct Range {
    const char* text;
    bool tuned;
    bool alternative;
    friend void PrintTo(const Range& row, std::ostream* out) { *out << '"' << row.text << '"'; }
};

class FrequencyRange : public ::testing::TestWithParam<Range> {};

TEST_P(FrequencyRange, DiffersForTunedAndAlternativeFrequencies) {
    EXPECT_EQ(isTunedFrequency(GetParam().text), GetParam().tuned);
    EXPECT_EQ(isAlternativeFrequency(GetParam().text), GetParam().alternative);
}

INSTANTIATE_TEST_SUITE_P(
    Texts, FrequencyRange,
    ::testing::Values(Range{"85.9", false, false}, Range{"86", true, false}, Range{"87.4", true, false},
                      Range{"87.5", true, true}, Range{"108", true, true}, Range{"108.0", true, true},
                      Range{"108.01", false, false}, Range{"108.1", false, false}, Range{"87,6", true, false},
                      Range{"90,1", true, true}, Range{"", false, false}, Range{"abc", false, false},
                      Range{"1e999", false, false}, Range{"-98.5", false, false}, Range{" 98.5 MHz", true, true}));

struct Decimal {
    const char* typed;
    const char* tuned;
    friend void PrintTo(const Decimal& row, std::ostream* out) { *out << '"' << row.typed << '"'; }
};

class TunedFrequency : public ::testing::TestWithParam<Decimal> {};

TEST_P(TunedFrequency, IsCutToOneDecimal) {
    EXPECT_EQ(withOneDecimal(GetParam().typed), GetParam().tuned);
}

INSTANTIATE_TEST_SUITE_P(Texts, TunedFrequency,
                         ::testing::Values(Decimal{"90", "90.0"}, Decimal{"100", "100.0"}, Decimal{"99", "99.0"},
                                           Decimal{"87.65", "87.6"}, Decimal{"87.69", "87.6"},
                                           Decimal{"101.25", "101.2"}, Decimal{"87.6", "87.6"},
                                           Decimal{"100.1", "100.1"}, Decimal{"90.", "90.0"}, Decimal{"100.", "100.0"},
                                           Decimal{"087.65", "087.6"}, Decimal{" 98.55", " 98.5"},
                                           Decimal{"  98.55", "  98.55"}, Decimal{"0098.55", "0098.55"},
                                           Decimal{"9.8e1", "9.8e1"}, Decimal{".98e2", ".98e2"}, Decimal{"087", "087."},
                                           Decimal{"", ".00"}));

TEST(PastedFrequencies, TakesAWholeListOfAllowedOnes) {
    using List = std::vector<std::string>;
    EXPECT_EQ(pastedFrequencies("90.1,94.3"), (List{"90.1", "94.3"}));
    EXPECT_EQ(pastedFrequencies(" 90.1, 94.3 ,108"), (List{"90.1", "94.3", "108"}));
    EXPECT_EQ(pastedFrequencies("90,88,99"), (List{"90", "88", "99"}));
    EXPECT_EQ(pastedFrequencies("90,88"), List{}) << "may be a decimal comma";
    EXPECT_EQ(pastedFrequencies("90.1,12"), List{});
    EXPECT_EQ(pastedFrequencies("90.1,"), List{});
    EXPECT_EQ(pastedFrequencies("90.1,x"), List{});
    EXPECT_LE(pastedFrequencies("90.1").size(), 1U);
    EXPECT_EQ(pastedFrequencies("90.1; 94.3;103.5 105.1"), (List{"90.1", "94.3", "103.5", "105.1"}));
    EXPECT_EQ(pastedFrequencies("90.1\n94.3\r\n"), (List{"90.1", "94.3"})) << "a column of a table";
    EXPECT_EQ(pastedFrequencies("90 88"), (List{"90", "88"}));
    EXPECT_EQ(pastedFrequencies("90.1 94.3 200.1"), List{});
}

TEST(PastedFrequencies, TellTheFirstEntryThatCannotBeTaken) {
    EXPECT_EQ(wrongFrequency("90.1,200.1; x"), "200.1");
    EXPECT_EQ(wrongFrequency("abc 90.1"), "abc");
    EXPECT_EQ(wrongFrequency("90.1,94.3"), std::nullopt);
    EXPECT_EQ(wrongFrequency("200.1"), std::nullopt) << "no list";
    EXPECT_EQ(wrongFrequency("87,6"), std::nullopt) << "may be a decimal comma";
    EXPECT_EQ(wrongFrequency(" ,; "), std::nullopt);
    EXPECT_EQ(wrongFrequency(""), std::nullopt);
}

TEST(SortFrequencies, GoesByTheNumberAndKeepsEqualOnesInOrder) {
    std::vector<std::string> frequencies{"100.1", "90.10", "90.1", "88"};
    sortFrequencies(frequencies);
    EXPECT_EQ(frequencies, (std::vector<std::string>{"88", "90.10", "90.1", "100.1"}));
}

}  // namespace
}  // namespace kdx
