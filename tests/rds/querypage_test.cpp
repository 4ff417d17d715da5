#include "rds/querypage.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <iterator>
#include <ostream>

#include "base/numbers.h"
#include "coder/readback.h"
#include "support/pagetest.h"

namespace kdx::test {
namespace {

class QueryPageTest : public PageTest {
protected:
    QueryPageTest() { page.label(); }
    QWidget& root() override { return page; }

    QueryPage page{context, nullptr};
};

struct Button {
    const char* name;
    std::vector<std::pair<std::string, std::string>> asked;  ///< log label and key, in order
    bool generator = false;
};

void PrintTo(const Button& button, std::ostream* out) {
    *out << button.name;
}

// Written out once more, so that neither names in the log nor questions change unnoticed.
const std::vector<Button>& buttons() {
    static const std::vector<Button> all = {
        {"Command1", {{"Ari ein/aus?", "ARI"}, {"ARI Hub?", "ARI-DEV"}, {"ARI mode?", "ARI-ID"}, {"BK?", "BK"}}},
        {"Command4",
         {{"AF_Liste1?", "AF1"},
          {"AF_Liste2?", "AF2"},
          {"AF_Liste3?", "AF3"},
          {"AF_Liste4?", "AF4"},
          {"AF_Liste5?", "AF5"}}},
        {"Command5", {{"PS?", "PS"}}},
        {"Command6", {{"PI?", "PI"}}},
        {"Command7", {{"PTY?", "PTY"}}},
        {"Command8", {{"RT?", "RT"}}},
        {"Command9", {{"CT?", "CT"}}},
        {"Command10", {{"Freq?", "FREQ"}}, true},
        {"Command11", {{"MPX Hub?", "MPX-DEV"}}},
        {"Command12", {{"Mod Eingang?", "SRC"}}},
        {"Command13", {{"Preemphasis?", "PRE"}}},
        {"Command14", {{"Pilot?", "PIL"}, {"Pilot Hub?", "PIL-DEV"}, {"Pilot Phase?", "PIL-PH"}}},
        {"Command15", {{"Stereo Mode??", "MODE"}}},  // both question marks are meant
        {"Command16", {{"RDS?", "RDS"}, {"RDS-Hub?", "RDS-DEV"}}},
        {"Command17", {{"Gruppenfolge?", "GS"}}},
        {"Command18", {{"Impedanz?", "IMP"}}},
        {"Command19",
         {{"EON PI?", "EON-PI"},
          {"EON PS?", "EON-PS,D3C2"},
          {"EON TP?", "EON-TP,D3C2"},
          {"EON TA?", "EON-TA,D3C2"},
          {"EON AFB?", "EON-AFB,D3C2,1"},
          {"EON AFB?", "EON-AFB,D3C2,2"},
          {"EON AFB?", "EON-AFB,D3C2,3"},
          {"EON AFB?", "EON-AFB,D3C2,4"},
          {"EON AFB?", "EON-AFB,D3C2,5"}}},
        {"Command20", {{"M/S ?", "MS"}}},
        {"Command21", {{"Decoder?", "DI"}}},
        {"Command22", {{"Pegel?", "POW"}}, true},
    };
    return all;
}

class EveryQueryButton : public QueryPageTest, public ::testing::WithParamInterface<Button> {
protected:
    Lines questions() const {
        Lines lines;
        for (const auto& [label, key] : GetParam().asked)
            lines.push_back(GetParam().generator ? key + "?" : coder(key));
        return lines;
    }
    /// What the words of this button make of these answers.
    std::string words(const std::vector<std::string>& answers) const {
        const auto own = std::find_if(readBacks().begin(), readBacks().end(),
                                      [](const ReadBack& one) { return std::string(one.button) == GetParam().name; });
        return toText(own->words(answers, captions)).toStdString();
    }
};

TEST_P(EveryQueryButton, AsksInTurnAndLogsEachQuestionUnderItsName) {
    state.eonIdentifier = "D3C2";
    state.LogEnabled = true;
    for (std::size_t i = 0; i < GetParam().asked.size(); ++i) visa.answers.push_back("\"1\"\n");
    click(GetParam().name);
    EXPECT_EQ(sent(), questions());
    EXPECT_EQ(static_cast<std::size_t>(visa.reads), GetParam().asked.size());
    std::string log;
    for (const auto& [label, key] : GetParam().asked) {
        const std::string head = rightmost(std::string(20, ' ').append(label), 15).append("= ");
        log.append(head).append(GetParam().generator ? ":? " : ":STEREO:DIRECT? ");
        log.append("\"").append(key).append("\"\r\n");
        log.append(head).append("Answer \"").append(padRight("\"1\"\n", 60)).append("\"\r\n");
        log.append(8, ' ').append("Anzeige= ").append(GetParam().generator ? "\"1\"" : "1").append("\r\n");
    }
    EXPECT_EQ(folder.read(kCommandLog), log);
}

TEST_P(EveryQueryButton, DoesNothingAtAllWithoutASession) {
    state.InstrumentOnline = false;
    state.LogEnabled = true;
    const std::string before = text("gelesen");
    click(GetParam().name);
    EXPECT_EQ(sent(), Lines{});
    EXPECT_EQ(visa.reads, 0);
    EXPECT_EQ(text("gelesen"), before);
    EXPECT_EQ(folder.read(kCommandLog), "");
    EXPECT_TRUE(clock.sleeps.empty());
}

TEST_P(EveryQueryButton, ShowsOneBoxForEachFailedReadAndLeavesItsPartEmpty) {
    visa.readStatus = visa::kTimeout;
    dialogs.expectedMessages = static_cast<int>(GetParam().asked.size());
    click(GetParam().name);
    for (const auto& box : dialogs.shown) {
        EXPECT_EQ(box.title, QStringLiteral("Interface Error"));
        EXPECT_EQ(box.text, QStringLiteral("Fehler: -1073807339"));
    }
    EXPECT_EQ(text("gelesen"), words(std::vector<std::string>(GetParam().asked.size())));
}

TEST_P(EveryQueryButton, TakesAnUnquotedAnswerOfOneCharacterAsItIs) {
    for (std::size_t i = 0; i < GetParam().asked.size(); ++i) visa.answers.push_back("7\n");
    click(GetParam().name);
    EXPECT_EQ(text("gelesen"), words(std::vector<std::string>(GetParam().asked.size(), "7")));
}

TEST_P(EveryQueryButton, ShowsUnknownAnswersInItsWords) {
    for (std::size_t i = 0; i < GetParam().asked.size(); ++i) visa.answers.push_back("\"odd one\"\n");
    click(GetParam().name);
    const std::string answer = GetParam().generator ? "\"odd one\"" : "odd one";
    EXPECT_EQ(text("gelesen"), words(std::vector<std::string>(GetParam().asked.size(), answer)));
}

TEST_P(EveryQueryButton, SaysThatAQuotedAnswerIsEmpty) {
    state.eonIdentifier = "D3C2";
    std::vector<std::string> answers;
    for (const auto& [label, key] : GetParam().asked) {
        visa.answers.push_back("\"\"\n");
        answers.push_back(GetParam().generator ? "\"\"" : key + ": leer | ");
    }
    click(GetParam().name);
    EXPECT_EQ(text("gelesen"), words(answers));
}

std::string buttonName(const ::testing::TestParamInfo<Button>& info) {
    return info.param.name;
}

INSTANTIATE_TEST_SUITE_P(Buttons, EveryQueryButton, ::testing::ValuesIn(buttons()), buttonName);

TEST_F(QueryPageTest, EonAsksNineQuestionsAndWritesTwentySevenLogLines) {
    state.LogEnabled = true;
    for (int i = 0; i < 9; ++i) visa.answers.push_back("\"x\"\n");
    click("Command19");
    EXPECT_EQ(sent().size(), 9U);
    const std::string log = folder.read(kCommandLog);
    std::size_t lines = 0;
    for (std::size_t at = 0; (at = log.find("\r\n", at)) != std::string::npos; ++at) ++lines;
    EXPECT_EQ(lines, 27U);
}

TEST_F(QueryPageTest, TheQuestionsLeftAreNotAskedAfterAStop) {
    visa.answers = {"\"D3C2\"\n"};
    visa.readStatuses = {visa::kSuccess, visa::kTimeout};
    dialogs.stopAtFailure = true;
    dialogs.expectedMessages = 1;
    click("Command19");
    EXPECT_EQ(sent().size(), 2U);
    EXPECT_EQ(text("gelesen"),
              "EON-PI:  D3C2 / EON-PS:   / EON-TP:   / EON-TA:   / \nEON-AFB1:   / \nEON-AFB2:   / \nEON-AFB3:   / "
              "\nEON-AFB4:   / \nEON-AFB5:  ");
    visa.answers = {"\"RADIO\"\n"};
    click("Command5");
    EXPECT_EQ(text("gelesen"), "RADIO");
}

TEST_F(QueryPageTest, AButtonPressedWhileABoxOfAnotherIsOpenLeavesEachItsOwnAnswers) {
    for (const auto& [query, answer] : {std::pair{"ARI-DEV", "350"}, {"ARI-ID", "3"}, {"BK", "B"}, {"PS", "RADIO"}}) {
        visa.answersTo[coder(query)] = std::string("\"") + answer + "\"\n";
    }
    visa.readStatuses = {visa::kTimeout};
    std::string meanwhile;
    instrument.onFailure([&](const std::string&, bool) {
        click("Command5");
        meanwhile = text("gelesen");
        return false;
    });
    click("Command1");
    EXPECT_EQ(meanwhile, "RADIO");
    const auto asked = std::find_if(readBacks().begin(), readBacks().end(),
                                    [](const ReadBack& one) { return std::string(one.button) == "Command1"; });
    EXPECT_EQ(text("gelesen"), toText(asked->words({"", "350", "3", "B"}, captions)).toStdString());
}

TEST_F(QueryPageTest, AnAnswerIsShownInWordsOverSeveralLines) {
    for (const char* answer : {"\"1\"\n", "\"350\"\n", "\"3\"\n", "\"B\"\n"}) visa.answers.emplace_back(answer);
    click("Command1");
    EXPECT_EQ(text("gelesen"), "ARI ein\nARI Hub: 3500 Hz\nBK + DK\nB");
}

TEST_F(QueryPageTest, AnotherLanguageChangesTheWordsOfTheShownAnswerOnly) {
    visa.answers = {"\"1\"\n", "\"675\"\n", "\"15\"\n"};
    click("Command14");
    EXPECT_EQ(text("gelesen"), "Pilot ein\nHub: 6750 Hz\nPhase: 15\xC2\xB0");
    sent();
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("gelesen"), "Pilot on\nDeviation: 6750 Hz\nPhase: 15\xC2\xB0");
    EXPECT_EQ(text("Command14"), "Pilot tone ?");
    EXPECT_EQ(sent(), Lines{});
}

TEST_F(QueryPageTest, ReadsItsCaptionUntilSomethingWasAsked) {
    EXPECT_EQ(text("gelesen"), "gelesen");
    useLanguage("english");
    page.label();
    EXPECT_EQ(text("gelesen"), "read back");
}

TEST_F(QueryPageTest, AnAnswerIsNeverTakenForMarkup) {
    visa.answers = {"\"<b>A</b>\"\n"};
    click("Command5");
    EXPECT_EQ(text("gelesen"), "<b>A</b>");
    page.ensurePolished();  // as before it is shown
    EXPECT_EQ(find<QLabel>("gelesen")->textFormat(), Qt::PlainText);
}

TEST_F(QueryPageTest, TheButtonsCanBeSwitchedOffTogether) {
    page.Fragen_Schalter(false);
    for (const Button& button : buttons()) EXPECT_FALSE(enabled(button.name)) << button.name;
    click("Command5");
    EXPECT_EQ(sent(), Lines{});
    page.Fragen_Schalter(true);
    for (const Button& button : buttons()) EXPECT_TRUE(enabled(button.name)) << button.name;
}

TEST_F(QueryPageTest, ButtonsWithoutACaptionNumberKeepTheirDesignText) {
    folder.write(kLanguageFile, "[deutsch]\r\n123=Name ?\r\n");
    useLanguage("deutsch");
    page.label();
    EXPECT_EQ(text("Command5"), "Name ?");
    EXPECT_EQ(text("Command10"), "Freq ?");
    EXPECT_EQ(text("Command22"), "Pegel ?");
}

}  // namespace
}  // namespace kdx::test
