#include "stereo/settingscrollbar.h"

#include <gtest/gtest.h>

#include <QDialog>
#include <QEventLoop>
#include <QMouseEvent>
#include <QStyle>
#include <QStyleOptionSlider>
#include <QTimer>
#include <QWheelEvent>

#include "stereopagetest.h"

namespace kdx::test {
namespace {

/// Scroll bars of the shown page, moved with the mouse, the wheel and the keys.
class SettingScrollBarTest : public StereoPageTest {
protected:
    SettingScrollBarTest() {
        page.resize(620, 322);
        page.show();
        bar = find<QScrollBar>("FM_Hub_Scroll");
        scroll("FM_Hub_Scroll", 4000);
        sent();
    }

    /// Middle of one of the bar's parts.
    QPoint at(QStyle::SubControl part) const {
        QStyleOptionSlider option;
        option.initFrom(bar);
        option.subControls = QStyle::SC_All;
        option.orientation = Qt::Horizontal;
        option.state |= QStyle::State_Horizontal;
        option.minimum = bar->minimum();
        option.maximum = bar->maximum();
        option.sliderPosition = bar->sliderPosition();
        option.sliderValue = bar->value();
        option.singleStep = bar->singleStep();
        option.pageStep = bar->pageStep();
        return bar->style()->subControlRect(QStyle::CC_ScrollBar, &option, part, bar).center();
    }
    void mouse(QEvent::Type type, QPoint where) {
        const auto pressed = type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton;
        const auto button = type == QEvent::MouseMove ? Qt::NoButton : Qt::LeftButton;
        QMouseEvent event(type, where, bar->mapToGlobal(QPointF(where)), button, pressed, {});
        QApplication::sendEvent(bar, &event);
    }
    void clickPart(QStyle::SubControl part) {
        const QPoint where = at(part);
        mouse(QEvent::MouseButtonPress, where);
        mouse(QEvent::MouseButtonRelease, where);
    }

    /// Turns the wheel over the bar by a notch. False when the bar passes it on.
    bool wheel(int notch) {
        const QPoint middle = bar->rect().center();
        QWheelEvent event(middle, bar->mapToGlobal(middle), {}, {0, notch}, Qt::NoButton, Qt::NoModifier,
                          Qt::NoScrollPhase, false);
        QApplication::sendEvent(bar, &event);
        return event.isAccepted();
    }

    QScrollBar* bar = nullptr;
};

TEST_F(SettingScrollBarTest, ADragIsFollowedByTheLabelAndSentOnceAtItsEnd) {
    const QPoint start = at(QStyle::SC_ScrollBarSlider);
    mouse(QEvent::MouseButtonPress, start);
    std::string last = text("FM_Hub_Label2");
    for (int step = 1; step <= 20; ++step) {
        mouse(QEvent::MouseMove, start + QPoint(step * 2, 0));
        EXPECT_NE(text("FM_Hub_Label2"), last);
        last = text("FM_Hub_Label2");
    }
    EXPECT_TRUE(sent().empty());
    EXPECT_EQ(general("MPX_DEV"), "04000");
    mouse(QEvent::MouseButtonRelease, start + QPoint(40, 0));
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION " + std::to_string(bar->value() * 10) + "HZ"});
    EXPECT_EQ(general("MPX_DEV"), multiplex.totalDeviation);
    EXPECT_GT(bar->value(), 4000);
    EXPECT_EQ(text("FM_Hub_Label2"), last);
}

TEST_F(SettingScrollBarTest, ADragBackToItsStartSendsNothing) {
    bar->setSliderDown(true);
    bar->setSliderPosition(4500);
    EXPECT_EQ(text("FM_Hub_Label2"), "Hub 45.0 kHz");
    bar->setSliderPosition(4000);
    bar->setSliderDown(false);
    EXPECT_EQ(text("FM_Hub_Label2"), "Hub 40.0 kHz");
    EXPECT_TRUE(sent().empty());
}

TEST_F(SettingScrollBarTest, ThePilotPhaseFollowsADragToo) {
    auto* phase = find<QScrollBar>("HScroll1");
    phase->setSliderDown(true);
    phase->setSliderPosition(-2);
    EXPECT_EQ(text("HScroll1_Label"), "Phase -2 °");
    phase->setSliderPosition(-3);
    EXPECT_EQ(text("HScroll1_Label"), "Phase -3 °");
    EXPECT_TRUE(sent().empty());
    phase->setSliderDown(false);
    EXPECT_EQ(sent(), Lines{":STEREO:PILOT:PHASE -3DEG"});
}

TEST_F(SettingScrollBarTest, EachClickOnAnArrowOrBesideTheSliderIsOneCommand) {
    clickPart(QStyle::SC_ScrollBarAddLine);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 40100HZ"});
    clickPart(QStyle::SC_ScrollBarAddLine);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 40200HZ"});
    clickPart(QStyle::SC_ScrollBarSubLine);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 40100HZ"});
    clickPart(QStyle::SC_ScrollBarAddPage);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION 40200HZ"});
}

TEST_F(SettingScrollBarTest, EachKeyIsOneCommand) {
    for (const auto key : {Qt::Key_Right, Qt::Key_PageUp, Qt::Key_Left, Qt::Key_End}) {
        const int before = bar->value();
        QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier);
        QApplication::sendEvent(bar, &event);
        EXPECT_NE(bar->value(), before);
        EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION " + std::to_string(bar->value() * 10) + "HZ"});
    }
    EXPECT_NE(bar->focusPolicy() & Qt::TabFocus, 0);
}

TEST_F(SettingScrollBarTest, EachNotchOfTheWheelOverAClickedBarIsOneCommand) {
    clickPart(QStyle::SC_ScrollBarAddLine);
    sent();
    for (const int notch : {120, -120, -120}) {
        const int before = bar->value();
        EXPECT_TRUE(wheel(notch));
        EXPECT_EQ(std::abs(bar->value() - before), 10);
        EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION " + std::to_string(bar->value() * 10) + "HZ"});
    }
}

TEST_F(SettingScrollBarTest, TheWheelPassesABarThatNobodyClicked) {
    EXPECT_FALSE(wheel(120));
    root().activateWindow();
    QApplication::processEvents();
    bar->setFocus(Qt::TabFocusReason);
    EXPECT_FALSE(wheel(-120));
    EXPECT_EQ(bar->value(), 4000);
    clickPart(QStyle::SC_ScrollBarAddLine);
    EXPECT_TRUE(wheel(120));
    find("Pilot_Hub_Scroll")->setFocus(Qt::TabFocusReason);  // another control is worked with
    sent();
    EXPECT_FALSE(wheel(120));
    EXPECT_TRUE(sent().empty());
}

TEST_F(SettingScrollBarTest, ADragSnapsToTheSmallStep) {
    const QPoint start = at(QStyle::SC_ScrollBarSlider);
    std::vector<int> followed;
    QObject::connect(bar, &QScrollBar::sliderMoved, &page, [&](int position) { followed.push_back(position); });
    mouse(QEvent::MouseButtonPress, start);
    for (int pixels = 1; pixels <= 30; ++pixels) mouse(QEvent::MouseMove, start + QPoint(pixels, 0));
    EXPECT_FALSE(followed.empty());
    for (const int position : followed) EXPECT_EQ(position % 10, 0);
    mouse(QEvent::MouseButtonRelease, start + QPoint(30, 0));
    EXPECT_EQ(bar->value() % 10, 0);
    EXPECT_EQ(sent(), Lines{":STEREO:DEVIATION " + std::to_string(bar->value() * 10) + "HZ"});
    mouse(QEvent::MouseButtonPress, at(QStyle::SC_ScrollBarSlider));
    mouse(QEvent::MouseMove, QPoint(bar->width() - 1, bar->height() / 2));
    mouse(QEvent::MouseButtonRelease, QPoint(bar->width() - 1, bar->height() / 2));
    EXPECT_EQ(bar->value(), bar->maximum());
}

// The arrow is still held when its step fails: without care every repetition would open one more box.
TEST_F(SettingScrollBarTest, AStepThatOpensABoxIsNotRepeatedBehindIt) {
    int boxes = 0;
    QObject::connect(bar, &QScrollBar::valueChanged, &page, [this, &boxes] {
        if (++boxes > 1) return;
        QDialog box(&page);
        // Longer than the half second after which a held arrow begins to repeat.
        QTimer::singleShot(700, &box, &QDialog::accept);
        box.exec();
    });
    const QPoint arrow = at(QStyle::SC_ScrollBarAddLine);
    mouse(QEvent::MouseButtonPress, arrow);
    QEventLoop after;
    QTimer::singleShot(200, &after, &QEventLoop::quit);
    after.exec();
    mouse(QEvent::MouseButtonRelease, arrow);
    EXPECT_EQ(boxes, 1);
    EXPECT_EQ(bar->value(), 4010);
    clickPart(QStyle::SC_ScrollBarAddLine);
    EXPECT_EQ(bar->value(), 4020);
}

}  // namespace
}  // namespace kdx::test
