#include "settings/captions.h"

#include <gtest/gtest.h>

#include <stdexcept>

#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx::test {
namespace {

class CaptionsTest : public ::testing::Test {
protected:
    void write(const std::string& bytes) { folder.write("SPRACHEN.INI", bytes); }

    TempFolder folder;
    DataFolder data{folder.path()};
    Captions captions{data};
};

TEST_F(CaptionsTest, TextsComeFromTheSectionOfTheLanguage) {
    write("[deutsch]\r\n53=senden\r\n[english]\r\n53=send\r\n[english US]\r\n53=send it\r\n");
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.text(53), "senden");
    captions.load("english", "RDS");
    EXPECT_EQ(captions.text(53), "send");
    captions.load("english US", "RDS");
    EXPECT_EQ(captions.text(53), "send it");
}

TEST_F(CaptionsTest, AMissingNumberIsAnEmptyText) {
    write("[deutsch]\r\n53=\r\n");
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.text(53), "");
    EXPECT_EQ(captions.text(54), "");
}

TEST_F(CaptionsTest, AMissingFileOrLanguageIsAllEmpty) {
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.text(0), "");
    write("[deutsch]\r\n0=Info\r\n");
    captions.load("francais", "RDS");
    EXPECT_EQ(captions.text(0), "");
    captions.load("", "");
    EXPECT_EQ(captions.text(0), "");
}

TEST_F(CaptionsTest, NothingOfTheLanguageBeforeIsLeft) {
    write("[deutsch]\r\n1=eins\r\n2=zwei\r\n[PTY-Liste_D]\r\n000=keine\r\n[english]\r\n1=one\r\n");
    captions.load("deutsch", "RDS");
    captions.load("english", "RDS");
    EXPECT_EQ(captions.text(1), "one");
    EXPECT_EQ(captions.text(2), "");
    EXPECT_EQ(captions.programmeType(0), "");
}

TEST_F(CaptionsTest, NumbersStandWithoutLeadingZeros) {
    write("[deutsch]\r\n07=falsch\r\n+8=falsch\r\n9 x=falsch\r\n99999999999999=falsch\r\nabc=falsch\r\n10=FM\r\n");
    captions.load("deutsch", "RDS");
    for (const int number : {0, 7, 8, 9}) EXPECT_EQ(captions.text(number), "") << number;
    EXPECT_EQ(captions.text(10), "FM");
}

TEST_F(CaptionsTest, OwnTextsFallBackOnTheDesign) {
    write("[deutsch]\r\n380=TP ein/aus\r\n381=\r\n");
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.own(380, "TP on/off"), "TP ein/aus");
    EXPECT_EQ(captions.own(381, "TA on / off"), "TA on / off");
    EXPECT_EQ(captions.own(382, "TA Single"), "TA Single");
}

TEST_F(CaptionsTest, TextsKeepTheirBytesAndQuotedBlanks) {
    write(
        "[deutsch]\r\n1=\xDC"
        "ber\r\n2=\"Uhrzeit: \"\r\n");
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.text(1),
              "\xDC"
              "ber");
    EXPECT_EQ(captions.text(2), "Uhrzeit: ");
}

TEST_F(CaptionsTest, ProgrammeTypesFollowLanguageAndStandard) {
    write("[PTY-Liste_D]\r\n031=D\r\n[PTY-Liste_E]\r\n031=E\r\n[PTY-Liste_US]\r\n031=US\r\n");
    const auto last = [this](const char* language, const char* standard) {
        captions.load(language, standard);
        return captions.programmeType(31);
    };
    EXPECT_EQ(last("deutsch", "RDS"), "D");
    EXPECT_EQ(last("deutsch", "RBDS"), "D");
    EXPECT_EQ(last("english", "RDS"), "E");
    EXPECT_EQ(last("english", "RBDS"), "US");
    EXPECT_EQ(last("english US", "RDS"), "E");
    EXPECT_EQ(last("english US", "RBDS"), "US");
    EXPECT_EQ(last("Deutsch", "RDS"), "E");  // compared by its exact text
}

TEST_F(CaptionsTest, ProgrammeTypesHaveThreeDigitKeys) {
    write("[PTY-Liste_D]\r\n0=falsch\r\n005=Bildung\r\n10=falsch\r\n010=Pop\r\n032=zu viel\r\n");
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.programmeType(0), "");
    EXPECT_EQ(captions.programmeType(5), "Bildung");
    EXPECT_EQ(captions.programmeType(10), "Pop");
    EXPECT_THROW((void)captions.programmeType(32), std::out_of_range);
}

TEST_F(CaptionsTest, TheFileIsReadAnewEachTime) {
    write("[deutsch]\r\n1=alt\r\n");
    captions.load("deutsch", "RDS");
    write("[deutsch]\r\n1=neu\r\n");
    EXPECT_EQ(captions.text(1), "alt");
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.text(1), "neu");
}

TEST_F(CaptionsTest, GarbageGivesNoTextAndNoHarm) {
    std::string garbage = "[deutsch]\r\n1=gut\r\n";
    for (int i = 0; i < 5000; ++i) garbage.push_back(static_cast<char>(i * 37 % 256));
    write(garbage + std::string(1 << 20, 'x'));
    captions.load("deutsch", "RDS");
    EXPECT_EQ(captions.text(1), "gut");
}

}  // namespace
}  // namespace kdx::test
