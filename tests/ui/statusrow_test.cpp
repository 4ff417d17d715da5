#include "ui/statusrow.h"

#include <gtest/gtest.h>

#include <QRegularExpression>

namespace kdx {
namespace {

class StatusRowTest : public ::testing::Test {
protected:
    std::string read(std::size_t slot) {
        return row.findChild<QLabel*>(QStringLiteral("Status_%1").arg(slot))->text().toStdString();
    }
    StatusRow row{nullptr};
};

TEST_F(StatusRowTest, HasNinePairsWithTheirDesignCaptions) {
    const std::pair<std::size_t, const char*> captions[] = {{16, "RF [MHz]"}, {12, "RF [dB\xC2\xB5V]"},
                                                            {15, "AF [kHz]"}, {7, "PI"},
                                                            {6, "PS"},        {11, "TP"},
                                                            {9, "TA"},        {8, "M / S"},
                                                            {5, "PTY"},       {17, "--"},
                                                            {13, "--"},       {14, "--"},
                                                            {2, "Label1"},    {3, "Label1"},
                                                            {10, "Label1"},   {0, "TA"},
                                                            {1, "Label1"},    {4, "Label1"}};
    for (const auto& [slot, caption] : captions) EXPECT_EQ(read(slot), caption) << slot;
}

TEST_F(StatusRowTest, ShowsThePairsFromLeftToRightEachValueUnderItsHeading) {
    row.resize(620, 40);
    row.show();
    const std::pair<std::size_t, std::size_t> pairs[] = {{16, 17}, {12, 13}, {15, 14}, {7, 2}, {6, 3},
                                                         {11, 10}, {9, 0},   {8, 1},   {5, 4}};
    int left = -1;
    for (const auto& [heading, value] : pairs) {
        const auto* above = row.findChild<QLabel*>(QStringLiteral("Status_%1").arg(heading));
        const auto* below = row.findChild<QLabel*>(QStringLiteral("Status_%1").arg(value));
        EXPECT_GT(above->x(), left);
        EXPECT_EQ(above->x(), below->x());
        EXPECT_LT(above->y(), below->y());
        left = above->x();
    }
}

TEST_F(StatusRowTest, TheAnnouncementTurnsLightGreenAndBack) {
    const auto* ta = row.findChild<QLabel*>(QStringLiteral("Status_0"));
    row.setAnnouncing(true);
    EXPECT_EQ(ta->palette().color(QPalette::Window), QColor(0, 255, 0));
    row.setAnnouncing(false);
    EXPECT_EQ(ta->palette().color(QPalette::Window), row.palette().color(QPalette::Button));
}

TEST_F(StatusRowTest, DesignCaptionsAreGreyAndFitTheirFields) {
    row.resize(row.minimumSizeHint().width(), 40);
    row.show();
    const QColor grey = row.palette().color(QPalette::Disabled, QPalette::WindowText);
    for (const std::size_t slot : {17, 13, 14, 2, 3, 10, 0, 1, 4}) {
        const auto* value = row.findChild<QLabel*>(QStringLiteral("Status_%1").arg(slot));
        EXPECT_EQ(value->palette().color(QPalette::WindowText), grey) << slot;
        EXPECT_EQ(value->property("zustand").toString(), QString()) << slot;
        EXPECT_GE(value->width(), value->minimumSizeHint().width()) << slot;
    }
    row.show(StatusSlot::Pi, std::string_view("D3C2"));
    const auto* pi = row.findChild<QLabel*>(QStringLiteral("Status_2"));
    EXPECT_EQ(pi->palette().color(QPalette::WindowText), row.palette().color(QPalette::WindowText));
}

TEST_F(StatusRowTest, UsesArial) {
    for (const QLabel* label : row.findChildren<QLabel*>(QRegularExpression(QStringLiteral("^Status_")))) {
        EXPECT_EQ(label->font().families().front(), QStringLiteral("Arial"));
    }
}

TEST_F(StatusRowTest, ValuesCanBeReadBack) {
    row.show(StatusSlot::Tp, std::string_view("ein"));
    EXPECT_EQ(row.text(StatusSlot::Tp), QStringLiteral("ein"));
}

}  // namespace
}  // namespace kdx
