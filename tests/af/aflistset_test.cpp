#include "af/aflistset.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frequencylists.h"
#include "support/linkfixture.h"

namespace kdx {
namespace {

using test::listOf;
using test::parameter;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class AfListSetTest : public ::testing::Test, protected test::Bench {
protected:
    void store(int number, const std::string& list) { settings.write(afListPlace(kAfKind, number), list); }
    /// The steps of what is stored.
    Steps steps(AfMethod method = AfMethod::A) {
        AfListSet set;
        set.method = method;
        set.load(settings);
        Steps steps;
        set.appendSteps(steps);
        return steps;
    }
};

TEST(AfListPlace, GoesByKindAndNumber) {
    EXPECT_STREQ(afListPlace("AF", 1).key, "AF_LISTE1");
    EXPECT_STREQ(afListPlace("AF", 5).key, "AF_LISTE5");
    EXPECT_STREQ(afListPlace("EON AF", 3).key, "EON_AFB3");
    EXPECT_STREQ(afListPlace("", 2).key, "AF_LISTE2");
}

TEST_F(AfListSetTest, IsWhatTheDataSetAtWorkHolds) {
    store(1, "100.1,88.0");
    state.CurrentDataSet = "3";
    setProfile("Datenset3.INI", "RDS", "AF_LISTE1", "87.6,90.1");
    setProfile("Datenset3.INI", "RDS", "AF_LISTE4", "99.2");
    AfListSet set;
    set.lists.at(4) = "left from before";
    set.method = AfMethod::B;
    set.load(settings);
    EXPECT_THAT(set.lists, ElementsAre("87.6,90.1", "", "", "99.2", ""));
    EXPECT_EQ(set.method, AfMethod::B) << "no data set names a method";
}

TEST_F(AfListSetTest, TheFirstListStartsANewSetAndTheOthersAreAdded) {
    store(1, "87.6,90.1,94.3");
    store(2, "99.2,101.5");
    store(5, "88");
    EXPECT_THAT(steps(), ElementsAre(parameter("AF1", "N,87.6,90.1,94.3"), parameter("AF2", "+,99.2,101.5"),
                                     parameter("AF5", "+,88")));
}

TEST_F(AfListSetTest, MethodBSendsPairs) {
    store(1, "87.6,90.1,94.3");
    store(4, "99.2,101.5");
    EXPECT_THAT(steps(AfMethod::B),
                ElementsAre(parameter("AF1", "N,87.6,87.6,90.1,87.6,94.3"), parameter("AF4", "+,99.2,99.2,101.5")));
}

TEST_F(AfListSetTest, WithoutTheFirstListThereIsNoStep) {
    for (const int number : {2, 3, 4, 5}) store(number, "99.2,101.5");
    EXPECT_THAT(steps(), IsEmpty());
}

TEST_F(AfListSetTest, AListThatMethodBCannotCarryIsRefusedBetweenItsNeighbours) {
    store(1, "87.6,90.1");
    store(2, listOf(13));
    store(3, listOf(12));
    EXPECT_THAT(steps(AfMethod::B),
                ElementsAre(parameter("AF1", "N,87.6,87.6,90.1"), Step{Step::Kind::Refused, "AF2", listOf(13)},
                            parameter("AF3", "+," + rewrittenForMethodB(listOf(12)))));
    EXPECT_THAT(steps(AfMethod::A), ElementsAre(parameter("AF1", "N,87.6,90.1"), parameter("AF2", "+," + listOf(13)),
                                                parameter("AF3", "+," + listOf(12))));
}

TEST_F(AfListSetTest, TheOthersAreAddedToWhatTheCoderHoldsWhenTheFirstIsRefused) {
    store(1, listOf(13));
    store(5, "88.0");
    EXPECT_THAT(steps(AfMethod::B),
                ElementsAre(Step{Step::Kind::Refused, "AF1", listOf(13)}, parameter("AF5", "+,88.0")));
}

}  // namespace
}  // namespace kdx
