#include "af/eonlist.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <vector>

namespace kdx {
namespace {

template <typename Case>
std::string caseName(const ::testing::TestParamInfo<Case>& tested) {
    return tested.param.name;
}

using Networks = std::vector<std::string>;

/// Which networks an answer has deleted.
struct AnswerCase {
    const char* name;
    const char* answer;
    Networks networks;
    friend void PrintTo(const AnswerCase& answered, std::ostream* out) { *out << '"' << answered.answer << '"'; }
};

class NetworksToDelete : public ::testing::TestWithParam<AnswerCase> {};

TEST_P(NetworksToDelete, AreThoseOfTheAnswer) {
    EXPECT_EQ(networksToDelete(GetParam().answer), GetParam().networks);
}

INSTANTIATE_TEST_SUITE_P(
    Answers, NetworksToDelete,
    ::testing::Values(AnswerCase{"TwoWithACommaBetween", "1234,5678", {"1234", "5678"}},
                      AnswerCase{"ACommaAfterEachStopsEarly", " D3C2,D3C3,", {"D3C2", "D3C3"}},
                      AnswerCase{"OneWithACommaAfterIt", " D3C2,", {"D3C2"}}, AnswerCase{"OneAlone", "D3C2", {"D3C2"}},
                      AnswerCase{"LastAfterAQuote", "1234,\"5678", {"1234", "5678"}},
                      AnswerCase{"OneAfterAQuote", "\"D3C2\"", {"D3C2"}},
                      AnswerCase{"QuoteLeadsTheFirst", "\"1234,5678", {"1234", "5678"}},
                      AnswerCase{"BlankLeadsTheLast", "1234, 5678", {"1234", " 567"}},
                      AnswerCase{"LastIsLong", "1234,567890", {"1234", "5678"}},
                      AnswerCase{"LastIsShort", "1234,56", {"1234", "56"}},
                      AnswerCase{"FirstIsLong", "001234,5678", {"1234", "5678"}},
                      AnswerCase{"FirstIsShort", "12,5678", {"12", "5678"}},
                      AnswerCase{"NothingBeforeTheComma", ",5678", {"", "5678"}},
                      AnswerCase{"NothingBetweenCommas", "1234,,5678", {"1234", "", "5678"}},
                      AnswerCase{"CommaAlone", ",", {""}}, AnswerCase{"QuoteAloneAtTheEnd", "1234,\"", {"1234", ""}},
                      // A coder without networks and a failed query have one more delete, which names no network.
                      AnswerCase{"NoNetworks", " ", {" "}},
                      AnswerCase{"EmptyAnswerInWords", "EON PI?: leer | ", {"EON "}},
                      AnswerCase{"FailedQuery", "", {""}}),
    caseName<AnswerCase>);

/// A piece of text and what it becomes.
struct TextCase {
    const char* name;
    const char* text;
    const char* expected;
    friend void PrintTo(const TextCase& shown, std::ostream* out) { *out << '"' << shown.text << '"'; }
};

class FirstNetwork : public ::testing::TestWithParam<TextCase> {};

TEST_P(FirstNetwork, IsTheSecondToTheFifthCharacter) {
    EXPECT_EQ(firstNetwork(GetParam().text), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Answers, FirstNetwork,
                         ::testing::Values(TextCase{"One", " D3C2,", "D3C2"},
                                           TextCase{"Several", " D3C2,D3C3,", "D3C2"},
                                           TextCase{"FirstCharacterIsSkipped", "D3C2", "3C2"},
                                           TextCase{"OneCharacter", "D", ""}, TextCase{"FailedQuery", "", ""}),
                         caseName<TextCase>);

TEST(EonAfValue, TheFirstListStartsANewSetAndTheOthersAreAdded) {
    EXPECT_EQ(eonAfValue("87.6,90.1", 1), "N,87.6,90.1");
    EXPECT_EQ(eonAfValue("99.2,101.5", 2), "+,99.2,101.5");
    EXPECT_EQ(eonAfValue("99.2,101.5", 5), "+,99.2,101.5");
}

}  // namespace
}  // namespace kdx
