#include "window/toolkittexts.h"

#include <map>
#include <string_view>

#include "ui/caption.h"

namespace kdx {

namespace {

const std::map<std::string_view, Caption>& texts() {
    static const std::map<std::string_view, Caption> known{
        // keys
        {"Ctrl", {1257, "Strg"}},
        {"Shift", {1258, "Umschalt"}},
        // the menu of a text
        {"&Undo", {1260, "&Rückgängig"}},
        {"&Redo", {1261, "&Wiederholen"}},
        {"Cu&t", {1262, "&Ausschneiden"}},
        {"&Copy", {1263, "&Kopieren"}},
        {"Copy &Link Location", {1264, "A&dresse kopieren"}},
        {"&Paste", {1265, "&Einfügen"}},
        {"Delete", {1266, "Löschen"}},
        {"Select All", {1267, "Al&les auswählen"}},
        {"&Select All", {1267, "Al&les auswählen"}},
        // the menu of a number
        {"&Step up", {1268, "Schritt nach &oben"}},
        {"Step &down", {1269, "Schritt nach &unten"}},
        // the menu of a scroll bar
        {"Scroll here", {1270, "Hierher rollen"}},
        {"Left edge", {1271, "Ganz nach links"}},
        {"Right edge", {1272, "Ganz nach rechts"}},
        {"Top", {1273, "Ganz nach oben"}},
        {"Bottom", {1274, "Ganz nach unten"}},
        {"Page left", {1275, "Seite nach links"}},
        {"Page right", {1276, "Seite nach rechts"}},
        {"Page up", {1277, "Seite nach oben"}},
        {"Page down", {1278, "Seite nach unten"}},
        {"Scroll left", {1279, "Nach links rollen"}},
        {"Scroll right", {1280, "Nach rechts rollen"}},
        {"Scroll up", {1281, "Nach oben rollen"}},
        {"Scroll down", {1282, "Nach unten rollen"}},
        {"Scroll Left", {1279, "Nach links rollen"}},
        {"Scroll Right", {1280, "Nach rechts rollen"}},
        // the box for a file
        {"Back", {1283, "Zurück"}},
        {"Go back", {1283, "Zurück"}},
        {"Forward", {1284, "Vor"}},
        {"Go forward", {1284, "Vor"}},
        {"Parent Directory", {1285, "Ordner darüber"}},
        {"Go to the parent directory", {1285, "Ordner darüber"}},
        {"Create New Folder", {1286, "Ordner anlegen"}},
        {"Create a New Folder", {1286, "Ordner anlegen"}},
        {"&New Folder", {1287, "Ordner an&legen"}},
        {"New Folder", {1288, "Neuer Ordner"}},
        {"List View", {1289, "Nur die Namen"}},
        {"Change to list view mode", {1289, "Nur die Namen"}},
        {"Detail View", {1290, "Mit Größe und Zeit"}},
        {"Change to detail view mode", {1290, "Mit Größe und Zeit"}},
        {"Sidebar", {1291, "Orte"}},
        {"List of places and bookmarks", {1291, "Orte"}},
        {"Files", {1292, "Dateien"}},
        {"Name", {1293, "Name"}},
        {"Size", {1294, "Größe"}},
        {"Type", {1295, "Art"}},
        {"Date Modified", {1296, "Geändert"}},
        {"Computer", {1297, "Computer"}},
        {"Drive", {1298, "Laufwerk"}},
        {"Folder", {1299, "Ordner"}},
        {"Unknown", {1300, "Unbekannt"}},
        {"&Rename", {1301, "&Umbenennen"}},
        {"&Delete", {1302, "&Löschen"}},
        {"Show &hidden files", {1303, "&Verborgene Dateien zeigen"}},
        {"Show ", {1304, "Zeigen:", QStringLiteral(" ")}},
        {"Remove", {1305, "Entfernen"}},
        {"%1\nFile not found.\nPlease verify the correct file name was given.", {1306, "Die Datei %1 gibt es nicht."}},
        {"%1\nDirectory not found.\nPlease verify the correct directory name was given.",
         {1307, "Den Ordner %1 gibt es nicht."}},
        {"Are you sure you want to delete '%1'?", {1308, "%1 löschen?"}},
        {"'%1' is write protected.\nDo you want to delete it anyway?",
         {1309, "%1 ist gegen Schreiben geschützt. Trotzdem löschen?"}},
        {"Could not delete directory.", {1310, "Der Ordner kann nicht gelöscht werden."}},
        {"&Open", {1311, "Ö&ffnen"}},
        {"&Save", {789, "&Sichern"}},
        {"&Yes", {315, "&Ja"}},
        {"&No", {316, "&Nein"}},
        {"OK", {317, "OK"}},
        {"Cancel", {318, "Abbrechen"}},
    };
    return known;
}

}  // namespace

QString ToolkitTexts::translate(const char* /*context*/, const char* text, const char* /*hint*/, int /*count*/) const {
    if (text == nullptr) return {};
    const auto found = texts().find(text);
    return found == texts().end() ? QString() : captionText(m_captions, found->second);
}

}  // namespace kdx
