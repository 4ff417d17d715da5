#include <gtest/gtest.h>

#include <QMenu>
#include <QMenuBar>
#include <QMouseEvent>
#include <QTabBar>

#include "support/windowtest.h"

namespace kdx::test {
namespace {

class MenuTest : public WindowTest {
protected:
    MenuTest() { startShipped(); }
};

TEST_F(MenuTest, TheAboutBoxHasAnEmptyTitle) {
    dialogs.expectedMessages = 1;
    action("Mnu_Info_Ueber")->trigger();
    EXPECT_EQ(dialogs.shown[0].title, QString());
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::Exclamation);
    EXPECT_EQ(dialogs.shown[0].text.toStdString(),
              "\nRDS/Stereo Remote Software for KDX-X4\n\nSupported IEEE-Interface: National Instruments\n\n"
              "VISA I/O standard\n\n");
    EXPECT_TRUE(dialogs.shown[0].preset.contains(QStringLiteral("scripted")));  // how instruments are reached
}

TEST_F(MenuTest, TheAboutBoxTellsVersionLicenceLinkAndLibraries) {
    dialogs.expectedMessages = 1;
    action("Mnu_Info_Ueber")->trigger();
    const QStringList lines = dialogs.shown[0].preset.split(QLatin1Char('\n'));
    ASSERT_EQ(lines.size(), 4);
    EXPECT_EQ(lines[0], QStringLiteral("KDX-RDS ") + QCoreApplication::applicationVersion());
    EXPECT_EQ(lines[1].toStdString(), "Lizenz: MIT");
    EXPECT_EQ(lines[2].toStdString(), "Verbindung: scripted");
    EXPECT_EQ(lines[3].toStdString().find("Bibliotheken: Qt 6."), 0U) << lines[3].toStdString();
}

TEST_F(MenuTest, WhatWasTriedInVainIsNoLinkInUse) {
    linkDescription = QStringLiteral("Built-in client; no library found:\nlibvisa.so: missing");
    start();
    dialogs.expectedMessages = 1;
    action("Mnu_Info_Ueber")->trigger();
    EXPECT_EQ(dialogs.shown[0].preset.split(QLatin1Char('\n')).at(2).toStdString(), "Verbindung: Built-in client");
    EXPECT_EQ(dialogs.shown[0].aboutDetails.toStdString(), "no library found:\nlibvisa.so: missing");
}

TEST_F(MenuTest, WithoutALanguageFileTheLanguageMenuIsStillThereToBeClicked) {
    std::filesystem::remove(folder.data() / kLanguageFile);
    start();
    const auto* menu = window->findChild<QMenu*>(QStringLiteral("Mnu_Info"));
    EXPECT_EQ(menu->title(), QString()) << "as described";
    const QRect place = window->menuBar()->actionGeometry(menu->menuAction());
    EXPECT_GE(place.width(), 10);
    EXPECT_EQ(window->menuBar()->actionAt(place.center()), menu->menuAction());
    folder.copyShipped();
    action("Mnu_Info_Sprache_D")->trigger();
    EXPECT_TRUE(menu->icon().isNull());
}

TEST_F(MenuTest, TheNoticeBoxSaysWhatTheProgramIsFor) {
    dialogs.expectedMessages = 1;
    action("Mnu_Info_Hinweis")->trigger();
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("Hinweis"));
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::Exclamation);
    EXPECT_EQ(dialogs.shown[0].text.toStdString(),
              "Programm soll RDS Parameter einstellen\nGedacht f\xC3\xBCr VRN mit Opt. X4\n");
}

TEST_F(MenuTest, TheTreeHasItsEntries) {
    const std::pair<const char*, const char*> entries[] = {{"Mnu_Info_Interface_COM", "TCPIP"},
                                                           {"Mnu_Info_Interface_IEC", "IEEE488"},
                                                           {"Mnu_Info_Ueber",
                                                            "\xC3\x9C"
                                                            "ber"},
                                                           {"Mnu_Info_Hinweis", "Hinweis"},
                                                           {"Mnu_Info_Sprache_D", "deutsch"},
                                                           {"Mnu_Info_Sprache_E", "english"},
                                                           {"Mnu_Info_Sprache_US", "english US"},
                                                           {"Mnu_Info_RDS_RBDS", "RDS /RBDS"},
                                                           {"Mnu_Info_RS232", "RS232_Set"},
                                                           {"Mnu_TMC_Edit", "TMC Edit"},
                                                           {"Mnu_Info_Log", "&Log"}};
    for (const auto& [name, caption] : entries) EXPECT_EQ(action(name)->text().toStdString(), caption) << name;
    const auto entriesOf = [this](const char* menu) {
        Lines names;
        for (const QAction* entry : window->findChild<QMenu*>(QString::fromLatin1(menu))->actions()) {
            const QObject* named = entry->menu() != nullptr ? static_cast<const QObject*>(entry->menu()) : entry;
            names.push_back(named->objectName().toStdString());
        }
        return names;
    };
    EXPECT_EQ(entriesOf("Mnu_Info"),
              (Lines{"Mnu_Info_Interface", "Mnu_Info_Ueber", "Mnu_Info_Hinweis", "Mnu_Info_Sprache",
                     "Mnu_Info_RDS_RBDS", "Mnu_Info_RS232", "Mnu_TMC_Edit"}));
    EXPECT_EQ(entriesOf("Mnu_Ansicht"), (Lines{"Mnu_Info_Log", "Mnu_Ansicht_OnAir", "Mnu_Ansicht_Vergleich",
                                               "Mnu_Ansicht_Ablauf", "", "Mnu_Ansicht_Lesen"}));
    EXPECT_EQ(entriesOf("Mnu_Info_Interface"), (Lines{"Mnu_Info_Interface_COM", "Mnu_Info_Interface_IEC"}));
    EXPECT_EQ(entriesOf("Mnu_Info_Sprache"),
              (Lines{"Mnu_Info_Sprache_D", "Mnu_Info_Sprache_E", "Mnu_Info_Sprache_US"}));
}

TEST_F(MenuTest, TheLanguageInUseIsMarked) {
    const auto marks = [this] {
        std::string marked;
        for (const char* entry : {"Mnu_Info_Sprache_D", "Mnu_Info_Sprache_E", "Mnu_Info_Sprache_US"}) {
            marked += action(entry)->isChecked() ? 'x' : '-';
        }
        return marked;
    };
    EXPECT_EQ(marks(), "x--");
    action("Mnu_Info_Sprache_D")->trigger();  // once more: the mark stays
    EXPECT_EQ(marks(), "x--");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(marks(), "-x-");
    action("Mnu_Info_Sprache_US")->trigger();
    EXPECT_EQ(marks(), "--x");
    start();
    EXPECT_EQ(marks(), "--x");
    EXPECT_EQ(text("Label10").substr(0, 12), "RDS sequence");
}

TEST_F(MenuTest, AChoiceThatCannotBeStoredIsNotMarked) {
    std::filesystem::remove(folder.data() / kGeneralSettings);
    std::filesystem::create_directory(folder.data() / kGeneralSettings);
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_TRUE(action("Mnu_Info_Sprache_D")->isChecked());
    EXPECT_FALSE(action("Mnu_Info_Sprache_E")->isChecked());
    EXPECT_EQ(text("QuietLine"), "Nicht gespeichert: RDS_Allg.INI");
}

TEST_F(MenuTest, TheIndicatorsSpeakTheLanguageAtOnceEvenWhileASessionIsOpen) {
    openSession();
    EXPECT_EQ(text("Status_10") + text("Status_0"), "ausaus");
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(text("Status_10") + text("Status_0"), "offoff");
}

TEST_F(MenuTest, TheSerialEntryDoesNothing) {
    setGeneral("BUS", "INTERFACE", "TCPIP");
    start();
    const std::string before = folder.read(kGeneralSettings);
    action("Mnu_Info_RS232")->trigger();
    EXPECT_EQ(folder.read(kGeneralSettings), before);
    EXPECT_EQ(visa.calls, Lines{});
}

TEST_F(MenuTest, ExitEndsTheProgramAtOnceWithoutAWord) {
    click("Ende_Taste");
    EXPECT_EQ(ended, 1);
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(MenuTest, ChoosingALanguageStoresItAndRelabels) {
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(general("Sprache", "Sprache"), "english");
    EXPECT_EQ(state.language, "english");
    EXPECT_EQ(text("Ende_Taste"), "E&xit");
    action("Mnu_Info_Sprache_US")->trigger();
    EXPECT_EQ(general("Sprache", "Sprache"), "english US");
    action("Mnu_Info_Sprache_D")->trigger();
    EXPECT_EQ(general("Sprache", "Sprache"), "deutsch");
    EXPECT_EQ(text("Ende_Taste"), "&Ende");
}

TEST_F(MenuTest, RelabellingShowsTheFirstPage) {
    showPage(4);
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(find<QTabWidget>("SSTab1")->currentIndex(), 0);
}

TEST_F(MenuTest, TheStandardCanBeSwitchedInEnglishOnly) {
    EXPECT_FALSE(action("Mnu_Info_RDS_RBDS")->isEnabled());
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_TRUE(action("Mnu_Info_RDS_RBDS")->isEnabled());
    const QString european = find<QComboBox>("PTY_Combo1")->itemText(5);
    action("Mnu_Info_RDS_RBDS")->trigger();
    EXPECT_EQ(general("Sprache", "RDS_RBDS"), "RBDS");
    EXPECT_NE(find<QComboBox>("PTY_Combo1")->itemText(5), european);
    EXPECT_NE(find<QComboBox>("EON_PTY_Combo")->itemText(5), european);
    EXPECT_TRUE(action("Mnu_Info_RDS_RBDS")->isChecked());
    action("Mnu_Info_RDS_RBDS")->trigger();
    EXPECT_EQ(general("Sprache", "RDS_RBDS"), "RDS");
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->itemText(5), european);
}

TEST_F(MenuTest, GermanKeepsItsProgrammeTypesInBothStandards) {
    const QString german = find<QComboBox>("PTY_Combo1")->itemText(1);
    setGeneral("Sprache", "RDS_RBDS", "RBDS");
    start();
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->itemText(1), german);
}

TEST_F(MenuTest, RelabellingSelectsTheTypesStoredInDataSet1WhateverSetIsCurrent) {
    setDataSet1("RDS", "PTY", "7");
    setDataSet1("RDS", "EON_PTY", "9");
    state.CurrentDataSet = "3";
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->currentIndex(), 7);
    EXPECT_EQ(find<QComboBox>("PTY_Combo1")->count(), 32);
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->currentIndex(), 9);
    EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->count(), 32);
}

TEST_F(MenuTest, OpeningTheGroupPageLoadsTheStoredSequenceEachTime) {
    openSession();
    showPage(3);
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,2A,0A,8A,");
    EXPECT_FALSE(enabled("Gruppe4"));
    find("Gruppe4")->setEnabled(true);
    setDataSet1("RDS", "GR_FOLGE", "0A,");
    showPage(0);
    showPage(3);
    EXPECT_EQ(text("Label10"), "Gruppenfolge:0A,");
    EXPECT_FALSE(enabled("Gruppe4"));
}

TEST_F(MenuTest, TwoPagesSetTheKindOfTheListEditorThoughTheyDoNotOpenIt) {
    showPage(3);
    EXPECT_EQ(state.afEditorKind, "AF");
    showPage(5);
    EXPECT_EQ(state.afEditorKind, "EON AF");
    showPage(2);
    EXPECT_EQ(state.afEditorKind, "EON AF");
    showPage(4);
    EXPECT_EQ(state.afEditorKind, "EON AF");
}

TEST_F(MenuTest, WithoutASessionThePagesCanBeLookedAt) {
    auto* bar = find<QTabWidget>("SSTab1")->tabBar();
    const QPointF place = bar->tabRect(6).center();
    QMouseEvent press(QEvent::MouseButtonPress, place, bar->mapToGlobal(place), Qt::LeftButton, Qt::LeftButton,
                      Qt::NoModifier);
    QCoreApplication::sendEvent(bar, &press);
    EXPECT_EQ(find<QTabWidget>("SSTab1")->currentIndex(), 6);
    EXPECT_FALSE(find("Store_Taste_0")->isEnabled());
}

}  // namespace
}  // namespace kdx::test
