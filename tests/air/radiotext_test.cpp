#include "air/airtest.h"

namespace kdx::air {
namespace {

class RadiotextGroups : public AirTest {
protected:
    RadiotextGroups() { coder("GS=2A"); }
    void text(const std::string& text, int flag = 0) { coder("RT=10," + std::to_string(flag) + "," + text); }
};

TEST_F(RadiotextGroups, EndWithTheEndMarkAndBlanks) {
    text("HELLO");
    EXPECT_EQ(next(3), (Groups{"1000 2000 4845 4C4C", "1000 2001 4F0D 2020", "1000 2000 4845 4C4C"}));
}

TEST_F(RadiotextGroups, OneCharacterTakesOneSegment) {
    text("A");
    EXPECT_EQ(next(2), (Groups{"1000 2000 410D 2020", "1000 2000 410D 2020"}));
}

TEST_F(RadiotextGroups, AFullSegmentHasTheEndMarkInTheNext) {
    text("ABC");
    EXPECT_EQ(next(2), (Groups{"1000 2000 4142 430D", "1000 2000 4142 430D"}));
    text("ABCD");
    EXPECT_EQ(next(3), (Groups{"1000 2010 4142 4344", "1000 2011 0D20 2020", "1000 2010 4142 4344"}));
}

TEST_F(RadiotextGroups, SixtyThreeCharactersEndWithTheEndMark) {
    text(std::string(63, 'x'));
    const Groups groups = next(17);
    EXPECT_EQ(groups[0], "1000 2000 7878 7878");
    EXPECT_EQ(groups[14], "1000 200E 7878 7878");
    EXPECT_EQ(groups[15], "1000 200F 7878 780D");
    EXPECT_EQ(groups[16], "1000 2000 7878 7878");
}

TEST_F(RadiotextGroups, SixtyFourCharactersHaveNoEndMark) {
    text(std::string(63, 'x') + "y");
    const Groups groups = next(17);
    EXPECT_EQ(groups[15], "1000 200F 7878 7879");
    EXPECT_EQ(groups[16], "1000 2000 7878 7878");
}

TEST_F(RadiotextGroups, NoTextPassesTheSlotTo0A) {
    EXPECT_EQ(next(), "1000 0008 E0CD 4B44");
    text("A");
    EXPECT_EQ(next(), "1000 2000 410D 2020");
    coder("RT=0,0,");
    EXPECT_EQ(next(), "1000 0009 E0CD 582D");
}

TEST_F(RadiotextGroups, BlanksAreAText) {
    text("   ");
    EXPECT_EQ(next(), "1000 2000 2020 200D");
}

TEST_F(RadiotextGroups, OfVersionBHaveTwoCharactersASegment) {
    coder("GS=2B");
    text("HELLO");
    EXPECT_EQ(next(4),
              (Groups{"1000 2800 1000 4845", "1000 2801 1000 4C4C", "1000 2802 1000 4F0D", "1000 2800 1000 4845"}));
    text("AB");
    EXPECT_EQ(next(3), (Groups{"1000 2810 1000 4142", "1000 2811 1000 0D20", "1000 2810 1000 4142"}));
}

TEST_F(RadiotextGroups, OfVersionBCarryTheFirst32Characters) {
    coder("GS=2B");
    text(std::string(31, 'x'));
    EXPECT_EQ(next(17)[15], "1000 280F 1000 780D");
    text(std::string(31, 'x') + "y");
    const Groups full = next(17);
    EXPECT_EQ(full[15], "1000 281F 1000 7879");
    EXPECT_EQ(full[16], "1000 2810 1000 7878");
    text(std::string(31, 'x') + "yzzzz");
    const Groups cut = next(17);
    EXPECT_EQ(cut[15], "1000 280F 1000 7879");
    EXPECT_EQ(cut[16], "1000 2800 1000 7878");
}

TEST_F(RadiotextGroups, OfBothVersionsShareOneCounter) {
    coder("GS=2A,2B");
    text("ABCDEFGHIJKLMNO");
    EXPECT_EQ(next(4),
              (Groups{"1000 2000 4142 4344", "1000 2801 1000 4344", "1000 2002 494A 4B4C", "1000 2803 1000 4748"}));
}

TEST_F(RadiotextGroups, TheFirstTextTakesTheFlagOfItsCommandAndChangedOnesToggleIt) {
    text("A", 1);
    EXPECT_EQ(block(2, 1), (Groups{"2010"}));
    text("B", 1);
    EXPECT_EQ(block(2, 1), (Groups{"2000"}));
    text("B", 1);
    EXPECT_EQ(block(2, 1), (Groups{"2000"}));
    text("C", 0);
    EXPECT_EQ(block(2, 1), (Groups{"2010"}));
}

TEST_F(RadiotextGroups, TheFlagIsThatOfTheTextBeforeTheFirstGroup) {
    text("A", 0);
    text("B", 1);
    EXPECT_EQ(block(2, 1), (Groups{"2010"}));
}

TEST_F(RadiotextGroups, ATextTakenAwayIsStillTheOneBefore) {
    text("A", 1);
    EXPECT_EQ(block(2, 1), (Groups{"2010"}));
    coder("RT=0,0,");
    (void)next();
    text("A", 0);
    EXPECT_EQ(block(2, 1), (Groups{"2010"}));
    coder("RT=0,0,");
    (void)next();
    text("B", 0);
    EXPECT_EQ(block(2, 1), (Groups{"2000"}));
}

TEST_F(RadiotextGroups, AChangedTextBeginsAtItsFirstSegmentTheSameOneGoesOn) {
    text("ABCDEFGH");
    EXPECT_EQ(block(2, 1), (Groups{"2000"}));
    text("ABCDEFGH");
    EXPECT_EQ(block(2, 1), (Groups{"2001"}));
    text("IJKLMNOP");
    EXPECT_EQ(next(), "1000 2010 494A 4B4C");
}

TEST_F(RadiotextGroups, CharactersWithoutAPlaceAreBlanksAndTold) {
    text("\xC4~\x96");  // 96 is a dash
    EXPECT_EQ(next(), "1000 2000 D120 200D");
    EXPECT_EQ(warnings, (Groups{"radiotext: \"~\" has no place in the RDS character set and is sent as a blank",
                                "radiotext: \"–\" has no place in the RDS character set and is sent as a blank"}));
}

}  // namespace
}  // namespace kdx::air
