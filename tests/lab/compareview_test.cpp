#include "lab/compareview.h"

#include <QHeaderView>

#include "labtest.h"
#include "support/everyfont.h"
#include "ui/clickablelabel.h"

namespace kdx::test {
namespace {

class CompareViewTest : public LabTest {
protected:
    void openView(const char* language = "deutsch") {
        open(language);
        action("Mnu_Ansicht_Vergleich")->trigger();
        view = window->findChild<CompareView*>(QStringLiteral("CompareView"));
        ASSERT_NE(view, nullptr);
        table = find<QTableWidget>("Vergleich_Tabelle");
    }
    int row(const char* setting) {
        for (int at = 0; at < table->rowCount(); ++at) {
            const QString name = table->item(at, 0)->text();
            if (name == QString::fromUtf8(setting) ||
                name.startsWith(QString::fromUtf8(setting) + QStringLiteral("  ")))
                return at;
        }
        ADD_FAILURE() << "no row " << setting;
        return 0;
    }
    /// Window, file and instrument, with a mark behind when they differ.
    std::string cells(const char* setting) {
        const int at = row(setting);
        std::string all;
        for (int column = 1; column < 4; ++column) all += table->item(at, column)->text().toStdString() + "|";
        const bool marked = table->item(at, 0)->text().contains(QChar(u'\u2260'));
        EXPECT_EQ(marked, table->item(at, 3)->foreground() != table->palette().brush(QPalette::Text));
        return all + (marked ? "!" : "");
    }

    CompareView* view = nullptr;
    QTableWidget* table = nullptr;
};

TEST_F(CompareViewTest, ShowsWindowAndFileBeforeTheInstrumentIsRead) {
    openView();
    EXPECT_EQ(table->columnCount(), 4);
    EXPECT_EQ(cells("PI"), "D7A1|D7A1|–|");
    EXPECT_EQ(taken(), Lines{});
    EXPECT_NE(text("Vergleich_Stand").find("das Gerät ist nicht gelesen"), std::string::npos);
}

TEST_F(CompareViewTest, AFreshlySentDataSetDiffersInNothing) {
    openView();
    click("Vergleich_Lesen");
    for (int at = 0; at < table->rowCount(); ++at)
        EXPECT_FALSE(table->item(at, 0)->text().contains(QChar(u'\u2260'))) << table->item(at, 0)->text().toStdString();
    EXPECT_TRUE(text("Vergleich_Stand").starts_with("0 von ")) << text("Vergleich_Stand");
}

TEST_F(CompareViewTest, MarksWhatSomebodyElseChangedInTheInstrument) {
    openView();
    send(direct("PS=FREMD"));
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("PS"), "MESSTURM|MESSTURM|FREMD|!");
    EXPECT_EQ(cells("PI"), "D7A1|D7A1|D7A1|");
    EXPECT_TRUE(text("Vergleich_Stand").starts_with("1 von ")) << text("Vergleich_Stand");
}

TEST_F(CompareViewTest, MarksWhatIsTypedInTheWindowAndNotSent) {
    openView();
    click("Vergleich_Lesen");
    type("PI_T", "D3C9");
    type("PS_T", "GETIPPT");
    QEvent activated(QEvent::WindowActivate);
    QApplication::sendEvent(view, &activated);
    EXPECT_EQ(cells("PI"), "D3C9|D7A1|D7A1|!");
    EXPECT_EQ(cells("PS"), "GETIPPT|MESSTURM|MESSTURM|!");
}

TEST_F(CompareViewTest, ShowsWhatTheCoderRefusesAsItWasTyped) {
    openView();
    type("PS_T", "TEST\"AB");
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("PS"), "TEST\"AB  (Der Coder nimmt diesen Wert nicht an.)|MESSTURM|MESSTURM|!");
    taken();
    click("Vergleich_Senden");
    EXPECT_EQ(taken(), Lines{});
}

TEST_F(CompareViewTest, MarksWhatAnotherProgramChangedInTheFile) {
    openView();
    setDataSet1("RDS", "PS", "ANDERS");
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("PS"), "MESSTURM|ANDERS|MESSTURM|!");
}

TEST_F(CompareViewTest, SendsTheSelectedRowsOfTheWindow) {
    openView();
    send(direct("PS=FREMD"));
    send(direct("PI=ABCD"));
    click("Vergleich_Lesen");
    table->selectRow(row("PS"));
    taken();
    click("Vergleich_Senden");
    EXPECT_EQ(taken(), Lines{direct("PS=MESSTURM")});
    EXPECT_EQ(cells("PS"), "MESSTURM|MESSTURM|MESSTURM|");
    EXPECT_EQ(cells("PI"), "D7A1|D7A1|ABCD|!");
}

TEST_F(CompareViewTest, SendsAllDifferencesWithoutASelection) {
    openView();
    send(direct("PS=FREMD"));
    send(direct("PI=ABCD"));
    click("Vergleich_Senden");  // reads first
    EXPECT_EQ(taken(), (Lines{direct("PI=D7A1"), direct("PS=MESSTURM")}));
    EXPECT_TRUE(text("Vergleich_Stand").starts_with("0 von ")) << text("Vergleich_Stand");
}

TEST_F(CompareViewTest, TakesOverWhatTheInstrumentHasAndSendsNothing) {
    openView();
    send(direct("PS=FREMD"));
    send(direct("PI=ABCD"));
    click("Vergleich_Lesen");
    table->selectRow(row("PS"));
    click("Vergleich_Uebernehmen");
    EXPECT_EQ(taken(), Lines{});
    EXPECT_EQ(text("PS_T"), "FREMD");
    EXPECT_EQ(profile(kSet1, "RDS", "PS"), "FREMD");
    EXPECT_EQ(text("PI_T"), "D7A1");
    EXPECT_EQ(cells("PS"), "FREMD|FREMD|FREMD|");
    table->clearSelection();
    click("Vergleich_Uebernehmen");
    EXPECT_EQ(text("PI_T"), "ABCD");
    EXPECT_EQ(taken(), Lines{});
}

TEST_F(CompareViewTest, TakesOverTheMultiplexIntoTheGeneralSettings) {
    openView();
    session->params.SendParam("PILOT_HUB", std::string("0650"));
    taken();
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("Pilottonhub").back(), '!');
    click("Vergleich_Uebernehmen");
    EXPECT_EQ(taken(), Lines{});
    EXPECT_EQ(general("FM", "PILOT_HUB"), "0650");
    EXPECT_NE(cells("Pilottonhub").back(), '!');
}

TEST_F(CompareViewTest, ANetworkThatOnlyTheInstrumentHasIsRemovedByTheWindow) {
    openView();
    send(direct("EON-PI=ABCD"));
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("EON PI  ABCD"), "–|–|ABCD|!");
    EXPECT_NE(cells("EON PS  ABCD").back(), '!');  // the network counts as one
    table->selectRow(row("EON PI  ABCD"));
    click("Vergleich_Senden");
    EXPECT_EQ(taken(), Lines{direct("EON-DEL=ABCD")});
    EXPECT_TRUE(text("Vergleich_Stand").starts_with("0 von ")) << text("Vergleich_Stand");
}

TEST_F(CompareViewTest, TakesOverAValueOfTheNetworkThatTheDataSetHas) {
    openView();
    session->params.SendParam("EON_PS", std::string("NEU"));
    taken();
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("EON PS  D7A2"), "TALWELLE|TALWELLE|NEU|!");
    click("Vergleich_Uebernehmen");
    EXPECT_EQ(taken(), Lines{});
    EXPECT_EQ(profile(kSet1, "RDS", "EON_PS"), "NEU");
    EXPECT_EQ(profile(kSet1, "RDS", "EON_PI"), "D7A2");
    EXPECT_TRUE(text("Vergleich_Stand").starts_with("0 von ")) << text("Vergleich_Stand");
}

TEST_F(CompareViewTest, TellsWhatNoFileKeeps) {
    openView();
    send(direct("TA=1"));
    click("Vergleich_Uebernehmen");
    EXPECT_EQ(cells("TA"), "0|0|1|!");
    EXPECT_NE(text("Vergleich_Stand").find("nicht übernommen, da keine Datei sie hält: 1"), std::string::npos)
        << text("Vergleich_Stand");
}

TEST_F(CompareViewTest, ShowsTheGeneratorsValueThatTheWindowShows) {
    openView();
    dialogs.inputs = {QStringLiteral("99.1")};
    emit find<ClickableLabel>("Input_HF_Freq_Label")->clicked();
    click("Vergleich_Lesen");
    EXPECT_EQ(cells("HF-Frequenz [MHz]"), "99.1|98.5|99.1|!");
}

TEST_F(CompareViewTest, ShowsListsWithoutTheWayTheyAreSent) {
    openView();
    const std::string list = profile(kSet1, "RDS", "AF_LISTE2");
    EXPECT_EQ(cells("AF Liste 2"), list + "|" + list + "|–|");
}

TEST_F(CompareViewTest, HidesWhatIsTheSameWhenOnlyDifferencesAreWanted) {
    openView();
    send(direct("PS=FREMD"));
    click("Vergleich_Lesen");
    click("Vergleich_Nur_Unterschiede");
    EXPECT_FALSE(table->isRowHidden(row("PS")));
    EXPECT_TRUE(table->isRowHidden(row("PI")));
    click("Vergleich_Nur_Unterschiede");
    EXPECT_FALSE(table->isRowHidden(row("PI")));
}

TEST_F(CompareViewTest, NothingCanBeReadOrSentWithoutASession) {
    openView();
    click("Vergleich_Lesen");
    click("GTL_Taste");
    for (const char* button : {"Vergleich_Lesen", "Vergleich_Senden", "Vergleich_Uebernehmen"})
        EXPECT_FALSE(enabled(button)) << button;
    EXPECT_EQ(cells("PI"), "D7A1|D7A1|–|");
    openSession();
    EXPECT_TRUE(enabled("Vergleich_Lesen"));
}

TEST_F(CompareViewTest, NothingIsCutOffInAnyLanguageAtAnySizeOfLetters) {
    expectNothingCutOffAnywhere([this](const char* language) -> QWidget& {
        openView(language);
        send(direct("PS=FREMD"));
        send(direct("TA=1"));
        click("Vergleich_Uebernehmen");
        QCoreApplication::processEvents();
        for (int at = 0; at < table->rowCount(); ++at) {
            EXPECT_FALSE(table->item(at, 0)->text().isEmpty()) << at;
            EXPECT_FALSE(table->item(at, 0)->text().contains(QLatin1Char('_')))
                << table->item(at, 0)->text().toStdString();
        }
        EXPECT_LE(table->horizontalHeader()->length(), table->viewport()->width());
        return *view;
    });
}

TEST_F(CompareViewTest, SpeaksTheLanguageOfTheWindow) {
    openView();
    EXPECT_EQ(table->horizontalHeaderItem(0)->text(), QStringLiteral("Einstellung"));
    action("Mnu_Info_Sprache_E")->trigger();
    EXPECT_EQ(table->horizontalHeaderItem(0)->text(), QStringLiteral("Setting"));
    EXPECT_EQ(view->windowTitle(), QStringLiteral("Compare"));
}

}  // namespace
}  // namespace kdx::test
