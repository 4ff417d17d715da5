#include "lab/mistaketext.h"

#include <algorithm>
#include <array>

#include "base/codepage.h"
#include "base/numbers.h"
#include "base/split.h"
#include "coder/fieldsizes.h"
#include "scenario/values.h"
#include "station/wrongsettings.h"
#include "ui/caption.h"
#include "ui/text.h"
#include "ui/valuestate.h"

namespace kdx {

namespace {

using scenario::Mistake;

struct Wording {
    Mistake mistake;
    Caption caption;
};

// The words have the same places as in the sentences of kdx-ctl.
const std::array kWordings = {
    Wording{Mistake::NotUtf8, {1160, "das ist kein UTF-8"}},
    Wording{Mistake::ControlCharacter, {1161, "ein Steuerzeichen"}},
    Wording{Mistake::TabIndents, {1162, "ein Tabulator rückt diese Zeile ein; YAML will Leerzeichen"}},
    Wording{Mistake::SecondScenario, {1163, "eine Datei enthält einen Ablauf; hier beginnt ein zweiter"}},
    Wording{Mistake::Reference, {1164, "Verweise (*) gibt es hier nicht; repeat wiederholt Schritte"}},
    Wording{Mistake::ReferenceName, {1165, "Namen für Verweise (&) gibt es hier nicht; repeat wiederholt Schritte"}},
    Wording{Mistake::Tag, {1166, "Typangaben (!) gibt es hier nicht; jeder Wert ist ein Text"}},
    Wording{Mistake::OpenQuote, {1167, "ein Anführungszeichen wird hier geöffnet und nie geschlossen"}},
    Wording{Mistake::TooDeep, {1168, "das ist zu tief verschachtelt"}},
    Wording{Mistake::NameMissing, {1169, "hier gehört ein Name hin"}},
    Wording{Mistake::Twice, {1170, "%1 steht hier zweimal"}},
    Wording{Mistake::NoYaml,
            {1171, "das ist kein gültiges YAML (%1); ein Text mit Sonderzeichen braucht Anführungszeichen"}},
    Wording{Mistake::TooLarge, {1172, "ein Ablauf hat höchstens %1 KiB"}},
    Wording{Mistake::NoSteps, {1173, "es gibt keine Schritte (steps)"}},
    Wording{Mistake::NoScenario, {1174, "ein Ablauf besteht aus Namen mit Werten: title, steps und so weiter"}},
    Wording{Mistake::ReportName, {1175, "report braucht den Namen einer Datei"}},
    Wording{Mistake::UnknownWord, {1176, R"(unbekanntes Wort "%1"; bekannt sind hier: %2)"}},
    Wording{Mistake::NoList,
            {1177, "Schritte (steps) sind eine Liste: jeder beginnt mit einem Strich, etwa - wait: 2 s"}},
    Wording{Mistake::EmptyList, {1178, "in dieser Liste stehen keine Schritte"}},
    Wording{Mistake::Nesting, {1179, "Schritte sind höchstens %1-fach verschachtelt"}},
    Wording{Mistake::NoStep, {1180, "ein Schritt ist ein Wort, ein Doppelpunkt und was dazugehört, etwa wait: 2 s"}},
    Wording{Mistake::TwoThings, {1181, "ein Schritt tut nur eines; %1 braucht einen eigenen Strich"}},
    Wording{Mistake::NoNames, {1182, "%1 braucht Namen mit Werten, etwa %2"}},
    Wording{Mistake::NoSuchKey, {1183, "es gibt keinen Schlüssel %1"}},
    Wording{Mistake::NothingExpected, {1184, "hier wird nichts erwartet"}},
    Wording{Mistake::NoQuestion, {1185, "%1 lässt sich nicht abfragen"}},
    Wording{Mistake::OneAnswer, {1186, "auf %1 kommt %2 Antwort; erwartet werden %3"}},
    Wording{Mistake::Answers, {1187, "auf %1 kommen %2 Antworten; erwartet werden %3"}},
    Wording{Mistake::NoNumberToSweep, {1188, "%1 ist keine Zahl, die sich durchfahren ließe"}},
    Wording{Mistake::NoPace, {1189, "sweep braucht dwell oder steps oder beides"}},
    Wording{Mistake::PointsAndRange, {1190, "sweep hat entweder points oder from, to und step, nicht beides"}},
    Wording{Mistake::NoPoints, {1191, "points ist eine Liste von Zahlen, etwa [60, 40, 20]"}},
    Wording{Mistake::MostPoints, {1192, "sweep hat höchstens %1 Werte"}},
    Wording{Mistake::MostPointsOfAll, {1193, "alle sweep zusammen haben höchstens %1 Werte"}},
    Wording{Mistake::NoRange, {1194, "sweep braucht from, to und step oder points"}},
    Wording{Mistake::StepZero, {1195, "mit einem step von 0 endet sweep nie"}},
    Wording{Mistake::StepUpwards, {1196, "step führt vom Ende weg: von %1 bis %2 muss er über 0 liegen"}},
    Wording{Mistake::StepDownwards, {1197, "step führt vom Ende weg: von %1 bis %2 muss er unter 0 liegen"}},
    Wording{Mistake::TooManyPoints, {1198, "sweep hat höchstens %1 Werte, dieser %2"}},
    Wording{Mistake::NothingToRepeat, {1199, "repeat braucht steps"}},
    Wording{Mistake::Until, {1200, R"(until kennt nur Return, nicht "%1")"}},
    Wording{Mistake::NoMessage,
            {1201, R"(tmc braucht zehn hexadezimale Ziffern, die erste 0 oder 1, etwa 0B90E400CC; nicht "%1")"}},
    Wording{
        Mistake::NoValue,
        {1202, R"(%1 hat keinen Wert; ein leerer Text wird "" geschrieben, ein Wort wie null in Anführungszeichen)"}},
    Wording{Mistake::OneValue, {1203, "%1 braucht einen Wert, keine Liste und keine weiteren Namen"}},
    Wording{Mistake::ControlInText, {1204, "%1 enthält ein Zeilenende oder ein anderes Steuerzeichen"}},
    Wording{Mistake::NoCharacter, {1205, "%1: der Zeichensatz des Geräts (Windows-1252) hat kein %3"}},
    Wording{Mistake::NoUnit, {1206, R"(%1 braucht eine Einheit: 500 ms, 2 s, 1.5 min oder 1 h, nicht "%2")"}},
    Wording{Mistake::NoTime, {1207, R"(%1 ist eine Zeit: 500 ms, 2 s, 1.5 min oder 1 h, nicht "%2")"}},
    Wording{Mistake::TimeLimits, {1208, R"(%1 ist mindestens 1 ms und höchstens 168 h, nicht "%2")"}},
    Wording{Mistake::NoWhole, {1209, R"(%1 ist eine ganze Zahl von %2 bis %3, nicht "%4")"}},
    Wording{Mistake::NoChoice, {1210, R"(%1 ist true oder false, nicht "%2")"}},
    Wording{Mistake::Comma, {1211, R"(%1 ist eine Zahl mit Dezimalpunkt, nicht "%2")"}},
    Wording{Mistake::NoNumber, {1212, R"(%1 ist eine Zahl, nicht "%2")"}},
};
const Caption kWrongValue{1213, R"(%1 kann nicht "%2" sein.)"};

QString withWords(const PageContext& with, const Caption& caption, const std::vector<std::string>& words) {
    return captionText(with.captions, caption, words);
}

std::string alternatives(const PageContext& with, std::string_view words) {
    const auto views = split(words, " ");
    std::vector<std::string> all(views.begin(), views.end());
    const std::string last = all.back();
    all.pop_back();
    return withWords(with, {1225, "%1 oder %2"}, {joined(all, ", "), last}).toStdString();
}

std::string unitText(const PageContext& with, std::string_view unit) {
    if (unit == "degrees") return captionText(with.captions, {1228, "Grad"}).toStdString();
    if (unit == "dBuV") return "dB\u00B5V";
    return std::string(unit);
}

/// What is legal in words; "" where what is wrong says it already.
QString legalText(const PageContext& with, const LegalValues& legal) {
    const auto say = [&](const Caption& caption, const std::vector<std::string>& words = {}) {
        return withWords(with, caption, words);
    };
    const std::string lowest = shortestDecimal(legal.lowest);
    const std::string highest = shortestDecimal(legal.highest);
    switch (legal.kind) {
        case ValueKind::Word:
            return QString::fromStdString(alternatives(with, legal.words));
        case ValueKind::Whole:
            return say({1226, "%1 bis %2"}, {lowest, highest});
        case ValueKind::Number:
            return say({1227, "%1 bis %2 %3, mit Dezimalpunkt"}, {lowest, highest, unitText(with, legal.unit)});
        case ValueKind::Frequencies:
            return say({1229, R"("N," oder "+,", dann Frequenzen in MHz mit Komma dazwischen: N,98.5,87.6,107.9)"});
        case ValueKind::PlainList:
            return say({1230, "Frequenzen in MHz mit Komma dazwischen: 98.5,87.6,107.9"});
        case ValueKind::Groups:
            return say({1231, "Gruppen 0A bis 15B mit Komma dazwischen, höchstens %1: 0A,0A,2A"},
                       {std::to_string(kMostGroups)});
        case ValueKind::Message:
            return say({1232, "zwei Ziffern, ein Komma und zehn hexadezimale Ziffern: 02,0B90E400CC"});
        case ValueKind::TrafficMessage:
            return say({1233, "zwei Ziffern, ein Komma, 0 oder 1 und neun hexadezimale Ziffern: 02,0B90E400CC"});
        case ValueKind::Ignored:
        case ValueKind::Text:
        case ValueKind::Identifier:
        case ValueKind::Clock:
            break;
    }
    return {};
}

/// That the key cannot have the value, why, and what is legal.
QString valueText(const PageContext& with, const std::string& key, const std::string& utf8, const LegalValues& legal) {
    QString text = withWords(with, kWrongValue, {key, utf8});
    const QString why = whyRefused(with, key.c_str(), QString::fromStdString(utf8));
    const QString values = legalText(with, legal);
    if (!why.isEmpty()) text += QLatin1Char(' ') + why;
    if (!values.isEmpty()) text += QLatin1Char(' ') + withWords(with, {1234, "Erlaubt: %1."}, {values.toStdString()});
    return text;
}

}  // namespace

QString mistakeText(const PageContext& with, const scenario::Problem& problem) {
    if (problem.mistake == Mistake::Value) {
        const KeyFacts* const facts = factsOf(problem.words.at(0));
        return valueText(with, problem.words.at(0), problem.words.at(1),
                         facts == nullptr ? LegalValues() : facts->legal);
    }
    auto words = problem.words;
    if (!words.empty() && words.front() == scenario::kPointName)
        words.front() = captionText(with.captions, {1238, "ein Wert von points"}).toStdString();
    const auto* const wording = std::find_if(kWordings.begin(), kWordings.end(),
                                             [&](const Wording& one) { return one.mistake == problem.mistake; });
    return wording == kWordings.end() ? QString() : withWords(with, wording->caption, words);
}

QString mistakeText(const PageContext& with, const WrongSetting& wrong) {
    const std::string entry = std::string(wrong.place.key) + "=" + toUtf8(wrong.stored);
    return valueText(with, wrong.key, toUtf8(wrong.stored), wrong.legal) + QLatin1Char(' ') +
           withWords(with, {1235, "Es steht in %1, [%2] %3."}, {wrong.file, wrong.place.section, entry});
}

}  // namespace kdx
