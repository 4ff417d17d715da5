#include "af/modul2.h"

#include <gtest/gtest.h>

#include "support/listrows.h"

#include <QLabel>
#include <QListWidget>

namespace kdx {
namespace {

using test::rowsOf;
using Rows = std::vector<std::string>;

class FillAfListsTest : public ::testing::Test {
protected:
    QListWidget list;
    QLabel tuned;
};

TEST_F(FillAfListsTest, TheTunedFrequencyGoesToTheLabelAndEachAfToARow) {
    FillAfLists(list, tuned, "87.6,90.1,94.3");
    EXPECT_EQ(tuned.text(), QStringLiteral("87.6"));
    EXPECT_EQ(rowsOf(list), Rows({"90.1", "94.3"}));
}

TEST_F(FillAfListsTest, ANewListReplacesTheFormerOne) {
    FillAfLists(list, tuned, "87.6,90.1,94.3");
    FillAfLists(list, tuned, "100.1,88.0");
    EXPECT_EQ(tuned.text(), QStringLiteral("100.1"));
    EXPECT_EQ(rowsOf(list), Rows({"88.0"}));
}

TEST_F(FillAfListsTest, AnEntryWithADoubleQuoteIsRed) {
    FillAfLists(list, tuned, "98.5,90.1\",94.3");
    EXPECT_EQ(rowsOf(list), Rows({"90.1\"", "94.3"}));
    EXPECT_EQ(list.item(0)->foreground().color(), QColor(Qt::red));
    EXPECT_NE(list.item(1)->foreground().color(), QColor(Qt::red));
}

TEST_F(FillAfListsTest, ATunedFrequencyWithADoubleQuoteIsRedUntilAnotherListIsShown) {
    const auto colour = [this] { return tuned.palette().color(QPalette::WindowText); };
    const QColor plain = colour();
    FillAfLists(list, tuned, "98.5\",90.1");
    EXPECT_EQ(tuned.text(), QStringLiteral("98.5\""));
    EXPECT_EQ(colour(), QColor(Qt::red));
    FillAfLists(list, tuned, "98.5,90.1");
    EXPECT_EQ(colour(), plain);
}

TEST_F(FillAfListsTest, AListWithoutACommaChangesNothing) {
    FillAfLists(list, tuned, "87.6,90.1");
    for (const char* text : {"", "100.1"}) {
        FillAfLists(list, tuned, text);
        EXPECT_EQ(tuned.text(), QStringLiteral("87.6"));
        EXPECT_EQ(rowsOf(list), Rows({"90.1"}));
    }
}

TEST_F(FillAfListsTest, APieceAfterTheLastCommaIsARowEvenWhenItIsEmpty) {
    FillAfLists(list, tuned, ",");
    EXPECT_EQ(tuned.text(), QString());
    EXPECT_EQ(rowsOf(list), Rows({""}));
}

TEST_F(FillAfListsTest, BytesAreShownAsTheirCodePageHasThem) {
    FillAfLists(list, tuned, "\xDC,\xB5");
    EXPECT_EQ(tuned.text(), QStringLiteral("Ü"));
    EXPECT_EQ(rowsOf(list), Rows({"µ"}));
}

}  // namespace
}  // namespace kdx
