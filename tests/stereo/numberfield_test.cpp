#include <gtest/gtest.h>

#include <QDoubleSpinBox>
#include <QWheelEvent>

#include "stereo/numberfield.h"
#include "stereopagetest.h"

namespace kdx::test {
namespace {

/// The number fields beside the scroll bars.
class NumberFieldTest : public StereoPageTest {
protected:
    void typeNumber(const char* name, const char* number) {
        auto* entry = find(name)->findChild<QLineEdit*>();
        entry->selectAll();
        entry->insert(QString::fromLatin1(number));
    }
};

TEST_F(NumberFieldTest, HasTheRangeAndTheStepOfItsBar) {
    const struct {
        const char* name;
        double highest, step;
    } rows[] = {
        {"FM_Hub_Zahl", 80, 0.1}, {"Pilot_Hub_Zahl", 15, 0.05}, {"RDS_Hub_Zahl", 4, 0.05}, {"Ari_hub_Zahl", 8, 0.05}};
    for (const auto& row : rows) {
        const auto* field = find<QDoubleSpinBox>(row.name);
        EXPECT_EQ(field->minimum(), 0) << row.name;
        EXPECT_EQ(field->maximum(), row.highest) << row.name;
        EXPECT_EQ(field->singleStep(), row.step) << row.name;
        EXPECT_TRUE(field->text().endsWith(QStringLiteral(" kHz"))) << row.name;
    }
    const auto* phase = find<QSpinBox>("HScroll1_Zahl");
    EXPECT_EQ(phase->minimum(), -4);
    EXPECT_EQ(phase->maximum(), 5);
}

TEST_F(NumberFieldTest, AnEnteredNumberIsSentAndKeptAsTheBarsValue) {
    find<QDoubleSpinBox>("FM_Hub_Zahl")->setValue(67.5);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 67500HZ"});
    EXPECT_EQ(general("MPX_DEV"), "06750");
    EXPECT_EQ(text("FM_Hub_Label2"), "Hub 67.5 kHz");
    find<QDoubleSpinBox>("Pilot_Hub_Zahl")->setValue(6.75);
    find<QDoubleSpinBox>("RDS_Hub_Zahl")->setValue(2);
    find<QDoubleSpinBox>("Ari_hub_Zahl")->setValue(3.5);
    find<QSpinBox>("HScroll1_Zahl")->setValue(-3);
    EXPECT_EQ(sent(), (Lines{":STEREO:PILOT:DEVIATION 6750HZ", ":STEREO:RDS:DEVIATION 2000HZ",
                             ":stereo:ari:deviation 3500HZ", ":STEREO:PILOT:PHASE -3DEG"}));
}

TEST_F(NumberFieldTest, FollowsItsBarWithoutSendingTwice) {
    scroll("FM_Hub_Scroll", 4000);
    EXPECT_EQ(find<QDoubleSpinBox>("FM_Hub_Zahl")->value(), 40);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 40000HZ"});
    find<QScrollBar>("HScroll1")->setSliderDown(true);
    find<QScrollBar>("HScroll1")->setSliderPosition(4);
    EXPECT_EQ(find<QSpinBox>("HScroll1_Zahl")->value(), 4);
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(NumberFieldTest, WhatIsTypedGoesOutOnceAtReturn) {
    for (const char* typed : {"67.5", "68,25"}) {
        typeNumber("FM_Hub_Zahl", typed);
        EXPECT_EQ(sent(), Lines{});
        EXPECT_EQ(stateOf("FM_Hub_Zahl"), "ungesendet");
        press("FM_Hub_Zahl", Qt::Key_Return);
        EXPECT_EQ(sent().size(), 1U) << typed;
        EXPECT_EQ(stateOf("FM_Hub_Zahl"), "");
    }
    EXPECT_EQ(general("MPX_DEV"), "06825");
}

TEST_F(NumberFieldTest, ANumberOutOfRangeIsMarkedAndNotSent) {
    const auto press = [&](const char* name, const char* keys) {
        auto* field = find<QAbstractSpinBox>(name);
        field->selectAll();
        for (const char* at = keys; *at != 0; ++at) {
            QKeyEvent key(QEvent::KeyPress, 0, Qt::NoModifier, QString(QLatin1Char(*at)));
            QApplication::sendEvent(field, &key);
        }
    };
    const auto enter = [&](const char* name) {
        QKeyEvent key(QEvent::KeyPress, Qt::Key_Return, Qt::NoModifier);
        QApplication::sendEvent(find(name), &key);
    };
    const struct {
        const char *name, *typed, *range;
    } rows[] = {{"FM_Hub_Zahl", "100", "Von 0 bis 80.00; "},
                {"Ari_hub_Zahl", "99.9", "Von 0 bis 8.00; "},
                {"HScroll1_Zahl", "17", "Von -4 bis 5; "}};
    for (const auto& row : rows) {
        const QString before = find<QAbstractSpinBox>(row.name)->text();
        press(row.name, row.typed);
        EXPECT_TRUE(find<QAbstractSpinBox>(row.name)->text().startsWith(QLatin1String(row.typed))) << row.name;
        EXPECT_EQ(find(row.name)->property("zustand").toString(), QStringLiteral("abgelehnt")) << row.name;
        EXPECT_TRUE(find(row.name)->toolTip().startsWith(QLatin1String(row.range))) << row.name;
        enter(row.name);
        EXPECT_EQ(sent(), Lines{}) << row.name;
        EXPECT_EQ(find<QAbstractSpinBox>(row.name)->text(), before) << "what is in force stands there again";
        EXPECT_EQ(find(row.name)->property("zustand").toString(), QString()) << row.name;
    }
    press("FM_Hub_Zahl", "7,5");
    enter("FM_Hub_Zahl");
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 7500HZ"});
}

TEST_F(NumberFieldTest, TheArrowKeysGoByTheStepAndTheWheelPasses) {
    scroll("Pilot_Hub_Scroll", 675);
    sent();
    press("Pilot_Hub_Zahl", Qt::Key_Up);
    EXPECT_EQ(sent(), Lines{":STEREO:PILOT:DEVIATION 6800HZ"});
    auto* field = find("Pilot_Hub_Zahl");
    QWheelEvent event({5, 5}, field->mapToGlobal(QPoint(5, 5)), {}, {0, 120}, Qt::NoButton, Qt::NoModifier,
                      Qt::NoScrollPhase, false);
    QApplication::sendEvent(field, &event);
    EXPECT_FALSE(event.isAccepted());
    EXPECT_EQ(sent(), Lines{});
}

}  // namespace
}  // namespace kdx::test
