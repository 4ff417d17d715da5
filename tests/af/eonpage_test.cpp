#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "eonpagetest.h"

#include <QGroupBox>

namespace kdx::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

const std::string query = coder("EON PI?");

// --- PI ---

TEST_F(EonPageTest, EveryKeystrokeOfThePiIsHeldAndStored) {
    load();
    type("EON_PI_Text", "D");
    EXPECT_EQ(stored("EON_PI"), "D");
    type("EON_PI_Text", "D3C4");
    EXPECT_EQ(heldPi(), "D3C4");
    EXPECT_EQ(stored("EON_PI"), "D3C4");
    EXPECT_THAT(sent(), IsEmpty());
}

TEST_F(EonPageTest, SettingsAreStoredInTheCurrentDataSet) {
    load();
    state.CurrentDataSet = "3";
    type("EON_PI_Text", "D3C4");
    click("EON_TP_Check");
    EXPECT_EQ(profile("Datenset3.INI", "RDS", "EON_PI"), "D3C4");
    EXPECT_EQ(profile("Datenset3.INI", "RDS", "EON_TP"), "0");
    EXPECT_EQ(stored("EON_PI"), "D3C2");
}

TEST_F(EonPageTest, SendingThePiFirstDeletesTheOneTheCoderReports) {
    load();
    type("EON_PI_Text", "D3C4");
    visa.answersTo[query] = "\" D3C2,\"\n";
    click("EON_PI_Taste");
    EXPECT_THAT(sent(), ElementsAre(query, direct("EON-DEL=D3C2"), direct("EON-PI=D3C4")));
}

TEST_F(EonPageTest, TheReturnKeySendsTheEntryItIsPressedIn) {
    load();
    visa.answersTo[query] = "\" D3C2,\"\n";
    press("EON_PI_Text", Qt::Key_Return);
    type("EON_PS_Text", "RADIO 2");
    press("EON_PS_Text", Qt::Key_Return);
    EXPECT_THAT(sent(),
                ElementsAre(query, direct("EON-DEL=D3C2"), direct("EON-PI=D3C2"), direct("EON-PS=D3C2,RADIO 2 ")));
}

TEST_F(EonPageTest, AnEntryTellsWhetherTheCoderHasIt) {
    load();
    const auto stateOf = [this](const char* name) { return find(name)->property("zustand").toString().toStdString(); };
    EXPECT_EQ(stateOf("EON_PI_Text"), "ungesendet");
    visa.answersTo[query] = "\" D3C2,\"\n";
    click("EON_PI_Taste");
    EXPECT_EQ(stateOf("EON_PI_Text"), "");
    click("EON_PS_Taste");
    EXPECT_EQ(stateOf("EON_PS_Text"), "");
    type("EON_PS_Text", "A^B");
    EXPECT_EQ(stateOf("EON_PS_Text"), "ungesendet");
    click("EON_PS_Taste");
    EXPECT_EQ(stateOf("EON_PS_Text"), "abgelehnt");
    type("EON_PI_Text", "D3");
    page->stepGoesOut(parameter("EON_PI", "D3"));
    EXPECT_EQ(stateOf("EON_PI_Text"), "abgelehnt");
    EXPECT_EQ(stateOf("EON_PS_Text"), "ungesendet") << "the new network has no name yet";
    page->stepGoesOut(parameter("EON_PS", "A^B"));
    EXPECT_EQ(stateOf("EON_PS_Text"), "abgelehnt");
}

TEST_F(EonPageTest, SendingThePiDeletesItEvenWhenTheCoderHoldsTheSame) {
    load();
    visa.answersTo[query] = "\" D3C2,\"\n";
    click("EON_PI_Taste");
    EXPECT_THAT(sent(), ElementsAre(query, direct("EON-DEL=D3C2"), direct("EON-PI=D3C2")));
}

TEST_F(EonPageTest, SendingThePiAfterAFailedQueryDeletesNothingByName) {
    load();
    visa.readStatus = visa::kTimeout;
    dialogs.expectedMessages = 1;
    click("EON_PI_Taste");
    EXPECT_THAT(sent(), ElementsAre(query, direct("EON-DEL="), direct("EON-PI=D3C2")));
    EXPECT_EQ(dialogs.shown.at(0).text.toStdString(), "Fehler: -1073807339");
}

TEST_F(EonPageTest, AShortPiIsPaddedInItsOwnCommandOnly) {
    load();
    type("EON_PI_Text", "D3C");
    const Lines all = held();
    EXPECT_EQ(all.at(0), direct("EON-PI=D3C "));
    EXPECT_EQ(all.at(1), direct("EON-TA=D3C,0"));
    EXPECT_EQ(heldPi(), "D3C");
}

// --- PS ---

TEST_F(EonPageTest, ThePsIsStoredAndSentWhenItsButtonIsPressed) {
    load();
    type("EON_PS_Text", "RADIO 2");
    EXPECT_EQ(stored("EON_PS"), "RADIO 1");
    EXPECT_THAT(sent(), IsEmpty());
    click("EON_PS_Taste");
    EXPECT_EQ(stored("EON_PS"), "RADIO 2");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-PS=D3C2,RADIO 2 ")));
}

TEST_F(EonPageTest, ALongPsIsStoredWholeAndSentCut) {
    load();
    type("EON_PS_Text", "ÄBCDEFGHIJ");
    click("EON_PS_Taste");
    EXPECT_EQ(stored("EON_PS"),
              "\xC4"
              "BCDEFGHIJ");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-PS=D3C2,\xC4"
                                           "BCDEFGH")));
}

TEST_F(EonPageTest, APsThatIsTypedOnlyGoesOutWithTheWholeNetwork) {
    load();
    type("EON_PS_Text", "NEU");
    EXPECT_EQ(held().at(3), direct("EON-PS=D3C2,NEU     "));
}

// --- programme type ---

TEST_F(EonPageTest, TheChosenProgrammeTypesNameIsSentUnderTheKeyOfThePi) {
    load();
    select("EON_PTY_Combo", 10);
    const std::string name = captions.programmeType(10);
    EXPECT_EQ(stored("EON_PTY"), name);
    EXPECT_THAT(sent(), ElementsAre(direct("EON-PI=" + (name + "    ").substr(0, 4))));
    EXPECT_EQ(heldPi(), "D3C2") << "the network stays the one it was";
    EXPECT_EQ(stored("EON_PI"), "D3C2");
}

TEST_F(EonPageTest, ATypeStoredByNameShowsTheFirstEntryAfterARelabelling) {
    load();
    select("EON_PTY_Combo", 10);
    page->label();
    EXPECT_EQ(chosenType(), 0);
    EXPECT_EQ(stored("EON_PTY"), captions.programmeType(10)) << "labelling stores nothing";
}

TEST_F(EonPageTest, LabellingShowsTheTypeThatDataSetOneStoresWhateverSetIsCurrent) {
    state.CurrentDataSet = "2";
    setProfile("Datenset2.INI", "RDS", "EON_PTY", "4");
    store("EON_PTY", "31");
    page->label();
    EXPECT_EQ(chosenType(), 31);
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_EQ(stored("EON_PTY"), "31");
}

TEST_F(EonPageTest, ANumberThatIsNoTypeShowsNone) {
    for (const char* number : {"32", "-1", "1e300", "-1e300"}) {
        store("EON_PTY", number);
        page->label();
        EXPECT_EQ(chosenType(), -1) << number;
    }
    EXPECT_THAT(sent(), IsEmpty());
}

TEST_F(EonPageTest, TheTypesFollowLanguageAndStandard) {
    const auto first = [this](int type) {
        page->label();
        EXPECT_EQ(find<QComboBox>("EON_PTY_Combo")->count(), 32);
        return find<QComboBox>("EON_PTY_Combo")->itemText(type).toStdString();
    };
    useLanguage("deutsch", "RBDS");
    const std::string german = first(4);
    EXPECT_EQ(german, "Sport");
    useLanguage("english", "RDS");
    const std::string english = first(5);
    useLanguage("english", "RBDS");
    EXPECT_NE(first(5), english);
}

// --- traffic programme ---

TEST_F(EonPageTest, TheTrafficProgrammeFlagIsStoredAndSentAtOnce) {
    load();
    click("EON_TP_Check");
    EXPECT_EQ(stored("EON_TP"), "0");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TP=D3C2,0")));
    click("EON_TP_Check");
    EXPECT_EQ(stored("EON_TP"), "1");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TP=D3C2,1")));
}

// --- start-up ---

TEST_F(EonPageTest, StartUpShowsWhatDataSetOneHolds) {
    store("EON_TA", "0");
    store("EON_PTY", "7");
    store("EON_AFB", "3");
    store("EON_AFB3", "99.2,101.5");
    const std::string before = folder.read(kSet);
    timer().setEnabled(true);
    startUp();
    EXPECT_EQ(text("EON_PI_Text"), "D3C2");
    EXPECT_EQ(heldPi(), "D3C2");
    EXPECT_EQ(text("EON_PS_Text"), "RADIO 1");
    EXPECT_TRUE(checked("EON_TP_Check"));
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isEnabled());
    EXPECT_EQ(chosenType(), 7);
    EXPECT_EQ(chosenList(), 2);
    EXPECT_EQ(text("Tuned_AFB"), "99.2");
    EXPECT_THAT(rows(), ElementsAre("101.5"));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_EQ(folder.read(kSet), before);
}

TEST_F(EonPageTest, StartUpWithAnEmptyDataSetShowsEmptyEntries) {
    folder.write(kSet, "");
    startUp();
    EXPECT_EQ(text("EON_PI_Text"), "");
    EXPECT_EQ(text("EON_PS_Text"), "");
    EXPECT_FALSE(checked("EON_TP_Check"));
    EXPECT_EQ(chosenType(), 0);
    EXPECT_EQ(chosenList(), -1);
    EXPECT_EQ(folder.read(kSet), "");
    EXPECT_THAT(held(), ElementsAre(direct("EON-PI=    "), direct("EON-TA=,0"), direct("EON-TP=,0"),
                                    direct("EON-PS=,        ")));
}

TEST_F(EonPageTest, AListNumberThatIsNoOptionChoosesNone) {
    for (const char* number : {"0", "6", "1.5", "x"}) {
        store("EON_AFB", number);
        startUp();
        EXPECT_EQ(chosenList(), -1) << number;
    }
}

// --- captions and layout ---

TEST_F(EonPageTest, CaptionsAreTheDesignTextsInGerman) {
    EXPECT_EQ(text("EON_PI_Label"), "EON PI");
    EXPECT_EQ(text("EON_PS_LABEL"), "EON PS");
    EXPECT_EQ(text("EON_PTY_LAbel"), "EON PTY");
    EXPECT_EQ(text("EON_TA_Label"), "EON TA");
    EXPECT_EQ(text("EON_TP_Check"), "    EON TP");
    EXPECT_EQ(find("EON_TP_Check")->toolTip().toStdString(), "TP OtherNet");
    EXPECT_EQ(find("EON_TA_Schalter")->toolTip().toStdString(), "Gibt den Start EON");
    EXPECT_EQ(text("EON_PI_Taste"), "senden");
    EXPECT_EQ(text("EON_PS_Taste"), "senden");
    EXPECT_EQ(text("EON_AFB_Senden"), "senden");
    EXPECT_EQ(text("EON_AF_Bearbeiten"), "&bearbeiten");
    EXPECT_EQ(find<QGroupBox>("Frame3")->title().toStdString(), "EON AF Listen");
    for (int i = 0; i < 5; ++i) {
        const std::string number = std::to_string(i + 1);
        EXPECT_EQ(text(("EON_AFB_Opt_" + std::to_string(i)).c_str()), "Liste " + number);
    }
}

TEST_F(EonPageTest, RelabellingKeepsWhatIsShown) {
    store("EON_AFB", "1");
    store("EON_AFB1", "87.6,90.1");
    load();
    type("EON_PS_Text", "NEU");
    click("EON_TA_Schalter");
    useLanguage("english");
    page->label();
    EXPECT_EQ(text("EON_AFB_Opt_0"), "List 1");
    EXPECT_EQ(text("EON_PI_Text"), "D3C2");
    EXPECT_EQ(text("EON_PS_Text"), "NEU");
    EXPECT_TRUE(checked("EON_TP_Check"));
    EXPECT_TRUE(checked("EON_TA_Schalter"));
    EXPECT_EQ(chosenList(), 0);
    EXPECT_EQ(text("Tuned_AFB"), "87.6");
}

TEST_F(EonPageTest, ControlsWithoutATextOfTheirOwnHaveAName) {
    for (const char* name :
         {"EON_PI_Text", "EON_PS_Text", "EON_PTY_Combo", "EON_TA_Schalter", "Tuned_AFB", "AFB_Liste"}) {
        EXPECT_FALSE(find(name)->accessibleName().isEmpty()) << name;
    }
}

TEST_F(EonPageTest, ButtonsOfTheSameTextAreNamedWithWhatTheySend) {
    EXPECT_EQ(find("EON_PI_Taste")->accessibleName().toStdString(), "EON PI senden");
    EXPECT_EQ(find("EON_PS_Taste")->accessibleName().toStdString(), "EON PS senden");
    EXPECT_EQ(find("EON_AFB_Senden")->accessibleName().toStdString(), "EON AF Listen senden");
}

}  // namespace
}  // namespace kdx::test
