#include <gtest/gtest.h>

#include <QMenu>
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
    EXPECT_EQ(dialogs.shown[0].preset, QStringLiteral("scripted"));  // how instruments are reached
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
                                                           {"Mnu_Info_Log", "Log"}};
    for (const auto& [name, caption] : entries) EXPECT_EQ(action(name)->text().toStdString(), caption) << name;
    const auto* info = window->findChild<QMenu*>(QStringLiteral("Mnu_Info"));
    EXPECT_EQ(info->actions().size(), 8);
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
