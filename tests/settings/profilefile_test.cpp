#include "settings/profilefile.h"

#include <gtest/gtest.h>

#include "support/tempfolder.h"

namespace kdx {
namespace {

using namespace std::string_literals;

std::string written(std::string bytes, std::string_view section, std::string_view key, std::string_view value) {
    ProfileText text(std::move(bytes));
    text.setValue(section, key, value);
    return text.bytes();
}

TEST(ProfileTextTest, AnEmptyValueReadsLikeAMissingKey) {
    const ProfileText text("[RDS]\r\nPS=\r\n");
    EXPECT_EQ(text.value("RDS", "PS"), "");
    EXPECT_EQ(text.value("RDS", "PI"), "");
}

TEST(ProfileTextTest, AValueIsCutAt254Characters) {
    const std::string value(300, 'x');
    const ProfileText text("[RDS]\r\nRTA=" + value + "\r\n");
    EXPECT_EQ(text.value("RDS", "RTA"), std::string(254, 'x'));
    EXPECT_EQ(text.value("RDS", "RTA", 1000), value);
}

TEST(ProfileTextTest, QuotesGoBeforeTheValueIsCut) {
    const ProfileText text("[RDS]\r\nRTA=\"" + std::string(300, 'x') + "\"\r\n");
    EXPECT_EQ(text.value("RDS", "RTA"), std::string(254, 'x'));
}

TEST(ProfileTextTest, AWriteNeverCutsTheValue) {
    const std::string value(300, 'x');
    EXPECT_EQ(written("", "RDS", "RTA", value), "[RDS]\r\nRTA=" + value + "\r\n");
}

TEST(ProfileTextTest, AHyphenAndAnUnderscoreAreTwoKeys) {
    // The window writes "ARI-BK" and start-up reads "ARI_BK": the choice is not restored, which is left so on purpose.
    ProfileText text("[FM]\r\nARI_BK=2\r\n");
    text.setValue("FM", "ARI-BK", "3");
    EXPECT_EQ(text.value("FM", "ARI_BK"), "2");
    EXPECT_EQ(text.value("FM", "ARI-BK"), "3");
}

TEST(ProfileTextTest, NamesOfSectionsAndKeysAreFoundInAnyLetterCase) {
    const ProfileText text("[BUS]\r\nInterface=TCPIP\r\n[RDS]\r\nGR_Folge=0A,2A\r\n");
    EXPECT_EQ(text.value("Bus", "INTERFACE"), "TCPIP");
    EXPECT_EQ(text.value("rds", "GR_FOLGE"), "0A,2A");
}

TEST(ProfileTextTest, TheMarkOfAUtf8FileIsPassedOverAndKept) {
    const std::string mark = "\xEF\xBB\xBF";
    const std::string marked = mark + "[RDS]\r\nPS=RADIO\r\n";
    EXPECT_EQ(ProfileText(marked).value("RDS", "PS"), "RADIO");
    EXPECT_EQ(written(marked, "RDS", "PS", "X"), mark + "[RDS]\r\nPS=X\r\n");
    EXPECT_EQ(written(marked, "FM", "ARI", "1"), marked + "[FM]\r\nARI=1\r\n");
    EXPECT_EQ(written(mark, "RDS", "PS", "X"), mark + "[RDS]\r\nPS=X\r\n");
    EXPECT_EQ(ProfileText(mark + "[RDS]\r\nPS=F\xC3\x9CNF\r\n").value("RDS", "PS"), "F\xC3\x9CNF") << "8-bit text";
    EXPECT_EQ(ProfileText("[RDS]\r\n" + mark + "PS=RADIO\r\n").value("RDS", "PS"), "") << "only where a file begins";
}

TEST(ProfileTextTest, Utf16IsRecognisedByItsMark) {
    EXPECT_TRUE(isUtf16("\xFF\xFE[\0"s));
    EXPECT_TRUE(isUtf16("\xFE\xFF\0["s));
    EXPECT_TRUE(isUtf16("\xFF\xFE"));
    EXPECT_FALSE(isUtf16("\xFF"));
    EXPECT_FALSE(isUtf16(""));
    EXPECT_FALSE(isUtf16("[RDS]\r\n\xFF\xFE"));
}

TEST(ProfileTextTest, HoldsWhatAWriteWouldNotChange) {
    const ProfileText text("[RDS]\r\nPS=RADIO\r\n PI = D3C0\r\nRTA=\"x\"\r\nPTY=1");
    EXPECT_TRUE(text.holds("rds", " ps ", "RADIO"));
    EXPECT_FALSE(text.holds("RDS", "PS", "Radio"));
    EXPECT_FALSE(text.holds("RDS", "PI", "D3C0")) << "blanks around it";
    EXPECT_FALSE(text.holds("RDS", "RTA", "x")) << "quotes around it";
    EXPECT_FALSE(text.holds("RDS", "PTY", "1")) << "its line has no end";
    EXPECT_FALSE(text.holds("RDS", "MS", "")) << "not there";
}

TEST(ProfileTextTest, VerticalTabsAreDroppedAtTheEdges) {
    EXPECT_EQ(ProfileText("\v[\vRDS\v]\v\r\n\vPS\v=\vRADIO\v\r\n").value("RDS", "PS"), "RADIO");
}

TEST(ProfileTextTest, ANumberSignStartsNoComment) {
    EXPECT_EQ(ProfileText("[RDS]\r\n#PS=RADIO\r\n").value("RDS", "#PS"), "RADIO");
}

TEST(ProfileTextTest, ABlankedCommentLineIsNoKey) {
    EXPECT_EQ(ProfileText("[RDS]\r\n  ;PS=RADIO\r\n").value("RDS", ";PS"), "");
}

TEST(ProfileTextTest, AHeaderWithoutItsBracketEndsWithTheLine) {
    EXPECT_EQ(ProfileText("[RDS\r\nPS=RADIO\r\n").value("RDS", "PS"), "RADIO");
}

TEST(ProfileTextTest, TextBehindAHeaderIsIgnored) {
    EXPECT_EQ(ProfileText("[RDS] ]=x\r\nPS=RADIO\r\n").value("RDS", "PS"), "RADIO");
}

TEST(ProfileTextTest, TheEmptySectionNameMeansEmptyBrackets) {
    const std::string bytes = "PS=1\r\n[]\r\nPS=2\r\n";
    EXPECT_EQ(ProfileText(bytes).value("", "PS"), "2");
    EXPECT_EQ(written("", "", "PS", "3"), "[]\r\nPS=3\r\n");
}

TEST(ProfileTextTest, AnExistingKeyKeepsItsSpellingAndItsLineEnd) {
    EXPECT_EQ(written("[Fm]\n pilot_Hub = 675 \nRDS=1\n", "FM", "PILOT_HUB", "700"), "[Fm]\npilot_Hub=700\nRDS=1\n");
}

TEST(ProfileTextTest, AWriteIntoALastLineWithoutLineEndGivesItOne) {
    EXPECT_EQ(written("[FM]\r\nRDS=1", "FM", "RDS", "0"), "[FM]\r\nRDS=0\r\n");
    EXPECT_EQ(written("[FM]\nRDS=1\nARI=1", "FM", "RDS", "0"), "[FM]\nRDS=0\nARI=1") << "another line is not touched";
}

TEST(ProfileTextTest, AnEmptyValueIsWrittenAsKeyAndEqualsSign) {
    EXPECT_EQ(written("[RDS]\r\nPS=RADIO\r\n", "RDS", "PS", ""), "[RDS]\r\nPS=\r\n");
}

TEST(ProfileTextTest, ANewKeyGoesBeforeTheCommentsAndBlankLinesThatEndItsSection) {
    EXPECT_EQ(written("[RDS]\r\nPS=A\r\n\r\n; the generator\r\n\r\n[VRN]\r\nX=1\r\n", "RDS", "PI", "D3C0"),
              "[RDS]\r\nPS=A\r\nPI=D3C0\r\n\r\n; the generator\r\n\r\n[VRN]\r\nX=1\r\n");
}

TEST(ProfileTextTest, ANewKeyOfASectionWithoutKeysGoesBehindTheHeader) {
    EXPECT_EQ(written("[RDS]\r\n; nothing yet\r\n[VRN]\r\n", "RDS", "PI", "D3C0"),
              "[RDS]\r\nPI=D3C0\r\n; nothing yet\r\n[VRN]\r\n");
}

TEST(ProfileTextTest, ANewKeyGoesToTheFirstSectionOfItsName) {
    EXPECT_EQ(written("[M]\r\n[N]\r\n[m]\r\na=1\r\n", "M", "a", "2"), "[M]\r\na=2\r\n[N]\r\n[m]\r\na=1\r\n");
}

TEST(ProfileTextTest, GarbageIsReadAsNothingAndKept) {
    std::string garbage;
    for (int i = 0; i < 4096; ++i) garbage += static_cast<char>(i * 151 % 256);
    EXPECT_EQ(ProfileText(garbage).value("RDS", "PS"), "");
    const std::string after = written(garbage, "RDS", "PS", "RADIO");
    EXPECT_EQ(after.substr(0, garbage.size()), garbage);
    EXPECT_EQ(ProfileText(after).value("RDS", "PS"), "RADIO");
}

TEST(ProfileTextTest, NulBytesAreTextLikeAnyOther) {
    const std::string bytes = "\0\0[X]\0\r\n[RDS]\0\r\nP\0S=1\r\nPS=A\0B\r\n"s;
    EXPECT_EQ(ProfileText(bytes).value("RDS", "PS"), "A\0B"s);
    EXPECT_EQ(written(bytes, "RDS", "PS", "C"), "\0\0[X]\0\r\n[RDS]\0\r\nP\0S=1\r\nPS=C\r\n"s);
}

TEST(ProfileTextTest, AMegabyteLongLineIsPassedOverAndKept) {
    const std::string longLine(1 << 20, 'x');
    const std::string bytes = longLine + "\r\n[RDS]\r\n" + longLine + "\r\nRTA=" + longLine + "\r\nPS=RADIO\r\n";
    const ProfileText text(bytes);
    EXPECT_EQ(text.value("RDS", "PS"), "RADIO");
    EXPECT_EQ(text.value("RDS", "RTA"), std::string(254, 'x'));
    EXPECT_EQ(written(bytes, "RDS", "PS", "RADI1"),
              longLine + "\r\n[RDS]\r\n" + longLine + "\r\nRTA=" + longLine + "\r\nPS=RADI1\r\n");
}

TEST(ReadFileTest, GivesTheBytesOfAFile) {
    const test::TempFolder folder;
    const std::string bytes = "\r\n\0\xFF\x1Ax"s;
    folder.write("a.ini", bytes);
    folder.write("empty.ini", "");
    EXPECT_EQ(readFile(folder.data() / "a.ini"), bytes);
    EXPECT_EQ(readFile(folder.data() / "empty.ini"), "");
}

TEST(ReadFileTest, GivesNothingForWhatIsNoFile) {
    const test::TempFolder folder;
    EXPECT_EQ(readFile(folder.data() / "missing.ini"), std::nullopt);
    EXPECT_EQ(readFile(folder.data()), std::nullopt);
}

TEST(FileHoldsTest, ComparesEveryByteAndTheLength) {
    const test::TempFolder folder;
    const std::string bytes(200'000, 'x');
    const auto file = folder.data() / "a.ini";
    folder.write("a.ini", bytes);
    EXPECT_TRUE(fileHolds(file, bytes));
    EXPECT_FALSE(fileHolds(file, bytes + "x"));
    EXPECT_FALSE(fileHolds(file, bytes.substr(1)));
    EXPECT_FALSE(fileHolds(file, bytes.substr(1) + "y"));
    EXPECT_FALSE(fileHolds(file, ""));
    folder.write("a.ini", "");
    EXPECT_TRUE(fileHolds(file, ""));
    EXPECT_FALSE(fileHolds(folder.data() / "missing.ini", ""));
    EXPECT_FALSE(fileHolds(folder.data(), ""));
}

TEST(ReadToChangeTest, GivesTheBytesOfAFileAndNoneOfOneYetToBeMade) {
    const test::TempFolder folder;
    folder.write("a.ini", "PS=A");
    EXPECT_EQ(readToChange(folder.data() / "a.ini"), "PS=A");
    EXPECT_EQ(readToChange(folder.data() / "missing.ini"), "");
}

TEST(ReadFileTest, TakesNoFileThatNoSettingsCanFill) {
    const test::TempFolder folder;
    const auto file = folder.data() / "a.ini";
    folder.write("a.ini", "[RDS]");
    EXPECT_EQ(readFile(file, 5), "[RDS]");
    EXPECT_EQ(readFile(file, 4), std::nullopt);
    std::filesystem::resize_file(file, kMostBytes + 1);
    EXPECT_EQ(readFile(file), std::nullopt);
    EXPECT_EQ(readToChange(file), std::nullopt) << "nobody may write over it";
}

}  // namespace
}  // namespace kdx
