#include "base/clock.h"
#include "support/listrows.h"
#include "tmcpagetest.h"
#include "ui/ticker.h"

namespace kdx::test {
namespace {

const std::string kFirstVariant = direct("3A=01,106100CD46");
const std::string kSecondVariant = direct("3A=01,100066CD46");

std::string message(const std::string& code) {
    return direct("8A=02," + code);
}

class TmcTransmissionTest : public TmcPageTest {
protected:
    Ticker& timer() { return *find<Ticker>("TMC_Sende_Timer"); }
    /// Starts to cycle through that many messages.
    void startCycling(int messages) {
        addMessages(messages);
        click("optMultiMessage");
        click("TMC_Senden_Taste");
    }
    /// The message commands of so many ticks.
    Lines messagesSent(int ticks) {
        Lines messages;
        for (int i = 0; i < ticks; ++i) {
            EXPECT_TRUE(tick("TMC_Sende_Timer"));
            const Lines commands = sent();
            EXPECT_EQ(commands.size(), 2U);
            messages.push_back(commands.back());
        }
        return messages;
    }
};

TEST_F(TmcTransmissionTest, AddingBuildsTheEntryFromLocationEventAndCode) {
    composeMessage();
    click("TMC_Gr8_apply");
    ASSERT_EQ(list().count(), 1);
    EXPECT_EQ(list().item(0)->text().toStdString(), "Musterstadt" + std::string(24, ' ') + "  :" + "Verkehrsproblem" +
                                                        std::string(20, ' ') + "   :" + "0810013039");
}

TEST_F(TmcTransmissionTest, AnIncompleteMessageCanBeAdded) {
    click("TMC_Gr8_apply");
    ASSERT_EQ(list().count(), 1);
    EXPECT_EQ(list().item(0)->text().toStdString(),
              std::string(35, ' ') + "  :" + std::string(35, ' ') + "   :-000000000");
}

TEST_F(TmcTransmissionTest, AnEntryWithLongTextsStillEndsInItsCode) {
    folder.write("Event.txt", std::string(42, 'E') + ";00001\r\n");
    folder.write("Location.txt", std::string(42, 'L') + ";12345\r\n");
    page->reloadLists();
    composeMessage();
    click("TMC_Gr8_apply");
    click("TMC_Senden_Taste");
    EXPECT_EQ(messagesSent(1), Lines{message("0810013039")});
}

TEST_F(TmcTransmissionTest, ALineTellsWhatIsBeingSent) {
    EXPECT_EQ(text("TMC_Lauf"), "Es wird nichts gesendet.");
    addMessages(3);
    type("txtCycleTime", "2.5");
    click("optMultiMessage");
    click("TMC_Senden_Taste");
    const std::string since = timeText(clock);
    EXPECT_EQ(text("TMC_Lauf"), "Sendet alle 2,5 s eine Meldung, seit " + since + ", bis zum Anhalten.");
    messagesSent(1);
    clock.advance(std::chrono::minutes(2));
    messagesSent(1);
    EXPECT_EQ(text("TMC_Lauf"),
              "Sendet " + code(2) + " (3 von 3) alle 2,5 s, 2-mal seit " + since + ", bis zum Anhalten.");
    useLanguage("english");
    page->label();
    EXPECT_EQ(text("TMC_Lauf"),
              "Sends " + code(2) + " (3 of 3) every 2.5 s, 2 times since " + since + ", until stopped.");
    click("Stop_Timer");
    EXPECT_EQ(text("TMC_Lauf"), "Sent: 2 times from " + since + " to " + timeText(clock) + ", last " + code(2) + ".");
}

TEST_F(TmcTransmissionTest, TheLineSaysThatTheCoderRefusesAMessage) {
    click("TMC_Gr8_apply");  // no field is chosen: the code lacks bits
    const std::string code = list().item(0)->text().right(10).toStdString();
    click("optMultiMessage");
    click("TMC_Senden_Taste");
    messagesSent(1);
    EXPECT_NE(text("TMC_Lauf").find(code + " (vom Coder abgelehnt) (1 von 1)"), std::string::npos) << text("TMC_Lauf");
}

TEST_F(TmcTransmissionTest, TheLineSaysWhenNothingWillEverBeSent) {
    addMessages(1);
    click("optMultiMessage");
    for (const char* never : {"0", "abc"}) {
        type("txtCycleTime", never);
        click("TMC_Senden_Taste");
        EXPECT_FALSE(tick("TMC_Sende_Timer"));
        EXPECT_EQ(text("TMC_Lauf"), "Wechselzeit 0: Es wird nichts gesendet, bis eine andere gilt.");
    }
}

TEST_F(TmcTransmissionTest, ASingleMessageIsToldBeforeAndAfter) {
    addMessages(1);
    click("TMC_Senden_Taste");
    EXPECT_EQ(text("TMC_Lauf"), "Sendet eine Meldung nach 1 s.");
    messagesSent(1);
    EXPECT_EQ(text("TMC_Lauf"),
              "Gesendet: 1-mal von " + timeText(clock) + " bis " + timeText(clock) + ", zuletzt " + code(0) + ".");
}

TEST_F(TmcTransmissionTest, RemovingTakesTheSelectedEntry) {
    addMessages(3);
    list().setCurrentRow(1);
    click("TMC_Gr8_Remove");
    ASSERT_EQ(list().count(), 2);
    EXPECT_TRUE(list().item(0)->text().endsWith(QString::fromStdString(code(0))));
    EXPECT_TRUE(list().item(1)->text().endsWith(QString::fromStdString(code(2))));
    EXPECT_TRUE(list().selectedItems().isEmpty());
}

TEST_F(TmcTransmissionTest, RemovingWithoutASelectionAsksForOne) {
    addMessages(2);
    dialogs.expectedMessages = 1;
    click("TMC_Gr8_Remove");
    EXPECT_EQ(list().count(), 2);
    ASSERT_EQ(dialogs.shown.size(), 1U);
    EXPECT_EQ(dialogs.shown[0].title.toStdString(), "Ungültig");
    EXPECT_EQ(dialogs.shown[0].text.toStdString(), "Wählen sie einen Eintrag aus !");
}

TEST_F(TmcTransmissionTest, StartingWithAnEmptyListDoesNothing) {
    click("TMC_Senden_Taste");
    EXPECT_FALSE(timer().isEnabled());
    EXPECT_TRUE(enabled("TMC_Gr8_apply"));
    EXPECT_TRUE(enabled("TMC_Gr8_Remove"));
}

TEST_F(TmcTransmissionTest, StartingSelectsTheFirstEntryAndLocksTheList) {
    addMessages(2);
    type("txtCycleTime", "2.5");
    click("TMC_Senden_Taste");
    EXPECT_EQ(list().currentRow(), 0);
    EXPECT_FALSE(list().selectedItems().isEmpty());
    EXPECT_FALSE(enabled("TMC_Gr8_apply"));
    EXPECT_FALSE(enabled("TMC_Gr8_Remove"));
    EXPECT_TRUE(timer().isActive());
    EXPECT_EQ(timer().interval(), 2500);
    EXPECT_EQ(timer().timerType(), Qt::PreciseTimer);
    EXPECT_TRUE(sent().empty()) << "the first message comes one interval later";
}

TEST_F(TmcTransmissionTest, StartingKeepsASelection) {
    addMessages(3);
    list().setCurrentRow(2);
    click("TMC_Senden_Taste");
    EXPECT_EQ(messagesSent(1), Lines{message(code(2))});
}

TEST_F(TmcTransmissionTest, ASingleMessageIsSentOnce) {
    addMessages(2);
    click("optSingleMessage");
    click("TMC_Senden_Taste");
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_EQ(sent(), (Lines{kFirstVariant, message(code(0))}));
    EXPECT_FALSE(timer().isEnabled());
    EXPECT_FALSE(tick("TMC_Sende_Timer"));
    EXPECT_TRUE(enabled("TMC_Gr8_apply"));
    EXPECT_TRUE(enabled("TMC_Gr8_Remove"));
}

TEST_F(TmcTransmissionTest, TheAnnouncementGoesOnAlternatingFromOneSingleMessageToTheNext) {
    addMessages(1);
    for (const std::string& variant : {kFirstVariant, kSecondVariant, kFirstVariant}) {
        click("TMC_Senden_Taste");
        EXPECT_TRUE(tick("TMC_Sende_Timer"));
        EXPECT_EQ(sent(), (Lines{variant, message(code(0))}));
    }
}

TEST_F(TmcTransmissionTest, ThreeMessagesCycleWithTheAnnouncementAlternating) {
    startCycling(3);
    Lines all;
    for (int i = 0; i < 4; ++i) {
        EXPECT_TRUE(tick("TMC_Sende_Timer"));
        const Lines commands = sent();
        all.insert(all.end(), commands.begin(), commands.end());
    }
    EXPECT_EQ(all, (Lines{kFirstVariant, message(code(1)), kSecondVariant, message(code(2)), kFirstVariant,
                          message(code(0)), kSecondVariant, message(code(1))}));
    EXPECT_EQ(list().currentRow(), 1);
}

TEST_F(TmcTransmissionTest, OneMessageIsSentAtEveryTick) {
    startCycling(1);
    EXPECT_EQ(messagesSent(3), Lines(3, message(code(0))));
}

TEST_F(TmcTransmissionTest, OfALongListTheFirstAndThoseBeyondThe21stEntryAreNeverSent) {
    startCycling(23);
    const Lines messages = messagesSent(41);
    for (int i = 0; i < 41; ++i) EXPECT_EQ(messages[static_cast<std::size_t>(i)], message(code(i % 20 + 1)));
}

TEST_F(TmcTransmissionTest, ThePositionGoesOnAfterAStop) {
    startCycling(3);
    messagesSent(1);
    click("Stop_Timer");
    EXPECT_FALSE(timer().isActive());
    EXPECT_TRUE(enabled("TMC_Gr8_apply"));
    EXPECT_TRUE(enabled("TMC_Gr8_Remove"));
    click("TMC_Senden_Taste");
    EXPECT_EQ(messagesSent(1), Lines{message(code(2))});
}

TEST_F(TmcTransmissionTest, ASingleMessageMovesThePositionOnToo) {
    addMessages(4);
    list().setCurrentRow(3);
    click("TMC_Senden_Taste");
    EXPECT_EQ(messagesSent(1), Lines{message(code(3))});
    click("optMultiMessage");
    click("TMC_Senden_Taste");
    EXPECT_EQ(messagesSent(2), (Lines{message(code(2)), message(code(3))}));
}

TEST_F(TmcTransmissionTest, ChoosingSingleMessageEndsTheCyclingAtTheEntryThatIsSelected) {
    startCycling(3);
    messagesSent(1);
    click("optSingleMessage");
    EXPECT_EQ(messagesSent(1), Lines{message(code(1))});
    EXPECT_FALSE(timer().isEnabled());
}

TEST_F(TmcTransmissionTest, RemovingStartsThePositionAnew) {
    startCycling(4);
    messagesSent(2);
    click("Stop_Timer");
    list().setCurrentRow(3);
    click("TMC_Gr8_Remove");
    click("TMC_Senden_Taste");
    EXPECT_EQ(messagesSent(1), Lines{message(code(1))});
}

TEST_F(TmcTransmissionTest, TheCurrentDataSetKeepsTheLastMessage) {
    state.CurrentDataSet = "3";
    startCycling(2);
    messagesSent(1);
    EXPECT_EQ(profile("Datenset3.INI", "RDS", "TMC"), "02," + code(1));
    EXPECT_EQ(profile("Datenset1.INI", "RDS", "TMC"), "");
}

TEST_F(TmcTransmissionTest, TheAnnouncementIsStoredBeforeTheMessageReplacesIt) {
    startCycling(2);
    Lines stored;
    const TrafficListener listener(instrument, [&](const Traffic& traffic) {
        if (traffic.kind == Traffic::Kind::Written) stored.push_back(profile("Datenset1.INI", "RDS", "TMC"));
    });
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_EQ(stored, (Lines{"", "01,106100CD46", "02," + code(1), "01,100066CD46"}));
}

TEST_F(TmcTransmissionTest, WithoutASessionTheDataSetKeepsTheMessageAllTheSame) {
    state.InstrumentOnline = false;
    startCycling(1);
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_TRUE(sent().empty());
    EXPECT_EQ(profile("Datenset1.INI", "RDS", "TMC"), "02," + code(0));
}

TEST_F(TmcTransmissionTest, TheChangeTimeIsForCyclingOnly) {
    click("optMultiMessage");
    EXPECT_TRUE(enabled("txtCycleTime"));
    EXPECT_TRUE(enabled("lblCycleTime"));
    click("optSingleMessage");
    EXPECT_FALSE(enabled("txtCycleTime"));
    EXPECT_FALSE(enabled("lblCycleTime"));
}

TEST_F(TmcTransmissionTest, ASingleMessageIsPreparedAtTheStart) {
    EXPECT_TRUE(checked("optSingleMessage"));
    EXPECT_FALSE(enabled("txtCycleTime"));
    EXPECT_EQ(text("txtCycleTime"), "1");
}

TEST_F(TmcTransmissionTest, AChangeTimeWithoutANumberLeavesTheTimerWithoutTicks) {
    for (const char* time : {"", "abc", "0"}) {
        startCycling(1);
        click("Stop_Timer");
        type("txtCycleTime", time);
        click("TMC_Senden_Taste");
        EXPECT_TRUE(timer().isEnabled()) << time;
        EXPECT_FALSE(tick("TMC_Sende_Timer")) << time;
        EXPECT_FALSE(enabled("TMC_Gr8_apply")) << time;
        EXPECT_FALSE(enabled("TMC_Gr8_Remove")) << time;
        click("Stop_Timer");
        EXPECT_TRUE(enabled("TMC_Gr8_apply")) << time;
        EXPECT_TRUE(enabled("TMC_Gr8_Remove")) << time;
    }
}

TEST_F(TmcTransmissionTest, TheLongestChangeTimeIsAccepted) {
    addMessages(1);
    click("optMultiMessage");
    type("txtCycleTime", "65.535");
    click("TMC_Senden_Taste");
    EXPECT_EQ(timer().interval(), 65535);
}

TEST_F(TmcTransmissionTest, AChangeTimeOutsideTheTimersRangeIsToldAndStartsNothing) {
    addMessages(1);
    click("optMultiMessage");
    for (const char* time : {"65.536", "100", "-1", "1e999"}) {
        dialogs.shown.clear();
        dialogs.expectedMessages = 1;
        type("txtCycleTime", time);
        click("TMC_Senden_Taste");
        ASSERT_EQ(dialogs.shown.size(), 1U) << time;
        EXPECT_EQ(dialogs.shown[0].title.toStdString(), "Wechselzeit");
        EXPECT_EQ(dialogs.shown[0].text.toStdString(), "Die Wechselzeit muss zwischen 0 und 65,535 Sekunden liegen.");
        EXPECT_EQ(text("txtCycleTime"), time);
        EXPECT_FALSE(timer().isEnabled()) << time;
        EXPECT_TRUE(enabled("TMC_Gr8_apply")) << time;
        EXPECT_TRUE(enabled("TMC_Gr8_Remove")) << time;
        EXPECT_TRUE(list().selectedItems().isEmpty()) << time;
    }
}

TEST_F(TmcTransmissionTest, ARunningTransmissionGoesOnWhenANewChangeTimeIsRefused) {
    startCycling(2);
    type("txtCycleTime", "66");
    dialogs.expectedMessages = 1;
    click("TMC_Senden_Taste");
    EXPECT_EQ(timer().interval(), 1000);
    EXPECT_EQ(messagesSent(1), Lines{message(code(1))});
}

TEST_F(TmcTransmissionTest, TheBoxesSpeakTheCurrentLanguage) {
    useLanguage("english");
    page->label();
    dialogs.expectedMessages = 2;
    click("TMC_Gr8_Remove");
    addMessages(1);
    type("txtCycleTime", "70");
    click("TMC_Senden_Taste");
    EXPECT_EQ(dialogs.shown[0].text.toStdString(), "Please select an entry!");
    EXPECT_EQ(dialogs.shown[1].text.toStdString(), "The cycle time must be between 0 and 65.535 seconds.");
}

TEST_F(TmcTransmissionTest, TicksWaitWhileTheBoxOfAFailedWriteIsOpen) {
    // A box that keeps the window's timers going, as a real one does.
    int boxes = 0;
    instrument.onFailure([&](const std::string&, bool) {
        ++boxes;
        tick("TMC_Sende_Timer");
        return false;
    });
    startCycling(2);
    visa.writeStatus = visa::kTimeout;
    EXPECT_TRUE(tick("TMC_Sende_Timer"));
    EXPECT_EQ(sent(), (Lines{kFirstVariant, message(code(1))}));
    EXPECT_EQ(boxes, 2);
}

}  // namespace
}  // namespace kdx::test
