#include <gtest/gtest.h>

#include <QApplication>
#include <QComboBox>
#include <QImage>
#include <QVBoxLayout>
#include <QWheelEvent>

#include "settings/datafolder.h"
#include "support/tempfolder.h"
#include "ui/clickablelabel.h"
#include "ui/pictureswitch.h"
#include "ui/valuescrollbar.h"

namespace kdx {
namespace {

/// Controls that the style shows no focus on, in a window that is in use.
class FocusTest : public ::testing::Test {
protected:
    FocusTest() {
        auto* column = new QVBoxLayout(&window);
        for (QWidget* control : controls) column->addWidget(control);
        window.show();
        window.activateWindow();
        QApplication::processEvents();
    }
    bool framed(QWidget* control) const {
        const QImage picture = control->grab().toImage();
        return picture.pixelColor(1, 1) == control->palette().color(QPalette::Highlight) &&
               picture.pixelColor(picture.width() - 2, picture.height() - 2) ==
                   control->palette().color(QPalette::Highlight);
    }

    test::TempFolder folder;
    DataFolder data{folder.path()};
    QWidget window;
    std::array<QWidget*, 3> controls{new ValueScrollBar(&window), new ClickableLabel(&window),
                                     new PictureSwitch(data, &window)};
};

TEST_F(FocusTest, ItIsSeenWhereItIsAndNowhereElse) {
    for (QWidget* control : controls) {
        control->setFocus(Qt::TabFocusReason);
        for (QWidget* other : controls) EXPECT_EQ(framed(other), other == control) << other->metaObject()->className();
    }
}

TEST(WheelTest, PassesAClosedComboBox) {
    QWidget page;
    auto* combo = new QComboBox(&page);
    combo->addItems({QStringLiteral("a"), QStringLiteral("b"), QStringLiteral("c")});
    combo->setCurrentIndex(1);
    for (const bool editable : {false, true}) {
        combo->setEditable(editable);
        for (const int notch : {120, -120}) {
            QWheelEvent event({5, 5}, combo->mapToGlobal(QPoint(5, 5)), {}, {0, notch}, Qt::NoButton, Qt::NoModifier,
                              Qt::NoScrollPhase, false);
            QApplication::sendEvent(combo, &event);
            EXPECT_FALSE(event.isAccepted());
            EXPECT_EQ(combo->currentIndex(), 1);
        }
    }
}

}  // namespace
}  // namespace kdx
