#include "onair/warningtexts.h"

#include <QRegularExpression>

#include <algorithm>

#include "settings/programstate.h"
#include "ui/caption.h"

namespace kdx {

namespace {

/// The texts as the transmission words them, %1 and %2 for what varies.
struct WarningRow {
    const char* warning;
    Caption caption;
};
const WarningRow kWarnings[] = {
    {"EON is set but 14A has no slot", {800, "EON ist gesetzt, aber 14A hat keinen Platz in der Folge"}},
    {"8A without 3A", {801, "8A ohne 3A"}},
    {"a traffic message is set but 8A has no slot",
     {802, "Eine Verkehrsmeldung ist gesetzt, aber 8A hat keinen Platz in der Folge"}},
    {"PS is never sent: neither 0A nor 0B has a slot", {803, "PS wird nie gesendet: weder 0A noch 0B in der Folge"}},
    {"PS takes %1: more than 1 s is noticed", {804, "PS braucht %1: mehr als 1 s fällt auf"}},
    {"AF lists are set but 0A has no slot", {805, "AF-Listen sind gesetzt, aber 0A hat keinen Platz in der Folge"}},
    {"radiotext is set but neither 2A nor 2B has a slot",
     {806, "Radiotext ist gesetzt, aber weder 2A noch 2B hat einen Platz in der Folge"}},
    {"2B in the sequence with a radiotext above 32 characters",
     {807, "2B in der Folge bei einem Radiotext von mehr als 32 Zeichen"}},
    {"2A and 2B in one sequence: their segments have different lengths",
     {808, "2A und 2B in einer Folge: ihre Segmente sind verschieden lang"}},
    {"2A and 2B in one sequence: neither ever sends the whole radiotext",
     {809, "2A und 2B in einer Folge: keine sendet je den ganzen Radiotext"}},
    {"EON takes %1: all networks should come within 2 minutes",
     {810, "EON braucht %1: alle Netze sollten in 2 Minuten kommen"}},
    {"4A in the sequence: the clock comes at the full minute, the slot sends 0A",
     {811, "4A in der Folge: die Uhr kommt zur vollen Minute, der Platz sendet 0A"}},
    {"%1 in the sequence has nothing to send: the slot sends 0A",
     {812, "%1 in der Folge hat nichts zu senden: der Platz sendet 0A"}},
    {"a test pattern goes out instead of groups", {813, "Statt Gruppen geht ein Testmuster hinaus"}},
    {"RDS is off: no groups go out", {814, "RDS ist aus: es gehen keine Gruppen hinaus"}},
    {"the stereo coder is off: no multiplex goes out", {815, "Der Stereocoder ist aus: es geht kein Multiplex hinaus"}},
    {"pilot, RDS and ARI take %1 of %2: nothing is left for the audio",
     {816, "Pilot, RDS und ARI brauchen %1 von %2: für den Ton bleibt nichts"}},
    {"the multiplex peaks at %1: 75 kHz is the most", {817, "Der Spitzenhub ist %1: höchstens 75 kHz sind erlaubt"}},
    {"the pilot has %1: radios await 6.00 to 7.50 kHz", {818, "Der Pilot hat %1: Radios erwarten 6.00 bis 7.50 kHz"}},
    {"RDS has %1: radios await 1.00 kHz at least", {819, "RDS hat %1: Radios erwarten mindestens 1.00 kHz"}},
    {"refused: %1", {820, "Nicht angenommen: %1"}},
    {"%1: %2 has no place in the RDS character set and is sent as a blank",
     {821, "%1: %2 hat keinen Platz im RDS-Zeichensatz und geht als Leerzeichen hinaus"}},
    {"%1: the tuned frequency %2 MHz has no code, so the list is left out",
     {822, "%1: die Senderfrequenz %2 MHz hat keinen Code, deshalb entfällt die Liste"}},
    {"%1: %2 MHz has no code and is left out", {823, "%1: %2 MHz hat keinen Code und entfällt"}},
    {"further warnings are left out", {824, "Weitere Warnungen entfallen"}},
};

/// What the transmission calls the settings that it warns of.
const WarningRow kNames[] = {
    {"AF list", {826, "AF-Liste"}}, {"AF method A", {827, "AF-Methode A"}}, {"radiotext:", {828, "Radiotext:"}}};

/// What stands for %1 and %2 when the warning is this one.
std::optional<QStringList> partsOf(const QString& warning, const char* form) {
    QString pattern = QRegularExpression::escape(QString::fromLatin1(form));
    pattern.replace(QRegularExpression(QStringLiteral("\\\\%\\d")), QStringLiteral("(.+)"));
    const auto match = QRegularExpression(QRegularExpression::anchoredPattern(pattern)).match(warning);
    if (!match.hasMatch()) return std::nullopt;
    return match.capturedTexts().mid(1);
}

/// A traffic message is refused as long as nobody chose its T field: its code begins with a "-".
bool isOfUnchosenFields(const QString& warning) {
    return warning.startsWith(QLatin1String("refused: ")) && warning.contains(QLatin1String("\"8A=02,-"));
}

QString inWords(const QString& text, const Captions& captions) {
    for (const WarningRow& row : kWarnings) {
        const auto parts = partsOf(text, row.warning);
        if (!parts) continue;
        QString shown = captionText(captions, row.caption);
        if (parts->size() == 1) shown = shown.arg(parts->at(0));
        if (parts->size() == 2) shown = shown.arg(parts->at(0), parts->at(1));
        for (const WarningRow& name : kNames)
            shown.replace(QLatin1String(name.warning), captionText(captions, name.caption));
        return shown;
    }
    return text;
}

}  // namespace

QString warningText(const std::string& warning, const Captions& captions, const ProgramState& state) {
    const QString text = QString::fromStdString(warning);
    const QString shown = inWords(text, captions);
    return isOfUnchosenFields(text) ? withRemedy(shown, &Corrections::trafficFields, captions, state) : shown;
}

QString refusalText(std::string_view entry, const QString& shown, const Captions& captions, const ProgramState& state) {
    const QString why = captionText(captions, {791, "Der Coder nimmt %1 nicht an"}).arg(shown);
    const bool isQuoted = entry.find('"') != std::string_view::npos;
    return isQuoted ? withRemedy(why, &Corrections::quotes, captions, state) : why;
}

QString withRemedy(const QString& why, bool Corrections::*correction, const Captions& captions,
                   const ProgramState& state) {
    if (state.corrections.*correction) return why;
    const auto* const key = std::ranges::find(kCorrectionKeys, correction, &CorrectionKey::isOn);
    return why + QStringLiteral(". ") +
           captionText(captions, {825, "Die Berichtigung %1 behebt das"}).arg(QLatin1String(key->key));
}

}  // namespace kdx
