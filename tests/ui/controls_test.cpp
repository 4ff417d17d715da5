#include "ui/controls.h"

#include <gtest/gtest.h>

#include <QCoreApplication>

#include "ui/clickablelabel.h"

namespace kdx {
namespace {

TEST(OptionArrayTest, NamesItsElementsAndKeepsOneChosen) {
    QWidget page;
    OptionArray<3> options;
    options.create("Pre_opt", &page);
    EXPECT_EQ(options[2]->objectName(), QStringLiteral("Pre_opt_2"));
    EXPECT_EQ(options.chosen(), -1);
    options[0]->click();
    options[1]->click();
    EXPECT_EQ(options.chosen(), 1);
    EXPECT_FALSE(options[0]->isChecked());
}

TEST(OptionArrayTest, ChoosingRunsNoHandler) {
    QWidget page;
    OptionArray<3> options;
    options.create("Pre_opt", &page);
    int clicks = 0;
    for (const QRadioButton* option : options) {
        QObject::connect(option, &QRadioButton::toggled, [&clicks] { ++clicks; });
    }
    options.choose(2);
    EXPECT_EQ(options.chosen(), 2);
    options.choose(7);
    EXPECT_EQ(options.chosen(), -1);
    EXPECT_EQ(clicks, 0);
    options[1]->click();
    EXPECT_EQ(options.chosen(), 1);
}

TEST(NamedTest, ControlsBearTheSystemsNames) {
    QWidget page;
    EXPECT_EQ(named<QWidget>("Frame7", &page)->objectName(), QStringLiteral("Frame7"));
    EXPECT_EQ(element<QWidget>("Status", 17, &page)->objectName(), QStringLiteral("Status_17"));
}

TEST(ScrollTest, SettingQuietlyStaysInTheRange) {
    QScrollBar bar;
    bar.setRange(0, 400);
    int changes = 0;
    QObject::connect(&bar, &QScrollBar::valueChanged, [&changes] { ++changes; });
    setQuietly(&bar, 500);
    EXPECT_EQ(bar.value(), 400);
    EXPECT_EQ(changes, 0);
}

TEST(ClickableLabelTest, AnswersToMouseAndKeyboard) {
    ClickableLabel label(nullptr);
    label.resize(50, 20);
    int clicks = 0;
    QObject::connect(&label, &ClickableLabel::clicked, [&clicks] { ++clicks; });
    QMouseEvent release(QEvent::MouseButtonRelease, QPointF(5, 5), QPointF(5, 5), Qt::LeftButton, Qt::NoButton,
                        Qt::NoModifier);
    QCoreApplication::sendEvent(&label, &release);
    EXPECT_EQ(clicks, 1);
    QKeyEvent space(QEvent::KeyPress, Qt::Key_Space, Qt::NoModifier);
    QCoreApplication::sendEvent(&label, &space);
    EXPECT_EQ(clicks, 2);
    QMouseEvent outside(QEvent::MouseButtonRelease, QPointF(80, 5), QPointF(80, 5), Qt::LeftButton, Qt::NoButton,
                        Qt::NoModifier);
    QCoreApplication::sendEvent(&label, &outside);
    EXPECT_EQ(clicks, 2);
}

}  // namespace
}  // namespace kdx
