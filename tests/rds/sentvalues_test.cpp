#include "rdspagetest.h"

namespace kdx::test {
namespace {

/// What the page and the status row tell of a value: is it the one that the instrument has?
class SentValuesTest : public RdsPageTest {
protected:
    std::string tipOf(const char* name) { return find(name)->toolTip().toStdString(); }
    QLabel* slot(int number) { return statusRow.findChild<QLabel*>(QStringLiteral("Status_%1").arg(number)); }
    std::string statusState(int number) { return slot(number)->property("zustand").toString().toStdString(); }
};

TEST_F(SentValuesTest, ATypedValueIsMarkedUntilItIsSent) {
    const struct {
        const char *entry, *button, *value;
    } rows[] = {{"PS_T", "PS_Taste", "RADIO"}, {"PI_T", "Command3", "D3C2"}, {"RT_Text1", "RT_Taste1", "News"}};
    for (const auto& row : rows) {
        EXPECT_EQ(stateOf(row.entry), "") << row.entry;
        type(row.entry, row.value);
        EXPECT_EQ(stateOf(row.entry), "ungesendet") << row.entry;
        EXPECT_EQ(tipOf(row.entry), "Noch nicht gesendet.") << row.entry;
        click(row.button);
        EXPECT_EQ(stateOf(row.entry), "") << row.entry;
        EXPECT_EQ(tipOf(row.entry), "") << row.entry;
        type(row.entry, "x");
        EXPECT_EQ(stateOf(row.entry), "ungesendet") << row.entry;
        type(row.entry, row.value);  // what the instrument has
        EXPECT_EQ(stateOf(row.entry), "") << row.entry;
    }
}

TEST_F(SentValuesTest, AValueThatDidNotArriveStaysMarked) {
    type("PS_T", "RADIO");
    visa.writeStatus = -1073807339;
    dialogs.expectedMessages = 1;
    click("PS_Taste");
    EXPECT_EQ(stateOf("PS_T"), "ungesendet");
    EXPECT_EQ(statusState(3), "ungesendet");
    visa.writeStatus = 0;
    click("PS_Taste");
    EXPECT_EQ(stateOf("PS_T"), "");
    EXPECT_EQ(statusState(3), "");
}

TEST_F(SentValuesTest, APiThatIsNotFourHexadecimalDigitsIsRedAndSaysWhy) {
    for (const char* wrong : {"12G4", "D3C", "D3C2F"}) {
        type("PI_T", wrong);
        click("Command3");
        EXPECT_EQ(stateOf("PI_T"), "abgelehnt") << wrong;
        EXPECT_EQ(statusState(2), "abgelehnt") << wrong;
        EXPECT_EQ(status(StatusSlot::Pi), wrong);
        EXPECT_EQ(slot(2)->toolTip().toStdString(),
                  std::string("Die PI muss aus vier hexadezimalen Ziffern bestehen.\n") + wrong);
        const QColor letters = slot(2)->palette().color(QPalette::WindowText);
        EXPECT_GT(letters.red(), 128);
        EXPECT_LT(letters.green(), 64);
    }
    type("PI_T", "D3C2");
    click("Command3");
    EXPECT_EQ(statusState(2), "");
    EXPECT_EQ(slot(2)->palette().color(QPalette::WindowText), statusRow.palette().color(QPalette::WindowText));
}

TEST_F(SentValuesTest, ATextIsRefusedForAQuoteForeignCharactersAndItsLength) {
    const struct {
        const char *text, *why;
    } rows[] = {{"A\"B", "Ein Anf\u00FChrungszeichen beendet den Text f\u00FCr den Coder."},
                {"A^B", "RDS kennt das Zeichen ^ nicht."},
                {"\u0416", "RDS kennt das Zeichen \u0416 nicht."},
                {"ABCDEFGHIJ", "H\u00F6chstens 8 Zeichen."}};
    for (const auto& row : rows) {
        type("PS_T", row.text);
        click("PS_Taste");
        EXPECT_EQ(stateOf("PS_T"), "abgelehnt") << row.text;
        EXPECT_EQ(tipOf("PS_T"), row.why);
    }
    state.corrections.quotes = true;  // then a quote is taken
    type("PS_T", "A\"B");
    click("PS_Taste");
    EXPECT_EQ(stateOf("PS_T"), "");
    type("RT_Text1", std::string(65, 'x').c_str());
    click("RT_Taste1");
    EXPECT_EQ(tipOf("RT_Text1"), "H\u00F6chstens 64 Zeichen.");
}

TEST_F(SentValuesTest, WhatTheWholeDataSetSentIsShown) {
    type("PS_T", "OLD");
    click("PS_Taste");
    type("PS_T", "NEW");
    type("PI_T", "D3C2");
    type("RT_Text1", "News");
    programme.musicSpeech = "S";
    sendProgramme();
    EXPECT_EQ(status(StatusSlot::Pi), "D3C2");
    EXPECT_EQ(statusState(2), "");
    EXPECT_EQ(stateOf("PI_T"), "");
    EXPECT_EQ(stateOf("RT_Text1"), "");
    EXPECT_EQ(status(StatusSlot::Ps), "OLD");  // only its button takes the typed name over
    EXPECT_EQ(stateOf("PS_T"), "ungesendet");
    EXPECT_EQ(status(StatusSlot::MusicSpeech), "Sprache");
    EXPECT_EQ(statusState(1), "");
    EXPECT_EQ(statusState(4), "");
}

TEST_F(SentValuesTest, ALoadedDataSetIsNotInForceBeforeItIsSent) {
    setProfile(kSet1, "RDS", "PS", "RADIO");
    setProfile(kSet1, "RDS", "PI", "D3C2");
    load();
    for (const int number : {2, 3, 4}) {
        EXPECT_EQ(statusState(number), "ungesendet") << number;
        EXPECT_EQ(slot(number)->palette().color(QPalette::WindowText),
                  statusRow.palette().color(QPalette::Disabled, QPalette::WindowText));
    }
    EXPECT_EQ(stateOf("PS_T"), "ungesendet");
    sendProgramme();
    for (const int number : {2, 3, 4}) EXPECT_EQ(statusState(number), "") << number;
    EXPECT_EQ(stateOf("PS_T"), "");
}

TEST_F(SentValuesTest, EntriesAreCountedAndCheckedAsTheyAreTyped) {
    const struct {
        const char *entry, *counter, *typed, *count, *why;
    } rows[] = {
        {"PS_T", "PS_Zaehler", "RADIO", "5/8", ""},
        {"PS_T", "PS_Zaehler", "M\u00FCnchen \u20AC", "9/8", "H\u00F6chstens 8 Zeichen."},
        {"PS_T", "PS_Zaehler", "A~", "2/8", "RDS kennt das Zeichen ~ nicht."},
        {"PI_T", "PI_Zaehler", "D3C", "3/4", "Die PI muss aus vier hexadezimalen Ziffern bestehen."},
        {"PI_T", "PI_Zaehler", "d3c2", "4/4", ""},
        {"PI_T", "PI_Zaehler", "", "0/4", ""},
        {"RT_Text1", "RT_Zaehler", "News", "4/64", ""},
        {"RT_Text1", "RT_Zaehler", "A\"", "2/64", "Ein Anf\u00FChrungszeichen beendet den Text f\u00FCr den Coder."}};
    for (const auto& row : rows) {
        type(row.entry, row.typed);
        EXPECT_EQ(text(row.counter), row.count);
        EXPECT_EQ(tipOf(row.counter), row.why);
        const QColor letters = find(row.counter)->palette().color(QPalette::WindowText);
        EXPECT_EQ(letters.red() > 128, *row.why != 0) << row.typed;
    }
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(SentValuesTest, TheTipFollowsTheLanguageAndKeepsWhatTheControlSaysOfItself) {
    setProfile(kSet1, "RDS", "RTB", "second");
    load();
    type("RT_Text1", "News");
    EXPECT_EQ(tipOf("RT_Text1"), "Noch nicht gesendet.\nRTB: second");
    useLanguage("english");
    page.label();
    EXPECT_EQ(tipOf("RT_Text1"), "Not sent yet.\nRTB: second");
    click("RT_Taste1");
    EXPECT_EQ(tipOf("RT_Text1"), "RTB: second");
}

TEST_F(SentValuesTest, TheEndOfTheDynamicPsSendsTheTypedName) {
    type("PS_T", "RADIO");
    click("Taste_PS_Auto");
    click("Taste_PS_Auto");
    EXPECT_EQ(stateOf("PS_T"), "");
    EXPECT_EQ(statusState(3), "");
}

TEST_F(SentValuesTest, WhatTheDynamicPsShowsWithoutASessionIsNotInForce) {
    state.InstrumentOnline = false;
    type("PS_T", "RADIO");
    tick("PS_Timer");  // its first tick comes by itself
    EXPECT_EQ(status(StatusSlot::Ps), "RADIO");
    EXPECT_EQ(statusState(3), "ungesendet");
}

}  // namespace
}  // namespace kdx::test
