#include "rds/programme.h"

#include <gtest/gtest.h>

#include "settings/datafolder.h"
#include "support/linkfixture.h"

namespace kdx::test {
namespace {

class ProgrammeTest : public ::testing::Test, protected Bench {
protected:
    void load(const std::string& lines) {
        folder.write("Datenset1.INI", "[RDS]\r\n" + lines);
        programme.load(settings);
    }
    [[nodiscard]] Steps steps() const {
        Steps steps;
        programme.appendSteps(steps);
        return steps;
    }
    [[nodiscard]] std::string ptyStep() const {
        Steps steps;
        programme.appendPtySteps(steps);
        EXPECT_EQ(steps.size(), 1U);
        EXPECT_EQ(steps.at(0).key, "PTY");
        return steps.at(0).value;
    }

    Programme programme;
};

TEST_F(ProgrammeTest, IsReadFromTheDataSetAndSentInItsFixedOrder) {
    load("PS=ABCDEFGHIJ\r\nPI=d3c\r\nRTA=News\r\nRTB=Second\r\nMS=M\r\nDI=5\r\nPTY=3\r\n");
    EXPECT_EQ(steps(),
              (Steps{parameter("PI", "d3c"), parameter("TP", "0"), parameter("TA", "0"), parameter("PS", "ABCDEFGH"),
                     parameter("TEST_M", "0"), parameter("MS", "M"), parameter("RT", "News")}));
    EXPECT_EQ(ptyStep(), "3");
    EXPECT_EQ(programme.decoderInfo, "5");  // kept, and sent by its options only
}

TEST_F(ProgrammeTest, AnEmptyDataSetSendsEmptyValuesAndTheFirstProgrammeType) {
    load("");
    EXPECT_EQ(steps(), (Steps{parameter("PI", ""), parameter("TP", "0"), parameter("TA", "0"), parameter("PS", ""),
                              parameter("TEST_M", "0"), parameter("MS", ""), parameter("RT", "")}));
    EXPECT_EQ(ptyStep(), "0");
    EXPECT_EQ(programme.decoderInfo, "");
}

TEST_F(ProgrammeTest, WhatIsTypedGoesOutAsItStands) {
    load("PI=D3C2\r\nRTA=News\r\n");
    programme.pi = "e2f01";
    programme.radiotext = " typed, not sent yet ";
    EXPECT_EQ(steps().front(), parameter("PI", "e2f01"));
    EXPECT_EQ(steps().back(), parameter("RT", " typed, not sent yet "));
}

TEST_F(ProgrammeTest, TheTrafficFlagsAreKeptInNoDataSetAndStay) {
    programme.trafficProgramme = "1";
    programme.announcement = "1";
    load("TP=0\r\nTA=0\r\n");
    EXPECT_EQ(steps()[1], parameter("TP", "1"));
    EXPECT_EQ(steps()[2], parameter("TA", "1"));
}

TEST_F(ProgrammeTest, AProgrammeTypeThatNoEntryHasGoesOutAsNone) {
    for (const char* number : {"32", "-1", "1e300", "99999999999"}) {
        load(std::string("PTY=") + number + "\r\n");
        EXPECT_EQ(ptyStep(), "-1") << number;
    }
    load("PTY=31 x\r\n");
    EXPECT_EQ(ptyStep(), "31");
}

TEST_F(ProgrammeTest, TheProgrammeTypeIsTheOneOfTheDataSetThatIsLoaded) {
    folder.write("Datenset3.INI", "[RDS]\r\nPTY=9\r\n");
    state.CurrentDataSet = "3";
    load("PTY=3\r\n");
    EXPECT_EQ(ptyStep(), "9");
}

TEST_F(ProgrammeTest, SpeechIsEverythingThatIsNotMusic) {
    for (const char* text : {"S", "m", "1", "MS"}) {
        load(std::string("MS=") + text + "\r\n");
        EXPECT_EQ(programme.musicSpeech, "S") << text;
    }
}

TEST_F(ProgrammeTest, DecoderInformationOutsideItsOptionsIsNone) {
    for (const char* number : {"16", "-1", "1e300"}) {
        load(std::string("DI=") + number + "\r\n");
        EXPECT_EQ(programme.decoderInfo, "") << number;
    }
    load("DI=abc\r\n");  // no number counts as the first option
    EXPECT_EQ(programme.decoderInfo, "0");
}

}  // namespace
}  // namespace kdx::test
