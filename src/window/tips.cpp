#include "window/tips.h"

#include <QHash>
#include <QLatin1String>
#include <QWidget>

#include <array>

#include "ui/caption.h"
#include "ui/valuestate.h"

namespace kdx {

namespace {

/// @param name of a control, or what the names of like controls begin with before their numbers.
struct Tip {
    const char* name;
    Caption caption;
};

const std::array kTips = {
    Tip{"PS_T", {1000, "Programmname: was ein Radio anzeigt, höchstens 8 Zeichen"}},
    Tip{"PS_Taste", {1001, "Sendet und speichert den PS; Return im Feld tut dasselbe"}},
    Tip{"PI_T", {1002, "Programmkennung: 4 Hexadezimalziffern, zuerst Land und Bereich"}},
    Tip{"Command3", {1003, "Sendet und speichert die PI; Return im Feld tut dasselbe"}},
    Tip{"PTY_Combo1", {1004, "Programmart 0 bis 31; die Wahl wird sofort gesendet"}},
    Tip{"Taste_PS_Auto", {1005, "Wechselt den PS im Takt; der Abstand steht in den Einstellungen"}},
    Tip{"Check1", {1006, "TP: Der Sender bringt Verkehrsfunk"}},
    Tip{"TA_Check", {1007, "TA: Jetzt läuft eine Durchsage; Radios schalten um. Nur mit TP"}},
    Tip{"TA_EON_Hilfe", {1008, "Wann sich EON TA geben lässt"}},
    Tip{"TA_HScroll", {1009, "Dauer der Durchsage in Sekunden, höchstens so lang wie die Wiederholung"}},
    Tip{"TA_Rep_HScroll", {1010, "Abstand von einer Durchsage zur nächsten in Sekunden"}},
    Tip{"MS_opt", {1011, "Ob Musik oder Sprache läuft: Radios stellen danach Klang und Lautstärke"}},
    Tip{"Zeit_Taste", {1012, "Sendet die Uhrzeit des Rechners alle 20 Sekunden"}},
    Tip{"Uhr_Zeit", {1013, "Die Uhrzeit, die zuletzt gesendet wurde"}},
    Tip{"DI_Opt_2", {1014, "DI 2: Kunstkopf ohne Stereo; hat keinen Namen (NN)"}},
    Tip{"DI_Opt", {1015, "DI ist die Summe aus 1 Stereo, 2 Kunstkopf, 4 komprimiert, 8 dynamische PTY"}},
    Tip{"RT_Text1", {1016, "Radiotext, höchstens 64 Zeichen"}},
    Tip{"RT_Taste1", {1017, "Sendet und speichert den Radiotext; Return im Feld tut dasselbe"}},
    Tip{"RT_clear1", {1018, "Leert das Feld und sendet einen leeren Radiotext"}},
    Tip{"FM_Source_Opt",
        {1019, "Woher der Ton kommt: keiner, analoge Buchsen, digitaler Eingang, eingebauter Generator"}},
    Tip{"FM_Imp_Opt", {1020, "Eingangswiderstand der analogen Buchsen"}},
    Tip{"Pre_opt", {1021, "Höhenanhebung: 50 µs in Europa, 75 µs in Amerika"}},
    Tip{"Stereo_Opt", {1022, "Welche Kanäle Ton führen und mit welcher Phase"}},
    Tip{"ARI_Mode_Opt", {1023, "ARI: DK ist die Durchsagekennung (125 Hz), BK die Bereichskennung"}},
    Tip{"BK_Opt", {1024, "BK: der Verkehrsfunkbereich A bis F"}},
    Tip{"TestDat_Opt", {1025, "Bitfolge, die im Testmodus statt der Gruppen hinausgeht"}},
    Tip{"GTL_Taste", {1026, "Schließt die Verbindung; was eingestellt ist, bleibt auf Sendung"}},
    Tip{"AFList_Opt", {1027, "Zeigt diese Liste: zuerst die eigene Frequenz, dann die anderen"}},
    Tip{"AF_Bearbeiten", {1028, "Öffnet die Listen zum Ändern"}},
    Tip{"AF_List1", {1029, "Andere Frequenzen, auf denen dasselbe Programm läuft"}},
    Tip{"AFMethod_opt_0", {1030, "Methode A: eine Liste für alle Sender, höchstens 25 Frequenzen"}},
    Tip{"AFMethod_opt_1", {1031, "Methode B: Paare mit der eigenen Frequenz, höchstens 12"}},
    Tip{"Taste_AF_Senden", {1032, "Sendet alle Listen mit der gewählten Methode"}},
    Tip{"Gruppe", {1033, "Hängt diese Gruppe an die Folge an"}},
    Tip{"newList", {1034, "Beginnt eine neue Folge"}},
    Tip{"GS_Senden", {1035, "Sendet und speichert die Folge"}},
    Tip{"EON_PI_Text", {1036, "PI des anderen Programms: 4 Hexadezimalziffern"}},
    Tip{"EON_PI_Taste", {1037, "Nimmt das erste andere Programm heraus und sendet diese PI"}},
    Tip{"EON_PS_Text", {1038, "Name des anderen Programms, höchstens 8 Zeichen"}},
    Tip{"EON_PS_Taste", {1039, "Sendet und speichert den Namen"}},
    Tip{"EON_PTY_Combo", {1040, "Art des anderen Programms; die Wahl wird sofort gesendet"}},
    Tip{"EON_AFB_Opt", {1041, "Zeigt diese Liste des anderen Programms"}},
    Tip{"EON_AF_Bearbeiten", {1042, "Öffnet die Listen des anderen Programms zum Ändern"}},
    Tip{"AFB_Liste", {1043, "Frequenzen des anderen Programms"}},
    Tip{"EON_AFB_Senden", {1044, "Sendet alle Listen des anderen Programms"}},
    Tip{"Command", {1045, "Fragt das Gerät nach diesem Wert"}},
    Tip{"gelesen", {1046, "Was das Gerät geantwortet hat"}},
    Tip{"Store_Taste", {1047, "Speichert, was der Coder jetzt sendet, in diesem Speicher des Geräts"}},
    Tip{"TMC_Event_Combo", {1048, "Ereignis aus Event.txt; die Nummer davor geht in die Meldung"}},
    Tip{"TMC_Loc_Combo", {1049, "Ort aus Location.txt; gilt in der Ortstabelle (LTN) der Gruppe 3A"}},
    Tip{"Tmc_richtung", {1050, "Richtung, in die sich die Störung vom Ort aus erstreckt"}},
    Tip{"TMC_Var_Combo", {1051, "Über wie viele Orte sich die Störung erstreckt, 0 bis 7"}},
    Tip{"TMC_DP1_Check", {1052, "DP: voraussichtliche Dauer, 0 bis 7 (drei Bits)"}},
    Tip{"TMC_DP2_Check", {1052, "DP: voraussichtliche Dauer, 0 bis 7 (drei Bits)"}},
    Tip{"TMC_DP3Check", {1052, "DP: voraussichtliche Dauer, 0 bis 7 (drei Bits)"}},
    Tip{"DurationCombo", {1052, "DP: voraussichtliche Dauer, 0 bis 7 (drei Bits)"}},
    Tip{"TMC_Div", {1053, "Umleitung empfohlen"}},
    Tip{"TMC_F_Check", {1054, "F: 1 Meldung in einer Gruppe, 0 in mehreren"}},
    Tip{"TMC_T_Check", {1055, "T: 0 Meldung, 1 Angaben über den Dienst"}},
    Tip{"TMC_Gr8_Label", {1056, "Die Meldung als Code der Gruppe 8A"}},
    Tip{"TMC_Event_Combo_Suche", {996, "Suchen: Teil des Wortes oder Code"}},
    Tip{"TMC_Loc_Combo_Suche", {996, "Suchen: Teil des Wortes oder Code"}},
    Tip{"Gruppe_Zurueck", {1068, "Nimmt die letzte Gruppe aus der Folge"}},
    Tip{"TMC_List", {1057, "Meldungen, die gesendet werden; eine wird gewählt"}},
    Tip{"TMC_Gr8_apply", {1058, "Hängt die Meldung an die Liste an"}},
    Tip{"TMC_Gr8_Remove", {1059, "Nimmt die gewählte Meldung aus der Liste"}},
    Tip{"optSingleMessage", {1060, "Sendet die gewählte Meldung einmal"}},
    Tip{"optMultiMessage", {1061, "Sendet alle Meldungen reihum, bis gestoppt wird"}},
    Tip{"txtCycleTime", {1062, "Abstand der Meldungen in Sekunden, bis 65.535; 0 sendet nicht"}},
    Tip{"TMC_Senden_Taste", {1063, "Sendet abwechselnd Gruppe 3A mit Ortstabelle (LTN) und Meldungen in 8A"}},
    Tip{"Stop_Timer", {1064, "Hört auf, Meldungen zu senden"}},
    Tip{"INIT_Taste", {1065, "Öffnet die Verbindung und sendet den ganzen Datensatz"}},
    Tip{"Ende_Taste", {1066, "Beendet das Programm"}},
    Tip{"Adr1_Label", {1067, "Adresse des Geräts; ein Klick ändert sie"}},
};

using TipsByName = QHash<QLatin1String, const Tip*>;

TipsByName tipsByName() {
    TipsByName byName;
    byName.reserve(static_cast<int>(kTips.size()));
    for (const Tip& tip : kTips) byName.insert(QLatin1String(tip.name), &tip);
    return byName;
}

/// The most exact one: like controls differ in the number at the end.
const Tip* tipOf(const QString& name) {
    static const TipsByName kByName = tipsByName();
    const QByteArray latin = name.toLatin1();
    qsizetype length = latin.size();
    while (length > 0) {
        if (const Tip* tip = kByName.value(QLatin1String(latin.data(), length))) return tip;
        const char last = latin[--length];
        if (last != '_' && (last < '0' || last > '9')) return nullptr;
    }
    return nullptr;
}

}  // namespace

void Tips::show(const QWidget& window, const Captions& captions) {
    for (QWidget* control : window.findChildren<QWidget*>()) {
        const Tip* tip = tipOf(control->objectName());
        if (tip == nullptr) continue;
        QString& shown = m_shown[control];
        if (const QString own = ownTip(*control); !own.isEmpty() && own != shown) continue;
        shown = captionText(captions, tip->caption);
        setOwnTip(*control, shown);
    }
}

}  // namespace kdx
