// What is wrong with a scenario, its steps and its report, in the language of the window.
#include <gmock/gmock.h>

#include "scenariotest.h"

namespace kdx::test {
namespace {

using ::testing::HasSubstr;
using ::testing::Not;

struct WrongFile {
    const char* name;
    std::string text;
    std::string german, english;
};

std::string nested(int deep) {
    return deep == 0 ? "[note: x]" : (deep == 9 ? "steps: " : "") + ("[{repeat: 1, steps: " + nested(deep - 1) + "}]");
}

std::string manyPoints() {
    std::string points = "1";
    for (std::size_t count = 0; count < scenario::kMostPoints; ++count) points += ",1";
    return points;
}

const std::string halfTheTable = "- {sweep: HF-Pegel, from: 0, to: 99, step: 0.0019, dwell: 1 s}\n";

std::vector<WrongFile> wrongFiles() {
    return {
        {"NotUtf8", "title: \xE4\n", "das ist kein UTF-8", "this is not UTF-8"},
        {"ControlCharacter", "title: a\x04 b\n", "ein Steuerzeichen", "a control character"},
        {"TabIndents", "steps:\n\t- note: x\n", "ein Tabulator rückt diese Zeile ein; YAML will Leerzeichen",
         "a tab indents this line; YAML wants blanks"},
        {"SecondScenario", "steps: [note: x]\n---\nsteps: [note: y]\n",
         "eine Datei enthält einen Ablauf; hier beginnt ein zweiter",
         "a file holds one scenario; a second one begins here"},
        {"ReferenceName", "title: &name a\n", "Namen für Verweise (&) gibt es hier nicht; repeat wiederholt Schritte",
         "names for references (&) are not taken; repeat does things again"},
        {"Tag", "title: !!str a\n", "Typangaben (!) gibt es hier nicht; jeder Wert ist ein Text",
         "tags (!) are not taken; every value is a text"},
        {"OpenQuote", "title: \"a\nsteps: [note: x]\n", "ein Anführungszeichen wird hier geöffnet und nie geschlossen",
         "a quotation mark is opened here and never closed"},
        {"TooDeep", "steps: " + std::string(100, '['), "das ist zu tief verschachtelt", "this is nested too deeply"},
        {"NameMissing", "? [a, b]\n: c\nsteps: [note: x]\n", "hier gehört ein Name hin", "a name belongs here"},
        {"Twice", "title: a\ntitle: b\nsteps: [note: x]\n", "title steht hier zweimal", "title stands here twice"},
        {"NoYaml", "steps: [note: x\n",
         "das ist kein gültiges YAML (end of sequence flow not found); ein Text mit Sonderzeichen braucht "
         "Anführungszeichen",
         "this is not YAML (end of sequence flow not found); a text with special characters needs quotation marks"},
        {"TooLarge", "title: " + std::string(scenario::kLargestFile, 'x'), "ein Ablauf hat höchstens 512 KiB",
         "a scenario has 512 KiB at most"},
        {"NoSteps", "title: Test\n", "es gibt keine Schritte (steps)", "there are no steps"},
        {"NoScenario", "", "ein Ablauf besteht aus Namen mit Werten: title, steps und so weiter",
         "a scenario is written as names with values: title, steps and so on"},
        {"ReportName", "report: \"\"\nsteps: [note: x]\n", "report braucht den Namen einer Datei",
         "report needs the name of a file"},
        {"UnknownWord", "steps: [jump: 3]",
         R"(unbekanntes Wort "jump"; bekannt sind hier: send, wait, expect, sweep, repeat, tmc, pause, note)",
         R"(unknown word "jump"; known here: send, wait, expect, sweep, repeat, tmc, pause, note)"},
        {"NoList", "steps:\n", "Schritte (steps) sind eine Liste: jeder beginnt mit einem Strich, etwa - wait: 2 s",
         "steps are a list: each begins with a dash, as - wait: 2 s"},
        {"EmptyList", "steps: []", "in dieser Liste stehen keine Schritte", "there are no steps in this list"},
        {"Nesting", nested(9), "Schritte sind höchstens 8-fach verschachtelt", "steps are nested 8 deep at most"},
        {"NoStep", "steps: [pause]", "ein Schritt ist ein Wort, ein Doppelpunkt und was dazugehört, etwa wait: 2 s",
         "a step is a word, a colon and what belongs to it, as wait: 2 s"},
        {"TwoThings", "steps:\n- send: {TA: 1}\n  wait: 1 s\n",
         "ein Schritt tut nur eines; wait braucht einen eigenen Strich",
         "a step does one thing; wait needs a dash of its own"},
        {"NoNames", "steps: [send: {}]", "send braucht Namen mit Werten, etwa send: {PS: MESSTURM, TP: 1}",
         "send takes names with values, as send: {PS: MESSTURM, TP: 1}"},
        {"NoSuchKey", "steps: [send: {TAA: 1}]", "es gibt keinen Schlüssel TAA", "there is no key TAA"},
        {"NothingExpected", "steps: [expect: {within: 1 s}]", "hier wird nichts erwartet", "nothing is expected here"},
        {"NoQuestion", "steps: [expect: {nothing: 1}]", "nothing lässt sich nicht abfragen",
         "nothing cannot be asked for"},
        {"OneAnswer", "steps: [expect: {TA: [1, 2]}]", "auf TA kommt 1 Antwort; erwartet werden 2",
         "TA has 1 answer; expected are 2"},
        {"Answers", "steps: [expect: {pilot: 1}]", "auf pilot kommen 3 Antworten; erwartet werden 1",
         "pilot has 3 answers; expected are 1"},
        {"NoNumberToSweep", "steps: [{sweep: PS, points: [1], dwell: 1 s}]",
         "PS ist keine Zahl, die sich durchfahren ließe", "PS is no number that could be swept"},
        {"NoPace", "steps: [{sweep: PTY, points: [1]}]", "sweep braucht dwell oder steps oder beides",
         "a sweep needs dwell or steps, or both"},
        {"PointsAndRange", "steps: [{sweep: PTY, from: 1, points: [1], dwell: 1 s}]",
         "sweep hat entweder points oder from, to und step, nicht beides",
         "a sweep has points, or from, to and step; not both"},
        {"NoPoints", "steps: [{sweep: PTY, points: [], dwell: 1 s}]",
         "points ist eine Liste von Zahlen, etwa [60, 40, 20]", "points are a list of numbers, as [60, 40, 20]"},
        {"MostPoints", "steps: [{sweep: PTY, points: [" + manyPoints() + "], dwell: 1 s}]",
         "sweep hat höchstens 100000 Werte", "a sweep has 100000 points at most"},
        {"MostPointsOfAll", "steps:\n" + halfTheTable + halfTheTable,
         "alle sweep zusammen haben höchstens 100000 Werte", "all sweeps together have 100000 points at most"},
        {"NoRange", "steps: [{sweep: PTY, dwell: 1 s}]", "sweep braucht from, to und step oder points",
         "a sweep needs from, to and step, or points"},
        {"StepZero", "steps: [{sweep: PTY, from: 1, to: 5, step: 0, dwell: 1 s}]",
         "mit einem step von 0 endet sweep nie", "with a step of 0 the sweep never ends"},
        {"StepUpwards", "steps: [{sweep: PTY, from: 1, to: 5, step: -1, dwell: 1 s}]",
         "step führt vom Ende weg: von 1 bis 5 muss er über 0 liegen",
         "the step leads away from the end: 1 to 5 needs a step above 0"},
        {"StepDownwards", "steps: [{sweep: PTY, from: 5, to: 1, step: 1, dwell: 1 s}]",
         "step führt vom Ende weg: von 5 bis 1 muss er unter 0 liegen",
         "the step leads away from the end: 5 to 1 needs a step below 0"},
        {"TooManyPoints", "steps: [{sweep: HF-Pegel, from: 0, to: 120, step: 0.001, dwell: 1 s}]",
         "sweep hat höchstens 100000 Werte, dieser 120001", "a sweep has 100000 points at most, this one 120001"},
        {"NothingToRepeat", "steps: [repeat: 3]", "repeat braucht steps", "repeat needs steps"},
        {"Until", "steps: [{repeat: 3, until: noon, steps: [note: x]}]", R"(until kennt nur Return, nicht "noon")",
         R"(until knows Return only, not "noon")"},
        {"NoMessage", "steps: [tmc: 2B90E400CC]",
         R"(tmc braucht zehn hexadezimale Ziffern, die erste 0 oder 1, etwa 0B90E400CC; nicht "2B90E400CC")",
         R"(tmc takes ten hexadecimal digits, the first 0 or 1, as 0B90E400CC; not "2B90E400CC")"},
        {"NoValue", "title:\nsteps: [note: x]\n",
         R"(title hat keinen Wert; ein leerer Text wird "" geschrieben, ein Wort wie null in Anführungszeichen)",
         R"(title has no value; an empty text is written "", a word like null in quotation marks)"},
        {"OneValue", "title: [a]\nsteps: [note: x]\n", "title braucht einen Wert, keine Liste und keine weiteren Namen",
         "title takes one value, no list and no further names"},
        {"ControlInText", "title: \"\\e[2J\"\nsteps: [note: x]\n",
         "title enthält ein Zeilenende oder ein anderes Steuerzeichen",
         "title holds a line end or another control character"},
        {"NoCharacter", "steps: [send: {RT: Stau → A1}]", "RT: der Zeichensatz des Geräts (Windows-1252) hat kein →",
         "RT: the instrument's character set (Windows-1252) has no →"},
        {"NoUnit", "steps: [wait: 2]", R"(wait braucht eine Einheit: 500 ms, 2 s, 1.5 min oder 1 h, nicht "2")",
         R"(wait needs a unit: 500 ms, 2 s, 1.5 min or 1 h, not "2")"},
        {"NoTime", "steps: [wait: soon]", R"(wait ist eine Zeit: 500 ms, 2 s, 1.5 min oder 1 h, nicht "soon")",
         R"(wait is a time: 500 ms, 2 s, 1.5 min or 1 h, not "soon")"},
        {"TimeLimits", "steps: [wait: 200 h]", R"(wait ist mindestens 1 ms und höchstens 168 h, nicht "200 h")",
         R"(wait is 1 ms at least and 168 h at most, not "200 h")"},
        {"NoWhole", "data_set: 6\nsteps: [note: x]\n", R"(data_set ist eine ganze Zahl von 1 bis 5, nicht "6")",
         R"(data_set is a whole number, 1 to 5, not "6")"},
        {"NoChoice", "restore: yes\nsteps: [note: x]\n", R"(restore ist true oder false, nicht "yes")",
         R"(restore is true or false, not "yes")"},
        {"Comma", "steps: [{sweep: HF-Pegel, from: \"60,5\", to: 10, step: -1, dwell: 1 s}]",
         R"(from ist eine Zahl mit Dezimalpunkt, nicht "60,5")",
         R"(from is a number with a decimal point, not "60,5")"},
        {"NoNumber", "steps: [{sweep: HF-Pegel, from: x, to: 10, step: -1, dwell: 1 s}]",
         R"(from ist eine Zahl, nicht "x")", R"(from is a number, not "x")"},
        {"OutOfRange", "steps: [send: {PTY: 32}]",
         R"(PTY kann nicht "32" sein. Der Coder nimmt diesen Wert nicht an. Erlaubt: 0 bis 31.)",
         R"(PTY cannot be "32". The coder does not take this value. Legal: 0 to 31.)"},
        {"NotOneOfTheWords", "steps: [send: {TA: 2}]",
         R"(TA kann nicht "2" sein. Der Coder nimmt diesen Wert nicht an. Erlaubt: 0 oder 1.)",
         R"(TA cannot be "2". The coder does not take this value. Legal: 0 or 1.)"},
        {"DecimalComma", "steps: [send: {HF-Pegel: \"98,5\"}]",
         R"(HF-Pegel kann nicht "98,5" sein. Der Coder nimmt nur einen Punkt, kein Komma. Erlaubt: 0 bis 120 dBµV, mit Dezimalpunkt.)",
         R"(HF-Pegel cannot be "98,5". The coder takes a point only, no comma. Legal: 0 to 120 dBµV, with a decimal point.)"},
        {"NoPhase", "steps: [send: {RDS_PHASE: 400}]",
         R"(RDS_PHASE kann nicht "400" sein. Der Coder nimmt diesen Wert nicht an. Erlaubt: 0 bis 359 Grad, mit Dezimalpunkt.)",
         R"(RDS_PHASE cannot be "400". The coder does not take this value. Legal: 0 to 359 degrees, with a decimal point.)"},
        {"TooLong", "steps: [send: {PS: MESSTURM2}]", R"(PS kann nicht "MESSTURM2" sein. Höchstens 8 Zeichen.)",
         R"(PS cannot be "MESSTURM2". At most 8 characters.)"},
        {"NoIdentifier", "steps: [send: {PI: 1E1}]",
         R"(PI kann nicht "1E1" sein. Die PI muss aus vier hexadezimalen Ziffern bestehen.)",
         R"(PI cannot be "1E1". The PI must be four hexadecimal digits.)"},
        {"NoList", "steps: [send: {AF1: x}]",
         R"(AF1 kann nicht "x" sein. Der Coder nimmt diesen Wert nicht an. Erlaubt: "N," oder "+,", dann Frequenzen in MHz mit Komma dazwischen: N,98.5,87.6,107.9.)",
         R"(AF1 cannot be "x". The coder does not take this value. Legal: "N," or "+,", then frequencies in MHz with commas between: N,98.5,87.6,107.9.)"},
        {"NoPlainList", "steps: [send: {EON_AFA: x}]",
         "Erlaubt: Frequenzen in MHz mit Komma dazwischen: 98.5,87.6,107.9.",
         "Legal: frequencies in MHz with commas between: 98.5,87.6,107.9."},
        {"NoGroups", "steps: [send: {GROUPSEQ: 16A}]",
         "Erlaubt: Gruppen 0A bis 15B mit Komma dazwischen, höchstens 256: 0A,0A,2A.",
         "Legal: groups 0A to 15B with commas between, at most 256: 0A,0A,2A."},
        {"NoOda", "steps: [send: {ODA: x}]",
         "Erlaubt: zwei Ziffern, ein Komma und zehn hexadezimale Ziffern: 02,0B90E400CC.",
         "Legal: two digits, a comma and ten hexadecimal digits: 02,0B90E400CC."},
        {"NoTmc", "steps: [send: {TMC: x}]",
         "Erlaubt: zwei Ziffern, ein Komma, 0 oder 1 und neun hexadezimale Ziffern: 02,0B90E400CC.",
         "Legal: two digits, a comma, 0 or 1 and nine hexadecimal digits: 02,0B90E400CC."},
        {"NoPoint", "steps: [{sweep: PTY, points: [x], dwell: 1 s}]", R"(ein Wert von points ist eine Zahl, nicht "x")",
         R"(a value of points is a number, not "x")"},
    };
}

class MistakeTextTest : public ScenarioTest {
protected:
    std::string boxAbout(const std::string& text) {
        dialogs.expectedMessages = 1;
        load(text);
        return dialogs.shown.back().preset.toStdString();
    }
};

TEST_F(MistakeTextTest, EveryKindOfMistakeIsToldInGerman) {
    openView("deutsch");
    for (const WrongFile& file : wrongFiles()) {
        const std::string told = boxAbout(file.text);
        EXPECT_THAT(told, HasSubstr(file.german)) << file.name;
        EXPECT_TRUE(told.starts_with("Zeile ")) << file.name;
    }
}

TEST_F(MistakeTextTest, EveryKindOfMistakeIsToldInBothKindsOfEnglish) {
    for (const char* language : {"english", "english US"}) {
        openView(language);
        for (const WrongFile& file : wrongFiles()) {
            const std::string told = boxAbout(file.text);
            EXPECT_THAT(told, HasSubstr(file.english)) << file.name;
            EXPECT_THAT(told, Not(HasSubstr("kdx-ctl"))) << file.name;
        }
    }
}

TEST_F(MistakeTextTest, WhatKeepsItsDataSetFromBeingSentIsToldWithItsPlace) {
    openView("deutsch");
    setDataSet1("RDS", "PTY", "77");
    setDataSet1("RDS", "PS", "MESSTURM2");
    setGeneral("FM", "PILOT_PHASE", "90");
    const std::string told = boxAbout("data_set: 1\nsteps: [note: x]");
    EXPECT_THAT(told, HasSubstr(R"(PTY kann nicht "77" sein. Der Coder nimmt diesen Wert nicht an. Erlaubt: 0 bis 31. )"
                                "Es steht in Datenset1.INI, [RDS] PTY=77."));
    EXPECT_THAT(told, HasSubstr("Höchstens 8 Zeichen. Es steht in Datenset1.INI, [RDS] PS=MESSTURM2."));
    EXPECT_THAT(told, HasSubstr(R"(PILOT_PHASE kann nicht "90" sein. Erlaubt: -)"));
    EXPECT_THAT(told, Not(HasSubstr("cannot")));
}

TEST_F(MistakeTextTest, TheStepsAreToldInTheLanguageOfTheWindow) {
    const char* const all =
        "data_set: 1\nrestore: true\nsteps: [send: {PS: RADIO, TP: 1}, wait: 1.5 s, wait: 250 ms, expect: {TA: 1}, "
        "expect: {TA: 1, within: 2 s}, {sweep: HF-Pegel, points: [60, 50], dwell: 1 s}, {repeat: 3, steps: [wait: 1 "
        "s]}, tmc: 0B90E400CC, pause: bereit, note: fertig]";
    openView("deutsch");
    load(all);
    const auto column = [this] {
        Lines lines;
        for (int row = 0; row < table->rowCount(); ++row) lines.push_back(cell(row, 1));
        return lines;
    };
    EXPECT_EQ(column(), (Lines{"Datensatz 1 senden", "senden PS=RADIO TP=1", "warten: 1,5 s", "warten: 250 ms",
                               "erwarten TA=1", "erwarten TA=1 innerhalb 2 s", "HF-Pegel von 60 bis 50, 2 Werte",
                               "3× wiederholen", "    warten: 1 s", "TMC senden: 0B90E400CC", "Pause: bereit",
                               "Notiz: fertig", "wiederherstellen, was vorher war"}));
    EXPECT_EQ(table->item(1, 1)->toolTip(), QStringLiteral("senden PS=RADIO TP=1"));
    const Lines english{"send data set 1",
                        "send PS=RADIO TP=1",
                        "wait 1.5 s",
                        "wait 250 ms",
                        "expect TA=1",
                        "expect TA=1 within 2 s",
                        "HF-Pegel from 60 to 50, 2 values",
                        "repeat 3×",
                        "    wait 1 s",
                        "send TMC: 0B90E400CC",
                        "pause: bereit",
                        "note: fertig",
                        "restore what was before"};
    for (const char* language : {"Mnu_Info_Sprache_E", "Mnu_Info_Sprache_US"}) {
        action(language)->trigger();
        EXPECT_EQ(column(), english) << language << ": what is shown changes its language, too";
    }
}

TEST_F(MistakeTextTest, AReportThatCannotBeWrittenIsToldWithTheReason) {
    openView("deutsch");
    folder.write("there.csv", "mine");
    const auto startWith = [&](const std::filesystem::path& report) {
        load("report: " + report.string() + "\nsteps: [note: x]");
        dialogs.expectedMessages = 1;
        click("Ablauf_Start");
        return dialogs.shown.back().text.toStdString();
    };
    const auto there = folder.data() / "there.csv";
    EXPECT_EQ(startWith(there),
              there.string() + " ist schon da und ist kein Bericht, der neu geschrieben werden darf.");
    EXPECT_EQ(startWith(folder.data()), "Der Bericht " + folder.data().string() + " kann nicht geschrieben werden.");
}

}  // namespace
}  // namespace kdx::test
