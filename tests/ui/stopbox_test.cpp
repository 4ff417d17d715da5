#include "ui/qtdialogs.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QKeyEvent>
#include <QMessageBox>
#include <QPushButton>
#include <QTimer>

#include <functional>

#include "settings/captions.h"
#include "settings/datafolder.h"
#include "support/tempfolder.h"

namespace kdx::test {
namespace {

class StopBoxTest : public ::testing::Test {
protected:
    StopBoxTest() {
        folder.copyShipped();
        captions.load("deutsch", "RDS");
    }
    /// Does something with the box that opens next, once it is there.
    static void whenOpen(const std::function<void(QMessageBox& box)>& act) {
        QTimer::singleShot(0, qApp, [act] {
            auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            ASSERT_NE(box, nullptr);
            act(*box);
        });
    }
    static void press(const QMessageBox& box, const char* caption) {
        for (QAbstractButton* button : box.buttons()) {
            if (button->text() == QLatin1String(caption)) return button->click();
        }
        FAIL() << "no button " << caption;
    }
    bool askMessageOrStop() {
        return dialogs.messageOrStop(QStringLiteral("Interface Error"), QStringLiteral("Fehler: -1073807194"));
    }

    TempFolder folder;
    DataFolder data{folder.path()};
    Captions captions{data};
    QtDialogs dialogs{captions};
};

TEST_F(StopBoxTest, AFailureInASequenceKeepsItsLookAndGainsAButton) {
    whenOpen([](QMessageBox& box) {
        EXPECT_EQ(box.windowTitle(), QStringLiteral("Interface Error"));
        EXPECT_EQ(box.text(), QStringLiteral("Fehler: -1073807194"));
        EXPECT_EQ(box.icon(), QMessageBox::Critical);
        EXPECT_EQ(box.buttons().size(), 2);
        EXPECT_EQ(box.defaultButton()->text(), QStringLiteral("OK"));
        press(box, "OK");
    });
    EXPECT_FALSE(askMessageOrStop());
}

TEST_F(StopBoxTest, TheSecondButtonStopsTheSequence) {
    whenOpen([](QMessageBox& box) { press(box, "&Rest abbrechen"); });
    EXPECT_TRUE(askMessageOrStop());
}

TEST_F(StopBoxTest, EscapeDoesNotStopTheSequence) {
    whenOpen([](QMessageBox& box) {
        QKeyEvent escape(QEvent::KeyPress, Qt::Key_Escape, Qt::NoModifier);
        QApplication::sendEvent(&box, &escape);
    });
    EXPECT_FALSE(askMessageOrStop());
}

TEST_F(StopBoxTest, TheSecondButtonSpeaksTheCurrentLanguage) {
    captions.load("english", "RDS");
    whenOpen([](QMessageBox& box) {
        EXPECT_EQ(box.buttons().size(), 2);
        for (const QAbstractButton* button : box.buttons())
            EXPECT_NE(button->text(), QStringLiteral("&Rest abbrechen"));
        press(box, "OK");
    });
    EXPECT_FALSE(askMessageOrStop());
}

TEST_F(StopBoxTest, ASingleFailureHasOneButton) {
    whenOpen([](QMessageBox& box) {
        EXPECT_EQ(box.icon(), QMessageBox::Critical);
        EXPECT_EQ(box.buttons().size(), 1);
        press(box, "OK");
    });
    dialogs.message(Dialogs::Icon::Critical, QStringLiteral("Interface Error"), QStringLiteral("Fehler: 1"));
}

}  // namespace
}  // namespace kdx::test
