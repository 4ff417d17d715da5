#include "tmc/tmclist.h"
#include "tmc/tmclisttest.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace kdx {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::Optional;

namespace fs = std::filesystem;

TEST(ShownEntryTest, PadsTheTextToFortyTwoCharacters) {
    EXPECT_EQ(shownEntry("Stau;00101"), "Stau" + std::string(38, ' ') + "00101");
}

TEST(ShownEntryTest, CutsALongerTextToFortyTwoCharacters) {
    EXPECT_EQ(shownEntry(std::string(43, 'x') + ";00101"), std::string(42, 'x') + "00101");
}

TEST(ShownEntryTest, SeparatesAtTheFirstSemicolonOnly) {
    EXPECT_EQ(shownEntry("a;b;c"), "a" + std::string(41, ' ') + "b;c");
}

TEST(ShownEntryTest, MayHaveAnEmptyTextOrCode) {
    EXPECT_EQ(shownEntry(";7"), std::string(42, ' ') + "7");
    EXPECT_EQ(shownEntry("a;"), "a" + std::string(41, ' '));
}

TEST(ShownEntryTest, IsNothingWithoutASemicolon) {
    EXPECT_EQ(shownEntry("Stau 00101"), std::nullopt);
    EXPECT_EQ(shownEntry(""), std::nullopt);
}

TEST_F(TmcListTest, LoadsEveryLineThatHasASemicolon) {
    write("; a remark\r\nno entry\r\n\r\nStau;00101\r\nUnfall;00201\r\n");
    EXPECT_THAT(entries(),
                Optional(ElementsAre(std::string(42, ' ') + " a remark", "Stau" + std::string(38, ' ') + "00101",
                                     "Unfall" + std::string(36, ' ') + "00201")));
}

TEST_F(TmcListTest, LoadsTheLastLineWithoutItsEndAndBareLineFeeds) {
    write("a;1\nb;2");
    EXPECT_THAT(entries(), Optional(ElementsAre("a" + std::string(41, ' ') + "1", "b" + std::string(41, ' ') + "2")));
}

TEST_F(TmcListTest, LoadsAnEmptyFileAsAnEmptyList) {
    write("");
    EXPECT_THAT(entries(), Optional(IsEmpty()));
}

TEST_F(TmcListTest, LoadsGarbageWithoutLosingTheEntriesBesideIt) {
    write(std::string("\0\x01\xff\r\n", 5) + std::string(1'000'000, 'x') + "\r\nStau;00101\r\n");
    EXPECT_THAT(entries(), Optional(ElementsAre("Stau" + std::string(38, ' ') + "00101")));
}

TEST_F(TmcListTest, LoadingAMissingFileFails) {
    EXPECT_EQ(entries(), std::nullopt);
}

TEST_F(TmcListTest, AppendsALineAsItWasTyped) {
    write("Stau;00101\r\n");
    EXPECT_TRUE(appendToTmcList(file(), std::string(50, 'x'), "7;8"));
    EXPECT_EQ(content(), "Stau;00101\r\n" + std::string(50, 'x') + ";7;8\r\n");
}

TEST_F(TmcListTest, AppendingCreatesAMissingFile) {
    EXPECT_TRUE(appendToTmcList(file(), "Stau", "00101"));
    EXPECT_EQ(content(), "Stau;00101\r\n");
}

TEST_F(TmcListTest, AppendingEndsALastLineThatHadNoEnd) {
    write("Stau;00101");
    EXPECT_TRUE(appendToTmcList(file(), "Unfall", "00201"));
    EXPECT_EQ(content(), "Stau;00101\r\nUnfall;00201\r\n");
}

TEST_F(TmcListTest, AppendingKeepsALastLineThatEndsInACarriageReturnOnly) {
    write("Stau;00101\r");
    const auto before = entries();
    EXPECT_TRUE(appendToTmcList(file(), "Unfall", "00201"));
    EXPECT_EQ(content(), "Stau;00101\r\nUnfall;00201\r\n");
    EXPECT_EQ(entries()->front(), before->front());
}

TEST_F(TmcListTest, AppendingFailsWhereTheNameIsAFolder) {
    fs::create_directory(file());
    EXPECT_FALSE(appendToTmcList(file(), "Unfall", "00201"));
    EXPECT_TRUE(fs::is_directory(file()));
}

TEST_F(TmcListTest, AnEntryIsChangedInItsPlaceAndTheOthersStayByteForByte) {
    write("no entry\n\nStau;00101\r\nUnfall;00201\nNebel;00301");
    EXPECT_TRUE(changeInTmcList(file(), 0, "Stau;00101", "Stau, lang", "00102"));
    EXPECT_TRUE(changeInTmcList(file(), 2, "Nebel;00301", "Schnee", "00302"));
    EXPECT_EQ(content(), "no entry\n\nStau, lang;00102\r\nUnfall;00201\nSchnee;00302");
    EXPECT_TRUE(removeFromTmcList(file(), 1, "Unfall;00201"));
    EXPECT_EQ(content(), "no entry\n\nStau, lang;00102\r\nSchnee;00302");
    EXPECT_TRUE(removeFromTmcList(file(), 1, "Schnee;00302"));
    EXPECT_EQ(content(), "no entry\n\nStau, lang;00102\r\n");
}

TEST_F(TmcListTest, AnEntryThatIsNoLongerThereIsNotChanged) {
    write("Stau;00101\r\n");
    EXPECT_FALSE(changeInTmcList(file(), 0, "Unfall;00201", "x", "1"));
    EXPECT_FALSE(changeInTmcList(file(), 1, "Stau;00101", "x", "1"));
    EXPECT_FALSE(removeFromTmcList(file(), 0, "Unfall;00201"));
    EXPECT_EQ(content(), "Stau;00101\r\n");
    fs::remove(file());
    EXPECT_FALSE(removeFromTmcList(file(), 0, "Stau;00101"));
    EXPECT_FALSE(fs::exists(file()));
}

}  // namespace
}  // namespace kdx
