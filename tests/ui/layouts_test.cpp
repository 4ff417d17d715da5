#include "ui/layouts.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QLabel>

#include <array>

namespace kdx {
namespace {

/// A frame with four labels to place.
class LayoutsTest : public ::testing::Test {
protected:
    void show(QLayout* layout, QSize size, int margin = kGap) {
        for (QLabel* label : labels) label->setFixedHeight(20);
        layOut(&frame, layout, margin);
        frame.resize(size);
        frame.show();
        QApplication::processEvents();
    }
    QWidget frame;
    std::array<QLabel*, 4> labels{new QLabel(&frame), new QLabel(&frame), new QLabel(&frame), new QLabel(&frame)};
};

TEST_F(LayoutsTest, ARowSharesTheRoomAsItIsTold) {
    show(row({{labels[0], 1}, space(10), {labels[1], 3}}), {200, 40});
    EXPECT_EQ(labels[0]->x(), kGap);
    EXPECT_EQ(labels[1]->x(), labels[0]->geometry().right() + 1 + 10 + kGap);
    EXPECT_EQ(labels[1]->geometry().right() + 1, 200 - kGap);
    EXPECT_NEAR(labels[1]->width(), 3 * labels[0]->width(), 3);
}

TEST_F(LayoutsTest, RoomIsLeftWhereAColumnSaysSo) {
    show(add(column({labels[0], kRoom, labels[1]}), {labels[2]}), {100, 200}, 0);
    EXPECT_EQ(labels[0]->y(), 0);
    EXPECT_EQ(labels[2]->geometry().bottom() + 1, 200);
    EXPECT_EQ(labels[1]->geometry().bottom() + 1 + kGap, labels[2]->y());
}

TEST_F(LayoutsTest, AnArrayOfControlsIsPlacedInItsOrder) {
    show(column(labels), {100, 200});
    for (std::size_t i = 1; i < labels.size(); ++i) EXPECT_GT(labels[i]->y(), labels[i - 1]->geometry().bottom());
    EXPECT_EQ(labels[3]->x(), kGap);
}

TEST_F(LayoutsTest, AGridLeavesPlacesEmptyAndSpreadsControlsOverItsColumns) {
    for (QLabel* label : labels) label->setMinimumWidth(40);
    show(grid({{labels[0], labels[1]}, {{}, labels[2]}, {{labels[3], 2}}}), {200, 100});
    EXPECT_EQ(labels[2]->x(), labels[1]->x());
    EXPECT_GT(labels[2]->x(), labels[0]->geometry().right());
    EXPECT_EQ(labels[3]->x(), labels[0]->x());
    EXPECT_EQ(labels[3]->geometry().right(), labels[1]->geometry().right());
}

}  // namespace
}  // namespace kdx
