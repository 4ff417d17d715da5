#include "window/failurehint.h"

#include <algorithm>
#include <array>

#include "ui/caption.h"

namespace kdx {

namespace {

struct Hint {
    VisaStatus status;
    Caption caption;
};

const std::array kHints = {
    Hint{visa::kTimeout,
         {840, "Keine Antwort innerhalb von %1 s: Ist das Gerät eingeschaltet und stimmt die Adresse?"}},
    Hint{visa::kConnectionLost, {841, "Die Verbindung ist abgerissen: Kabel prüfen, dann \"Local\" und neu öffnen."}},
    Hint{visa::kResourceNotFound,
         {842, "Unter der Adresse antwortet niemand: Ist das Gerät eingeschaltet, am Netz und stimmt die Adresse?"}},
    Hint{visa::kInvalidResourceName, {843, "Die Adresse lässt sich nicht lesen: bitte ändern."}},
    Hint{visa::kResourceLocked,
         {844, "Ein anderes Programm hält das Gerät belegt: dort freigeben, dann noch einmal versuchen."}},
    Hint{visa::kAborted, {845, "Der Vorgang wurde abgebrochen: bei Bedarf noch einmal senden."}},
    Hint{visa::kInvalidObject, {846, "Es ist keine Verbindung offen: \"Local\" und neu öffnen."}},
    Hint{visa::kLibraryNotFound,
         {847, "Für diese Schnittstelle fehlt die VISA-Bibliothek: installieren oder TCPIP wählen."}},
};
const Caption kOther{839, "Die Übertragung ist fehlgeschlagen: Verbindung prüfen und noch einmal versuchen."};

}  // namespace

QString failureHint(VisaStatus status, std::chrono::milliseconds answerTime, const Captions& captions,
                    const QLocale& locale) {
    const auto* const known =
        std::find_if(kHints.begin(), kHints.end(), [status](const Hint& hint) { return hint.status == status; });
    QString text = captionText(captions, known == kHints.end() ? kOther : known->caption);
    if (status != visa::kTimeout) return text;
    return text.arg(locale.toString(static_cast<double>(answerTime.count()) / 1000, 'g', 3));
}

}  // namespace kdx
