#include "air/airtest.h"

namespace kdx::air {
namespace {

/// One network: D3C2, "RADIO 1 ", traffic programme, type 3.
class NetworkGroups : public AirTest {
protected:
    NetworkGroups() {
        for (const char* command : {"EON-PI=D3C2", "EON-PS=D3C2,RADIO 1", "EON-TP=D3C2,1", "EON-PTY=D3C2,3"})
            coder(command);
    }
    void only14A() { coder("GS=14A"); }
};

const Groups kNames = {"1000 E010 5241 D3C2", "1000 E011 4449 D3C2", "1000 E012 4F20 D3C2", "1000 E013 3120 D3C2"};

Groups namesAnd(const Groups& more) {
    Groups groups = kNames;
    groups.insert(groups.end(), more.begin(), more.end());
    return groups;
}

TEST_F(NetworkGroups, WithoutFrequenciesAreVariants0To3And13) {
    only14A();
    EXPECT_EQ(next(6), namesAnd({"1000 E01D 1800 D3C2", kNames[0]}));
    EXPECT_TRUE(warnings.empty());
}

TEST_F(NetworkGroups, Variant4IsTheListOfMethodA) {
    // 88.0, 90.0: 5, 25 behind 224 + 2; the first entry belongs to the list.
    only14A();
    coder("EON-AFA=D3C2,88.0,90.0");
    EXPECT_EQ(next(8),
              namesAnd({"1000 E014 E205 D3C2", "1000 E014 19CD D3C2", "1000 E01D 1800 D3C2", "1000 E010 5241 D3C2"}));
}

TEST_F(NetworkGroups, Variants5To8AreThePairsThroughAllLists) {
    // 87.6 with 90.1, 94.3, 107.9; 88.0 with 90.0, 100.0.
    only14A();
    coder("EON-AFB=D3C2,N,87.6,90.1,94.3,107.9");
    coder("EON-AFB=D3C2,+,88.0,90.0,100.0");
    EXPECT_EQ(next(11),
              namesAnd({"1000 E015 011A D3C2", "1000 E016 0144 D3C2", "1000 E017 01CC D3C2", "1000 E018 0519 D3C2",
                        "1000 E015 057D D3C2", "1000 E01D 1800 D3C2", "1000 E010 5241 D3C2"}));
}

TEST_F(NetworkGroups, FrequenciesWithoutACodeAreLeftOutAndTold) {
    only14A();
    coder("EON-AFA=D3C2,88.0,108.0");
    coder("EON-AFB=D3C2,N,87.6,87.5,94.3");
    coder("EON-AFB=D3C2,+,86.0,90.0,100.0");
    EXPECT_EQ(next(7), namesAnd({"1000 E014 E105 D3C2", "1000 E015 0144 D3C2", "1000 E01D 1800 D3C2"}));
    EXPECT_EQ(warnings,
              (Groups{"EON D3C2 AF method A: 108.0 MHz has no code and is left out",
                      "EON D3C2 AF list 1: 87.5 MHz has no code and is left out",
                      "EON D3C2 AF list 2: the tuned frequency 86.0 MHz has no code, so the list is left out"}));
}

TEST_F(NetworkGroups, EachNetworkHasItsTurn) {
    only14A();
    coder("EON-PI=1234");
    coder("EON-PS=1234,AB^");
    coder("EON-PTY=1234,31");
    EXPECT_EQ(next(11), namesAnd({"1000 E01D 1800 D3C2", "1000 E000 4142 1234", "1000 E001 2020 1234",
                                  "1000 E002 2020 1234", "1000 E003 2020 1234", "1000 E00D F800 1234", kNames[0]}));
    EXPECT_EQ(warnings, (Groups{"EON 1234 PS: \"^\" has no place in the RDS character set and is sent as a blank"}));
}

TEST_F(NetworkGroups, Variant13HasTheTypeAndTa) {
    only14A();
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(next(5)[4], "1000 E01D 1801 D3C2");
}

TEST_F(NetworkGroups, WithoutANetworkTheSlotsPassTo0A) {
    coder("GS=14A,14B");
    coder("EON-DEL=D3C2");
    EXPECT_EQ(block(2, 2), (Groups{"0008", "0009"}));
}

TEST_F(NetworkGroups, A14BSlotSendsTheStateOfTheNetworksInTurn) {
    coder("GS=14B");
    coder("EON-PI=1234");
    coder("EON-TA=1234,1");
    EXPECT_EQ(next(3), (Groups{"1000 E810 1000 D3C2", "1000 E808 1000 1234", "1000 E810 1000 D3C2"}));
}

const Groups kAnnounced(8, "1000 E818 1000 D3C2");
const Groups kOver(8, "1000 E810 1000 D3C2");

TEST_F(NetworkGroups, AChangeOfTaIsAnnouncedEightTimesWhileTheSequenceWaits) {
    EXPECT_EQ(block(2, 2), (Groups{"0008", "0009"}));
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(next(8), kAnnounced);
    EXPECT_EQ(block(2, 1), (Groups{"000A"}));
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(block(2, 1), (Groups{"000F"}));
    coder("EON-TA=D3C2,0");
    EXPECT_EQ(next(8), kOver);
    EXPECT_EQ(block(2, 1), (Groups{"0008"}));
}

TEST_F(NetworkGroups, ANewChangeEndsTheBurstAndBeginsItsOwn) {
    (void)next();
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(next(3), Groups(3, kAnnounced[0]));
    coder("EON-TA=D3C2,0");
    EXPECT_EQ(next(8), kOver);
    EXPECT_EQ(block(2, 1), (Groups{"0009"}));
}

TEST_F(NetworkGroups, ABurstCaresForNoTrafficProgramme) {
    (void)next();
    coder("EON-TP=D3C2,0");
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(next(8), Groups(8, "1000 E808 1000 D3C2"));
}

TEST_F(NetworkGroups, ChangesOfTwoNetworksAreAnnouncedOneAfterTheOther) {
    (void)next();
    coder("EON-PI=1234");
    coder("EON-TA=D3C2,1");
    coder("EON-TA=1234,1");
    EXPECT_EQ(next(8), kAnnounced);
    EXPECT_EQ(next(8), Groups(8, "1000 E808 1000 1234"));
    EXPECT_EQ(block(2, 1), (Groups{"0009"}));
}

TEST_F(NetworkGroups, ANetworkThatIsRemovedTakesItsBurstAlong) {
    (void)next();
    coder("EON-TA=D3C2,1");
    (void)next();
    coder("EON-DEL=D3C2");
    EXPECT_EQ(block(2, 1), (Groups{"0009"}));
}

TEST_F(NetworkGroups, WhatIsSetBeforeTheFirstGroupIsNoChange) {
    coder("EON-TA=D3C2,1");
    EXPECT_EQ(block(2, 1), (Groups{"0008"}));
}

TEST_F(NetworkGroups, AChangeWhileNoGroupsGoOutIsNotAnnouncedLater) {
    (void)next();
    coder("BIN=1");
    coder("EON-TA=D3C2,1");
    (void)next();
    coder("BIN=0");
    EXPECT_EQ(block(2, 1), (Groups{"0009"}));
}

}  // namespace
}  // namespace kdx::air
