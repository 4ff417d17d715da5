#include "af/eonpage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/layoutcheck.h"
#include "support/listrows.h"
#include "support/pagetest.h"
#include "ui/ticker.h"

#include <QDialog>
#include <QGroupBox>
#include <QListWidget>
#include <QSignalBlocker>
#include <QTimer>

#include <algorithm>
#include <functional>
#include <memory>
#include <ostream>
#include <string>
#include <string_view>

namespace kdx::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;
using ::testing::StartsWith;

constexpr const char* kSet = "Datenset1.INI";
constexpr const char* kQuery = R"(:STEREO:DIRECT? "EON PI?")";

template <typename Case>
std::string caseName(const ::testing::TestParamInfo<Case>& tested) {
    return tested.param.name;
}

/// The coder command inside the instrument's pass-through command.
std::string direct(const std::string& command) {
    return ":STEREO:DIRECT \"" + command + "\"";
}

class EonPageTest : public PageTest {
protected:
    EonPageTest() {
        instrument.setCaptionSource([this](int number) { return captions.text(number); });
        makePage(context);
        store("EON_PI", "D3C2");
        store("EON_PS", "RADIO 1");
        store("EON_TP", "1");
    }

    QWidget& root() override { return *page; }

    void makePage(const PageContext& with) {
        page = std::make_unique<EonPage>(with, nullptr);
        page->openEditorBy([] { FAIL() << "nobody pressed the button that opens the editor"; });
        page->label();
    }
    void store(const std::string& key, const std::string& value) { setProfile(kSet, "RDS", key, value); }
    std::string stored(const std::string& key) { return profile(kSet, "RDS", key); }
    /// Loads what is stored; the own programme then allows an announcement of the other one.
    void load() {
        page->loadDataSet();
        indicate("aus", "ein");
    }
    void indicate(std::string_view tp, std::string_view ta) {
        statusRow.show(StatusSlot::Tp, tp);
        statusRow.show(StatusSlot::Ta, ta);
    }
    std::string heldPi() const { return state.eonIdentifier; }
    /// What the other held values are, told by what a whole sending sends.
    Lines held() {
        sent();
        page->sendNetwork();
        return sent();
    }
    Lines rows() { return rowsOf(*find<QListWidget>("AFB_Liste")); }
    int chosenList() {
        for (int i = 0; i < 5; ++i) {
            if (checked(("EON_AFB_Opt_" + std::to_string(i)).c_str())) return i;
        }
        return -1;
    }
    int chosenType() { return find<QComboBox>("EON_PTY_Combo")->currentIndex(); }
    Ticker& timer() { return *find<Ticker>("EON_TA_Zeit"); }

    std::unique_ptr<EonPage> page;
};

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
    visa.answersTo[kQuery] = "\" D3C2,\"\n";
    click("EON_PI_Taste");
    EXPECT_THAT(sent(), ElementsAre(kQuery, direct("EON-DEL=D3C2"), direct("EON-PI=D3C4")));
}

TEST_F(EonPageTest, SendingThePiDeletesItEvenWhenTheCoderHoldsTheSame) {
    load();
    visa.answersTo[kQuery] = "\" D3C2,\"\n";
    click("EON_PI_Taste");
    EXPECT_THAT(sent(), ElementsAre(kQuery, direct("EON-DEL=D3C2"), direct("EON-PI=D3C2")));
}

TEST_F(EonPageTest, SendingThePiAfterAFailedQueryDeletesNothingByName) {
    load();
    visa.readStatus = visa::kTimeout;
    dialogs.expectedMessages = 1;
    click("EON_PI_Taste");
    EXPECT_THAT(sent(), ElementsAre(kQuery, direct("EON-DEL="), direct("EON-PI=D3C2")));
    EXPECT_EQ(dialogs.shown.at(0).text.toStdString(), "Fehler: -1073807339");
}

TEST_F(EonPageTest, AShortPiIsPaddedInItsOwnCommandOnly) {
    load();
    type("EON_PI_Text", "D3C");
    page->sendNetwork();
    const Lines all = sent();
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

// --- traffic announcement ---

TEST_F(EonPageTest, AnAnnouncementIsGivenForOneSecond) {
    load();
    click("EON_TA_Schalter");
    EXPECT_TRUE(checked("EON_TA_Schalter"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,1")));
    EXPECT_EQ(stored("EON_TA"), "1");
    EXPECT_TRUE(timer().isActive());
    EXPECT_EQ(timer().interval(), 1000);

    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
    EXPECT_EQ(stored("EON_TA"), "0");
    EXPECT_FALSE(timer().isActive());
}

TEST_F(EonPageTest, ASecondClickEndsTheAnnouncementBeforeItsTime) {
    load();
    click("EON_TA_Schalter");
    click("EON_TA_Schalter");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,1"), direct("EON-TA=D3C2,0")));
    EXPECT_FALSE(timer().isActive());
}

/// A language with its words and what the indicators read.
struct RefusalCase {
    const char* name;
    const char* language;
    const char* tp;
    const char* ta;
    int caption;  ///< text of the box; 0 when the announcement is given
    friend void PrintTo(const RefusalCase& refused, std::ostream* out) { *out << refused.name; }
};

class EonTaRefusal : public EonPageTest, public ::testing::WithParamInterface<RefusalCase> {};

TEST_P(EonTaRefusal, DependsOnTheOwnProgrammesIndicators) {
    const RefusalCase& the = GetParam();
    useLanguage(the.language);
    load();
    indicate(the.tp, the.ta);
    dialogs.expectedMessages = the.caption == 0 ? 0 : 1;
    click("EON_TA_Schalter");
    if (the.caption == 0) {
        EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,1")));
        return;
    }
    ASSERT_THAT(dialogs.shown, SizeIs(1));
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::Exclamation);
    EXPECT_EQ(toBytes(dialogs.shown[0].title), captions.text(167));
    EXPECT_EQ(toBytes(dialogs.shown[0].text), captions.text(the.caption));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_EQ(stored("EON_TA"), "");
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isActive());
}

INSTANTIATE_TEST_SUITE_P(
    Indicators, EonTaRefusal,
    ::testing::Values(RefusalCase{"GivenInGerman", "deutsch", "aus", "ein", 0},
                      RefusalCase{"OwnTpOnInGerman", "deutsch", "ein", "ein", 168},
                      RefusalCase{"OwnTaOffInGerman", "deutsch", "aus", "aus", 169},
                      RefusalCase{"OwnTpIsToldFirst", "deutsch", "ein", "aus", 168},
                      RefusalCase{"GivenInEnglish", "english", "off", "on", 0},
                      RefusalCase{"OwnTpOnInEnglish", "english", "on", "on", 168},
                      RefusalCase{"OwnTaOffInEnglish", "english", "off", "off", 169},
                      RefusalCase{"UsEnglishHasTheEnglishWords", "english US", "on", "on", 168},
                      RefusalCase{"UsEnglishOffWord", "english US", "off", "off", 169},
                      // Only the words of the current language count: the indicators' design texts are none of them.
                      RefusalCase{"OtherLanguagesWords", "deutsch", "on", "off", 0},
                      RefusalCase{"DesignTexts", "deutsch", "Label1", "TA", 0}),
    caseName<RefusalCase>);

TEST_F(EonPageTest, WithoutTheOthersTrafficProgrammeNothingHappensAndNothingIsSaid) {
    store("EON_TP", "0");
    load();
    click("EON_TA_Schalter");
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_EQ(stored("EON_TA"), "");
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isActive());
}

TEST_F(EonPageTest, TheOwnProgrammesStateIsToldBeforeTheOthersTrafficProgrammeCounts) {
    store("EON_TP", "0");
    load();
    indicate("ein", "ein");
    dialogs.expectedMessages = 1;
    click("EON_TA_Schalter");
    ASSERT_THAT(dialogs.shown, SizeIs(1));
    EXPECT_EQ(toBytes(dialogs.shown[0].text), captions.text(168));
}

TEST_F(EonPageTest, ARunningAnnouncementThatIsNoLongerAllowedIsRefusedAtEveryTickUntilItIs) {
    load();
    click("EON_TA_Schalter");
    sent();
    indicate("ein", "ein");
    dialogs.expectedMessages = 2;
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(dialogs.shown, SizeIs(2));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_TRUE(checked("EON_TA_Schalter"));

    indicate("aus", "ein");
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
    EXPECT_FALSE(tick("EON_TA_Zeit"));
}

TEST_F(EonPageTest, WhenTheOthersTrafficProgrammeEndsTheTimerWaitsQuietly) {
    load();
    click("EON_TA_Schalter");
    click("EON_TP_Check");
    sent();
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(sent(), IsEmpty());
    EXPECT_TRUE(timer().isActive());
    click("EON_TP_Check");
    sent();
    EXPECT_TRUE(tick("EON_TA_Zeit"));
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
}

/// Boxes that stay open for a while: the timers tick on meanwhile.
class SlowDialogs final : public Dialogs {
public:
    void message(Icon, const QString&, const QString&, const QString&) override {
        ++open;
        ++boxes;
        mostOpen = std::max(mostOpen, open);
        if (open < 5) whileOpen();
        --open;
    }
    bool messageOrStop(const QString&, const QString&) override { return false; }
    bool confirm(const QString&, const QString&) override { return false; }
    QString input(const QString&, const QString&, const QString&) override { return {}; }

    std::function<void()> whileOpen;
    int open = 0;
    int mostOpen = 0;
    int boxes = 0;
};

TEST_F(EonPageTest, ATickWhileARefusalIsOpenOpensNoSecondBox) {
    SlowDialogs slow;
    slow.whileOpen = [this] { tick("EON_TA_Zeit"); };
    makePage({params, instrument, state, statusRow, captions, slow, data, clock});
    load();
    click("EON_TA_Schalter");
    indicate("ein", "ein");
    tick("EON_TA_Zeit");
    EXPECT_EQ(slow.mostOpen, 1);
    tick("EON_TA_Zeit");
    EXPECT_EQ(slow.boxes, 2) << "the tick after the box was closed tells again";
}

// --- AF lists ---

TEST_F(EonPageTest, AnOptionShowsItsListAndStoresAndSendsNothing) {
    store("EON_AFB2", "87.6,90.1,94.3");
    load();
    const std::string before = folder.read(kSet);
    click("EON_AFB_Opt_1");
    EXPECT_EQ(text("Tuned_AFB"), "87.6");
    EXPECT_THAT(rows(), ElementsAre("90.1", "94.3"));
    EXPECT_EQ(folder.read(kSet), before);
    EXPECT_THAT(sent(), IsEmpty());
}

TEST_F(EonPageTest, AnOptionShowsTheListOfTheCurrentDataSet) {
    store("EON_AFB1", "87.6,90.1");
    setProfile("Datenset2.INI", "RDS", "EON_AFB1", "99.2,101.5");
    load();
    state.CurrentDataSet = "2";
    click("EON_AFB_Opt_0");
    EXPECT_EQ(text("Tuned_AFB"), "99.2");
}

TEST_F(EonPageTest, AListWithATunedFrequencyOnlyIsSentButNotShown) {
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB2", "99.2");
    load();
    click("EON_AFB_Opt_0");
    click("EON_AFB_Opt_1");
    EXPECT_EQ(text("Tuned_AFB"), "87.6");
    EXPECT_THAT(rows(), ElementsAre("90.1"));
    click("EON_AFB_Senden");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-AFB=D3C2,N,87.6,90.1"), direct("EON-AFB=D3C2,+,99.2")));
}

TEST_F(EonPageTest, AllListsThatAreNotEmptyAreSent) {
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB3", "99.2,101.5");
    store("EON_AFB5", "100.1,88.8");
    load();
    click("EON_AFB_Senden");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-AFB=D3C2,N,87.6,90.1"), direct("EON-AFB=D3C2,+,99.2,101.5"),
                                    direct("EON-AFB=D3C2,+,100.1,88.8")));
}

TEST_F(EonPageTest, AnEmptyFirstListDoesNotStopTheOthers) {
    store("EON_AFB2", "99.2,101.5");
    load();
    click("EON_AFB_Senden");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-AFB=D3C2,+,99.2,101.5")));
}

TEST_F(EonPageTest, ALongListIsSentAsItStands) {
    std::string list = "87.6";
    for (int i = 0; i < 25; ++i) list += ",90.1";
    store("EON_AFB1", list);
    load();
    click("EON_AFB_Senden");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-AFB=D3C2,N," + list)));
}

TEST_F(EonPageTest, EditingOpensTheEditorOnTheEonListsAndShowsTheResult) {
    store("EON_AFB", "2");
    store("EON_AFB2", "87.6,90.1");
    load();
    state.afEditorKind = "AF";
    page->openEditorBy([this] {
        EXPECT_EQ(state.afEditorKind, "EON AF");
        store("EON_AFB2", "87.7,99.9");
    });
    click("EON_AF_Bearbeiten");
    EXPECT_EQ(text("Tuned_AFB"), "87.7");
    EXPECT_THAT(rows(), ElementsAre("99.9"));
}

TEST_F(EonPageTest, TheEditorItselfEditsTheEonLists) {
    store("EON_AFB", "1");
    store("EON_AFB1", "87.6,90.1");
    store("AF_LISTE1", "98.5,99.9");
    page = std::make_unique<EonPage>(context, nullptr);  // with the editor it opens by default
    page->label();
    load();
    QTimer::singleShot(0, [] {
        auto* editor = qobject_cast<QDialog*>(QApplication::activeModalWidget());
        ASSERT_NE(editor, nullptr);
        EXPECT_EQ(editor->objectName(), QStringLiteral("AF_Listenform"));
        editor->findChild<QLineEdit*>(QStringLiteral("Text2"))->setText(QStringLiteral("94.3"));
        editor->findChild<QAbstractButton*>(QStringLiteral("Command1"))->click();
        editor->findChild<QAbstractButton*>(QStringLiteral("Uebernahme_Knopf"))->click();
    });
    click("EON_AF_Bearbeiten");
    EXPECT_EQ(stored("EON_AFB1"), "87.6,90.1,94.3");
    EXPECT_EQ(stored("AF_LISTE1"), "98.5,99.9");
    EXPECT_THAT(rows(), ElementsAre("90.1", "94.3"));
}

TEST_F(EonPageTest, EditingWithNoListChosenShowsNone) {
    store("EON_AFB1", "87.6,90.1");
    load();
    int opened = 0;
    page->openEditorBy([&opened] { ++opened; });
    click("EON_AF_Bearbeiten");
    EXPECT_EQ(opened, 1);
    EXPECT_THAT(rows(), IsEmpty());
}

// --- start-up ---

TEST_F(EonPageTest, StartUpShowsWhatDataSetOneHolds) {
    store("EON_TA", "0");
    store("EON_PTY", "7");
    store("EON_AFB", "3");
    store("EON_AFB3", "99.2,101.5");
    const std::string before = folder.read(kSet);
    timer().setEnabled(true);
    page->loadDataSet();
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
    page->loadDataSet();
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
        page->loadDataSet();
        EXPECT_EQ(chosenList(), -1) << number;
    }
}

TEST_F(EonPageTest, AnAnnouncementThatTheDataSetHoldsIsHeldWhileTheSwitchShowsOff) {
    store("EON_TA", "1");
    load();
    EXPECT_FALSE(checked("EON_TA_Schalter"));
    EXPECT_FALSE(timer().isActive());
    EXPECT_EQ(held().at(1), direct("EON-TA=D3C2,1"));
    click("EON_TA_Schalter");
    EXPECT_THAT(sent(), ElementsAre(direct("EON-TA=D3C2,0")));
    EXPECT_FALSE(checked("EON_TA_Schalter"));
}

TEST_F(EonPageTest, AnyOtherStoredAnnouncementCountsAsNone) {
    for (const char* value : {"", "0", "ein", "11"}) {
        store("EON_TA", value);
        page->loadDataSet();
        EXPECT_EQ(held().at(1), direct("EON-TA=D3C2,0")) << value;
    }
}

// --- the whole data set ---

TEST_F(EonPageTest, TheNetworkIsSentInOrder) {
    store("EON_AFB1", "87.6,90.1");
    store("EON_AFB2", "99.2,101.5");
    load();
    page->sendNetwork();
    EXPECT_THAT(sent(), ElementsAre(direct("EON-PI=D3C2"), direct("EON-TA=D3C2,0"), direct("EON-TP=D3C2,1"),
                                    direct("EON-PS=D3C2,RADIO 1 "), direct("EON-AFB=D3C2,N,87.6,90.1"),
                                    direct("EON-AFB=D3C2,+,99.2,101.5")));
}

TEST_F(EonPageTest, AllNetworksOfTheCoderAreRemoved) {
    visa.answersTo[kQuery] = "\"1234,5678\"\n";
    page->removeNetworks();
    EXPECT_THAT(sent(), ElementsAre(kQuery, direct("EON-DEL=1234"), direct("EON-DEL=5678")));
}

TEST_F(EonPageTest, AListOfNetworksThatEndsInACommaHasNoFurtherEntry) {
    visa.answersTo[kQuery] = "\" D3C2,D3C3,\"\n";
    page->removeNetworks();
    EXPECT_THAT(sent(), ElementsAre(kQuery, direct("EON-DEL=D3C2"), direct("EON-DEL=D3C3")));
}

TEST_F(EonPageTest, AFailedQueryLeadsToOneDeleteWithAnEmptyValue) {
    visa.readStatus = visa::kTimeout;
    dialogs.expectedMessages = 1;
    page->removeNetworks();
    EXPECT_THAT(sent(), ElementsAre(kQuery, direct("EON-DEL=")));
}

TEST_F(EonPageTest, TheQueryIsLoggedUnderItsName) {
    state.LogEnabled = true;
    visa.answersTo[kQuery] = "\" D3C2,\"\n";
    page->removeNetworks();
    EXPECT_THAT(folder.read("RDS_log.txt"), StartsWith("         EON-PI= :STEREO:DIRECT? \"EON PI?\"\r\n"));
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

TEST_F(EonPageTest, NothingIsCutOffInAnyLanguage) {
    store("EON_AFB", "1");
    store("EON_AFB1", "107.6,90.1,94.3,101.2");
    load();
    for (const char* language : {"deutsch", "english", "english US"}) {
        useLanguage(language);
        page->label();
        page->resize(620, 322);
        page->show();
        QApplication::processEvents();
        EXPECT_LE(page->minimumSizeHint().width(), 620) << language;
        EXPECT_LE(page->minimumSizeHint().height(), 322) << language;
        EXPECT_EQ(page->size(), QSize(620, 322)) << language;
        expectNothingCutOff(*page, language);
        for (int type = 0; type < 32; ++type) {
            const QSignalBlocker quiet(find<QComboBox>("EON_PTY_Combo"));
            find<QComboBox>("EON_PTY_Combo")->setCurrentIndex(type);
            expectNothingCutOff(*page, language);
        }
    }
}

}  // namespace
}  // namespace kdx::test
