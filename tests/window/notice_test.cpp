// What the quiet line at the lower edge tells beside what could not be saved.
#include <gtest/gtest.h>

#include <QListWidget>

#include <optional>

#include "window/noticetest.h"

namespace kdx::test {
namespace {

TEST_F(NoticeTest, ThereIsNoneWhenAllIsWell) {
    start();
    openSession();
    EXPECT_EQ(notice(), "");
}

TEST_F(NoticeTest, FilesThatTheUserChangedAndAreNotRenewedAreTold) {
    keptFiles = {"/usr/share/kdx-rds/Daten/Event.txt", "/usr/share/kdx-rds/Daten/Location.txt"};
    start();
    EXPECT_EQ(notice(),
              "Von Ihnen geändert, darum nicht erneuert; neue Fassung: /usr/share/kdx-rds/Daten/Event.txt, "
              "/usr/share/kdx-rds/Daten/Location.txt");
    setGeneral("Sprache", "Sprache", "english");
    start();
    EXPECT_EQ(notice(),
              "Changed by you and so not renewed; new version: /usr/share/kdx-rds/Daten/Event.txt, "
              "/usr/share/kdx-rds/Daten/Location.txt");
}

TEST_F(NoticeTest, SettingsAndALogThatCannotBeWrittenAreBothTold) {
    std::filesystem::create_directory(folder.data() / kCommandLog);
    folder.write("Datenset1.INI", "\xFF\xFE");
    start();
    openSession();
    click("PS_Taste");
    EXPECT_EQ(notice(), "Nicht gespeichert: Datenset1.INI  -  Nicht gespeichert: RDS_log.txt");
}

TEST_F(NoticeTest, SettingsInAnotherEncodingAreToldAndLeftAlone) {
    std::string wide = "\xFF\xFE";
    for (const char letter : std::string("[RDS]\r\nPS=RADIO\r\n")) wide += {letter, '\0'};
    folder.write("Datenset1.INI", wide);
    start();
    EXPECT_EQ(notice(), "Nicht lesbar: Datenset1.INI");
    openSession();
    type("PS_T", "NEW");
    click("PS_Taste");
    EXPECT_EQ(folder.read("Datenset1.INI"), wide);
    EXPECT_EQ(notice(), "Nicht gespeichert: Datenset1.INI");
}

TEST_F(NoticeTest, APictureThatCannotBeReadIsToldBesideOtherFilesUntilItCan) {
    const std::string picture = folder.read(kPictureOff);
    folder.write(kPictureOff, "no picture at all");
    start();
    QCoreApplication::processEvents();
    EXPECT_EQ(notice(), "Nicht lesbar: Sch_Off.ico") << "once, though several switches show it";

    std::filesystem::remove(folder.data() / "Datenset1.INI");
    std::filesystem::create_directory(folder.data() / "Datenset1.INI");
    start();
    QCoreApplication::processEvents();
    EXPECT_EQ(notice(), "Nicht lesbar: Datenset1.INI, Sch_Off.ico");
    openSession();
    type("PS_T", "NEW");
    click("PS_Taste");
    EXPECT_EQ(notice(), "Nicht lesbar: Sch_Off.ico  -  Nicht gespeichert: Datenset1.INI");

    showPage(2);
    folder.write(kPictureOff, picture);
    waitForRetry();
    QCoreApplication::processEvents();
    EXPECT_EQ(notice(), "Nicht gespeichert: Datenset1.INI");
}

TEST_F(NoticeTest, APictureThatIsAFolderIsToldAndAMissingOneIsNot) {
    std::filesystem::remove(folder.data() / kPictureOff);
    start();
    QCoreApplication::processEvents();
    EXPECT_EQ(notice(), "");
    std::filesystem::create_directory(folder.data() / kPictureOff);
    waitForRetry();
    QCoreApplication::processEvents();
    EXPECT_EQ(notice(), "Nicht lesbar: Sch_Off.ico");
}

TEST_F(NoticeTest, AnotherProgramOnTheSameDataIsToldWhileItRuns) {
    std::optional<FolderClaim> other(folder.data());
    start();
    EXPECT_EQ(notice(), "Ein anderes Programm nutzt dieselben Daten");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(notice(), "Another program uses the same data");
    other.reset();
    waitForRetry();
    EXPECT_EQ(notice(), "");
}

class QuoteTest : public NoticeTest {
protected:
    bool isRed(const char* entry) { return find<QLineEdit>(entry)->palette().color(QPalette::Text) == Qt::red; }
    bool isRedInList(const char* list) { return find<QListWidget>(list)->item(0)->foreground().color() == Qt::red; }
    bool isRedLabel(const char* label) { return find<QLabel>(label)->palette().color(QPalette::WindowText) == Qt::red; }
};

TEST_F(QuoteTest, AValueWithADoubleQuoteIsToldAndMarkedUntilAnotherIsSent) {
    start();
    openSession();
    visa.written.clear();
    type("PS_T", "A\"B");
    EXPECT_TRUE(isRed("PS_T"));
    EXPECT_EQ(notice(), "") << "not sent yet";
    click("PS_Taste");
    EXPECT_EQ(sent(), Lines{":STEREO:DIRECT \"PS=A\"B     \""}) << "sent as it stands";
    EXPECT_EQ(notice(), "Anführungszeichen beendet den Text: PS");
    type("PS_T", "AB");
    EXPECT_FALSE(isRed("PS_T"));
    click("PS_Taste");
    EXPECT_EQ(notice(), "");
}

TEST_F(QuoteTest, EveryTextThatGoesToTheCoderIsMarked) {
    setDataSet1("RDS", "RTA", "say \"hello\"");
    setDataSet1("RDS", "EON_PI", "D3C1");
    setDataSet1("RDS", "EON_PS", "E\"ON");
    setDataSet1("RDS", "AF_LISTE1", "98.5\",90.1\"");
    setDataSet1("RDS", "EON_AFB1", "98.5\",90.1\"");
    start();
    for (const char* entry : {"EON_PS_Text", "RT_Text1"}) EXPECT_TRUE(isRed(entry)) << entry;
    for (const char* list : {"AF_List1", "AFB_Liste"}) EXPECT_TRUE(isRedInList(list)) << list;
    for (const char* label : {"AF_TN", "Tuned_AFB"}) EXPECT_TRUE(isRedLabel(label)) << label;
    openSession();
    EXPECT_EQ(notice(), "Anführungszeichen beendet den Text: AF1, EON_AFB1, EON_PS, RT");
}

TEST_F(QuoteTest, ACraftedDataSetIsToldByItsKeysAndMarkedFromTheStart) {
    setDataSet1("RDS", "PS", "x\";*RST");
    setDataSet1("RDS", "PI", "D\"C0");
    start();
    EXPECT_TRUE(isRed("PS_T"));
    openSession();
    EXPECT_EQ(notice(), "Anführungszeichen beendet den Text: PI, PS");
}

TEST_F(NoticeTest, TheCorrectionOfMidnightIsAsTheGeneralSettingsSay) {
    start();
    EXPECT_TRUE(clock.midnightCorrected()) << "as it is shipped";
    setGeneral("Berichtigungen", "Mitternacht", "0");
    start();
    EXPECT_FALSE(clock.midnightCorrected());
    folder.write("RDS_Allg.INI", "[BUS]\r\n");
    start();
    EXPECT_FALSE(clock.midnightCorrected()) << "missing";
}

}  // namespace
}  // namespace kdx::test
