#include "af/othernetwork.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/linkfixture.h"

#include <ostream>
#include <string>
#include <vector>

namespace kdx {
namespace {

template <typename Case>
std::string caseName(const ::testing::TestParamInfo<Case>& tested) {
    return tested.param.name;
}

using test::parameter;
using ::testing::ElementsAre;

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

class OtherNetworkTest : public ::testing::Test, protected test::Bench {
protected:
    void store(const std::string& key, const std::string& value) {
        setProfile(dataSetFile(state.CurrentDataSet), "RDS", key, value);
    }
    OtherNetwork loaded() {
        OtherNetwork network;
        network.load(settings);
        return network;
    }
    Steps steps() {
        Steps steps;
        loaded().appendSteps(steps);
        return steps;
    }
    Steps listSteps() {
        Steps steps;
        loaded().appendListSteps(steps);
        return steps;
    }
};

TEST_F(OtherNetworkTest, IsWhatTheDataSetAtWorkHolds) {
    store("EON_PI", "D3C9");
    state.CurrentDataSet = "4";
    store("EON_PI", "D3C2");
    store("EON_PS", "RADIO 10 LANG");
    store("EON_PTY", "7");
    store("EON_TP", "1");
    store("EON_TA", "1");
    store("EON_AFB2", "87.6,90.1");
    store("EON_AFB5", "99.2");
    const OtherNetwork network = loaded();
    EXPECT_EQ(network.pi, "D3C2");
    EXPECT_EQ(network.ps, "RADIO 10 LANG");
    EXPECT_EQ(network.pty, "7");
    EXPECT_EQ(network.tp, "1");
    EXPECT_EQ(network.ta, "1");
    EXPECT_THAT(network.lists, ElementsAre("", "87.6,90.1", "", "", "99.2"));
}

TEST_F(OtherNetworkTest, OnlyAStoredOneIsAFlagThatIsSet) {
    for (const char* value : {"", "0", "ein", "11"}) {
        store("EON_TP", value);
        store("EON_TA", value);
        EXPECT_EQ(loaded().tp, "0") << value;
        EXPECT_EQ(loaded().ta, "0") << value;
    }
}

TEST_F(OtherNetworkTest, ItsListsAreReadAnewWithoutTheRest) {
    OtherNetwork network = loaded();
    network.pi = "D3C2";
    store("EON_PI", "D3C9");
    store("EON_AFB1", "87.6,90.1");
    network.loadLists(settings);
    EXPECT_EQ(network.lists.front(), "87.6,90.1");
    EXPECT_EQ(network.pi, "D3C2");
}

TEST_F(OtherNetworkTest, IsSentInItsOrderAfterTheRemovalOfThoseThatTheCoderHolds) {
    store("EON_PI", "D3C2");
    store("EON_PS", "RADIO 1");
    store("EON_PTY", "7");
    store("EON_TP", "1");
    store("EON_DEL", "D3C9");
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB2", "99.2,101.5");
    EXPECT_THAT(steps(),
                ElementsAre(Step{Step::Kind::AskNetworks}, parameter("EON_DEL", ""), parameter("EON_PI", "D3C2"),
                            parameter("EON_TA", "0"), parameter("EON_TP", "1"), parameter("EON_PS", "RADIO 1"),
                            parameter("EON_AFB1", "N,87.6,90.1"), parameter("EON_AFB2", "+,99.2,101.5")));
}

TEST_F(OtherNetworkTest, OfAnEmptyDataSetIsSentToo) {
    EXPECT_THAT(steps(), ElementsAre(Step{Step::Kind::AskNetworks}, parameter("EON_DEL", ""), parameter("EON_PI", ""),
                                     parameter("EON_TA", "0"), parameter("EON_TP", "0"), parameter("EON_PS", "")));
}

TEST_F(OtherNetworkTest, ItsFirstListStartsANewSetAndTheOthersAreAdded) {
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB3", "99.2");
    store("EON_AFB5", "100.1,88.8");
    EXPECT_THAT(listSteps(), ElementsAre(parameter("EON_AFB1", "N,87.6,90.1"), parameter("EON_AFB3", "+,99.2"),
                                         parameter("EON_AFB5", "+,100.1,88.8")));
}

TEST_F(OtherNetworkTest, AnEmptyFirstListDoesNotStopTheOthers) {
    store("EON_AFB2", "99.2,101.5");
    EXPECT_THAT(listSteps(), ElementsAre(parameter("EON_AFB2", "+,99.2,101.5")));
}

TEST_F(OtherNetworkTest, ALongListIsSentAsItStands) {
    std::string list = "87.6";
    for (int i = 0; i < 25; ++i) list += ",90.1";
    store("EON_AFB1", list);
    EXPECT_THAT(listSteps(), ElementsAre(parameter("EON_AFB1", "N," + list)));
}

}  // namespace
}  // namespace kdx
