// Menus, keys and tips as on every desktop, and the window's place.
#include <gtest/gtest.h>

#include <QMenu>
#include <QMenuBar>

#include <set>

#include "support/realkey.h"
#include "support/windowtest.h"

namespace kdx::test {
namespace {

class DesktopTest : public WindowTest {
protected:
    DesktopTest() { folder.copyShipped(); }
    void key(const QKeySequence& keys) { pressKey(*window, keys); }
    QMenu* menu(const char* name) { return window->findChild<QMenu*>(QString::fromLatin1(name)); }
    int page() { return find<QTabWidget>("SSTab1")->currentIndex(); }
};

TEST_F(DesktopTest, TheMenuBarHasTheMenusOfADesktopBesideTheDescribedOne) {
    start();
    QStringList titles;
    for (const QAction* entry : window->menuBar()->actions()) titles << entry->text().remove(QLatin1Char('&'));
    EXPECT_EQ(titles.join(QLatin1Char(' ')).toStdString(), "Info Datei Ansicht Einstellungen... Hilfe");
    EXPECT_TRUE(menu("Mnu_Datei")->actions().contains(menu("Mnu_Datensatz")->menuAction()));
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(menu("Mnu_Datei")->title().toStdString(), "&File");
    EXPECT_EQ(menu("Mnu_Datensatz_Sichern")->title().toStdString(), "&Save as set");
}

TEST_F(DesktopTest, NoMnemonicOfTheMenuBarIsAlsoOneOfAButton) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        setGeneral("Sprache", "Sprache", language);
        start();
        std::set<QString> taken;
        for (const QAbstractButton* button : window->findChildren<QAbstractButton*>())
            taken.insert(QKeySequence::mnemonic(button->text()).toString());
        for (const QAction* entry : window->menuBar()->actions()) {
            const QString key = QKeySequence::mnemonic(entry->text()).toString();
            EXPECT_TRUE(taken.insert(key).second) << language << " " << key.toStdString();
        }
    }
}

TEST_F(DesktopTest, CtrlAndADigitOpenThePages) {
    start();
    openSession();
    for (int i = 8; i >= 0; --i) {
        key(QKeySequence(Qt::CTRL | static_cast<Qt::Key>(Qt::Key_1 + i)));
        EXPECT_EQ(page(), i);
    }
}

TEST_F(DesktopTest, CtrlQClosesTheWindow) {
    start();
    key(QKeySequence(Qt::CTRL | Qt::Key_Q));
    EXPECT_FALSE(window->isVisible());
}

TEST_F(DesktopTest, CtrlSShowsTheSetsToSaveAs) {
    start();
    key(QKeySequence(Qt::CTRL | Qt::Key_S));
    EXPECT_TRUE(menu("Mnu_Datensatz_Sichern")->isVisible());
    EXPECT_EQ(menu("Mnu_Datensatz_Sichern")->actions().at(0)->text().toStdString(), "Sichern als Satz");
    menu("Mnu_Datensatz_Sichern")->hide();
}

TEST_F(DesktopTest, TheKeysOfTheMenusAreNamedAsOnTheKeyboard) {
    for (const auto& [language, open, save] : {std::tuple("deutsch", "Strg+O", "Strg+S"),
                                               {"english", "Ctrl+O", "Ctrl+S"},
                                               {"english US", "Ctrl+O", "Ctrl+S"}}) {
        setGeneral("Sprache", "Sprache", language);
        start();
        const auto shown = [](const QAction* entry) {
            return entry->shortcut().toString(QKeySequence::NativeText).toStdString();
        };
        EXPECT_EQ(shown(action("Mnu_Datensatz_Oeffnen")), open);
        EXPECT_EQ(shown(menu("Mnu_Datensatz_Sichern")->menuAction()), save);
    }
    EXPECT_EQ(QKeySequence(Qt::SHIFT | Qt::Key_F1).toString(QKeySequence::NativeText), QStringLiteral("Shift+F1"));
    action("Mnu_Info_Sprache_D")->trigger();
    EXPECT_EQ(QKeySequence(Qt::SHIFT | Qt::Key_F1).toString(QKeySequence::NativeText), QStringLiteral("Umschalt+F1"));
}

TEST_F(DesktopTest, EveryEntryOfTheViewMenuHasAMnemonicOfItsOwn) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        setGeneral("Sprache", "Sprache", language);
        start();
        std::set<QString> taken;
        for (const QAction* entry : menu("Mnu_Ansicht")->actions()) {
            if (entry->isSeparator()) continue;
            const QString key = QKeySequence::mnemonic(entry->text()).toString();
            EXPECT_FALSE(key.isEmpty()) << language << ' ' << entry->text().toStdString();
            EXPECT_TRUE(taken.insert(key).second) << language << ' ' << entry->text().toStdString();
        }
    }
}

TEST_F(DesktopTest, AClickOnTheNumberOfTheSetShowsAllSets) {
    start();
    press("Datensatz_Anzeige", Qt::Key_Space);
    EXPECT_TRUE(menu("Mnu_Datensatz")->isVisible());
    menu("Mnu_Datensatz")->hide();
}

TEST_F(DesktopTest, F5AsksEverythingBackAndShowsAllAnswers) {
    visa.answersTo[":STEREO:DIRECT? \"PS\""] = "\"MESSTURM\"\n";
    visa.answersTo[":STEREO:DIRECT? \"PI\""] = "\"D7A1\"\n";
    start();
    key(QKeySequence(Qt::Key_F5));
    EXPECT_EQ(sent(), Lines{}) << "no session";
    openSession();
    visa.written.clear();
    dialogs.expectedMessages = 36;  // what the scripted instrument does not know
    key(QKeySequence(Qt::Key_F5));
    EXPECT_EQ(page(), 5);
    EXPECT_EQ(sent().size(), 38U);
    const std::string shown = text("gelesen");
    EXPECT_NE(shown.find("MESSTURM"), std::string::npos) << shown;
    EXPECT_NE(shown.find("D7A1"), std::string::npos) << shown;
}

TEST_F(DesktopTest, WhatF5AsksCanBeStopped) {
    start();
    openSession();
    visa.written.clear();
    visa.writeStatus = -1073807343;
    dialogs.stopAtFailure = true;
    dialogs.expectedMessages = 1;
    key(QKeySequence(Qt::Key_F5));
    EXPECT_EQ(sent().size(), 1U);
}

TEST_F(DesktopTest, AboutIsAlsoUnderHelp) {
    start();
    dialogs.expectedMessages = 1;
    action("Mnu_Hilfe_Ueber")->trigger();
    EXPECT_EQ(dialogs.shown[0].title, QString());
}

TEST_F(DesktopTest, TheWindowRemembersPageAndPlace) {
    placeFile = folder.path() / "config" / "window.ini";
    start();
    EXPECT_EQ(page(), 0);
    window->resize(800, 600);
    showPage(4);
    start();
    EXPECT_EQ(page(), 4);
    EXPECT_EQ(window->size(), QSize(800, 600));
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(page(), 0) << "labelling shows the first page, as described";
    placeFile.clear();
    start();
    EXPECT_EQ(page(), 0);
}

TEST_F(DesktopTest, APlaceThatCannotBeReadIsPassedOver) {
    placeFile = folder.path() / "window.ini";
    folder.write("../window.ini", "[window]\nplace=garbage\npage=77\n");
    start();
    EXPECT_EQ(page(), 0);
    EXPECT_EQ(window->size(), QSize(640, 480));
}

}  // namespace
}  // namespace kdx::test
