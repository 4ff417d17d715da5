#include "window/toolkittexts.h"

#include <map>
#include <string_view>

#include "settings/captions.h"
#include "ui/text.h"

namespace kdx {

namespace {

/// The toolkit's texts, and which caption each becomes.
const std::map<std::string_view, int>& captionNumbers() {
    static const std::map<std::string_view, int> known{
        // keys
        {"Ctrl", 1257},
        {"Shift", 1258},
        // the menu of a text
        {"&Undo", 1260},
        {"&Redo", 1261},
        {"Cu&t", 1262},
        {"&Copy", 1263},
        {"Copy &Link Location", 1264},
        {"&Paste", 1265},
        {"Delete", 1266},
        {"Select All", 1267},
        {"&Select All", 1267},
        // the menu of a number
        {"&Step up", 1268},
        {"Step &down", 1269},
        // the menu of a scroll bar
        {"Scroll here", 1270},
        {"Left edge", 1271},
        {"Right edge", 1272},
        {"Top", 1273},
        {"Bottom", 1274},
        {"Page left", 1275},
        {"Page right", 1276},
        {"Page up", 1277},
        {"Page down", 1278},
        {"Scroll left", 1279},
        {"Scroll right", 1280},
        {"Scroll up", 1281},
        {"Scroll down", 1282},
        // the box for a file
        {"Back", 1283},
        {"Go back", 1283},
        {"Forward", 1284},
        {"Go forward", 1284},
        {"Parent Directory", 1285},
        {"Go to the parent directory", 1285},
        {"Create New Folder", 1286},
        {"Create a New Folder", 1286},
        {"&New Folder", 1287},
        {"New Folder", 1288},
        {"List View", 1289},
        {"Change to list view mode", 1289},
        {"Detail View", 1290},
        {"Change to detail view mode", 1290},
        {"Sidebar", 1291},
        {"List of places and bookmarks", 1291},
        {"Files", 1292},
        {"Name", 1293},
        {"Size", 1294},
        {"Type", 1295},
        {"Date Modified", 1296},
        {"Computer", 1297},
        {"Recent Places", 1312},
        {"Drive", 1298},
        {"Folder", 1299},
        {"Unknown", 1300},
        {"&Rename", 1301},
        {"&Delete", 1302},
        {"Show &hidden files", 1303},
        {"Show ", 1304},
        {"Remove", 1305},
        {"%1\nFile not found.\nPlease verify the correct file name was given.", 1306},
        {"%1\nDirectory not found.\nPlease verify the correct directory name was given.", 1307},
        {"Are you sure you want to delete '%1'?", 1308},
        {"'%1' is write protected.\nDo you want to delete it anyway?", 1309},
        {"Could not delete directory.", 1310},
        {"&Open", 1311},
        {"&Save", 789},
        {"&Yes", 315},
        {"&No", 316},
        {"OK", 317},
        {"Cancel", 318},
    };
    return known;
}

}  // namespace

QString ToolkitTexts::translate(const char* /*context*/, const char* text, const char* /*hint*/, int /*count*/) const {
    if (text == nullptr) return {};
    const auto found = captionNumbers().find(text);
    if (found == captionNumbers().end()) return {};
    const QString caption = toText(m_captions.text(found->second));
    if (caption.isEmpty()) return {};
    // What is shown follows; an INI file keeps no blank at an end.
    return found->first == "Show " ? caption + QLatin1Char(' ') : caption;
}

}  // namespace kdx
