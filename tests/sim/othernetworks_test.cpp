#include "sim/simtest.h"

namespace kdx::sim {
namespace {

class OtherNetworksTest : public SimTest {};

TEST_F(OtherNetworksTest, AreListedWithABlankInFrontAndACommaBehindEach) {
    coder("EON-PI=D3C2");
    coder("EON-PI=1234");
    coder("EON-PI=abcd");
    EXPECT_EQ(askCoder("EON PI?"), "\" D3C2,1234,ABCD,\"");
    coder("EON-DEL=1234");
    EXPECT_EQ(askCoder("EON PI?"), "\" D3C2,ABCD,\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(OtherNetworksTest, AreHeldOnceEachAndKeepTheirDataWhenAddedAgain) {
    coder("EON-PI=D3C2");
    coder("EON-PS=d3c2,RADIO 1 ");
    coder("EON-PI=d3c2");
    EXPECT_EQ(askCoder("EON-PI"), "\" D3C2,\"");
    EXPECT_EQ(askCoder("EON-PS,D3C2"), "\"RADIO 1 \"");
    EXPECT_EQ(error(), 0);
}

TEST_F(OtherNetworksTest, AreNotMadeFromATextThatIsNoPi) {
    // The programme's list of types sends its text under this command, cut to four characters.
    for (const char* pi : {"News", "d3c ", "None", "", "12345"}) {
        coder(std::string("EON-PI=") + pi);
        EXPECT_EQ(error(), -224) << pi;
    }
    EXPECT_EQ(askCoder("EON-PI"), "\" \"");
}

TEST_F(OtherNetworksTest, OfUnknownPiCannotBeRemoved) {
    coder("EON-PI=D3C2");
    for (const char* pi : {"", "1234", " ", "D3C2,"}) {
        coder(std::string("EON-DEL=") + pi);
        EXPECT_EQ(error(), -224) << pi;
    }
    EXPECT_EQ(askCoder("EON-PI"), "\" D3C2,\"");
}

TEST_F(OtherNetworksTest, FitWithTheirListIntoOneAnswerOfTheProgram) {
    for (int i = 0; i < 11; ++i) coder("EON-PI=" + std::to_string(1000 + i));
    EXPECT_EQ(error(), 0);
    coder("EON-PI=FFFF");
    EXPECT_EQ(error(), -223);
    EXPECT_LE(askCoder("EON PI?").size() + 1, 60U);
}

TEST_F(OtherNetworksTest, TakeEachItsOwnData) {
    coder("EON-PI=D3C2");
    coder("EON-PI=1234");
    coder("EON-PS=D3C2,FIRST   ");
    coder("EON-PS=1234,SECOND  ");
    coder("EON-TP=1234,1");
    coder("EON-AFB=1234,N,87.6,90.1");
    EXPECT_EQ(askCoder("EON-PS,D3C2"), "\"FIRST   \"");
    EXPECT_EQ(askCoder("EON-PS,1234"), "\"SECOND  \"");
    EXPECT_EQ(askCoder("EON-TP,D3C2"), "\"0\"");
    EXPECT_EQ(askCoder("EON-TP,1234"), "\"1\"");
    EXPECT_EQ(askCoder("EON-AFB,D3C2,1"), "\"\"");
    EXPECT_EQ(askCoder("EON-AFB,1234,1"), "\"87.6,90.1\"");
    EXPECT_EQ(error(), 0);
}

TEST_F(OtherNetworksTest, KeepFiveListsEach) {
    coder("EON-PI=D3C2");
    coder("EON-AFB=D3C2,N,87.6,90.1");
    for (const char* list : {"99.2,101.5", "100.1", "101.1,102.2", "103.3,104.4"}) {
        coder(std::string("EON-AFB=D3C2,+,") + list);
    }
    EXPECT_EQ(askCoder("EON-AFB,D3C2,1"), "\"87.6,90.1\"");
    EXPECT_EQ(askCoder("EON-AFB,D3C2,2"), "\"99.2,101.5\"");
    EXPECT_EQ(askCoder("EON-AFB,D3C2,3"), "\"100.1\"");
    EXPECT_EQ(askCoder("EON-AFB,D3C2,4"), "\"101.1,102.2\"");
    EXPECT_EQ(askCoder("EON-AFB,D3C2,5"), "\"103.3,104.4\"");
    EXPECT_EQ(error(), 0);
    coder("EON-AFB=D3C2,+,99.9");
    EXPECT_EQ(error(), -223);
}

TEST_F(OtherNetworksTest, RefuseWhatTheyCannotHold) {
    coder("EON-PI=D3C2");
    for (const auto& [command, code] : {std::pair{"EON-PS=D3C2,ABCDEFGHI", -223},
                                        {"EON-PS=D3C2", -109},
                                        {"EON-PS=1234,RADIO", -224},
                                        {"EON-PS=,RADIO", -224},
                                        {"EON-PS=D3C2,A\tB", -224},
                                        {"EON-PTY=D3C2,32", -222},
                                        {"EON-PTY=D3C2,News", -224},
                                        {"EON-TP=D3C2,2", -222},
                                        {"EON-TA=D3C2,on", -224},
                                        {"EON-AFA=D3C2,85", -222},
                                        {"EON-AFB=D3C2,87.6", -224},
                                        {"EON-XY=D3C2,1", -224}}) {
        coder(command);
        EXPECT_EQ(error(), code) << command;
    }
}

// Nothing would be left to read otherwise, and a reading program would wait for its whole time-out.
TEST_F(OtherNetworksTest, AnswerAnEmptyTextAndReportAnErrorForAnUnknownOne) {
    for (const char* query : {"EON-PS,1234", "EON-PS,", "EON-PS", "EON-TP,1234", "EON-TA,x", "EON-AFA,1234",
                              "EON-AFB,1234,1", "EON-AFB,,1"}) {
        EXPECT_EQ(askCoder(query), "\"\"") << query;
        EXPECT_EQ(error(), -224) << query;
    }
    coder("EON-PI=D3C2");
    EXPECT_EQ(askCoder("EON-AFB,D3C2,6"), "\"\"");
    EXPECT_EQ(error(), -222);
    EXPECT_EQ(askCoder("EON-AFB,D3C2,x"), "\"\"");
    EXPECT_EQ(error(), -224);
    EXPECT_EQ(askCoder("EON-AFB,D3C2"), "\"\"");
    EXPECT_EQ(error(), -109);
}

}  // namespace
}  // namespace kdx::sim
