#include <gtest/gtest.h>

#include "coder/sendparam.h"
#include "support/linkfixture.h"

namespace kdx {
namespace {

using test::Lines;

TEST(QuotesDoubled, DoublesThoseInsideACoderCommandOnly) {
    EXPECT_EQ(quotesDoubled(R"(:STEREO:DIRECT "PS=A"B     ")"), R"(:STEREO:DIRECT "PS=A""B     ")");
    EXPECT_EQ(quotesDoubled(R"(:STEREO:DIRECT "RT=10,0,"x"")"), R"(:STEREO:DIRECT "RT=10,0,""x""")");
    for (const char* same : {R"(:STEREO:DIRECT "PS=RADIO   ")", R"(FREQ "1"MHZ)", ":STEREO:DIRECT ",
                             ":STEREO:DIRECT \"", ":STEREO:DIRECT \"\"", ""}) {
        EXPECT_EQ(quotesDoubled(same), same);
    }
}

class QuotesTest : public ::testing::Test, protected test::LinkFixture {
protected:
    QuotesTest() { state.InstrumentOnline = true; }
};

TEST_F(QuotesTest, QuotesGoOutAsTheyStandOrDoubledAsIsCorrected) {
    params.SendParam("PS", "A\"B");
    EXPECT_EQ(sent(), Lines{test::direct("PS=A\"B     ")});
    EXPECT_EQ(params.quotedKeys().count("PS"), 1U);
    state.corrections.quotes = true;
    std::string value = "A\"B";
    params.SendParam("PS", value);
    EXPECT_EQ(sent(), Lines{test::direct("PS=A\"\"B     ")});
    EXPECT_EQ(value, "A\"B");
    EXPECT_TRUE(params.quotedKeys().empty());
    params.SendParam("HF-Frequenz", "\"");
    EXPECT_EQ(sent(), Lines{"FREQ \"MHZ"}) << "no text of the coder's";
}

}  // namespace
}  // namespace kdx
