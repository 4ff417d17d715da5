#include "af/afpage.h"

#include <gtest/gtest.h>

#include "frequencylists.h"
#include "support/listrows.h"
#include "support/pagetest.h"

#include <QDialog>
#include <QListWidget>
#include <QTimer>

namespace kdx {
namespace {

using test::direct;
using test::kSet1;
using test::Lines;
using test::listOf;

class AfPageTest : public test::PageTest {
protected:
    AfPageTest() { page.label(); }
    QWidget& root() override { return page; }

    void setList(int number, const std::string& list, const char* file = kSet1) {
        setProfile(file, "RDS", "AF_LISTE" + std::to_string(number), list);
    }
    Lines rows() { return test::rowsOf(*find<QListWidget>("AF_List1")); }
    int chosenList() {
        for (int i = 0; i < 5; ++i) {
            if (checked(("AFList_Opt_" + std::to_string(i)).c_str())) return i;
        }
        return -1;
    }
    static std::string pairsOf(int count) {
        std::string list = "98.5";
        for (int i = 0; i < count; ++i) list += ",98.5,90." + std::to_string(i % 10);
        return list;
    }

    /// Start-up: the data set's lists first, then the page.
    void load() {
        lists.load(settings);
        page.load();
    }

    AfListSet lists;
    AfPage page{context, lists, nullptr};
};

TEST_F(AfPageTest, ChoosingAListShowsItAndStoresItsNumber) {
    setList(3, "87.6,90.1,94.3");
    click("AFList_Opt_2");
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE"), "3");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(AfPageTest, ClickingTheChosenListAgainReadsItAnew) {
    setList(1, "87.6,90.1");
    click("AFList_Opt_0");
    setList(1, "100.1,88.0");
    click("AFList_Opt_0");
    EXPECT_EQ(text("AF_TN"), "100.1");
    EXPECT_EQ(rows(), Lines{"88.0"});
}

TEST_F(AfPageTest, ListsComeFromTheCurrentDataSet) {
    state.CurrentDataSet = "4";
    setList(5, "87.6,90.1", "Datenset4.INI");
    click("AFList_Opt_4");
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(profile("Datenset4.INI", "RDS", "AF_LISTE"), "5");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE"), "");
}

TEST_F(AfPageTest, AListWithATunedFrequencyOnlyIsNotShown) {
    setList(1, "87.6,90.1");
    setList(2, "100.1");
    click("AFList_Opt_0");
    click("AFList_Opt_1");
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines{"90.1"});
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE"), "2");
}

TEST_F(AfPageTest, StartUpShowsTheListOfDataSetOneAndChoosesMethodA) {
    setProfile(kSet1, "RDS", "AF_LISTE", "4");
    setList(4, "87.6,90.1");
    const std::string before = folder.read(kSet1);
    load();
    EXPECT_EQ(chosenList(), 3);
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines{"90.1"});
    EXPECT_TRUE(checked("AFMethod_opt_0"));
    EXPECT_FALSE(checked("AFMethod_opt_1"));
    EXPECT_EQ(folder.read(kSet1), before);
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(AfPageTest, WithoutAStoredNumberStartUpShowsListOne) {
    setList(1, "87.6,90.1");
    load();
    EXPECT_EQ(chosenList(), 0);
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE"), "");
}

TEST_F(AfPageTest, AStoredNumberThatNoListHasChoosesNone) {
    setList(1, "87.6,90.1");
    for (const char* number : {"0", "6", "-1", "abc", "1.5", "1e999"}) {
        setProfile(kSet1, "RDS", "AF_LISTE", number);
        load();
        EXPECT_EQ(chosenList(), -1) << number;
        EXPECT_EQ(text("AF_TN"), "") << number;
    }
}

TEST_F(AfPageTest, SendingWithMethodASendsAllListsInTheirOrder) {
    load();
    setList(1, "87.6,90.1,94.3");
    setList(2, "99.2,101.5");
    setList(3, "88");
    setList(4, "89.1,90.123");
    setList(5, "90,91,92");
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines({direct("AF=N,87.6,90.1,94.3"), direct("AF=+,99.2,101.5"), direct("AF=+,88"),
                             direct("AF=+,89.1,90.123"), direct("AF=+,90,91,92")}));
}

TEST_F(AfPageTest, SendingWithMethodBSendsPairs) {
    load();
    click("AFMethod_opt_1");
    setList(1, "87.6,90.1,94.3");
    setList(4, "99.2,101.5");
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines({direct("AF=N,87.6,87.6,90.1,87.6,94.3"), direct("AF=+,99.2,99.2,101.5")}));
}

TEST_F(AfPageTest, WithoutListOneNothingIsSent) {
    setList(2, "99.2,101.5");
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(AfPageTest, AListWithATunedFrequencyOnlyIsSentThoughNotShown) {
    setList(1, "87.6");
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines{direct("AF=N,87.6")});
}

TEST_F(AfPageTest, ListsAreSentFromTheCurrentDataSet) {
    state.CurrentDataSet = "2";
    setList(1, "87.6,90.1", "Datenset2.INI");
    setList(1, "100.1,88.0");
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines{direct("AF=N,87.6,90.1")});
}

TEST_F(AfPageTest, TwelveAfsGoWithMethodB) {
    click("AFMethod_opt_1");
    setList(1, listOf(12));
    setList(2, listOf(12));
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines({direct("AF=N," + pairsOf(12)), direct("AF=+," + pairsOf(12))}));
}

TEST_F(AfPageTest, ThirteenAfsAreRefusedWithMethodBAndTheOtherListsAreStillAdded) {
    click("AFMethod_opt_1");
    setList(1, listOf(13));
    setList(2, "99.2,101.5");
    setList(3, listOf(20));
    setList(5, "88.0,89.0");
    dialogs.expectedMessages = 2;
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines({direct("AF=+,99.2,99.2,101.5"), direct("AF=+,88.0,88.0,89.0")}));
    ASSERT_EQ(dialogs.shown.size(), 2U);
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("Liste Nr.1 ungültig"));
    EXPECT_EQ(dialogs.shown[0].text,
              QStringLiteral("Es ist nicht möglich mehr als 12 AFs mit Methode B zu übertragen"));
    EXPECT_EQ(dialogs.shown[0].icon, Dialogs::Icon::None);
    EXPECT_EQ(dialogs.shown[1].title, QStringLiteral("Liste Nr.3 ungültig"));
    EXPECT_EQ(dialogs.shown[1].text, dialogs.shown[0].text);
}

TEST_F(AfPageTest, TheRefusalIsEnglishInEnglishOnly) {
    click("AFMethod_opt_1");
    setList(1, listOf(13));
    dialogs.expectedMessages = 2;
    useLanguage("english");
    click("Taste_AF_Senden");
    EXPECT_EQ(dialogs.shown[0].title, QStringLiteral("List Nr.1 invalid"));
    EXPECT_EQ(dialogs.shown[0].text, QStringLiteral("It is not possible to transmit more than 12 AFs with Method B"));
    useLanguage("english US");
    click("Taste_AF_Senden");
    EXPECT_EQ(dialogs.shown[1].title, QStringLiteral("Liste Nr.1 ungültig"));
}

TEST_F(AfPageTest, ARefusedListIsToldWhenItsTurnComesInARunningSequenceToo) {
    dialogs.expectedMessages = 1;
    page.stepGoesOut({Step::Kind::Refused, "AF4", listOf(13)});
    EXPECT_EQ(dialogs.shown.at(0).title, QStringLiteral("Liste Nr.4 ungültig"));
    page.stepGoesOut({Step::Kind::Parameter, "AF4", "+,87.6"});
    page.stepGoesOut({Step::Kind::Refused, "TA", "1"});
    EXPECT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(AfPageTest, TheDataSetHoldsTheChosenMethodAndTheListsAsTheyAreShown) {
    load();
    EXPECT_EQ(lists.method, AfMethod::A);
    click("AFMethod_opt_1");
    EXPECT_EQ(lists.method, AfMethod::B);
    click("AFMethod_opt_0");
    EXPECT_EQ(lists.method, AfMethod::A);
    setList(2, "87.6,90.1");
    click("AFList_Opt_1");
    EXPECT_EQ(lists.lists.at(1), "87.6,90.1");
}

TEST_F(AfPageTest, MethodAHasNoLimit) {
    click("AFMethod_opt_0");
    setList(1, listOf(40));
    click("Taste_AF_Senden");
    EXPECT_EQ(sent(), Lines{direct("AF=N," + listOf(40))});
}

TEST_F(AfPageTest, TheEditorOpensOnTheAfListsAndTheChosenListIsShownAgain) {
    setProfile(kSet1, "RDS", "AF_LISTE", "2");
    setList(2, "87.6,90.1");
    load();
    state.afEditorKind = "EON AF";
    page.openEditorBy([this] {
        EXPECT_EQ(state.afEditorKind, "AF");
        setList(2, "100.1,88.0,89.0");
    });
    click("AF_Bearbeiten");
    EXPECT_EQ(chosenList(), 1);
    EXPECT_EQ(text("AF_TN"), "100.1");
    EXPECT_EQ(rows(), Lines({"88.0", "89.0"}));
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(AfPageTest, AListEmptiedInTheEditorStaysInView) {
    setList(1, "87.6,90.1");
    load();
    page.openEditorBy([this] { setList(1, "100.1"); });
    click("AF_Bearbeiten");
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines{"90.1"});
}

TEST_F(AfPageTest, TheEditorOpensWhenNoListIsChosen) {
    bool opened = false;
    page.openEditorBy([&opened] { opened = true; });
    click("AF_Bearbeiten");
    EXPECT_TRUE(opened);
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE"), "");
}

TEST_F(AfPageTest, TheEditorIsAWindowOfItsOwnThatBlocksThisOne) {
    setList(1, "87.6,90.1");
    load();
    page.show();
    bool edited = false;
    QTimer::singleShot(0, [&edited] {
        auto* editor = qobject_cast<QDialog*>(QApplication::activeModalWidget());
        ASSERT_NE(editor, nullptr);
        EXPECT_EQ(editor->objectName(), QStringLiteral("AF_Listenform"));
        editor->findChild<QLineEdit*>(QStringLiteral("Text2"))->setText(QStringLiteral("94.3"));
        editor->findChild<QAbstractButton*>(QStringLiteral("Command1"))->click();
        editor->findChild<QAbstractButton*>(QStringLiteral("Uebernahme_Knopf"))->click();
        edited = true;
    });
    click("AF_Bearbeiten");
    EXPECT_TRUE(edited);
    EXPECT_EQ(rows(), Lines({"90.1", "94.3"}));
    EXPECT_EQ(profile(kSet1, "RDS", "AF_LISTE1"), "87.6,90.1,94.3");
}

TEST_F(AfPageTest, RelabellingKeepsTheListAndTheMethod) {
    setList(2, "87.6,90.1");
    click("AFList_Opt_1");
    click("AFMethod_opt_1");
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("AFList_Opt_1"), "List 2");
    EXPECT_EQ(find<QGroupBox>("Frame2")->title(), QStringLiteral("Alternative frequencies"));
    EXPECT_EQ(chosenList(), 1);
    EXPECT_TRUE(checked("AFMethod_opt_1"));
    EXPECT_EQ(text("AF_TN"), "87.6");
    EXPECT_EQ(rows(), Lines{"90.1"});
}

TEST_F(AfPageTest, TheControlsBearTheirTexts) {
    const auto caption = [this](int number) { return toText(captions.text(number)).toStdString(); };
    EXPECT_EQ(find<QGroupBox>("Frame2")->title(), QStringLiteral("alternative Frequenzen"));
    EXPECT_EQ(text("AF_Bearbeiten"), caption(72));
    EXPECT_EQ(text("Taste_AF_Senden"), caption(73));
    EXPECT_EQ(text("AFMethod_opt_0"), caption(75));
    EXPECT_EQ(text("AFMethod_opt_1"), caption(76));
    for (int i = 0; i < 5; ++i) {
        EXPECT_EQ(text(("AFList_Opt_" + std::to_string(i)).c_str()), "Liste " + std::to_string(i + 1));
    }
}

TEST_F(AfPageTest, WhatShowsTheListHasANameForThoseWhoCannotSeeIt) {
    for (const char* language : {"deutsch", "english", "english US"}) {
        useLanguage(language);
        page.label();
        EXPECT_FALSE(find("AF_TN")->accessibleName().isEmpty());
        EXPECT_FALSE(find("AF_List1")->accessibleName().isEmpty());
    }
}

}  // namespace
}  // namespace kdx
