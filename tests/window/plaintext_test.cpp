#include <gtest/gtest.h>

#include <QHelpEvent>
#include <QImage>
#include <QToolTip>

#include "support/windowtest.h"
#include "ui/clickablelabel.h"
#include "ui/qtdialogs.h"

namespace kdx::test {
namespace {

/// Markup wherever a text comes from outside: a language file that is not ours, a data set from somebody else.
class PlainTextTest : public WindowTest {
protected:
    PlainTextTest() {
        folder.copyShipped();
        std::string texts = "[deutsch]\r\n";
        for (int number = 0; number < 700; ++number) {
            texts += std::to_string(number) + "=<b>T" + std::to_string(number) + "</b>\r\n";
        }
        folder.write(kLanguageFile, texts + "[PTY-Liste_D]\r\n010=<i>Pop</i>\r\n");
        setDataSet1("RDS", "PS", "<b>PS</b>");
        setDataSet1("RDS", "RTB", "<b>second</b>");
        setGeneral("ADRESSEN", "KDX_TCPIP", "<b>lab</b>");
        start();
        openSession();
    }
    Dialogs& boxesOfWindow() override { return boxes; }

    /// Fails for each label of the window that might take its text for markup.
    static void expectPlain(const QWidget& shown, std::size_t atLeast) {
        const auto labels = shown.findChildren<QLabel*>();
        EXPECT_GE(static_cast<std::size_t>(labels.size()), atLeast);
        for (const QLabel* label : labels) {
            EXPECT_EQ(label->textFormat(), Qt::PlainText)
                << shown.objectName().toStdString() << ": " << label->objectName().toStdString() << " \""
                << label->text().toStdString() << '"';
        }
    }
    /// Opens something modal and looks at its labels.
    static void expectPlainBox(std::size_t atLeast, const std::function<void()>& open) {
        bool looked = false;
        QTimer::singleShot(0, qApp, [&] {
            QWidget* box = QApplication::activeModalWidget();
            ASSERT_NE(box, nullptr);
            looked = true;
            expectPlain(*box, atLeast);
            box->close();
        });
        open();
        EXPECT_TRUE(looked);
    }
    /// The tool tip that the control shows when the mouse rests on it.
    const QLabel* tipOf(const char* name) {
        auto* control = find(name);
        QHelpEvent rest(QEvent::ToolTip, {1, 1}, control->mapToGlobal(QPoint(1, 1)));
        QApplication::sendEvent(control, &rest);
        for (const QWidget* top : QApplication::topLevelWidgets()) {
            if (top->inherits("QTipLabel") && top->isVisible()) return qobject_cast<const QLabel*>(top);
        }
        return nullptr;
    }

    QtDialogs boxes{captions};
};

TEST_F(PlainTextTest, EveryLabelOfTheWindowAndItsPages) {
    action("Mnu_Info_Log")->trigger();  // a window of its own, and a child of the main one
    for (int page = 0; page < 9; ++page) {
        showPage(page);
        QCoreApplication::processEvents();
    }
    EXPECT_TRUE(find("LogView")->isVisible());
    expectPlain(*window, 40);
}

TEST_F(PlainTextTest, TheEditorsOfTheLists) {
    expectPlainBox(3, [this] { click("AF_Bearbeiten"); });
    expectPlainBox(3, [this] { click("EON_AF_Bearbeiten"); });
    expectPlainBox(6, [this] { action("Mnu_TMC_Edit")->trigger(); });
}

TEST_F(PlainTextTest, TheBoxes) {
    const QString text = QStringLiteral("<b>text</b>");
    expectPlainBox(2, [&] { boxes.message(Dialogs::Icon::Critical, text, text, text); });
    expectPlainBox(1, [&] { boxes.messageOrStop(text, text); });
    expectPlainBox(1, [&] { boxes.confirm(text, text); });
    expectPlainBox(1, [&] { boxes.input(text, text, text); });
    expectPlainBox(2, [this] { action("Mnu_Info_Ueber")->trigger(); });
}

TEST_F(PlainTextTest, ToolTips) {
    showPage(1);
    const QLabel* tip = tipOf("RT_Text1");
    ASSERT_NE(tip, nullptr);
    EXPECT_EQ(tip->text(), QStringLiteral("RTB: <b>second</b>"));
    EXPECT_EQ(tip->textFormat(), Qt::PlainText);
    QToolTip::hideText();
}

TEST_F(PlainTextTest, AnEntryThatCannotBeUsedLooksSoWhateverWasTyped) {
    showPage(1);
    QCoreApplication::processEvents();
    const auto letters = [this](QPalette::ColorGroup group) {
        return find("PS_T")->palette().color(group, QPalette::Text).name().toStdString();
    };
    const std::string usual = letters(QPalette::Active);
    const std::string grey =
        QApplication::palette(find("PS_T")).color(QPalette::Disabled, QPalette::Text).name().toStdString();
    ASSERT_NE(usual, grey);
    type("PS_T", "RADIO");
    EXPECT_EQ(letters(QPalette::Disabled), grey);
    type("PS_T", "RA\"DIO");
    EXPECT_EQ(letters(QPalette::Disabled), "#ff0000") << "seen before the session that would send it";
    type("PS_T", "RADIO");
    click("GTL_Taste");
    EXPECT_EQ(letters(QPalette::Disabled), grey);
}

TEST_F(PlainTextTest, NoPictureIsFetchedForACaption) {
    QImage picture(400, 400, QImage::Format_RGB32);
    picture.fill(Qt::red);
    const QString file = QString::fromStdString((folder.path() / "p.png").string());
    ASSERT_TRUE(picture.save(file));
    folder.write(kLanguageFile, "[deutsch]\r\n393=<img src=\"" + file.toStdString() + "\">\r\n");
    setDataSet1("RDS", "RTB", "<img src=\"" + file.toStdString() + "\">");
    start();
    openSession();
    showPage(1);
    EXPECT_LT(find("PS_Label")->sizeHint().height(), 100);
    const QLabel* tip = tipOf("RT_Text1");
    ASSERT_NE(tip, nullptr);
    EXPECT_LT(tip->height(), 300);
    QToolTip::hideText();
}

}  // namespace
}  // namespace kdx::test
