#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "eonpagetest.h"

#include <QDialog>
#include <QListWidget>
#include <QTimer>

namespace kdx::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

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
    page = std::make_unique<EonPage>(context, network, nullptr);  // with the editor it opens by default
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

}  // namespace
}  // namespace kdx::test
